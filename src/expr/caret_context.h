// What an expression says about a place in it while it is typed: the word under the caret, what may follow
// there, the call around it, and which bracket belongs to which. Works on the tokens alone, so the answers
// exist for a text that does not parse.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>

#include "expr/scanner.h"

namespace tessal {

enum class CaretPlace : std::uint8_t {
  Value,     ///< a value may begin
  Operator,  ///< a value has ended: an operator or a word such as THEN comes next
  Property,  ///< after `[`
  Target,    ///< the particle class of an interaction
  Nothing    ///< in a comment, a number, or a lexeme that is no word
};

/// A call whose parentheses are around the caret.
struct CallAtCaret {
  LexemeSpan name;           ///< in the text
  std::size_t argument = 0;  ///< the one that the caret is in, from 0
};

struct CaretContext {
  CaretPlace place = CaretPlace::Nothing;
  /// The word that the caret is in or after; empty at the caret without one.
  LexemeSpan word{0, 0};
  std::optional<CallAtCaret> call;
};

/// `caret` is an offset from 0 to the text's size.
CaretContext ContextAt(std::string_view text, std::size_t caret);

/// A bracket beside the caret, and the one that belongs to it, if there is one.
struct BracketPair {
  LexemeSpan bracket;
  std::optional<LexemeSpan> partner;
};

/// The bracket that ends at the caret, else the one that begins there; none without one.
std::optional<BracketPair> BracketAt(std::string_view text, std::size_t caret);

}  // namespace tessal
