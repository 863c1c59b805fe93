// Messages in the Static Analysis Results Interchange Format, version 2.1.0 (OASIS, 2020), which code hosts
// and continuous integration show beside the file.
#pragma once

#include <span>

#include "cli/finding_report.h"

namespace tessal::cli {

/// Prints one log over all files, result by result: it may be much longer than the messages.
void PrintSarif(std::span<const FileReport> files, const ReportSource& source);

}  // namespace tessal::cli
