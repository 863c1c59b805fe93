// The flat symbol table of a template: a record for each element in the order of the file, who uses whom, and
// the names in use that mean nothing. A rebuild makes it again, never patches it, in time proportional
// to the template; only the numbers of names stay from one rebuild to the next.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "core/name_table.h"
#include "elements/element_kind.h"
#include "keyfile/water_body.h"
#include "platform/uid.h"

namespace tessal {

class CEL_Element;
class CEL_Miscanellous;
class CEL_Property;
struct Collections;

/// One slot of the symbol table. A horizontal movement takes two: its direction, then its speed.
struct SymbolRecord {
  std::uint32_t sequence = 0;  ///< 1-based place in the table, the element's `ID` after a rebuild
  Uid uid = Uid::None;         ///< the element's identity
  CEL_Element* element = nullptr;
  const CEL_Property* expression = nullptr;  ///< none for an element without one
  ElementKind kind = ElementKind::None;
  std::uint32_t index = 0;        ///< place of the element in its own sequence, from 0
  std::int32_t specieIndex = -1;  ///< index of the owning particle class from 0; -1 for kinds 1 to 6
  /// Both mean something for the template's own collections only; the records of particle classes carry on
  /// those of the record before them.
  Scope scope = Scope::Global;
  SpatialVariation spatial = SpatialVariation::None;
  /// The records that the expression uses and those that use this one, by sequence number, each once. They
  /// lie in the table: those used in the order of first use, the users in the order of the table.
  std::span<const std::uint32_t> references;
  std::span<const std::uint32_t> referencedBy;
};

/// A name that expressions use and nobody has defined.
struct UndefinedSymbol {
  bool asked = false;  ///< the user has been asked about it
  bool stale = false;  ///< not met yet in the rebuild under way
  std::string symbol;
  std::vector<Uid> usedBy;  ///< identities of the users, each once, in first-seen order
};

/// The symbol of a record: the element's, composed with the class's for movements.
std::string RecordSymbol(const SymbolRecord& record);

/// The expression of a record, the number of an input as text, or the name that a search looks for.
std::string RecordText(const SymbolRecord& record);

/// Whether a name that no element has means something all the same: a word of the language, a function, or a
/// user function of the settings.
bool CountsAsDefined(std::string_view name, const CEL_Miscanellous& settings);

class SymbolTable final {
 public:
  const std::vector<SymbolRecord>& Records() const { return records; }
  std::vector<std::unique_ptr<UndefinedSymbol>>& Undefined() { return undefined; }
  const std::vector<std::unique_ptr<UndefinedSymbol>>& Undefined() const { return undefined; }
  void Clear();

  /// Numbers the elements, makes the records and finds who uses whom. Reports nothing. The public names of
  /// the settings' user functions count as defined.
  void Rebuild(const Collections& collections, const CEL_Miscanellous& settings);
  /// The same where the links of searches, which are numbers, are those of the numbers to come.
  void RebuildUnderLinks(const Collections& collections, const CEL_Miscanellous& settings);

  // Finding; none when there is no such record. The sizes are those of hand-written templates: the searches
  // are linear, and no index is kept between rebuilds.
  const SymbolRecord* BySequence(std::uint32_t sequence) const;
  /// The first record of the element: a horizontal movement's is that of its direction.
  const SymbolRecord* ByUid(Uid uid) const;
  /// The same for an element that is at hand: without a search, after a rebuild.
  const SymbolRecord* OfElement(const CEL_Element& element) const;
  const SymbolRecord* BySymbol(std::string_view symbol) const;
  /// The record that a use names; its number must be one of the table's.
  const SymbolRecord& Used(std::uint32_t sequence) const { return records[sequence - 1]; }
  /// Whether several elements have the same symbol.
  bool HasSharedSymbols() const { return hasSharedSymbols; }
  /// The identities of the elements with these sequence numbers. The two records of a movement give one.
  std::vector<Uid> UidsOf(std::span<const std::uint32_t> sequences) const;

  /// Calls the visitor with each element that has a record, once: the two records of a movement are side by
  /// side.
  template <class Visitor>
  void ForEachElement(Visitor visit) const {
    const CEL_Element* previous = nullptr;
    for (const SymbolRecord& record : records) {
      if (record.element != previous) visit(record);
      previous = record.element;
    }
  }
  /// The same for the records of the given numbers, in their order.
  template <class Visitor>
  void ForEachElement(std::span<const std::uint32_t> sequences, Visitor visit) const {
    const CEL_Element* previous = nullptr;
    for (const std::uint32_t sequence : sequences) {
      const SymbolRecord& record = Used(sequence);
      if (record.element != previous) visit(record);
      previous = record.element;
    }
  }

 private:
  class RebuildSteps;

  /// The names that a record's expression mentions, a part of a list. A rebuild takes it over as long as its
  /// element does not change.
  struct Mentions {
    const CEL_Element* element = nullptr;
    std::uint32_t start = 0;
    std::uint32_t end = 0;
    bool isLasting = false;  ///< whether they are the same wherever the scan of the expression starts
  };

  std::vector<SymbolRecord> records;
  std::vector<std::uint32_t> uses;   ///< of all records, one after the other
  std::vector<std::uint32_t> users;  ///< the same
  NameTable names;
  std::vector<Mentions> mentions;  ///< of the records, in their order
  std::vector<NameNumber> mentioned;
  bool hasSharedSymbols = false;
  std::vector<std::unique_ptr<UndefinedSymbol>> undefined;
};

}  // namespace tessal
