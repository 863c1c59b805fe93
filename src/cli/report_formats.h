// Findings in the formats that code hosts, test reports and editors read.
#pragma once

#include <span>

#include "cli/finding_report.h"

namespace tessal::cli {

/// Workflow commands, one a line, which a code host shows beside the changed lines.
void PrintWorkflowCommands(std::span<const FileReport> files);

/// A code quality report: a list of issues as JSON, each with a fingerprint that stays the same as long as
/// the file's path, the code, the symbol and the text do.
void PrintCodeQuality(std::span<const FileReport> files);

/// A suite for each file and a case for each finding. What is no fault of the file is a case that passes, and
/// so is one for a file without a finding.
void PrintJunit(std::span<const FileReport> files);

/// Lines as compilers print them: "file:line:column: warning: text [code]".
void PrintCompilerLines(std::span<const FileReport> files);

/// A number of 64 bits for a text (FNV-1a, Fowler, Noll and Vo), as hexadecimal digits: the same on every
/// machine.
std::string FingerprintOf(std::string_view text);

}  // namespace tessal::cli
