// The version number that the build stamps into files: a release and thousandths of a revision.
#pragma once

#include <string_view>

namespace tessal {

/// Makes a version from a branch stamp ("$Branch: Rel2026"), a revision stamp ("$Revision: 1") and, where
/// the branch stamp has no release, the build date ("Nov 24 2026"): the release, or the year plus 100, or 0,
/// plus the revision times 0.001; a revision that cannot be read counts as 1.
double VersionFromStamps(std::string_view branchStamp, std::string_view revisionStamp,
                         std::string_view buildDate);

/// The version of this build, and that of its expression parser.
double SoftwareVersion();
double ParserVersion();

/// A version rounded to three decimals, as files hold it.
double RoundVersion(double version);

}  // namespace tessal
