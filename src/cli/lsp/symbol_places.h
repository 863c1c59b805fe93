// Where a name is in the text of a template: the symbol in the section of its element, the keyword of an
// equation, which repeats it, and the uses in expressions and pools.
#pragma once

#include <optional>
#include <string_view>
#include <vector>

#include "cli/lsp/loaded_document.h"

namespace tessal::cli {

/// A name at a place in the text, whether an element has it or not.
struct NameAtPlace {
  std::string_view name;       ///< a part of the text
  const SymbolRecord* record;  ///< of the element of that name; none for one that means something else
};

/// The symbol, keyword of an equation, identifier of an expression or process of a pool at a place, its ends
/// included.
std::optional<NameAtPlace> NameAt(const LoadedDocument& document, std::size_t offset);

struct SymbolPlace {
  enum class Role : std::uint8_t { Symbol, EquationKeyword, Use };
  std::string_view part;  ///< of the text
  Role role;
};

/// All places of a name, in the order of the text. Of elements that share a symbol the first counts, as in
/// the rules.
std::vector<SymbolPlace> PlacesOf(const LoadedDocument& document, std::string_view name);

/// The record of the element that a name means; none for any other name.
const SymbolRecord* RecordOf(const TemplateCore& core, std::string_view name);

/// What a name's definition is in the text: the symbol, or for one that no file holds the head of the
/// section; empty for an element that was not read.
std::string_view DefinitionOf(const LoadedDocument& document, const CEL_Element& element);

}  // namespace tessal::cli
