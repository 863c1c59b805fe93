#include "expr/user_function_names.h"

#include <iterator>
#include <map>
#include <unordered_map>

namespace tessal {

namespace {

/// The list, and the place of each name in it: every symbol of every check is looked up here.
struct Names {
  std::list<std::string> list;
  std::unordered_map<std::string_view, std::list<std::string>::iterator> places;
  std::uint32_t version = 1;
  std::map<std::string, int> claims;  ///< how many declarations claim a name
};

Names& TheNames() {
  static Names names;
  return names;
}

}  // namespace

const std::list<std::string>& UserFunctionNames() {
  return TheNames().list;
}

bool RegisterUserFunctionName(std::string_view name) {
  if (IsUserFunctionName(name)) return false;
  Names& names = TheNames();
  ++names.version;
  names.list.emplace_back(name);
  names.places.emplace(names.list.back(), std::prev(names.list.end()));
  return true;
}

void UnregisterUserFunctionName(std::string_view name) {
  Names& names = TheNames();
  const auto hit = names.places.find(name);
  if (hit == names.places.end()) return;
  ++names.version;
  const auto place = hit->second;
  names.places.erase(hit);
  names.list.erase(place);
}

bool IsUserFunctionName(std::string_view name) {
  return TheNames().places.contains(name);
}

std::uint32_t UserFunctionNamesVersion() {
  return TheNames().version;
}

void ResetUserFunctionNames() {
  ++TheNames().version;
  TheNames().places.clear();
  TheNames().list.clear();
  TheNames().claims.clear();
}

void UserFunctionClaim::Claim(std::string_view name) {
  if (holds && claimed == name) return;
  Release();
  claimed = name;
  holds = true;
  ++TheNames().claims[claimed];
  RegisterUserFunctionName(claimed);
}

void UserFunctionClaim::Release() {
  if (!holds) return;
  holds = false;
  const auto count = TheNames().claims.find(claimed);
  if (count == TheNames().claims.end() || --count->second > 0) return;
  TheNames().claims.erase(count);
  UnregisterUserFunctionName(claimed);
}

}  // namespace tessal
