// The base of every item of a template: a bundle of typed properties that reads itself from a key-file
// section, writes itself to one, checks itself and hands its values over as named fields.
#pragma once

#include <cstdint>
#include <initializer_list>
#include <span>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "elements/choices.h"
#include "elements/element_field.h"
#include "elements/element_kind.h"
#include "elements/property.h"
#include "keyfile/water_body.h"
#include "platform/kvf2004.h"
#include "platform/uid.h"

namespace tessal {

class CEL_Element;
class ElementOwner;
class ReadStatus;

/// Where an element holds a property.
using PropertyPlace = CEL_Property CEL_Element::*;

/// One row of the table that an element class is described by: where a property is, how it is called in the
/// file and by people, what it may hold, and what it starts with.
struct PropertyRow {
  PropertyPlace place;
  std::string_view keyword;  ///< empty for a property that the element's own section does not hold
  std::string_view label;
  ValueType type;
  ChoiceSource choices = nullptr;
  std::string_view defaultText{};  ///< as it is in the file
  double defaultNumber = 0.0;
  bool readLast = false;        ///< a value that is read after the bounds that limit it
  bool listedLast = false;      ///< comes after the others in the field list
  std::string_view onlyWith{};  ///< read only when the section has this keyword; without it the value stays
  /// Another keyword, under which a save writes the value. A load finds it there when its own is missing.
  std::string_view writtenAs{};
  std::string_view caption{};  ///< the item under which a failed parse is reported; else the symbol
};

/// The place of a property of an element class.
template <class Element>
constexpr PropertyPlace PlaceOf(CEL_Property Element::*property) {
  return static_cast<PropertyPlace>(property);
}

// A row with one of its less common columns.
constexpr PropertyRow ReadLast(PropertyRow row) {
  row.readLast = true;
  return row;
}
constexpr PropertyRow ListedLast(PropertyRow row) {
  row.listedLast = true;
  return row;
}
constexpr PropertyRow OnlyWith(std::string_view keyword, PropertyRow row) {
  row.onlyWith = keyword;
  return row;
}
constexpr PropertyRow WrittenAs(std::string_view keyword, PropertyRow row) {
  row.writtenAs = keyword;
  return row;
}
constexpr PropertyRow Captioned(std::string_view caption, PropertyRow row) {
  row.caption = caption;
  return row;
}

/// A value of an element: the label of its field, and where its property is.
struct ElementValue {
  std::string_view label;
  PropertyPlace place;
};

/// A text that people write into an element: the label of its field, and its property.
struct ElementText {
  std::string_view label;
  const CEL_Property* property;
};

/// Which unit data an element has in the file.
enum class UnitMode : std::uint8_t { None = 0, Type = 1, Unit = 2, Both = 3 };

/// What passes over a template have found out about an element, and need not find out again before one of its
/// properties changes.
struct ElementFacts {
  std::uint32_t asOf = 0;        ///< the number of changes then
  std::uint32_t sequence = 0;    ///< of its last record in the symbol table; 0 before it has one
  std::uint32_t symbolName = 0;  ///< the number of its symbol among the template's names; 0 before it has one
  std::uint32_t cleanSince =
      0;  ///< the user function names with which a check found nothing; 0 before one did
  bool knowsPlace = false;
  Scope scope = Scope::Global;
  SpatialVariation spatial = SpatialVariation::None;
};

class CEL_Element : public PropertyHolder {
  // First, side by side: every pass over a template looks at it.
  ElementFacts facts;
  bool hasDescription;
  bool hasSymbol;
  bool hasId;
  bool loaded = false;
  // The expressions are rows side by side. A rebuild asks every element for them, and searches for none.
  std::uint8_t firstExpression = 0;
  std::uint8_t expressions = 0;
  UnitMode unitMode = UnitMode::None;
  Uid uid;
  ElementKind elementKind = ElementKind::None;
  int sourceLine = 0;
  CEL_Element* listHeader = nullptr;
  CEL_Element* parent = nullptr;
  ElementOwner* owner = nullptr;
  std::vector<std::pair<std::int32_t, std::int32_t>> visibility;
  std::span<const PropertyRow> rows;

 public:
  /// A list head or the root: the flags say what it reads and writes.
  CEL_Element(bool withSymbol, bool withId, bool withDescription);
  /// An element with all three, and a caption in its symbol.
  explicit CEL_Element(std::string_view caption);
  virtual ~CEL_Element() = default;

  /// Fills the properties from a key-file section; a node that is no section leaves the element alone.
  virtual void Read(KvfNode section, ReadStatus& status);
  /// Writes the properties as keywords into the section that the caller has opened.
  virtual void Write(KvfHandle file, int& status);
  /// Returns the properties to the defaults of the class.
  virtual void Reset() {}
  /// Reports each problem to the registry; true when there is none.
  virtual bool Check() { return true; }
  /// Compiles the expressions, reports failures; true when all compiled.
  virtual bool ParseExpression();
  /// Appends a named field for each property.
  virtual void GetFields(std::vector<ElementField>& fields) const;
  /// Sets each property that the list has a field for; the count of fields found.
  virtual int SetFields(const std::vector<ElementField>& fields);

  void OnPropertyChanged(CEL_Property& changed) override;
  void OnTableChanged() override { RebuildOwner(); }
  void OnChanging(CEL_Property& property) override;

  /// Makes editable what the present values leave to the modeller, and locks what they fix: after a load, a
  /// reset, and a change of what decides it. Values stay as they are.
  virtual void UpdateLocks() {}
  /// After values were put back as they were: what follows from them (choices, selections, locks) does too.
  /// No value changes.
  virtual void FollowValues();
  /// The element leaves its template, and may come back.
  virtual void Withdraw() {}

  /// Calls the visitor with each expression, its row and its property, in the order of the class's table.
  template <class Visitor>
  void ForEachExpression(Visitor visit) const {
    for (const PropertyRow& row : ExpressionRows()) visit(row, this->*row.place);
  }
  template <class Visitor>
  void ForEachExpression(Visitor visit) {
    for (const PropertyRow& row : ExpressionRows()) visit(row, this->*row.place);
  }
  /// The class's table, in the order of the file; empty for a list head.
  std::span<const PropertyRow> Rows() const { return rows; }
  /// The rows of the expressions, in the order of the class's table, where they are side by side.
  std::span<const PropertyRow> ExpressionRows() const { return rows.subspan(firstExpression, expressions); }

  /// The label of one of the element's properties; empty for any other.
  std::string_view LabelOf(const CEL_Property& property) const;
  /// Where the property with a label is; none for any other text.
  PropertyPlace PlaceWithLabel(std::string_view label) const;
  /// All properties of the class but the symbol and the number.
  std::vector<ElementValue> Values() const;
  /// Appends the texts and expressions, in the order of field lists. What is chosen from a list is none.
  void AppendTexts(std::vector<ElementText>& texts) const;

  bool HasExpression() const { return expressions > 0; }
  /// What the symbol table holds for an element without expressions: the number of an input, the name that a
  /// search looks for.
  virtual std::string RecordText() const { return {}; }

  /// Points each property's selection at the choice of its value.
  void SelectPresentValues();

  /// Takes the values of another element of the same class, but for its symbol and its number. Nobody hears
  /// of it; choices and locks follow.
  void TakeValuesOf(const CEL_Element& other);

  /// Empties the descriptive texts.
  void ClearTexts();

  /// The identity: never 0, never reused, not stored, the same through renames and moves.
  Uid GetUid() const { return uid; }

  /// Appends what the symbol table and messages call the element: its symbol, for a movement with its class.
  virtual void AppendFullSymbol(std::string& text) const { text += symbol.Text(); }
  std::string FullSymbol() const;

  ElementKind Kind() const { return elementKind; }
  std::string_view KindText() const { return tessal::KindText(elementKind); }

  /// The element's place in the tree: a list head, or the root.
  CEL_Element* Parent() const { return parent; }
  /// For a member of a particle class the list head of its list; none else.
  CEL_Element* ListHeader() const { return listHeader; }
  void SetParent(CEL_Element* element) { parent = element; }
  void SetListHeader(CEL_Element* head) { parent = listHeader = head; }
  ElementOwner* Owner() const { return owner; }
  virtual void SetOwner(ElementOwner* template_) { owner = template_; }

  /// The flag that a change of the element or of one of its properties sets.
  virtual void SetModifiedFlag(bool* flag) { SetFlag(flag); }

  /// Has the template, if there is one, bring its symbol table up to date.
  void RebuildOwner();

  /// What is known of the element as it is.
  ElementFacts& Facts() {
    if (facts.asOf != Changes()) facts = {.asOf = Changes()};
    return facts;
  }
  /// A new number among the elements, which changes nothing that is known.
  void Renumber(std::int32_t number);

  /// Whether the element was read from a file or shown in a form.
  bool Loaded() const { return loaded; }
  void SetLoaded(bool value) { loaded = value; }
  /// The line of the file, from 1, at which the element's section begins; 0 for one that was not read.
  int SourceLine() const { return sourceLine; }

  /// Memberships in visibility groups: pairs of a group's and a level's number, both from 1.
  const std::vector<std::pair<std::int32_t, std::int32_t>>& Visibility() const { return visibility; }
  /// Adds the pair, or removes it if it is there already.
  void SetVisibility(std::int32_t group, std::int32_t level);
  void RemoveVisibility(std::int32_t group, std::int32_t level);
  void RemoveVisibilityGroup(std::int32_t group);
  void ClearVisibility() { visibility.clear(); }
  /// Takes memberships of the groups (or, within a group, levels) after a removed one along to their new
  /// numbers.
  void CloseVisibilityGroupGap(std::int32_t removedGroup);
  void CloseVisibilityLevelGap(std::int32_t group, std::int32_t removedLevel);

  CEL_Property symbol{ValueType::Symbol};
  CEL_Property id{ValueType::Integer};
  CEL_Property description{ValueType::LongText};
  CEL_Property onlineHelp{ValueType::Text};
  CEL_Property documentation{ValueType::LongText};
  CEL_Property unqType{ValueType::Integer};
  CEL_Property unqUnit{ValueType::Integer};

 protected:
  void SetKind(ElementKind kindNumber) { elementKind = kindNumber; }
  /// A list head's kind, unit data and flags are set by who builds it.
  void SetUnitMode(UnitMode mode) { unitMode = mode; }
  void SetFileFlags(bool withSymbol, bool withId, bool withDescription);

  /// Takes the class's table, of which each class has one, and gives the properties in it their defaults.
  void Bind(std::span<const PropertyRow> classRows);
  void ListenTo(std::initializer_list<CEL_Property*> properties);

  void ReadBase(KvfNode section, ReadStatus& status);
  void WriteBase(KvfHandle file, int& status);
  /// The properties of the class's table, in its order, those that are read last after the others.
  void ReadOwn(KvfNode section, ReadStatus& status);
  void WriteOwn(KvfHandle file, int& status);
  void ResetOwn();
  /// The same as for a fresh element: no text stays a view into the file that it was read from.
  void RestartOwn();

  void AppendCaption(std::vector<ElementField>& fields) const;
  void AppendBaseFields(std::vector<ElementField>& fields) const;
  void AppendOwnFields(std::vector<ElementField>& fields) const;
  int SetBaseFields(const std::vector<ElementField>& fields);
  int SetOwnFields(const std::vector<ElementField>& fields);

  /// Offers the unit types, and selects the one of the present number.
  void OfferUnitTypes(const UnitTypes& types);
  /// What a new unit type does to the unit: a type that fixes it sets its text and its number and locks it. A
  /// number without a type counts as "User defined", and becomes it unless the family keeps it.
  void ApplyUnitType(const UnitTypes& types, CEL_Property& unit);
  /// Whether the present unit type leaves the unit to the modeller.
  bool LeavesUnitOpen(const UnitTypes& types) const;
  /// What a new scope does to the spatial variation. The caller brings the symbol table up to date.
  void ApplyScope(const CEL_Property& scope, CEL_Property& spatialVariation);
};

/// A list head or the root: an element that carries the descriptive texts of a collection.
class CEL_ListHead final : public CEL_Element {
 public:
  CEL_ListHead(ElementKind kindNumber, std::string_view caption);
};

/// A field that holds a property's value, with the allowed texts of a property that has choices.
ElementField MakeField(std::string_view label, const CEL_Property& property);

/// Sets a property from a field of its kind; false when the kinds do not fit.
bool SetFromField(CEL_Property& property, const ElementField& field);

/// The counter of the identities: the next element of the process gets this number plus 1. For tests.
void ResetElementUids();

}  // namespace tessal
