// What the words of the language mean that are neither functions nor a template's own: the properties of
// particles, which an expression has in square brackets, and the verbs of interactions.
#pragma once

#include <span>
#include <string_view>

namespace tessal {

struct WordReference {
  std::string_view word;
  std::string_view meaning;  ///< one or two sentences
  std::string_view unit;     ///< as the units of the function reference; empty for a verb
};

/// All of `PropertyNames()`, and all of `InteractionVerbs()`.
std::span<const WordReference> PropertyReferences();
std::span<const WordReference> VerbReferences();

/// The reference of a property or a verb, spelt exactly so, or none.
const WordReference* ReferenceOfWord(std::string_view word);

}  // namespace tessal
