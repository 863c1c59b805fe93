// The public names of the plug-in user functions, which expressions may call beside the catalogue. One list
// of the process, in the order of registration, each name once.
#pragma once

#include <cstdint>
#include <list>
#include <string>
#include <string_view>

namespace tessal {

const std::list<std::string>& UserFunctionNames();

/// Adds a name unless it is there; true when it added.
bool RegisterUserFunctionName(std::string_view name);
void UnregisterUserFunctionName(std::string_view name);
bool IsUserFunctionName(std::string_view name);

/// A number for the names as they are now, from 1: whenever it is the same, so are the names.
std::uint32_t UserFunctionNamesVersion();

/// Empties the list, for tests.
void ResetUserFunctionNames();

/// One declaration's claim on a public name. A name stays in the list as long as a declaration claims it, be
/// it another one of the same template or one of another open template.
class UserFunctionClaim final {
 public:
  UserFunctionClaim() = default;
  UserFunctionClaim(const UserFunctionClaim&) = delete;
  UserFunctionClaim& operator=(const UserFunctionClaim&) = delete;
  ~UserFunctionClaim() { Release(); }

  /// Gives the name claimed so far up, and registers this one.
  void Claim(std::string_view name);
  /// Gives the name up.
  void Release();

 private:
  std::string claimed;
  bool holds = false;
};

}  // namespace tessal
