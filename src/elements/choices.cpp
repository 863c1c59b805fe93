#include "elements/choices.h"

#include <algorithm>
#include <array>
#include <map>
#include <utility>

#include "expr/builtin_catalogue.h"
#include "keyfile/water_body.h"

namespace tessal {

namespace {

constexpr std::array<std::string_view, 4> kLayerScopes = {scope::kWaterSurface, scope::kWaterColumn,
                                                          scope::kWaterBottom, scope::kSediment};
constexpr std::array<std::string_view, 1> kNoScope = {scope::kNotSpecified};

struct DisplayedText {
  std::string_view display;
  std::string_view fileText;
};

constexpr std::array<DisplayedText, 3> kSpatialVariations = {{
    {"NONE", variation::kNone},
    {"HORIZONTAL", variation::kHorizontal},
    {"HORIZONTAL_AND_VERTICAL", variation::kHorizontalAndVertical},
}};

constexpr std::array<UnitTypeRow, 1> kPlainRows = {{{kUserDefined, kUserDefinedUnit, 0, "undefined"}}};

// A type without a known unit number has 0.
constexpr std::array<UnitTypeRow, 2> kInputRows = {{
    {"Process rate", 100150, 0, "/d"},
    {kUserDefined, kUserDefinedUnit, 0, ""},
}};

constexpr std::array<UnitTypeRow, 6> kStateVariableRows = {{
    {"Concentration", 100404, 2205, "mg/l"},
    {"Mass per Area", 100437, 4400, "g/m2"},
    {"Bacteria Concentration", 100008, 3001, "per 100 ml"},
    {kUserDefined, kUserDefinedUnit, 0, "undefined"},
    {"Volume", 110230, 1600, "m3"},
    {"Length", 110220, 1000, "m"},
}};

constexpr std::array<UnitTypeRow, 14> kParticleRows = {{
    {"Mass", 100039, 0, "kg"},
    {kUserDefined, kUserDefinedUnit, 0, "undefined"},
    {"Concentration", 100404, 2205, "mg/l"},
    {"Mass per Area", 100437, 4400, "g/m2"},
    {"Density", 100017, 0, "kg/m3"},
    {"Temperature", 100006, 0, "degree Celsius"},
    {"Surface Area", 100135, 0, "m2"},
    {"Light exinction", 100220, 0, "per meter"},
    {"Fraction", 100239, 0, "fraction"},
    {"Wind Speed", 100274, 0, "meter/sec"},
    {"Current Speed", 100242, 0, "meter/sec"},
    {"Attenuation", 100317, 0, "per meter"},
    {"Volume", 110230, 1600, "m3"},
    {"Length", 110220, 1000, "m"},
}};

}  // namespace

ChoiceList ShareChoices(std::vector<CEL_Choice> choices) {
  return std::make_shared<const std::vector<CEL_Choice>>(std::move(choices));
}

const ChoiceList& YesNoChoices() {
  static const ChoiceList kList =
      ShareChoices({CEL_Choice::Boolean(kYes, true), CEL_Choice::Boolean(kNo, false)});
  return kList;
}

const ChoiceList& LayerScopeChoices() {
  static const ChoiceList kList = MakeTextChoices(kLayerScopes);
  return kList;
}

const ChoiceList& InputScopeChoices() {
  static const ChoiceList kList = MakeTextChoices(LayerTexts());
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
    return ShareChoices(std::move(choices));
  }();
  return kList;
}

ChoiceList MakeTextChoices(std::span<const std::string_view> texts) {
  std::vector<CEL_Choice> choices;
  choices.reserve(texts.size());
  for (const std::string_view text : texts) choices.push_back(CEL_Choice::Text(text, text));
  return ShareChoices(std::move(choices));
}

const UnitTypes kPlainUnitTypes{kPlainRows, false};
const UnitTypes kInputUnitTypes{kInputRows, false};
const UnitTypes kStateVariableUnitTypes{kStateVariableRows, false};
const UnitTypes kParticleUnitTypes{kParticleRows, true};

const UnitTypeRow* FindUnitType(const UnitTypes& types, std::int32_t unqType) {
  const auto hit = std::find_if(types.rows.begin(), types.rows.end(),
                                [unqType](const UnitTypeRow& row) { return row.unqType == unqType; });
  return hit == types.rows.end() ? nullptr : &*hit;
}

int unqGetItemTypeKey(std::int32_t unqType, std::string& text) {
  for (const UnitTypes* types : {&kInputUnitTypes, &kStateVariableUnitTypes, &kParticleUnitTypes}) {
    const UnitTypeRow* row = FindUnitType(*types, unqType);
    if (row == nullptr) continue;
    text = row->display;
    return 1;
  }
  return 0;
}

const ChoiceList& UnitTypeChoices(const UnitTypes& types) {
  static std::map<const UnitTypeRow*, ChoiceList> lists;
  ChoiceList& list = lists[types.rows.data()];
  if (!list) {
    std::vector<CEL_Choice> choices;
    choices.reserve(types.rows.size());
    for (const UnitTypeRow& row : types.rows) choices.push_back(CEL_Choice::Number(row.display, row.unqType));
    list = ShareChoices(std::move(choices));
  }
  return list;
}

}  // namespace tessal
