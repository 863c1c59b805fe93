// Places in the text of a file as lines and columns.
#pragma once

#include <cstddef>
#include <string_view>
#include <vector>

#include "cli/finding_report.h"

namespace tessal::cli {

class FileLines final {
 public:
  /// The text outlives the lines.
  explicit FileLines(std::string_view fileText);

  /// The place of a part of the text; all 0 for a view that is none.
  FilePlace PlaceOf(std::string_view part) const;

 private:
  int ColumnOf(std::size_t lineStart, std::size_t place) const;

  std::string_view text;
  bool isUtf8;
  std::vector<std::size_t> starts;  ///< of the lines
};

}  // namespace tessal::cli
