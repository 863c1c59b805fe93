// One typed value of a template element, with its previous value, its allowed choices and its listeners.
// Every change goes through a setter: it keeps the old value, marks the template as modified and, while
// change notifications are on, calls the listeners.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace tessal {

enum class ValueType : std::int32_t {
  Real = 1,
  Integer = 2,
  Boolean = 3,
  Text = 4,
  Expression = 5,
  Symbol = 6,
  LongText = 7
};

/// Whether values of this type are text (types 4 to 7).
constexpr bool IsTextType(ValueType type) {
  return type >= ValueType::Text;
}

/// One allowed value of a property.
struct CEL_Choice {
  static constexpr std::int32_t kNumber = 2;
  static constexpr std::int32_t kText = 4;

  std::int32_t kind = kText;
  std::string display;         ///< selects it, and is what forms show
  std::int32_t intValue = -1;  ///< the number of a numbered choice
  bool boolValue = false;
  std::string fileText;  ///< what a text choice stores; empty for a numbered one
  double realValue = 0.0;
  bool enabled = true;

  static CEL_Choice Number(std::string_view display, std::int32_t value);
  static CEL_Choice Text(std::string_view display, std::string_view fileText);
  static CEL_Choice Boolean(std::string_view display, bool value);
};

/// A list of choices that properties may share until one of them changes its own.
using ChoiceList = std::shared_ptr<const std::vector<CEL_Choice>>;

class CEL_Property;
struct ParsedExpression;

/// Who wants to know of changes. Called after the change, in order of registration.
class PropertyListener {
 public:
  virtual void OnPropertyChanged(CEL_Property& changed) = 0;

 protected:
  PropertyListener() = default;
  PropertyListener(const PropertyListener&) = default;
  PropertyListener& operator=(const PropertyListener&) = default;
  ~PropertyListener() = default;
};

/// The words of a boolean, in files and choices.
inline constexpr std::string_view kYes = "YES";
inline constexpr std::string_view kNo = "NO";

/// The process-wide switch of all listeners. Off at start, during a load and during a rebuild.
bool NotifyChanges();
void SetNotifyChanges(bool on);

/// Turns notifications off for its lifetime, and on again at the end if they were on.
class NotificationsOff final {
 public:
  NotificationsOff() : wereOn(NotifyChanges()) { SetNotifyChanges(false); }
  ~NotificationsOff() {
    if (wereOn) SetNotifyChanges(true);
  }
  NotificationsOff(const NotificationsOff&) = delete;
  NotificationsOff& operator=(const NotificationsOff&) = delete;

 private:
  bool wereOn;
};

class CEL_Property final {
 public:
  explicit CEL_Property(ValueType valueType);
  ~CEL_Property();
  CEL_Property(const CEL_Property&) = delete;
  CEL_Property& operator=(const CEL_Property&) = delete;

  ValueType Type() const { return type; }
  std::int32_t IntValue() const { return intValue; }
  double RealValue() const { return realValue; }
  bool BoolValue() const { return boolValue; }
  const std::string& Text() const { return text; }
  std::int32_t PrevInt() const { return Former().intValue; }
  double PrevReal() const { return Former().realValue; }
  bool PrevBool() const { return Former().boolValue; }
  const std::string& PrevText() const { return Former().text; }

  /// Setters. Each returns false, and does nothing, on a property that does not hold that type of value;
  /// setting the present value is no change.
  bool SetInt(std::int32_t value);
  bool SetReal(double value);
  bool SetBool(bool value);
  bool SetText(std::string_view value);

  /// The value as text: numbers in decimal, booleans as "YES" or "NO", texts as they are.
  std::string TextOf() const;

  /// The parse of an expression, its quotes stripped. It is held beside the text and made when it is first
  /// asked for after a change; asking has the effect of a parse on the scanner's start all the same.
  const ParsedExpression& Parsed() const;

  /// A number that identifies the property to its listeners, drawn on first need.
  std::int32_t ChangeStamp();

  void SetModifiedFlag(bool* flag) { modifiedFlag = flag; }

  bool Editable() const { return editable; }
  void SetEditable(bool value) { editable = value; }
  bool Visible() const { return visible; }
  void SetVisible(bool value) { visible = value; }

  /// Writes whole numbers so that they read as reals.
  bool ForceReal() const { return forceReal; }
  void SetForceReal(bool value) { forceReal = value; }

  const std::vector<CEL_Choice>& Choices() const;
  bool HasChoices() const { return choices && !choices->empty(); }
  /// Takes a list that others may hold too. The selection is kept only as an index.
  void SetChoices(ChoiceList list) { choices = std::move(list); }
  void AddChoice(CEL_Choice choice);
  void ClearChoices() { choices.reset(); }
  bool HasChoice(std::string_view display) const;

  /// Index of the first choice of the present value, -1 for none. A NaN is like nothing.
  std::int32_t PresentChoice() const;

  /// Index of the selected choice, -1 for none.
  std::int32_t Selected() const { return selected; }
  /// Selects the first choice with exactly this display text, or none.
  void SelectChoice(std::string_view display);
  void SelectIndex(std::int32_t index) { selected = index; }
  /// Copies the selected choice's value into the property; nothing when none is selected.
  /// An index beyond the choices raises the standard out-of-range failure.
  void ApplySelection();
  /// The stored text of the selected choice, or the empty text.
  std::string SelectedFileText() const;

  /// Registers a listener once; a second registration of the same one is ignored.
  void AddListener(PropertyListener& listener);

  /// Marks the template as modified and calls the listeners, as a change of value does.
  void RaiseChange();

 private:
  struct Value {
    std::int32_t intValue = 0;
    bool boolValue = false;
    double realValue = 0.0;
    std::string text;
  };

  /// The value before the last change.
  const Value& Former() const;
  Value& KeptFormer();

  ValueType type;
  std::int32_t intValue = 0;
  double realValue = 0.0;
  std::string text;
  bool boolValue = false;
  bool editable = true;
  bool visible = true;
  bool forceReal = false;
  std::int32_t selected = -1;
  std::int32_t changeStamp = 0;
  bool* modifiedFlag = nullptr;
  ChoiceList choices;
  // A template has millions of properties, and few that were changed twice or have a listener.
  std::unique_ptr<Value> former;
  std::unique_ptr<std::vector<PropertyListener*>> listeners;
  mutable std::unique_ptr<const ParsedExpression> parsed;
};

}  // namespace tessal
