#include "elements/area_search.h"

#include <array>
#include <map>
#include <span>

#include "core/error_registry.h"
#include "elements/element_checks.h"
#include "elements/element_owner.h"
#include "elements/property_io.h"
#include "keyfile/keywords.h"

namespace tessal {

namespace {

constexpr std::string_view kEuler = "EULER";
constexpr std::string_view kLagrange = "LAGRANGE";
constexpr std::string_view kOilspill = "OILSPILL";
constexpr std::string_view kNone = "NONE";

constexpr std::int32_t kOwnSpecie = CEL_Lagrange_Spatial_Function::kOwnSpecie;
constexpr std::int32_t kAnyParticle = CEL_Lagrange_Spatial_Function::kAnyParticle;
constexpr std::int32_t kLargestVariableId = 999999;

constexpr std::array<std::string_view, 2> kFrameworks = {kEuler, kLagrange};
constexpr std::array<std::string_view, 9> kProperties = {kNone,  "XPOS",   "YPOS",   "ZPOS",    "AGE",
                                                         "HDIR", "HSPEED", "VSPEED", "DISTANCE"};
constexpr std::array<std::string_view, 2> kEulerPurposes = {"DIRECTION", "MAGNITUDE"};
constexpr std::array<std::string_view, 4> kLagrangePurposes = {"DIRECTION", "MAGNITUDE", "DISTANCE",
                                                               "PARTICLE"};
constexpr std::array<std::string_view, 5> kEulerMath = {kNone, "MIN", "MAX", "MIN_ABSOLUTE", "MAX_ABSOLUTE"};
constexpr std::array<std::string_view, 7> kMagnitudeMath = {kNone, "COUNT", "AVERAGE", "MIN",
                                                            "MAX", "SUM",   "SUM_NORM"};
constexpr std::array<std::string_view, 3> kParticleMath = {kNone, "MIN", "MAX"};
constexpr std::array<std::string_view, 4> kDistanceMath = {kNone, "AVERAGE", "MIN", "MAX"};
constexpr std::array<std::string_view, 1> kNoMath = {kNone};

const ChoiceList& FrameworkChoices() {
  static const ChoiceList kList = MakeTextChoices(kFrameworks);
  return kList;
}

const ChoiceList& PropertyChoices() {
  static const ChoiceList kList = MakeTextChoices(kProperties);
  return kList;
}

const ChoiceList& DimensionChoices() {
  static const ChoiceList kList = ShareChoices({CEL_Choice::Number("2", 2), CEL_Choice::Number("3", 3)});
  return kList;
}

std::span<const std::string_view> LagrangeMath(std::string_view purpose) {
  if (purpose == "MAGNITUDE") return kMagnitudeMath;
  if (purpose == "PARTICLE") return kParticleMath;
  if (purpose == "DISTANCE" || purpose == "DIRECTION") return kDistanceMath;
  return kNoMath;
}

constexpr std::array<PropertyRow, 11> kRows = {{
    {PlaceOf(&CEL_Lagrange_Spatial_Function::functionId), key::kFunctionId, "Function_ID", ValueType::Integer,
     nullptr, "", 100.0},
    {PlaceOf(&CEL_Lagrange_Spatial_Function::variableId), key::kVariableId, "Variable ID", ValueType::Integer,
     nullptr, "", -1.0},
    {PlaceOf(&CEL_Lagrange_Spatial_Function::specieId), key::kSpecieId, "Specie ID", ValueType::Integer,
     nullptr, "", -1.0},
    {PlaceOf(&CEL_Lagrange_Spatial_Function::radius), key::kRadius, "Radius", ValueType::Real, nullptr, "",
     0.0},
    {PlaceOf(&CEL_Lagrange_Spatial_Function::dimension), key::kDimension, "Dimension", ValueType::Integer,
     DimensionChoices, "", 2.0},
    {PlaceOf(&CEL_Lagrange_Spatial_Function::spatialVariation), key::kSpatialVariation, "Spatial Variation",
     ValueType::Text, nullptr, "PER_INDIVIDUAL"},
    {PlaceOf(&CEL_Lagrange_Spatial_Function::purpose), key::kPurpose, "Purpose", ValueType::Text, nullptr,
     "DIRECTION"},
    {PlaceOf(&CEL_Lagrange_Spatial_Function::framework), key::kFramework, "Framework", ValueType::Text,
     FrameworkChoices, kEuler},
    {PlaceOf(&CEL_Lagrange_Spatial_Function::property), key::kProperty, "Property", ValueType::Text,
     PropertyChoices, kNone},
    {PlaceOf(&CEL_Lagrange_Spatial_Function::math), key::kMath, "Math", ValueType::Text, nullptr, kNone},
    {PlaceOf(&CEL_Lagrange_Spatial_Function::lookFor), key::kLookFor, "Lookfor", ValueType::Integer, nullptr,
     "", kOwnSpecie},
}};

const ChoiceList& OilspillChoices() {
  static const ChoiceList kList = ShareChoices({CEL_Choice::Text("Oilspill(deprecated)", kOilspill)});
  return kList;
}

/// One list for each of the arrays above.
const ChoiceList& ChoicesOf(std::span<const std::string_view> texts) {
  static std::map<const std::string_view*, ChoiceList> lists;
  ChoiceList& list = lists[texts.data()];
  if (!list) list = MakeTextChoices(texts);
  return list;
}

/// Selects the choice that stores the property's text; without one the first choice takes its place.
void SelectOrTakeFirst(CEL_Property& property) {
  property.SelectIndex(property.PresentChoice());
  if (property.Selected() >= 0 || !property.HasChoices()) return;
  property.SelectIndex(0);
  property.ApplySelection();
}

}  // namespace

std::vector<CEL_Choice> FirstLookForChoices() {
  return {CEL_Choice::Number("OWN SPECIE", kOwnSpecie), CEL_Choice::Number("ANY PARTICLE", kAnyParticle)};
}

CEL_Lagrange_Spatial_Function::CEL_Lagrange_Spatial_Function(std::string_view caption)
    : CEL_Element(caption) {
  SetKind(ElementKind::SpatialFunction);
  Bind(kRows);
  ListenTo({&variableId, &lookFor, &purpose, &framework});
  static const ChoiceList kWithoutClasses = ShareChoices(FirstLookForChoices());
  lookFor.SetChoices(kWithoutClasses);
  CEL_Lagrange_Spatial_Function::Reset();
}

void CEL_Lagrange_Spatial_Function::Reset() {
  ResetOwn();
  RebuildChoices();
  RestoreSelections();
}

void CEL_Lagrange_Spatial_Function::Read(KvfNode section, ReadStatus& status) {
  if (!kvfIsSection(section)) return;
  CEL_Element::Read(section, status);
  struct Choice {
    CEL_Property* property;
    std::string_view keyword;
    std::string inFile;
  };
  const std::array<Choice, 3> choices = {{{&framework, key::kFramework, std::string(framework.Text())},
                                          {&purpose, key::kPurpose, std::string(purpose.Text())},
                                          {&math, key::kMath, std::string(math.Text())}}};
  RebuildChoices();
  RestoreSelections();
  for (const Choice& choice : choices) {
    const bool isThere = HasKeyword(section, choice.keyword);
    if (isThere && choice.property->Text() != choice.inFile) {
      status.NoteReplaced(section, choice.keyword, choice.property->Text());
    }
  }
}

bool CEL_Lagrange_Spatial_Function::SearchesGrid() const {
  return framework.Text() == kEuler && purpose.Text() != kOilspill;
}

bool CEL_Lagrange_Spatial_Function::SearchesParticles() const {
  return framework.Text() == kLagrange || purpose.Text() == kOilspill;
}

void CEL_Lagrange_Spatial_Function::RebuildChoices() {
  if (framework.Text() == kEuler && purpose.Text() == kOilspill) {
    // No longer offered, but kept where a file has it.
    purpose.SetChoices(OilspillChoices());
    purpose.SelectIndex(0);
  } else if (framework.Text() == kEuler) {
    purpose.SetChoices(ChoicesOf(kEulerPurposes));
    purpose.SelectChoice("DIRECTION");
    math.SetChoices(ChoicesOf(kEulerMath));
    math.SelectChoice("MIN");
  } else if (framework.Text() == kLagrange) {
    purpose.SetChoices(ChoicesOf(kLagrangePurposes));
    math.SetChoices(ChoicesOf(LagrangeMath(purpose.Text())));
  }
}

void CEL_Lagrange_Spatial_Function::RestoreSelections() {
  SelectOrTakeFirst(framework);
  SelectOrTakeFirst(purpose);
  SelectOrTakeFirst(math);
  property.SelectChoice(property.Text());
  property.ApplySelection();
}

bool CEL_Lagrange_Spatial_Function::Check() {
  bool good = CheckTextContent(*this);
  const auto report = [this, &good](Message message) {
    Errors().ReportCheck(symbol.Text(), GetUid(), {message});
    good = false;
  };
  const bool lagrange = framework.Text() == kLagrange;
  const std::int32_t sought = lookFor.IntValue();
  const std::int32_t variable = variableId.IntValue();
  const auto species = static_cast<std::int32_t>(Owner() == nullptr ? 0 : Owner()->SpecieCount());
  if (lagrange && (sought < kAnyParticle || sought == 0 || sought > species)) report("search-without-class");
  if (purpose.Text() != kOilspill) {
    const bool needsVariable = !lagrange || property.Text() == kNone;
    if (variable > kLargestVariableId || (variable < 1 && needsVariable)) report("search-without-variable");
  }
  if (math.Text() == kNone) report("search-without-function");
  if (!(radius.RealValue() > 0.0)) report("search-without-radius");
  return good;
}

void CEL_Lagrange_Spatial_Function::OnPropertyChanged(CEL_Property& changed) {
  if (&changed == &framework || &changed == &purpose) {
    OnFrameworkChanged();
  } else {
    RebuildOwner();
  }
}

void CEL_Lagrange_Spatial_Function::FollowValues() {
  RebuildChoices();
  CEL_Element::FollowValues();
}

void CEL_Lagrange_Spatial_Function::OnFrameworkChanged() {
  if (framework.Text() == kEuler || framework.Text() == kLagrange) {
    variableId.SetInt(-1);
    property.SelectChoice(property.Text());
    property.ApplySelection();
    property.SetEditable(true);
  }
  RebuildChoices();
  RestoreSelections();
  // Offers the classes too.
  if (Owner() != nullptr) Owner()->RefreshSearchFunctionChoices();
}

}  // namespace tessal
