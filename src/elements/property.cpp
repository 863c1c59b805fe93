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

struct CEL_Property::Extra {
  std::string text;  ///< the value of a property whose text was set, not lent
  std::string formerText;
  double formerReal = 0.0;
  std::int32_t formerInt = 0;
  std::int32_t changeStamp = 0;
  bool formerBool = false;
  ChoiceList ownChoices;
  std::vector<PropertyListener*> listeners;
};

static_assert(sizeof(void*) != 8 || sizeof(CEL_Property) == 48, "a template has millions of them");

CEL_Property::CEL_Property(ValueType valueType)
    : selected(0),
      type(valueType),
      reportsTo(ReportsTo::Nobody),
      editable(true),
      visible(true),
      forceReal(false) {
  if (IsTextType(valueType)) {
    value.text = "";
  } else if (valueType == ValueType::Real) {
    value.real = 0.0;
  } else {
    value.integer = 0;
  }
}

CEL_Property::~CEL_Property() = default;

CEL_Property::Extra& CEL_Property::More() {
  if (!extra) extra = std::make_unique<Extra>();
  return *extra;
}

template <class Former>
void CEL_Property::KeepFormer(Former Extra::*former, Former previous) {
  // Without it the former value is that of a fresh property.
  if (previous != Former() || extra) More().*former = std::move(previous);
}

std::int32_t CEL_Property::PrevInt() const {
  return extra ? extra->formerInt : 0;
}

double CEL_Property::PrevReal() const {
  return extra ? extra->formerReal : 0.0;
}

bool CEL_Property::PrevBool() const {
  return extra && extra->formerBool;
}

std::string_view CEL_Property::PrevText() const {
  return extra ? std::string_view(extra->formerText) : std::string_view();
}

bool CEL_Property::SetInt(std::int32_t number) {
  if (Type() != ValueType::Integer) return false;
  if (number == value.integer) return true;
  AnnounceChange();
  KeepFormer(&Extra::formerInt, value.integer);
  value.integer = number;
  RaiseChange();
  return true;
}

bool CEL_Property::SetReal(double number) {
  if (Type() != ValueType::Real) return false;
  if (number == value.real) return true;
  AnnounceChange();
  KeepFormer(&Extra::formerReal, value.real);
  value.real = number;
  RaiseChange();
  return true;
}

bool CEL_Property::SetBool(bool truth) {
  if (Type() != ValueType::Boolean) return false;
  if (truth == value.boolean) return true;
  AnnounceChange();
  KeepFormer(&Extra::formerBool, value.boolean);
  value.boolean = truth;
  RaiseChange();
  return true;
}

bool CEL_Property::SetText(std::string_view text) {
  if (!IsTextType(Type())) return false;
  if (text == Text()) return true;
  std::string replacement(text);  // the view may lie in the text that is replaced
  AnnounceChange();
  Extra& more = More();
  more.formerText = Text();
  more.text = std::move(replacement);
  PointTo(more.text);
  RaiseChange();
  return true;
}

void CEL_Property::StartWith(std::int32_t number) {
  if (number == value.integer) return;
  value.integer = number;
  MarkModified();
}

void CEL_Property::StartWith(double number) {
  if (number == value.real) return;
  value.real = number;
  MarkModified();
}

void CEL_Property::StartWith(bool truth) {
  if (truth == value.boolean) return;
  value.boolean = truth;
  MarkModified();
}

void CEL_Property::StartWithText(std::string_view lasting) {
  if (lasting == Text()) {
    // The same text may be about to go from where it was.
    PointTo(lasting);
    return;
  }
  PointTo(lasting);
  if (extra) extra->text.clear();
  MarkModified();
}

void CEL_Property::PointTo(std::string_view lasting) {
  value.text = lasting.empty() ? "" : lasting.data();
  textSize = static_cast<std::uint32_t>(lasting.size());
  parsed.reset();
}

std::string CEL_Property::TextOf() const {
  switch (Type()) {
    case ValueType::Real:
      return PlainNumberText(RealValue());
    case ValueType::Integer:
      return std::to_string(IntValue());
    case ValueType::Boolean:
      return std::string(BoolValue() ? kYes : kNo);
    default:
      return std::string(Text());
  }
}

const ParsedExpression& CEL_Property::Parsed() const {
  return ParseOnce(parsed, StripExpressionQuotes(Text()));
}

std::int32_t CEL_Property::ChangeStamp() {
  Extra& more = More();
  if (more.changeStamp == 0) more.changeStamp = NextValueSerial();
  return more.changeStamp;
}

const std::vector<CEL_Choice>& CEL_Property::Choices() const {
  static const std::vector<CEL_Choice> kNone;
  return choices != nullptr ? *choices : kNone;
}

void CEL_Property::SetChoices(ChoiceList list) {
  choices = list.get();
  if (list || extra) More().ownChoices = std::move(list);
}

void CEL_Property::OfferStanding(const ChoiceList& list) {
  if (extra) extra->ownChoices.reset();
  choices = list.get();
}

void CEL_Property::AddChoice(CEL_Choice choice) {
  std::vector<CEL_Choice> own = Choices();
  own.push_back(std::move(choice));
  SetChoices(std::make_shared<const std::vector<CEL_Choice>>(std::move(own)));
}

bool CEL_Property::HasChoice(std::string_view display) const {
  const auto& list = Choices();
  return std::any_of(list.begin(), list.end(),
                     [display](const CEL_Choice& choice) { return choice.display == display; });
}

std::int32_t CEL_Property::PresentChoice() const {
  const auto& all = Choices();
  const auto hit = std::find_if(all.begin(), all.end(), [this](const CEL_Choice& choice) {
    switch (Type()) {
      case ValueType::Real:
        return choice.realValue == value.real;
      case ValueType::Integer:
        return choice.intValue == value.integer;
      case ValueType::Boolean:
        return choice.boolValue == value.boolean;
      default:
        return choice.fileText == Text();
    }
  });
  return hit == all.end() ? -1 : static_cast<std::int32_t>(hit - all.begin());
}

void CEL_Property::SelectChoice(std::string_view display) {
  const auto& list = Choices();
  const auto hit = std::find_if(list.begin(), list.end(),
                                [display](const CEL_Choice& choice) { return choice.display == display; });
  SelectIndex(hit == list.end() ? -1 : static_cast<std::int32_t>(hit - list.begin()));
}

void CEL_Property::ApplySelection() {
  if (Selected() < 0) return;
  const CEL_Choice& choice = Choices().at(static_cast<std::size_t>(Selected()));
  switch (Type()) {
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
  const auto index = static_cast<std::size_t>(Selected());
  return Selected() >= 0 && index < list.size() ? list[index].fileText : std::string();
}

void CEL_Property::AddListener(PropertyListener& listener) {
  auto& listeners = More().listeners;
  if (std::find(listeners.begin(), listeners.end(), &listener) == listeners.end()) {
    listeners.push_back(&listener);
  }
}

void CEL_Property::RaiseChange() {
  MarkModified();
  if (!NotifyChanges()) return;
  if (holder != nullptr && reportsTo == ReportsTo::Holder) {
    holder->OnPropertyChanged(*this);
  } else if (holder != nullptr && reportsTo == ReportsTo::Table) {
    holder->OnTableChanged();
  }
  if (!extra) return;
  // By index: a listener may register another one while it is called.
  // NOLINTNEXTLINE(modernize-loop-convert)
  for (std::size_t index = 0; index < extra->listeners.size(); ++index)
    extra->listeners[index]->OnPropertyChanged(*this);
}

}  // namespace tessal
