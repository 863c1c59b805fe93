// What elements need of the template that owns them. The template implements it; elements know no more of it.
#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <memory>
#include <set>
#include <string_view>
#include <vector>

#include "platform/uid.h"

namespace tessal {

class CEL_Element;
class CEL_Property;

class ElementOwner {
 public:
  virtual ~ElementOwner() = default;

  /// Numbers all elements again and finds out who uses whom.
  virtual void RebuildSymbolTable() = 0;

  /// Whether any element has this symbol.
  virtual bool SymbolExists(std::string_view symbol) const = 0;

  /// Whether an element other than the one with this identity has this symbol.
  virtual bool IsSymbolTakenByOther(Uid uid, std::string_view symbol) const = 0;

  /// The elements that the element's expressions use, each once, in the order of their first use. For a
  /// horizontal movement, those of its direction come first.
  virtual std::vector<const CEL_Element*> ReferencedElements(const CEL_Element& element) const = 0;

  /// How many particle classes there are.
  virtual std::size_t SpecieCount() const = 0;

  /// The numbers of the symbol records of elements, by their identities; an identity without a record is left
  /// out. Costs a walk over the whole table: ask once for many.
  virtual std::map<Uid, std::int32_t> RecordNumbers(const std::set<Uid>& uids) const = 0;

  /// Fills the choice lists of all search functions from the present classes and their values.
  virtual void RefreshSearchFunctionChoices() = 0;

  // What happens to elements, for who keeps a record of it.
  /// A property is about to get another value.
  virtual void OnChanging(CEL_Element& /*element*/, CEL_Property& /*property*/) {}
  /// A member of a particle class, or a user function, was appended to its list.
  virtual void OnAppended(CEL_Element& /*element*/) {}
  /// A user function was taken out of the place that it had in its list.
  virtual void OnRemoved(std::unique_ptr<CEL_Element> /*element*/, std::size_t /*place*/) {}

 protected:
  ElementOwner() = default;
  ElementOwner(const ElementOwner&) = default;
  ElementOwner& operator=(const ElementOwner&) = default;
};

}  // namespace tessal
