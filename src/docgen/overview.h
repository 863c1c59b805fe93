// The overview of a template: every element in one table. The editor shows it as a list, from which a row
// leads to its element; the text of it goes into reports.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "platform/file_replacement.h"
#include "platform/uid.h"

namespace tessal {

class TemplateCore;

inline constexpr std::size_t kOverviewColumnCount = 5;

struct OverviewColumn {
  std::string_view title;      ///< above the column of the list
  std::string_view textTitle;  ///< in the first row of the text
  bool rightAligned;           ///< in the text; otherwise to the left
  bool cleaned;                ///< in the text, without line ends and tabs, and without blanks at its ends
};

inline constexpr std::array<OverviewColumn, kOverviewColumnCount> kOverviewColumns = {{
    {"No.", "No.", true, false},
    {"Symbol", "Symbol", true, false},
    {"Type", "Type", true, false},
    {"Expression", "Expression/ Default value", false, true},
    {"Description", "Description", false, true},
}};

struct OverviewRow {
  /// In the order of the columns. The number counts from 1 and is "-" for movements, which do not count; the
  /// expression is the default value of an input and the summary of a search function.
  std::array<std::string, kOverviewColumnCount> cells;
  Uid uid = Uid::None;  ///< the element that the row describes
};

std::vector<OverviewRow> BuildOverview(const TemplateCore& core);

/// The rows as aligned text, after the template's file name and, above 0, its revision. Rows end in carriage
/// return and line feed. Widths go by the rows alone: a longer title pushes its own row out of line.
std::string OverviewText(const TemplateCore& core, const std::vector<OverviewRow>& rows);

/// The same, handed out row by row: each row is as wide as the longest expression.
void WriteOverviewText(const TemplateCore& core, const std::vector<OverviewRow>& rows, const TextSink& write);

/// Writes that text. False, with the reason in words, when not every byte reached the file, or when the path
/// is that of the template itself, which is then left alone.
bool ExportOverview(const TemplateCore& core, const std::string& path, std::string& failure);

}  // namespace tessal
