#include "elements/choices.h"

#include <algorithm>
#include <array>
#include <utility>

namespace tessal {

namespace {

constexpr std::array<std::string_view, 4> kLayerScopes = {"WS", "WC", "WB", "SED"};

// The first two rows are one text, and the first of them wins a selection: the built-in catalogue counts
// its layers by this table.
constexpr std::array<std::string_view, 6> kInputScopes = {
    "NOT_SPECIFIED", "NOT_SPECIFIED", "WS", "WC", "WB", "SED"};

constexpr std::array<std::string_view, 1> kNoScope = {"NOT_SPECIFIED"};

struct DisplayedText {
  std::string_view display;
  std::string_view fileText;
};

// Files and rules go by the misspelt forms.
constexpr std::array<DisplayedText, 3> kSpatialVariations = {{
    {"NONE", "NONE"},
    {"HORIZONTAL", "HORISONTAL"},
    {"HORIZONTAL_AND_VERTICAL", "HORISONTAL_AND_VERTICAL"},
}};

ChoiceList Share(std::vector<CEL_Choice> choices) {
  return std::make_shared<const std::vector<CEL_Choice>>(std::move(choices));
}

}  // namespace

const ChoiceList& YesNoChoices() {
  static const ChoiceList kList = Share({CEL_Choice::Boolean("YES", true), CEL_Choice::Boolean("NO", false)});
  return kList;
}

const ChoiceList& LayerScopeChoices() {
  static const ChoiceList kList = MakeTextChoices(kLayerScopes);
  return kList;
}

const ChoiceList& InputScopeChoices() {
  static const ChoiceList kList = MakeTextChoices(kInputScopes);
  return kList;
}

const ChoiceList& NoScopeChoices() {
  static const ChoiceList kList = MakeTextChoices(kNoScope);
  return kList;
}

const ChoiceList& SpatialVariationChoices() {
  static const ChoiceList kList = [] {
    std::vector<CEL_Choice> choices;
    choices.reserve(kSpatialVariations.size());
    for (const DisplayedText& row : kSpatialVariations) {
      choices.push_back(CEL_Choice::Text(row.display, row.fileText));
    }
    return Share(std::move(choices));
  }();
  return kList;
}

ChoiceList MakeTextChoices(std::span<const std::string_view> texts) {
  std::vector<CEL_Choice> choices;
  choices.reserve(texts.size());
  for (const std::string_view text : texts) choices.push_back(CEL_Choice::Text(text, text));
  return Share(std::move(choices));
}

const UnitTypeRow* FindUnitType(std::span<const UnitTypeRow> rows, std::int32_t unqType) {
  const auto hit = std::find_if(rows.begin(), rows.end(),
                                [unqType](const UnitTypeRow& row) { return row.unqType == unqType; });
  return hit == rows.end() ? nullptr : &*hit;
}

ChoiceList MakeUnitTypeChoices(std::span<const UnitTypeRow> rows) {
  std::vector<CEL_Choice> choices;
  choices.reserve(rows.size());
  for (const UnitTypeRow& row : rows) choices.push_back(CEL_Choice::Number(row.display, row.unqType));
  return Share(std::move(choices));
}

std::string_view SpatialVariationOfScope(std::string_view scope) {
  if (scope == "WC") return "HORISONTAL_AND_VERTICAL";
  if (scope == "WS" || scope == "WB" || scope == "SED") return "HORISONTAL";
  return {};
}

}  // namespace tessal
