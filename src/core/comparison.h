// What differs between two templates, by symbol: which elements were added, removed, renamed or changed, and
// in which fields. Settings, user functions, the texts of lists, visibility groups and further sections of
// the file count as items with a name of their own.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace tessal {

class TemplateCore;

enum class ChangeKind : std::uint8_t { Removed, Added, Changed, Renamed };

/// One field of an item that both templates hold. A field that only one of them has is empty in the other.
struct FieldChange {
  std::string
      field;  ///< its label; "Kind" for the kind of an element, "Comes after" for its place in its list
  std::string before;
  std::string after;
  bool isExpression = false;
};

struct SymbolChange {
  ChangeKind change;
  std::string kind;    ///< of the item, for people: in the template that has it, or the later one
  std::string symbol;  ///< of the element, or the item's name
  std::vector<FieldChange> fields;  ///< of a changed or renamed item, in the order of its fields
  std::string formerSymbol{};       ///< of a renamed element
  std::string specie{};             ///< the particle class that it belongs to, in the template that has it
};

/// The differences between a template and a later state of it: what is removed, then what is added, then what
/// is renamed or changed, each in the order of the template. Elements count as renamed by the rule of
/// `core/matching.h`, and what a rename alone changes in expressions, links and groups is no difference. An
/// element that only gave way to others has not changed its place. The revision, which every save raises, and
/// the numbers of elements, which follow from their places, are no differences. Several items of one name are
/// matched in their order.
std::vector<SymbolChange> CompareBySymbol(const TemplateCore& former, const TemplateCore& later);

}  // namespace tessal
