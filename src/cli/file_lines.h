// Places in the text of a file as lines and columns.
#pragma once

#include <cstddef>
#include <string_view>
#include <vector>

#include "cli/file_place.h"

namespace tessal::cli {

/// Each place is found in a time that does not grow with the text, however long its lines are.
class FileLines final {
 public:
  /// The text outlives the lines.
  explicit FileLines(std::string_view fileText);

  /// The place of a part of the text; all 0 for a view that is none.
  FilePlace PlaceOf(std::string_view part) const;

  /// The place of what is in a line, without its margins; all 0 for a line that the text does not have.
  FilePlace PlaceOfLine(int line) const;

  /// The text from the start of a line on, which counts from 1; empty for a line that the text does not have.
  std::string_view From(int line) const;

 private:
  int ColumnOf(std::size_t lineStart, std::size_t place) const;
  /// How many bytes before the place belong to the character of the byte before them.
  std::size_t ContinuationsBefore(std::size_t place) const;

  std::string_view text;
  std::vector<std::size_t> starts;  ///< of the lines
  std::vector<std::size_t>
      continuations;  ///< before each block of the text; none where all bytes are characters
};

}  // namespace tessal::cli
