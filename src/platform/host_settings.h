// What the host suite's installation says of itself: where it lies, and where its manuals are served.
#pragma once

#include <string>

namespace tessal {

/// The folder that the suite is installed in; empty when none is known. Taken from TESSAL_INSTALL_ROOT.
std::string InstallRoot();

/// The address of the manuals' server, at most 1024 characters; empty when none is set. Taken from
/// TESSAL_MANUALS_URI.
std::string ManualsAddress();

}  // namespace tessal
