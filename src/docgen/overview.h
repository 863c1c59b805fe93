// The overview of a template: every element in one table, as the editor lists it and as a text for reports.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace tessal {

class TemplateCore;

struct OverviewRow {
  std::string number;  ///< from 1; "-" for movements, which do not count
  std::string symbol;
  std::string type;
  std::string expression;  ///< or the default value, or a search function's summary
  std::string description;
  std::uint32_t uid = 0;
};

std::vector<OverviewRow> BuildOverview(const TemplateCore& core);

/// The table as aligned text with its header. Rows end in carriage return and line feed.
std::string OverviewText(const TemplateCore& core);

}  // namespace tessal
