#include "cli/file_lines.h"

#include <algorithm>
#include <functional>

#include "platform/text_encoding.h"

namespace tessal::cli {

FileLines::FileLines(std::string_view fileText) : text(fileText), isUtf8(IsUtf8(fileText)), starts{0} {
  for (std::size_t end = 0; (end = text.find('\n', end)) != std::string_view::npos;) starts.push_back(++end);
}

FilePlace FileLines::PlaceOf(std::string_view part) const {
  const std::less<> isBefore;
  if (part.data() == nullptr || isBefore(part.data(), text.data()) ||
      isBefore(text.data() + text.size(), part.data() + part.size())) {
    return {};
  }
  const auto start = static_cast<std::size_t>(part.data() - text.data());
  const auto after = std::upper_bound(starts.begin(), starts.end(), start);
  FilePlace place;
  place.line = static_cast<int>(after - starts.begin());
  place.column = ColumnOf(*(after - 1), start);
  const std::size_t end = start + part.size();
  if (!part.empty() && (after == starts.end() || end < *after)) {
    place.endColumn = ColumnOf(*(after - 1), end);
  }
  return place;
}

int FileLines::ColumnOf(std::size_t lineStart, std::size_t place) const {
  const std::string_view before = text.substr(lineStart, place - lineStart);
  const auto continuesCharacter = [this](char byte) {
    constexpr unsigned kMask = 0xC0;
    constexpr unsigned kContinuation = 0x80;
    return isUtf8 && (static_cast<unsigned char>(byte) & kMask) == kContinuation;
  };
  const auto continuing = std::count_if(before.begin(), before.end(), continuesCharacter);
  return static_cast<int>(static_cast<std::ptrdiff_t>(before.size()) - continuing) + 1;
}

}  // namespace tessal::cli
