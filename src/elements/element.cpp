#include "elements/element.h"

#include <algorithm>
#include <array>
#include <cassert>

#include "elements/element_checks.h"
#include "elements/element_owner.h"
#include "elements/property_io.h"
#include "keyfile/keywords.h"
#include "keyfile/water_body.h"

namespace tessal {

namespace {

std::int32_t& UidCounter() {
  static std::int32_t last = 0;
  return last;
}

const ChoiceList& UserDefinedUnitChoices() {
  static const ChoiceList kList = ShareChoices({CEL_Choice::Number(kUserDefined, 0)});
  return kList;
}

/// The base fields in the order of field lists, which is not that of the file.
struct BaseRow {
  std::string_view label;
  PropertyPlace property;
};

constexpr std::array<BaseRow, 7> kBaseRows = {{
    {"Symbol", &CEL_Element::symbol},
    {"ID", &CEL_Element::id},
    {"Description", &CEL_Element::description},
    {"Documentation", &CEL_Element::documentation},
    {"Online help", &CEL_Element::onlineHelp},
    {"UNQ Type", &CEL_Element::unqType},
    {"UNQ Unit", &CEL_Element::unqUnit},
}};

/// The value that a row gives a fresh property, and the same as a change of the present one.
struct Starting {
  CEL_Property& property;
  void operator()(double value) const { property.StartWith(value); }
  void operator()(std::int32_t value) const { property.StartWith(value); }
  void operator()(bool value) const { property.StartWith(value); }
  void operator()(std::string_view value) const { property.StartWithText(value); }
};
struct Setting {
  CEL_Property& property;
  void operator()(double value) const { property.SetReal(value); }
  void operator()(std::int32_t value) const { property.SetInt(value); }
  void operator()(bool value) const { property.SetBool(value); }
  void operator()(std::string_view value) const { property.SetText(value); }
};

template <class Give>
void GiveDefault(const PropertyRow& row, Give give) {
  switch (row.type) {
    case ValueType::Real:
      return give(row.defaultNumber);
    case ValueType::Integer:
      return give(static_cast<std::int32_t>(row.defaultNumber));
    case ValueType::Boolean:
      return give(row.defaultText == kYes);
    default:
      return give(row.defaultText);
  }
}

}  // namespace

CEL_Element::CEL_Element(bool withSymbol, bool withId, bool withDescription)
    : hasDescription(withDescription), hasSymbol(withSymbol), hasId(withId), uid(Uid{++UidCounter()}) {
  for (const BaseRow& row : kBaseRows) (this->*row.property).BelongTo(*this);
  unqType.StartWith(kUserDefinedUnit);
  OfferUnitTypes(kPlainUnitTypes);
  unqUnit.OfferStanding(UserDefinedUnitChoices());
  unqUnit.SelectIndex(0);
}

CEL_Element::CEL_Element(std::string_view caption) : CEL_Element(true, true, true) {
  symbol.SetText(caption);
}

CEL_ListHead::CEL_ListHead(ElementKind kindNumber, std::string_view caption)
    : CEL_Element(false, false, true) {
  SetKind(kindNumber);
  symbol.SetText(caption);
  SetLoaded(true);
}

void CEL_Element::OfferUnitTypes(const UnitTypes& types) {
  unqType.OfferStanding(UnitTypeChoices(types));
  unqType.SelectIndex(unqType.PresentChoice());
}

void CEL_Element::ApplyUnitType(const UnitTypes& types, CEL_Property& unit) {
  if (const UnitTypeRow* row = FindUnitType(types, unqType.IntValue())) {
    if (!row->unit.empty()) unit.SetText(row->unit);
    unqUnit.SetInt(row->unqUnit);
  } else if (!types.keepsUnknown) {
    // Calls this again, with the row of "User defined".
    unqType.SetInt(kUserDefinedUnit);
  }
  SelectPresentValues();
  UpdateLocks();
}

bool CEL_Element::LeavesUnitOpen(const UnitTypes& types) const {
  const UnitTypeRow* row = FindUnitType(types, unqType.IntValue());
  return row == nullptr || row->unqType == kUserDefinedUnit;
}

void CEL_Element::ApplyScope(const CEL_Property& scope, CEL_Property& spatialVariation) {
  const NotificationsOff silent;
  const std::string_view variation = VariationOfScope(scope.Text());
  if (!variation.empty()) spatialVariation.SetText(variation);
  // A form opens on the selection, and would store it over the new variation.
  SelectPresentValues();
}

void CEL_Element::SetFileFlags(bool withSymbol, bool withId, bool withDescription) {
  hasSymbol = withSymbol;
  hasId = withId;
  hasDescription = withDescription;
}

void CEL_Element::Bind(std::span<const PropertyRow> classRows) {
  rows = classRows;
  for (const PropertyRow& row : rows) {
    CEL_Property& property = this->*row.place;
    assert(property.Type() == row.type);
    property.BelongTo(*this);
    if (row.choices != nullptr) property.OfferStanding(row.choices());
    GiveDefault(row, Starting{property});
    if (row.type != ValueType::Expression) continue;
    const auto place = static_cast<std::uint8_t>(&row - rows.data());
    assert(!HasExpression() || firstExpression + expressions == place);
    if (!HasExpression()) firstExpression = place;
    ++expressions;
  }
  SelectPresentValues();
}

void CEL_Element::ListenTo(std::initializer_list<CEL_Property*> properties) {
  for (CEL_Property* property : properties) property->ReportTo(ReportsTo::Holder);
}

void CEL_Element::ResetOwn() {
  for (const PropertyRow& row : rows) GiveDefault(row, Setting{this->*row.place});
  SelectPresentValues();
}

void CEL_Element::RestartOwn() {
  for (const PropertyRow& row : rows) GiveDefault(row, Starting{this->*row.place});
  SelectPresentValues();
}

void CEL_Element::SelectPresentValues() {
  unqType.SelectIndex(unqType.PresentChoice());
  unqUnit.SelectIndex(unqUnit.PresentChoice());
  for (const PropertyRow& row : rows) {
    CEL_Property& property = this->*row.place;
    property.SelectIndex(property.PresentChoice());
  }
}

void CEL_Element::TakeValuesOf(const CEL_Element& other) {
  assert(rows.data() == other.rows.data());
  const NotificationsOff silent;
  const auto take = [this, &other](PropertyPlace place) {
    const CEL_Property& from = other.*place;
    CEL_Property& to = this->*place;
    to.SetReal(from.RealValue());
    to.SetInt(from.IntValue());
    to.SetBool(from.BoolValue());
    to.SetText(from.Text());
  };
  for (const ElementValue& value : Values()) take(value.place);
  FollowValues();
}

void CEL_Element::ClearTexts() {
  for (CEL_Property* text : {&description, &onlineHelp, &documentation}) text->SetText("");
}

void ResetElementUids() {
  UidCounter() = 0;
}

void CEL_Element::Read(KvfNode section, ReadStatus& status) {
  if (!kvfIsSection(section)) return;
  ReadBase(section, status);
  ReadOwn(section, status);
  UpdateLocks();
}

void CEL_Element::Write(KvfHandle file, int& status) {
  WriteBase(file, status);
  WriteOwn(file, status);
}

void CEL_Element::ReadBase(KvfNode section, ReadStatus& status) {
  if (!kvfIsSection(section)) return;
  status.Begin(*this, section);
  if (hasSymbol) ReadProperty(symbol, section, key::kSymbol, status);
  status.SymbolWasRead();
  if (hasId) ReadProperty(id, section, key::kId, status);
  if (hasDescription) {
    ReadProperty(description, section, key::kDescription, status);
    ReadProperty(onlineHelp, section, key::kOnlineHelp, status);
    ReadProperty(documentation, section, key::kDocumentation, status);
  }
  if (unitMode == UnitMode::Type || unitMode == UnitMode::Both) {
    if (HasKeyword(section, key::kUnqType)) {
      ReadProperty(unqType, section, key::kUnqType, status);
    } else {
      unqType.SetInt(kUserDefinedUnit);
    }
  }
  if (unitMode == UnitMode::Unit || unitMode == UnitMode::Both) {
    if (HasKeyword(section, key::kUnqUnit)) {
      ReadProperty(unqUnit, section, key::kUnqUnit, status);
    } else {
      unqUnit.SetInt(0);
    }
  }
  loaded = true;
  sourceLine = kvfGetLine(section);
}

void CEL_Element::WriteBase(KvfHandle file, int& status) {
  if (hasSymbol) WriteProperty(symbol, file, key::kSymbol, *this, status);
  if (hasId) WriteProperty(id, file, key::kId, *this, status);
  if (hasDescription) {
    WriteProperty(description, file, key::kDescription, *this, status);
    WriteProperty(onlineHelp, file, key::kOnlineHelp, *this, status);
    WriteProperty(documentation, file, key::kDocumentation, *this, status);
  }
  if (unitMode == UnitMode::Type || unitMode == UnitMode::Both) {
    WriteProperty(unqType, file, key::kUnqType, *this, status);
  }
  if (unitMode == UnitMode::Unit || unitMode == UnitMode::Both) {
    WriteProperty(unqUnit, file, key::kUnqUnit, *this, status);
  }
}

void CEL_Element::ReadOwn(KvfNode section, ReadStatus& status) {
  for (const bool last : {false, true}) {
    for (const PropertyRow& row : rows) {
      if (row.readLast != last || row.keyword.empty()) continue;
      if (!row.onlyWith.empty() && !HasKeyword(section, row.onlyWith)) continue;
      const bool isElsewhere =
          !row.writtenAs.empty() && !HasKeyword(section, row.keyword) && HasKeyword(section, row.writtenAs);
      if (isElsewhere) status.ReportMissing(section, row.keyword);
      ReadProperty(this->*row.place, section, isElsewhere ? row.writtenAs : row.keyword, status);
    }
  }
  SelectPresentValues();
}

void CEL_Element::WriteOwn(KvfHandle file, int& status) {
  for (const PropertyRow& row : rows) {
    const std::string_view keyword = row.writtenAs.empty() ? row.keyword : row.writtenAs;
    if (!keyword.empty()) WriteProperty(this->*row.place, file, keyword, *this, status);
  }
}

ElementField MakeField(std::string_view label, const CEL_Property& property) {
  ElementField field;
  field.name = label;
  switch (property.Type()) {
    case ValueType::Real:
      field.kind = FieldKind::Real;
      field.realValue = property.RealValue();
      break;
    case ValueType::Integer:
      field.kind = FieldKind::Integer;
      field.intValue = property.IntValue();
      break;
    case ValueType::Boolean:
      field.kind = FieldKind::Boolean;
      field.boolValue = property.BoolValue();
      break;
    case ValueType::Expression:
      field.kind = FieldKind::Expression;
      field.text = property.Text();
      break;
    default:
      field.kind = FieldKind::Text;
      field.text = property.Text();
      break;
  }
  for (const CEL_Choice& choice : property.Choices()) field.choiceTexts.push_back(choice.display);
  return field;
}

bool SetFromField(CEL_Property& property, const ElementField& field) {
  switch (field.kind) {
    case FieldKind::Text:
    case FieldKind::Expression:
      return property.SetText(field.text);
    case FieldKind::Integer:
      return property.SetInt(field.intValue);
    case FieldKind::Real:
      return property.SetReal(field.realValue);
    case FieldKind::Boolean:
      return property.SetBool(field.boolValue);
    case FieldKind::Invalid:
      break;
  }
  return false;
}

void CEL_Element::AppendCaption(std::vector<ElementField>& fields) const {
  ElementField caption;
  caption.kind = FieldKind::Text;
  caption.name = "Caption";
  caption.text = KindText();
  fields.push_back(std::move(caption));
}

void CEL_Element::AppendBaseFields(std::vector<ElementField>& fields) const {
  for (const BaseRow& row : kBaseRows) fields.push_back(MakeField(row.label, this->*row.property));
}

void CEL_Element::AppendOwnFields(std::vector<ElementField>& fields) const {
  for (const bool last : {false, true}) {
    for (const PropertyRow& row : rows) {
      if (row.listedLast == last) fields.push_back(MakeField(row.label, this->*row.place));
    }
  }
}

void CEL_Element::GetFields(std::vector<ElementField>& fields) const {
  if (!rows.empty()) AppendCaption(fields);
  AppendBaseFields(fields);
  AppendOwnFields(fields);
}

int CEL_Element::SetBaseFields(const std::vector<ElementField>& fields) {
  int found = 0;
  for (const BaseRow& row : kBaseRows) {
    const ElementField* field = FindField(fields, row.label);
    if (field != nullptr && SetFromField(this->*row.property, *field)) ++found;
  }
  return found;
}

int CEL_Element::SetOwnFields(const std::vector<ElementField>& fields) {
  int found = 0;
  for (const PropertyRow& row : rows) {
    const ElementField* field = FindField(fields, row.label);
    if (field != nullptr && SetFromField(this->*row.place, *field)) ++found;
  }
  return found;
}

int CEL_Element::SetFields(const std::vector<ElementField>& fields) {
  return SetBaseFields(fields) + SetOwnFields(fields);
}

std::string_view CEL_Element::LabelOf(const CEL_Property& property) const {
  for (const BaseRow& row : kBaseRows) {
    if (&(this->*row.property) == &property) return row.label;
  }
  for (const PropertyRow& row : rows) {
    if (&(this->*row.place) == &property) return row.label;
  }
  return {};
}

PropertyPlace CEL_Element::PlaceWithLabel(std::string_view label) const {
  for (const BaseRow& row : kBaseRows) {
    if (row.label == label) return row.property;
  }
  for (const PropertyRow& row : rows) {
    if (row.label == label) return row.place;
  }
  return nullptr;
}

std::vector<ElementValue> CEL_Element::Values() const {
  std::vector<ElementValue> values;
  for (const BaseRow& row : kBaseRows) {
    if (row.property != &CEL_Element::symbol && row.property != &CEL_Element::id)
      values.push_back({row.label, row.property});
  }
  for (const PropertyRow& row : rows) values.push_back({row.label, row.place});
  return values;
}

void CEL_Element::AppendTexts(std::vector<ElementText>& texts) const {
  const auto append = [this, &texts](std::string_view label, PropertyPlace place) {
    const CEL_Property& property = this->*place;
    if (IsTextType(property.Type()) && !property.HasChoices()) texts.push_back({label, &property});
  };
  for (const BaseRow& row : kBaseRows) append(row.label, row.property);
  for (const PropertyRow& row : rows) append(row.label, row.place);
}

bool CEL_Element::ParseExpression() {
  bool good = true;
  ForEachExpression([this, &good](const PropertyRow& row, const CEL_Property& expression) {
    good = CheckParses(*this, row.caption.empty() ? symbol.Text() : row.caption, expression) && good;
  });
  return good;
}

void CEL_Element::OnPropertyChanged(CEL_Property& /*changed*/) {
  RebuildOwner();
}

void CEL_Element::OnChanging(CEL_Property& property) {
  // Numbers follow from places.
  if (owner != nullptr && &property != &id) owner->OnChanging(*this, property);
}

void CEL_Element::FollowValues() {
  SelectPresentValues();
  UpdateLocks();
}

std::string CEL_Element::FullSymbol() const {
  std::string text;
  AppendFullSymbol(text);
  return text;
}

void CEL_Element::Renumber(std::int32_t number) {
  if (id.IntValue() == number) return;
  const ElementFacts known = Facts();
  id.SetInt(number);
  facts = known;
  facts.asOf = Changes();
}

void CEL_Element::RebuildOwner() {
  if (owner != nullptr) owner->RebuildSymbolTable();
}

void CEL_Element::SetVisibility(std::int32_t group, std::int32_t level) {
  const auto hit = std::find(visibility.begin(), visibility.end(), std::pair(group, level));
  if (hit == visibility.end()) {
    visibility.emplace_back(group, level);
  } else {
    visibility.erase(hit);
  }
}

void CEL_Element::RemoveVisibility(std::int32_t group, std::int32_t level) {
  std::erase(visibility, std::pair(group, level));
}

void CEL_Element::RemoveVisibilityGroup(std::int32_t group) {
  std::erase_if(visibility, [group](const auto& pair) { return pair.first == group; });
}

void CEL_Element::CloseVisibilityGroupGap(std::int32_t removedGroup) {
  for (auto& [group, level] : visibility) {
    if (group > removedGroup) --group;
  }
}

void CEL_Element::CloseVisibilityLevelGap(std::int32_t group, std::int32_t removedLevel) {
  for (auto& [itsGroup, level] : visibility) {
    if (itsGroup == group && level > removedLevel) --level;
  }
}

}  // namespace tessal
