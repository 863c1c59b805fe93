#include "expr/user_function_names.h"

#include <algorithm>

namespace tessal {

std::vector<std::string>& UserFunctionNames() {
  static std::vector<std::string> names;
  return names;
}

bool RegisterUserFunctionName(std::string_view name) {
  if (IsUserFunctionName(name)) return false;
  UserFunctionNames().emplace_back(name);
  return true;
}

void UnregisterUserFunctionName(std::string_view name) {
  std::erase(UserFunctionNames(), name);
}

bool IsUserFunctionName(std::string_view name) {
  const auto& names = UserFunctionNames();
  return std::find(names.begin(), names.end(), name) != names.end();
}

}  // namespace tessal
