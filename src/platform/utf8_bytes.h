// Characters of UTF-8 by their bytes.
#pragma once

namespace tessal {

/// Whether the byte goes on with the character of the byte before it.
constexpr bool ContinuesCharacter(char byte) {
  constexpr unsigned kMask = 0xC0;
  constexpr unsigned kContinuation = 0x80;
  return (static_cast<unsigned char>(byte) & kMask) == kContinuation;
}

}  // namespace tessal
