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

enum class ValueType : std::uint8_t {
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
class ParsedExpression;

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

/// What properties belong to, and what a change of them marks as modified. It hears of the changes of those
/// that are to report to it, before any listener.
class PropertyHolder : public PropertyListener {
 public:
  PropertyHolder(const PropertyHolder&) = delete;
  PropertyHolder& operator=(const PropertyHolder&) = delete;

  /// A property that reports to the symbol table only has changed.
  virtual void OnTableChanged() = 0;
  /// A setter is about to give the property another value. Not called for the value that a file gives.
  virtual void OnChanging(CEL_Property& /*property*/) {}
  void MarkModified() {
    ++changes;
    if (modifiedFlag != nullptr) *modifiedFlag = true;
  }
  /// How often one of the properties has changed.
  std::uint32_t Changes() const { return changes; }

 protected:
  PropertyHolder() = default;
  ~PropertyHolder() = default;
  void SetFlag(bool* flag) { modifiedFlag = flag; }

 private:
  bool* modifiedFlag = nullptr;
  std::uint32_t changes = 0;
};

/// Whom a property reports its changes to beside its listeners: nobody, the symbol table of the template, or
/// its holder. The holder does more than the table needs.
enum class ReportsTo : std::uint8_t { Nobody, Table, Holder };

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
  std::int32_t IntValue() const { return Type() == ValueType::Integer ? value.integer : 0; }
  double RealValue() const { return Type() == ValueType::Real ? value.real : 0.0; }
  bool BoolValue() const { return Type() == ValueType::Boolean && value.boolean; }
  /// Good until the next change.
  std::string_view Text() const {
    return IsTextType(Type()) ? std::string_view(value.text, textSize) : std::string_view();
  }
  std::int32_t PrevInt() const;
  double PrevReal() const;
  bool PrevBool() const;
  std::string_view PrevText() const;

  /// Setters. Each returns false, and does nothing, on a property that does not hold that type of value;
  /// setting the present value is no change.
  bool SetInt(std::int32_t number);
  bool SetReal(double number);
  bool SetBool(bool truth);
  bool SetText(std::string_view text);

  // The same for the value that a file or the class's table gives: nobody is called, and what was there
  // before is no former value. Of a text only the place is kept: it must outlive the property, or its next
  // change.
  void StartWith(std::int32_t number);
  void StartWith(double number);
  void StartWith(bool truth);
  void StartWithText(std::string_view lasting);

  /// The value as text: numbers in decimal, booleans as "YES" or "NO", texts as they are.
  std::string TextOf() const;

  /// The parse of an expression, its quotes stripped. It is held beside the text and made when it is first
  /// asked for after a change; asking has the effect of a parse on the scanner's start all the same.
  const ParsedExpression& Parsed() const;

  /// A number that identifies the property to its listeners, drawn on first need.
  std::int32_t ChangeStamp();

  void BelongTo(PropertyHolder& itsHolder) { holder = &itsHolder; }
  void ReportTo(ReportsTo whom) { reportsTo = whom; }

  bool Editable() const { return editable; }
  void SetEditable(bool isEditable) { editable = isEditable; }
  bool Visible() const { return visible; }
  void SetVisible(bool isVisible) { visible = isVisible; }

  /// Writes whole numbers so that they read as reals.
  bool ForceReal() const { return forceReal; }
  void SetForceReal(bool isForced) { forceReal = isForced; }

  const std::vector<CEL_Choice>& Choices() const;
  bool HasChoices() const { return choices != nullptr && !choices->empty(); }
  /// Takes a list that others may hold too. The selection is kept only as an index.
  void SetChoices(ChoiceList list);
  /// The same for a list that is there for as long as the process.
  void OfferStanding(const ChoiceList& list);
  void AddChoice(CEL_Choice choice);
  void ClearChoices() { SetChoices({}); }
  bool HasChoice(std::string_view display) const;

  /// Index of the first choice of the present value, -1 for none. A NaN is like nothing.
  std::int32_t PresentChoice() const;

  /// Index of the selected choice, -1 for none.
  std::int32_t Selected() const { return static_cast<std::int32_t>(selected) - 1; }
  /// Selects the first choice with exactly this display text, or none.
  void SelectChoice(std::string_view display);
  void SelectIndex(std::int32_t index) { selected = static_cast<std::uint32_t>(index + 1) & kMostChoices; }
  /// Copies the selected choice's value into the property; nothing when none is selected.
  /// An index beyond the choices raises the standard out-of-range failure.
  void ApplySelection();
  /// The stored text of the selected choice, or the empty text.
  std::string SelectedFileText() const;

  /// Registers a listener once; a second registration of the same one is ignored.
  void AddListener(PropertyListener& listener);

  /// Marks the template as modified and calls the holder and the listeners, as a change of value does.
  void RaiseChange();

 private:
  /// A file of the largest size has fewer elements to choose from.
  static constexpr std::uint32_t kMostChoices = (1U << 24U) - 1U;

  union Value {
    double real;
    std::int32_t integer;
    bool boolean;
    const char* text;
  };

  /// What few properties have: a template has millions of them, most as the file gave them.
  struct Extra;

  Extra& More();
  /// Keeps the former value, where there is one, beside a new one.
  template <class Former>
  void KeepFormer(Former Extra::*former, Former previous);
  void PointTo(std::string_view lasting);
  void AnnounceChange() {
    if (holder != nullptr) holder->OnChanging(*this);
  }
  void MarkModified() {
    if (holder != nullptr) holder->MarkModified();
  }

  Value value;
  PropertyHolder* holder = nullptr;
  const std::vector<CEL_Choice>* choices = nullptr;
  std::unique_ptr<Extra> extra;
  mutable std::unique_ptr<const ParsedExpression> parsed;
  std::uint32_t textSize = 0;
  std::uint32_t selected : 24;  ///< from 1; 0 for none
  ValueType type : 3;
  ReportsTo reportsTo : 2;
  bool editable : 1;
  bool visible : 1;
  bool forceReal : 1;
};

}  // namespace tessal
