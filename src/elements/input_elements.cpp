#include "elements/input_elements.h"

#include <array>
#include <limits>
#include <optional>
#include <utility>

#include "core/error_registry.h"
#include "elements/element_checks.h"
#include "expr/builtin_catalogue.h"
#include "keyfile/keywords.h"
#include "keyfile/water_body.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

constexpr InputKind kConstantKind{ElementKind::Constant, 1, ConstantBuiltinIds};
constexpr InputKind kForcingKind{ElementKind::Forcing, 2, ForcingBuiltinIds};

constexpr std::int32_t kNoBuiltin = -1;

constexpr std::array<PropertyRow, 8> kRows = {{
    {PlaceOf(&CEL_Input::isUserSpecified), key::kIsUserSpecified, "Is user specified", ValueType::Boolean,
     YesNoChoices, kYes},
    {PlaceOf(&CEL_Input::builtInId), key::kBuiltInId, "Build in ID", ValueType::Integer, nullptr, "",
     kNoBuiltin},
    {PlaceOf(&CEL_Input::scope), key::kScope, "Scope", ValueType::Text, InputScopeChoices,
     scope::kNotSpecified},
    {PlaceOf(&CEL_Input::spatialVariation), key::kSpatialVariation, "Spatial Variation", ValueType::Text,
     SpatialVariationChoices, variation::kNone},
    {PlaceOf(&CEL_Input::unit), key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    ReadLast({PlaceOf(&CEL_Input::defaultValue), key::kDefaultValue, "Default Value", ValueType::Real,
              nullptr, "", 0.0}),
    {PlaceOf(&CEL_Input::minValue), key::kMinValue, "Min Value", ValueType::Real, nullptr, "", 0.0},
    {PlaceOf(&CEL_Input::maxValue), key::kMaxValue, "Max Value", ValueType::Real, nullptr, "", 100.0},
}};

ChoiceList BuiltinChoices(const InputKind& input, bool withDeprecated, std::int32_t inUse) {
  std::vector<CEL_Choice> choices{CEL_Choice::Number(kUserDefined, kNoBuiltin)};
  CatalogueBuiltin row;
  for (const std::int32_t builtinId : input.builtinIds()) {
    if (IsDeprecatedBuiltin(builtinId) && !withDeprecated && builtinId != inUse) continue;
    if (GetBuiltinById(builtinId, row) == 0) choices.push_back(CEL_Choice::Number(row.name, builtinId));
  }
  return ShareChoices(std::move(choices));
}

/// The row that an input of the kind is bound to by this id; none for an id that binds to nothing.
std::optional<CatalogueBuiltin> BuiltinInUse(const InputKind& input, std::int32_t builtinId) {
  CatalogueBuiltin row;
  const bool isBound = builtinId >= 1 && GetBuiltinById(builtinId, row) == 0 && row.kind == input.builtinKind;
  return isBound ? std::optional(row) : std::nullopt;
}

/// The list of an element that shows no deprecated row is the same for all of its kind.
const ChoiceList& UsualBuiltinChoices(const InputKind& input) {
  static const ChoiceList kConstants = BuiltinChoices(kConstantKind, false, kNoBuiltin);
  static const ChoiceList kForcings = BuiltinChoices(kForcingKind, false, kNoBuiltin);
  return input.kind == ElementKind::Constant ? kConstants : kForcings;
}

}  // namespace

CEL_Input::CEL_Input(const InputKind& inputKind, std::string_view caption)
    : CEL_Element(caption), input(inputKind) {
  SetKind(input.kind);
  SetUnitMode(UnitMode::Both);
  OfferUnitTypes(kInputUnitTypes);
  Bind(kRows);
  ListenTo({&symbol, &builtInId, &spatialVariation, &unqType, &unqUnit});
  // The scope of an input that a modeller chooses leaves the variation alone.
  scope.ReportTo(ReportsTo::Table);
  RebuildBuiltInChoices(false);
  CEL_Input::UpdateLocks();
}

CEL_Constant::CEL_Constant(std::string_view caption) : CEL_Input(kConstantKind, caption) {}

CEL_Forcing::CEL_Forcing(std::string_view caption) : CEL_Input(kForcingKind, caption) {}

void CEL_Input::Reset() {
  ResetOwn();
  unqType.SetInt(kUserDefinedUnit);
  unqType.SelectChoice(kUserDefined);
  unqUnit.SetInt(0);
  RebuildBuiltInChoices(false);
  CEL_Input::UpdateLocks();
}

void CEL_Input::Read(KvfNode section, ReadStatus& status) {
  CEL_Element::Read(section, status);
  // Again, so that a deprecated id that the file holds stays in the list.
  if (kvfIsSection(section)) RebuildBuiltInChoices(showDeprecated);
}

void CEL_Input::RebuildBuiltInChoices(bool withDeprecated) {
  showDeprecated = withDeprecated;
  const std::int32_t inUse = builtInId.IntValue();
  const bool usual = !withDeprecated && !IsDeprecatedBuiltin(inUse);
  if (usual) {
    builtInId.OfferStanding(UsualBuiltinChoices(input));
  } else {
    builtInId.SetChoices(BuiltinChoices(input, withDeprecated, inUse));
  }
  builtInId.SelectIndex(builtInId.PresentChoice());
}

std::string CEL_Input::RecordText() const {
  return SixDigitNumberText(defaultValue.RealValue());
}

bool CEL_Input::Check() {
  const bool inRange = CheckDefaultInRange(*this, minValue, defaultValue, maxValue);
  const bool ordered = CheckRangeOrder(*this, minValue, maxValue);
  const bool named = CheckSymbolForm(*this);
  const bool worded = CheckTextContent(*this);
  const bool current = !IsDeprecatedBuiltin(builtInId.IntValue());
  if (!current) Errors().ReportCheck(symbol.Text(), GetUid(), {"deprecated-builtin"});
  return inRange && ordered && named && worded && current;
}

void CEL_Input::OnPropertyChanged(CEL_Property& changed) {
  if (&changed == &builtInId) {
    ApplyBuiltin();
  } else if (&changed == &unqType) {
    ApplyUnitType(kInputUnitTypes, unit);
  } else {
    if (&changed == &scope) ApplyScope(scope, spatialVariation);
    RebuildOwner();
  }
}

void CEL_Input::UpdateLocks() {
  const bool isOpen = !BuiltinInUse(input, builtInId.IntValue());
  for (CEL_Property* property :
       {&scope, &spatialVariation, &unqType, &unqUnit, &unit, &defaultValue, &minValue, &maxValue}) {
    property->SetEditable(isOpen);
  }
  if (!LeavesUnitOpen(kInputUnitTypes)) unit.SetEditable(false);
}

void CEL_Input::FollowValues() {
  RebuildBuiltInChoices(showDeprecated);
  CEL_Element::FollowValues();
}

void CEL_Input::ApplyBuiltin() {
  if (builtInId.IntValue() < 1) {
    isUserSpecified.SetBool(true);
    UpdateLocks();
    SelectPresentValues();
    return;
  }
  const auto found = BuiltinInUse(input, builtInId.IntValue());
  if (!found) {
    UpdateLocks();
    return;
  }
  const CatalogueBuiltin& row = *found;
  {
    // As one change: the rules for a unit type that a modeller chooses are not for the catalogue's.
    const NotificationsOff silent;
    isUserSpecified.SetBool(false);
    scope.SetText(LayerText(row.layer));
    spatialVariation.SetText(VariationText(row.variation));
    unqType.SetInt(row.unitType);
    unqUnit.SetInt(0);  // the catalogue has no unit numbers
    unit.SetText(row.unit);
    // Wide open first, so that no limit is in the way of the default.
    minValue.SetReal(std::numeric_limits<double>::lowest());
    maxValue.SetReal(std::numeric_limits<double>::max());
    defaultValue.SetReal(row.defaultValue);
    minValue.SetReal(row.minimum);
    maxValue.SetReal(row.maximum);
  }
  UpdateLocks();
  SelectPresentValues();
  RebuildOwner();
}

}  // namespace tessal
