#include "docgen/overview.h"

#include <algorithm>
#include <filesystem>
#include <system_error>
#include <utility>

#include "core/template_core.h"
#include "elements/property_io.h"
#include "platform/file_replacement.h"

namespace tessal {

namespace {

/// The name that a search function refers to by number.
std::string NameOfReference(const TemplateCore& core, std::int32_t reference, std::string_view otherwise) {
  if (reference < 1) return std::string(otherwise);
  const CEL_Element* element = core.GetElementBySequence(static_cast<std::uint32_t>(reference));
  return element == nullptr ? "unkown" : element->symbol.TextOf();
}

std::string OwnerName(const TemplateCore& core, std::int32_t considered) {
  if (considered == -1) return "own";
  if (considered < 1) return "any";
  const auto place = static_cast<std::size_t>(considered - 1);
  return place < core.Species().size() ? core.Species()[place]->symbol.TextOf() : "unkown";
}

std::string SearchSummary(const TemplateCore& core, const CEL_Lagrange_Spatial_Function& function) {
  if (function.purpose.Text() == "OILSPILL") return "Oilspill(deprecated)";
  const std::int32_t reference = function.variableId.IntValue();
  std::string sought;
  if (function.framework.Text() == "EULER") {
    sought = NameOfReference(core, reference, "unkown");
  } else {
    sought = OwnerName(core, function.lookFor.IntValue()) + "." +
             NameOfReference(core, reference, function.property.Text());
  }
  return function.purpose.TextOf() + "(" + function.math.TextOf() + "[" + sought + "])";
}

/// Collects the rows, counting those that show a number.
class OverviewBuilder final {
 public:
  explicit OverviewBuilder(const TemplateCore& templateCore) : core(templateCore) {}

  std::vector<OverviewRow> Build() {
    ForEachHeadedCollection([this](const auto& row) { AddAll(core.Elements().*row.elements, ""); });
    for (const auto& specie : core.Species()) {
      const std::string ofClass = " (" + specie->symbol.TextOf() + ")";
      ForEachMemberList([this, &specie, &ofClass](const auto& list) {
        // The forcings of a class are kept out on purpose; its movements do not count.
        const bool isListed = list.hasHead && list.kind != ElementKind::SpecieForcing;
        if (isListed) AddAll((*specie).*list.members, ofClass);
      });
      for (const auto& vector : specie->horizontalVectors) {
        AddMovement(*vector, "Direction" + ofClass, vector->direction, "horizontal direction equation");
        AddMovement(*vector, "Speed" + ofClass, vector->speed, "horizontal speed equation");
      }
      const auto& vertical = *specie->verticalEquation;
      AddMovement(vertical, std::string(vertical.KindText()) + ofClass, vertical.speed,
                  "vertical speed equation");
    }
    return std::move(rows);
  }

 private:
  /// What the table shows of an element: its expression, the summary of a search, or its default value.
  template <class Element>
  std::string TextOf(const Element& element) const {
    if constexpr (requires { element.equation; }) {
      return element.equation.TextOf();
    } else if constexpr (requires { element.expression; }) {
      return element.expression.TextOf();
    } else if constexpr (requires { element.defaultValue; }) {
      return element.defaultValue.TextOf();
    } else if constexpr (requires { element.framework; }) {
      return SearchSummary(core, element);
    } else {
      return {};
    }
  }

  template <class Elements>
  void AddAll(const Elements& elements, const std::string& ofClass) {
    for (const auto& element : elements) {
      rows.push_back(
          {{std::to_string(++counted), element->symbol.TextOf(), std::string(element->KindText()) + ofClass,
            TextOf(*element), element->description.TextOf()},
           element->GetUid()});
    }
  }

  void AddMovement(const CEL_Element& movement, std::string type, const CEL_Property& expression,
                   const char* description) {
    rows.push_back({{"-", movement.symbol.TextOf(), std::move(type), expression.TextOf(), description},
                    movement.GetUid()});
  }

  const TemplateCore& core;
  std::vector<OverviewRow> rows;
  std::size_t counted = 0;
};

/// A text for one line of the table: without line ends and tabs, and without blanks at its ends.
std::string Cleaned(std::string text) {
  std::erase_if(text,
                [](char character) { return character == '\r' || character == '\n' || character == '\t'; });
  return std::string(CleanText(text));
}

using Cells = std::array<std::string, kOverviewColumnCount>;
using Widths = std::array<std::size_t, kOverviewColumnCount>;

Cells TextCells(Cells cells) {
  for (std::size_t column = 0; column < cells.size(); ++column) {
    if (kOverviewColumns[column].cleaned) cells[column] = Cleaned(std::move(cells[column]));
  }
  return cells;
}

Cells TextTitles() {
  Cells titles;
  for (std::size_t column = 0; column < titles.size(); ++column) {
    titles[column] = kOverviewColumns[column].textTitle;
  }
  return titles;
}

/// Each column is one wider than its longest text; tabs separate them.
void AppendRow(const Cells& cells, const Widths& longest, std::string& text) {
  for (std::size_t column = 0; column < cells.size(); ++column) {
    if (column > 0) text += '\t';
    const std::size_t width = longest[column] + 1;
    const std::size_t padding = width - std::min(width, cells[column].size());
    if (kOverviewColumns[column].rightAligned) text.append(padding, ' ');
    text += cells[column];
    if (!kOverviewColumns[column].rightAligned) text.append(padding, ' ');
  }
  text += "\r\n";
}

}  // namespace

std::vector<OverviewRow> BuildOverview(const TemplateCore& core) {
  return OverviewBuilder(core).Build();
}

void WriteOverviewText(const TemplateCore& core, const std::vector<OverviewRow>& rows,
                       const TextSink& write) {
  std::string text = "Template " + core.TemplateFileName() + "\r\n";
  // No line end follows the revision: the header row begins right after it.
  if (core.GetMisc() != nullptr && core.GetDocumentRevision() > 0) {
    text += "\nRevision " + std::to_string(core.GetDocumentRevision());
  }
  Widths longest{};
  for (const OverviewRow& row : rows) {
    const Cells cells = TextCells(row.cells);
    for (std::size_t column = 0; column < longest.size(); ++column) {
      longest[column] = std::max(longest[column], cells[column].size());
    }
  }
  AppendRow(TextTitles(), longest, text);
  write(text);
  for (const OverviewRow& row : rows) {
    text.clear();
    AppendRow(TextCells(row.cells), longest, text);
    write(text);
  }
}

std::string OverviewText(const TemplateCore& core, const std::vector<OverviewRow>& rows) {
  std::string text;
  WriteOverviewText(core, rows, [&text](std::string_view part) { text += part; });
  return text;
}

bool ExportOverview(const TemplateCore& core, const std::string& path, std::string& failure) {
  std::error_code notThere;
  if (std::filesystem::equivalent(path, core.TemplateFileName(), notThere)) {
    failure = "can not write the overview over its template '" + path + "'";
    return false;
  }
  failure = WriteOutputFile(path, [&core](const TextSink& write) {
    WriteOverviewText(core, BuildOverview(core), write);
    return true;
  });
  return failure.empty();
}

}  // namespace tessal
