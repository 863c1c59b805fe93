// Messages in the Static Analysis Results Interchange Format, version 2.1.0 (OASIS, 2020), which code hosts
// and continuous integration show beside the file.
#pragma once

#include <vector>

#include "cli/template_messages.h"

namespace tessal::cli {

/// Prints one log over all files, result by result: it may be much longer than the messages.
void PrintSarif(const std::vector<TemplateMessages>& files);

}  // namespace tessal::cli
