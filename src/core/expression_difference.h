// Which parts of an expression differ from another state of it, token by token.
#pragma once

#include <cstddef>
#include <string_view>
#include <vector>

namespace tessal {

/// A part of a text, by its bytes.
struct TextPart {
  std::size_t start;
  std::size_t end;
  bool operator==(const TextPart&) const = default;
};

struct ExpressionDifference {
  std::vector<TextPart> before;  ///< what went, in the former text
  std::vector<TextPart> after;   ///< what came, in the later one
};

/// What differs, as few tokens as possible; of texts that differ much, all between the first and the last
/// different token. Blanks and comments are no tokens: where only they differ, there are no parts.
ExpressionDifference DifferenceOf(std::string_view before, std::string_view after);

}  // namespace tessal
