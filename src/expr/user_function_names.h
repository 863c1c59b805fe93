// The public names of the plug-in user functions, which expressions may call beside the catalogue. One list
// of the process, in the order of registration, each name once.
#pragma once

#include <list>
#include <string>
#include <string_view>

namespace tessal {

const std::list<std::string>& UserFunctionNames();

/// Adds a name unless it is there; true when it added.
bool RegisterUserFunctionName(std::string_view name);
void UnregisterUserFunctionName(std::string_view name);
bool IsUserFunctionName(std::string_view name);

/// Empties the list, for tests.
void ResetUserFunctionNames();

}  // namespace tessal
