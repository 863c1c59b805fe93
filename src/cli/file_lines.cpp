#include "cli/file_lines.h"

#include <algorithm>
#include <functional>

#include "platform/text_encoding.h"
#include "platform/utf8_bytes.h"

namespace tessal::cli {

namespace {

constexpr std::size_t kBlock = 256;

std::size_t ContinuationsIn(std::string_view bytes) {
  return static_cast<std::size_t>(std::count_if(bytes.begin(), bytes.end(), ContinuesCharacter));
}

std::string_view WithoutMargins(std::string_view text) {
  constexpr std::string_view kBlanks = " \t\r";
  const std::size_t first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos) return text.substr(text.size());
  return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

}  // namespace

FileLines::FileLines(std::string_view fileText) : text(fileText), starts{0} {
  for (std::size_t end = 0; (end = text.find('\n', end)) != std::string_view::npos;) starts.push_back(++end);
  // In any other encoding a byte is a character.
  if (!IsUtf8(text)) return;
  std::size_t count = 0;
  for (std::size_t start = 0; start <= text.size(); start += kBlock) {
    continuations.push_back(count);
    count += ContinuationsIn(text.substr(start, kBlock));
  }
  if (count == 0) continuations.clear();
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

FilePlace FileLines::PlaceOfLine(int line) const {
  const std::string_view rest = From(line);
  return PlaceOf(WithoutMargins(rest.substr(0, rest.find('\n'))));
}

std::string_view FileLines::From(int line) const {
  const auto number = static_cast<std::size_t>(line);
  return line < 1 || number > starts.size() ? std::string_view() : text.substr(starts[number - 1]);
}

int FileLines::ColumnOf(std::size_t lineStart, std::size_t place) const {
  const std::size_t bytes = place - lineStart;
  return static_cast<int>(bytes + ContinuationsBefore(lineStart) - ContinuationsBefore(place)) + 1;
}

std::size_t FileLines::ContinuationsBefore(std::size_t place) const {
  if (continuations.empty()) return 0;
  const std::size_t block = place / kBlock;
  return continuations[block] + ContinuationsIn(text.substr(block * kBlock, place % kBlock));
}

}  // namespace tessal::cli
