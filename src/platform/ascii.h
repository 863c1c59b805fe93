// Text of the ASCII characters, the same whatever the locale: what words, names and keywords are made of. All
// other bytes are no letters and have no case.
#pragma once

#include <algorithm>
#include <string>
#include <string_view>

namespace tessal {

constexpr bool IsAsciiLetter(char character) {
  return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z');
}

constexpr bool IsAsciiDigit(char character) {
  return character >= '0' && character <= '9';
}

/// A letter, a digit or the underscore.
constexpr bool IsWordCharacter(char character) {
  return IsAsciiLetter(character) || IsAsciiDigit(character) || character == '_';
}

constexpr char UpperCase(char character) {
  return character >= 'a' && character <= 'z' ? static_cast<char>(character - 'a' + 'A') : character;
}

inline std::string UpperCase(std::string_view text) {
  std::string upper(text);
  for (char& character : upper) character = UpperCase(character);
  return upper;
}

inline bool EqualIgnoringCase(std::string_view left, std::string_view right) {
  return std::equal(left.begin(), left.end(), right.begin(), right.end(),
                    [](char one, char other) { return UpperCase(one) == UpperCase(other); });
}

}  // namespace tessal
