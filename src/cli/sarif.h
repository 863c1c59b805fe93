// Messages in the Static Analysis Results Interchange Format, version 2.1.0 (OASIS, 2020), which code hosts
// and continuous integration show beside the file.
#pragma once

#include <string>
#include <vector>

#include "cli/template_messages.h"

namespace tessal::cli {

std::string SarifText(const std::vector<TemplateMessages>& files);

}  // namespace tessal::cli
