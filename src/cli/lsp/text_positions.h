// Places in a text as lines and columns, in the units that the other side counts in.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

namespace tessal::cli {

/// What a column counts: bytes, code units of UTF-16, or characters.
enum class ColumnUnit : std::uint8_t { Bytes, Utf16, Characters };

/// Which characters end a line: those of the protocol are CRLF, CR and LF.
enum class LineEnds : std::uint8_t { AllKinds, FeedsOnly };

/// Both from 0.
struct TextPosition {
  std::size_t line = 0;
  std::size_t column = 0;
};

/// Finds each place in a time that does not grow with the text, however long its lines are.
class TextPositions final {
 public:
  /// The text is UTF-8 and outlives the positions.
  TextPositions(std::string_view positioned, ColumnUnit columnUnit, LineEnds lineEnds);

  TextPosition PositionOf(std::size_t offset) const;
  /// The offset of a position, of one within a character that after it. A column after the line's last is the
  /// end of the line, and a line after the last is the end of the text.
  std::size_t OffsetOf(TextPosition position) const;
  /// The end of a line, before what ends it.
  std::size_t EndOfLine(std::size_t line) const;
  std::size_t StartOfLine(std::size_t line) const;

 private:
  std::size_t UnitsIn(std::string_view bytes) const;
  std::size_t UnitsBefore(std::size_t offset) const;

  std::string_view text;
  ColumnUnit unit;
  std::vector<std::size_t> starts;  ///< of the lines
  std::vector<std::size_t> units;   ///< before each block of the text; none where units are bytes
};

}  // namespace tessal::cli
