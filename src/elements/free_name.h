// Default names of new elements: a prefix and the first number from which nobody else has the name.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace tessal {

/// The prefix with the first number from `number` up whose name is not taken.
template <class IsTaken>
std::string FirstFreeName(std::string_view prefix, std::size_t number, IsTaken isTaken) {
  std::string name = std::string(prefix) + std::to_string(number);
  while (isTaken(name)) name = std::string(prefix) + std::to_string(++number);
  return name;
}

}  // namespace tessal
