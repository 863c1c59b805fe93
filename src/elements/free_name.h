// Default names of new elements: a prefix and the first number from which nobody else has the name.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace tessal {

inline std::string NumberedName(std::string_view prefix, std::size_t number) {
  return std::string(prefix) + std::to_string(number);
}

/// The first number from `number` up whose name after the prefix is not taken.
template <class IsTaken>
std::size_t FirstFreeNumber(std::string_view prefix, std::size_t number, IsTaken isTaken) {
  while (isTaken(NumberedName(prefix, number))) ++number;
  return number;
}

/// The prefix with that number.
template <class IsTaken>
std::string FirstFreeName(std::string_view prefix, std::size_t number, IsTaken isTaken) {
  return NumberedName(prefix, FirstFreeNumber(prefix, number, isTaken));
}

}  // namespace tessal
