// The public names of the plug-in user functions, which expressions may call beside the catalogue. One list
// of the process.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace tessal {

std::vector<std::string>& UserFunctionNames();

/// Adds a name unless it is there; true when it added.
bool RegisterUserFunctionName(std::string_view name);
void UnregisterUserFunctionName(std::string_view name);
bool IsUserFunctionName(std::string_view name);

}  // namespace tessal
