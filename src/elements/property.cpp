#include "elements/property.h"

#include <algorithm>
#include <utility>

#include "expr/parser.h"
#include "expr/scanner.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

bool& NotificationSwitch() {
  static bool on = false;
  return on;
}

std::int32_t NextValueSerial() {
  static std::int32_t serial = 0;
  return ++serial;
}

}  // namespace

CEL_Choice CEL_Choice::Number(std::string_view display, std::int32_t value) {
  CEL_Choice choice;
  choice.kind = kNumber;
  choice.display = display;
  choice.intValue = value;
  return choice;
}

CEL_Choice CEL_Choice::Text(std::string_view display, std::string_view fileText) {
  CEL_Choice choice;
  choice.display = display;
  choice.fileText = fileText;
  return choice;
}

CEL_Choice CEL_Choice::Boolean(std::string_view display, bool value) {
  CEL_Choice choice = Text(display, display);
  choice.boolValue = value;
  return choice;
}

bool NotifyChanges() {
  return NotificationSwitch();
}

void SetNotifyChanges(bool on) {
  NotificationSwitch() = on;
}

CEL_Property::CEL_Property(ValueType valueType) : type(valueType) {}

CEL_Property::~CEL_Property() = default;

bool CEL_Property::SetInt(std::int32_t value) {
  if (type != ValueType::Integer) return false;
  if (value == intValue) return true;
  if (intValue != 0 || former) KeptFormer().intValue = intValue;
  intValue = value;
  RaiseChange();
  return true;
}

bool CEL_Property::SetReal(double value) {
  if (type != ValueType::Real) return false;
  if (value == realValue) return true;
  if (realValue != 0.0 || former) KeptFormer().realValue = realValue;
  realValue = value;
  RaiseChange();
  return true;
}

bool CEL_Property::SetBool(bool value) {
  if (type != ValueType::Boolean) return false;
  if (value == boolValue) return true;
  if (boolValue || former) KeptFormer().boolValue = boolValue;
  boolValue = value;
  RaiseChange();
  return true;
}

bool CEL_Property::SetText(std::string_view value) {
  if (!IsTextType(type)) return false;
  if (value == text) return true;
  std::string replacement(value);  // the view may lie in the text that is replaced
  if (!text.empty() || former) KeptFormer().text = std::move(text);
  text = std::move(replacement);
  parsed.reset();
  RaiseChange();
  return true;
}

const CEL_Property::Value& CEL_Property::Former() const {
  static const Value none;
  return former ? *former : none;
}

CEL_Property::Value& CEL_Property::KeptFormer() {
  if (!former) former = std::make_unique<Value>();
  return *former;
}

std::string CEL_Property::TextOf() const {
  switch (type) {
    case ValueType::Real:
      return PlainNumberText(realValue);
    case ValueType::Integer:
      return std::to_string(intValue);
    case ValueType::Boolean:
      return std::string(boolValue ? kYes : kNo);
    default:
      return text;
  }
}

const ParsedExpression& CEL_Property::Parsed() const {
  return ParseOnce(parsed, StripExpressionQuotes(text));
}

std::int32_t CEL_Property::ChangeStamp() {
  if (changeStamp == 0) changeStamp = NextValueSerial();
  return changeStamp;
}

const std::vector<CEL_Choice>& CEL_Property::Choices() const {
  static const std::vector<CEL_Choice> kNone;
  return choices ? *choices : kNone;
}

void CEL_Property::AddChoice(CEL_Choice choice) {
  std::vector<CEL_Choice> own = Choices();
  own.push_back(std::move(choice));
  choices = std::make_shared<const std::vector<CEL_Choice>>(std::move(own));
}

bool CEL_Property::HasChoice(std::string_view display) const {
  const auto& list = Choices();
  return std::any_of(list.begin(), list.end(),
                     [display](const CEL_Choice& choice) { return choice.display == display; });
}

std::int32_t CEL_Property::PresentChoice() const {
  const auto& all = Choices();
  const auto hit = std::find_if(all.begin(), all.end(), [this](const CEL_Choice& choice) {
    switch (type) {
      case ValueType::Real:
        return choice.realValue == realValue;
      case ValueType::Integer:
        return choice.intValue == intValue;
      case ValueType::Boolean:
        return choice.boolValue == boolValue;
      default:
        return choice.fileText == text;
    }
  });
  return hit == all.end() ? -1 : static_cast<std::int32_t>(hit - all.begin());
}

void CEL_Property::SelectChoice(std::string_view display) {
  const auto& list = Choices();
  const auto hit = std::find_if(list.begin(), list.end(),
                                [display](const CEL_Choice& choice) { return choice.display == display; });
  selected = hit == list.end() ? -1 : static_cast<std::int32_t>(hit - list.begin());
}

void CEL_Property::ApplySelection() {
  if (selected < 0) return;
  const CEL_Choice& choice = Choices().at(static_cast<std::size_t>(selected));
  switch (type) {
    case ValueType::Real:
      SetReal(choice.realValue);
      break;
    case ValueType::Integer:
      SetInt(choice.intValue);
      break;
    case ValueType::Boolean:
      SetBool(choice.boolValue);
      break;
    default:
      SetText(choice.fileText);
      break;
  }
}

std::string CEL_Property::SelectedFileText() const {
  const auto& list = Choices();
  const auto index = static_cast<std::size_t>(selected);
  return selected >= 0 && index < list.size() ? list[index].fileText : std::string();
}

void CEL_Property::AddListener(PropertyListener& listener) {
  if (!listeners) listeners = std::make_unique<std::vector<PropertyListener*>>();
  if (std::find(listeners->begin(), listeners->end(), &listener) == listeners->end()) {
    listeners->push_back(&listener);
  }
}

void CEL_Property::RaiseChange() {
  if (modifiedFlag != nullptr) *modifiedFlag = true;
  if (!NotifyChanges() || !listeners) return;
  // By index: a listener may register another one while it is called.
  // NOLINTNEXTLINE(modernize-loop-convert)
  for (std::size_t index = 0; index < listeners->size(); ++index)
    (*listeners)[index]->OnPropertyChanged(*this);
}

}  // namespace tessal
