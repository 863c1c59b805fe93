// What is wrong with an expression, at its place and in plain language: beside the parser's own words a
// sentence that says what to write. For whoever edits an expression; nothing here is reported.
#pragma once

#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "expr/scanner.h"

namespace tessal {

struct ExpressionFault {
  LexemeSpan at{0, 0};    ///< in the text; empty in an empty text alone
  std::string words;      ///< the parser's or the check's own; empty where neither has any
  std::string plain;      ///< one sentence, or two
  bool isSyntax = false;  ///< the parse stopped here
};

/// The fault at which a text stops parsing; otherwise what the checks of calls and properties find, in the
/// order of the text, and a comment or character that hides the rest. Starts with the scanner in its normal
/// state, and leaves it so.
std::vector<ExpressionFault> FindLanguageFaults(std::string_view text);

/// " Near it: A, B." after a sentence on a name that is not known; empty where none of the known names is
/// near.
std::string NearNamesText(std::string_view typed, std::span<const std::string_view> names);

}  // namespace tessal
