#include "cli/lsp/text_positions.h"

#include <algorithm>

#include "platform/utf8_bytes.h"

namespace tessal::cli {

namespace {

constexpr std::size_t kBlock = 256;

/// Whether the byte begins a character that UTF-16 has two units for.
bool BeginsPair(char byte) {
  constexpr unsigned char kFourBytes = 0xF0;
  return static_cast<unsigned char>(byte) >= kFourBytes;
}

}  // namespace

TextPositions::TextPositions(std::string_view positioned, ColumnUnit columnUnit, LineEnds lineEnds)
    : text(positioned), unit(columnUnit), starts{0} {
  const std::string_view ends = lineEnds == LineEnds::AllKinds ? "\r\n" : "\n";
  for (std::size_t end = 0; (end = text.find_first_of(ends, end)) != std::string_view::npos;) {
    const bool isPair = lineEnds == LineEnds::AllKinds && text.substr(end, 2) == "\r\n";
    starts.push_back(end += isPair ? 2 : 1);
  }
  if (unit == ColumnUnit::Bytes) return;
  std::size_t count = 0;
  for (std::size_t start = 0; start <= text.size(); start += kBlock) {
    units.push_back(count);
    count += UnitsIn(text.substr(start, kBlock));
  }
}

TextPosition TextPositions::PositionOf(std::size_t offset) const {
  const auto after = std::upper_bound(starts.begin(), starts.end(), offset);
  const std::size_t start = *(after - 1);
  return {static_cast<std::size_t>(after - starts.begin()) - 1, UnitsBefore(offset) - UnitsBefore(start)};
}

std::size_t TextPositions::OffsetOf(TextPosition position) const {
  if (position.line >= starts.size()) return text.size();
  const std::size_t start = starts[position.line];
  const std::size_t end = EndOfLine(position.line);
  const std::size_t before = UnitsBefore(start);
  std::size_t low = start;
  std::size_t high = end;
  while (low < high) {
    const std::size_t middle = low + (high - low) / 2;
    if (UnitsBefore(middle) - before < position.column) {
      low = middle + 1;
    } else {
      high = middle;
    }
  }
  while (low < end && ContinuesCharacter(text[low])) ++low;
  return low;
}

std::size_t TextPositions::StartOfLine(std::size_t line) const {
  return line < starts.size() ? starts[line] : text.size();
}

std::size_t TextPositions::EndOfLine(std::size_t line) const {
  if (line + 1 >= starts.size()) return text.size();
  std::size_t end = starts[line + 1] - 1;
  if (end > starts[line] && text[end] == '\n' && text[end - 1] == '\r') --end;
  return end;
}

std::size_t TextPositions::UnitsIn(std::string_view bytes) const {
  std::size_t count = 0;
  for (const char byte : bytes) {
    if (!ContinuesCharacter(byte)) ++count;
    if (unit == ColumnUnit::Utf16 && BeginsPair(byte)) ++count;
  }
  return count;
}

std::size_t TextPositions::UnitsBefore(std::size_t offset) const {
  if (unit == ColumnUnit::Bytes) return offset;
  const std::size_t block = offset / kBlock;
  return units[block] + UnitsIn(text.substr(block * kBlock, offset % kBlock));
}

}  // namespace tessal::cli
