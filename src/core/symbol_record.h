// The rows of a template's symbol table, and the names in use that stand for nothing.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "platform/uid.h"

namespace tessal {

class CEL_Element;

/// One slot of the symbol table. A horizontal movement takes two: its direction, then its speed.
struct SymbolRecord {
  std::uint32_t sequence = 0;  ///< 1-based place in the table, the element's `ID` after a rebuild
  /// Codes of scope and spatial variation (see scope_rule.h). They mean something for kinds 1 to 6 only; the
  /// records of particle classes carry on those of the record before them.
  std::int32_t scope = 0;
  std::int32_t spatial = 0;
  std::int32_t index = 0;         ///< place of the element in its own sequence, from 0
  std::int32_t specieIndex = -1;  ///< index of the owning particle class from 0; -1 for kinds 1 to 6
  std::string text;               ///< the expression, or the number of an input as text
  /// The records that the expression uses and those that use this one: by sequence number and, in parallel,
  /// by identity. Each entry stands once, in the order of first use.
  std::vector<std::uint32_t> references;
  std::vector<std::uint32_t> referencedBy;
  std::vector<Uid> referenceUids;
  std::vector<Uid> referencedByUids;
  CEL_Element* element = nullptr;
  Uid uid = Uid::None;  ///< the element's identity
};

/// A name that expressions use and nobody has defined.
struct UndefinedSymbol {
  bool asked = false;  ///< the user has been asked about it
  bool stale = false;  ///< not met yet in the rebuild under way
  std::string symbol;
  std::vector<Uid> usedBy;  ///< identities of the users, each once, in first-seen order
};

}  // namespace tessal
