#include "tessal/element.h"

#include <charconv>
#include <cmath>
#include <cstddef>
#include <system_error>

#include "core/edit_history.h"
#include "core/rebuild_off.h"
#include "elements/element.h"
#include "elements/property_io.h"
#include "elements/specie.h"
#include "library/template_data.h"

namespace tessal {
inline namespace v1 {

namespace {

/// Whether a kind of the surface has the number that the library's inside gives it.
constexpr bool IsSame(Kind shown, ElementKind inside) {
  return static_cast<std::int32_t>(shown) == NumberOf(inside);
}

static_assert(IsSame(Kind::StateVariable, ElementKind::StateVariable) &&
              IsSame(Kind::Constant, ElementKind::Constant) && IsSame(Kind::Forcing, ElementKind::Forcing) &&
              IsSame(Kind::Auxiliary, ElementKind::Auxiliary) &&
              IsSame(Kind::Process, ElementKind::Process) &&
              IsSame(Kind::DerivedOutput, ElementKind::DerivedOutput) &&
              IsSame(Kind::ParticleClass, ElementKind::Specie) &&
              IsSame(Kind::ParticleStateVariable, ElementKind::SpecieStateVariable) &&
              IsSame(Kind::ParticleConstant, ElementKind::SpecieConstant) &&
              IsSame(Kind::ParticleForcing, ElementKind::SpecieForcing) &&
              IsSame(Kind::AreaSearch, ElementKind::SpatialFunction) &&
              IsSame(Kind::ArithmeticExpression, ElementKind::ArithmeticExpression) &&
              IsSame(Kind::HorizontalMovement, ElementKind::HorizontalVector) &&
              IsSame(Kind::VerticalMovement, ElementKind::VerticalEquation));

/// The value that a choice gives a property of that type, as text.
std::string ValueOf(const CEL_Choice& choice, ValueType type) {
  switch (type) {
    case ValueType::Integer:
      return std::to_string(choice.intValue);
    case ValueType::Boolean:
      return std::string(choice.boolValue ? kYes : kNo);
    default:
      return choice.fileText;
  }
}

Field FieldOf(std::string_view label, const CEL_Property& property) {
  Field field{std::string(label), property.TextOf(), property.Editable(), {}};
  for (const CEL_Choice& choice : property.Choices()) {
    if (choice.enabled) field.choices.push_back(ValueOf(choice, property.Type()));
  }
  return field;
}

template <class Number>
std::optional<Number> NumberIn(std::string_view text) {
  Number number{};
  const auto read = std::from_chars(text.data(), text.data() + text.size(), number);
  const bool isAll = read.ec == std::errc() && read.ptr == text.data() + text.size();
  return isAll ? std::optional(number) : std::nullopt;
}

/// Sets a value of the property's own type. False for a text that is none.
bool SetValue(CEL_Property& property, std::string_view value) {
  switch (property.Type()) {
    case ValueType::Real: {
      const std::optional<double> number = NumberIn<double>(value);
      return number && std::isfinite(*number) && property.SetReal(*number);
    }
    case ValueType::Integer: {
      const std::optional<std::int32_t> number = NumberIn<std::int32_t>(value);
      return number && property.SetInt(*number);
    }
    case ValueType::Boolean:
      return (value == kYes || value == kNo) && property.SetBool(value == kYes);
    default:
      return property.SetText(value);
  }
}

/// Selects the choice of that value, or the one that people see under that text. False when there is none.
bool Choose(CEL_Property& property, std::string_view value) {
  const std::vector<CEL_Choice>& choices = property.Choices();
  for (std::size_t index = 0; index < choices.size(); ++index) {
    const CEL_Choice& choice = choices[index];
    if (!choice.enabled || (ValueOf(choice, property.Type()) != value && choice.display != value)) continue;
    property.SelectIndex(static_cast<std::int32_t>(index));
    property.ApplySelection();
    return true;
  }
  return false;
}

std::string Quoted(std::string_view text) {
  return "'" + std::string(text) + "'";
}

/// Why a field can not be set, whatever the value; empty when it can.
std::string Obstacle(const CEL_Element& element, std::string_view label) {
  const PropertyPlace place = element.PlaceWithLabel(label);
  if (place == nullptr) return Quoted(element.FullSymbol()) + " has no field " + Quoted(label);
  const CEL_Property& property = element.*place;
  if (&property == &element.symbol) return "a rename changes symbols, and takes their uses along";
  if (&property == &element.id) return "the number of an element follows from its place";
  if (!property.Editable()) return Quoted(label) + " is fixed by another value of the element";
  return {};
}

}  // namespace

bool Element::Exists() const {
  return data->Find(*this) != nullptr;
}

std::string Element::Symbol() const {
  const CEL_Element* element = data->Find(*this);
  return element == nullptr ? std::string() : element->FullSymbol();
}

Kind Element::GetKind() const {
  const CEL_Element* element = data->Find(*this);
  return element == nullptr ? Kind::None : static_cast<Kind>(element->Kind());
}

std::string Element::ClassSymbol() const {
  const CEL_Element* element = data->Find(*this);
  if (element == nullptr || element->ListHeader() == nullptr) return {};
  const CEL_Lagrange_Specie* owner = data->Core().GetParentSpecie(element->ListHeader()->GetUid());
  return owner == nullptr ? std::string() : std::string(owner->symbol.Text());
}

std::vector<Field> Element::Fields() const {
  std::vector<Field> fields;
  const CEL_Element* element = data->Find(*this);
  if (element == nullptr) return fields;
  std::vector<ElementField> all;
  element->GetFields(all);
  for (const ElementField& field : all) {
    // The caption alone is no property: it says what the element is.
    const PropertyPlace place = element->PlaceWithLabel(field.name);
    if (place != nullptr) fields.push_back(FieldOf(field.name, element->*place));
  }
  return fields;
}

std::optional<std::string> Element::Get(std::string_view label) const {
  const CEL_Element* element = data->Find(*this);
  const PropertyPlace place = element == nullptr ? nullptr : element->PlaceWithLabel(label);
  return place == nullptr ? std::nullopt : std::optional((element->*place).TextOf());
}

Outcome Element::Set(std::string_view label, std::string_view value) {
  CEL_Element* element = data->Find(*this);
  if (element == nullptr) return {false, "the element was removed"};
  if (std::string obstacle = Obstacle(*element, label); !obstacle.empty()) {
    return {false, std::move(obstacle)};
  }
  CEL_Property& property = element->*element->PlaceWithLabel(label);
  TemplateCore& core = data->Core();
  const EditStep step(core.History());
  const RebuildOff untilTheNextQuestion(core);
  const std::string_view clean = CleanText(value);
  const bool isSet = property.HasChoices() ? Choose(property, clean) : SetValue(property, clean);
  if (!isSet) return {false, Quoted(label) + " can not be " + Quoted(value)};
  data->MarkStale();
  return {};
}

std::vector<Element> Element::Uses() const {
  std::vector<Element> used;
  const CEL_Element* element = data->Find(*this);
  if (element == nullptr) return used;
  for (const CEL_Element* other : data->Core().ReferencedElements(*element)) {
    used.push_back(data->HandleOf(*other));
  }
  return used;
}

std::vector<Element> Element::UsedBy() const {
  std::vector<Element> users;
  const CEL_Element* element = data->Find(*this);
  if (element == nullptr) return users;
  std::vector<Uid> uids;
  data->Core().GetReferrerUids(element->GetUid(), uids);
  for (const Uid user : uids) {
    if (const CEL_Element* found = data->Find(user)) users.push_back(data->HandleOf(*found));
  }
  return users;
}

}  // namespace v1
}  // namespace tessal
