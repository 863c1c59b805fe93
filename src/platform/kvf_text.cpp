#include "platform/kvf_text.h"

#include <algorithm>

#include "platform/ascii.h"

namespace tessal {

namespace {

constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";

}  // namespace

std::string KvfReadableText(std::string_view bytes) {
  bytes = bytes.substr(0, bytes.find('\0'));
  if (bytes.starts_with(kByteOrderMark)) bytes.remove_prefix(kByteOrderMark.size());
  std::string text;
  text.reserve(bytes.size() + static_cast<std::size_t>(std::count(bytes.begin(), bytes.end(), '\n')));
  char previous = '\0';
  for (const char byte : bytes) {
    if (byte == '\n' && previous != '\r') text += '\r';
    text += byte;
    previous = byte;
  }
  return text;
}

std::string KvfWritableText(std::string_view text) {
  std::string written;
  written.reserve(text.size() + static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n')));
  for (const char character : text) {
    if (character == '\r') continue;
    if (character == '\n') written += '\r';
    written += character;
  }
  return written;
}

bool IsKvfName(std::string_view text) {
  return !text.empty() && !IsAsciiDigit(text.front()) &&
         std::all_of(text.begin(), text.end(), IsWordCharacter);
}

}  // namespace tessal
