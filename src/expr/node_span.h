// Where a part of a tree is in the text that it was parsed from.
#pragma once

#include <string_view>

#include "expr/expression_node.h"
#include "expr/scanner.h"

namespace tessal {

/// The place of a node and all below it in the text that its tree was parsed from: from the first token to
/// the last, its own sign and word and the brackets of a call included. Takes time in proportion to the text.
LexemeSpan SpanOf(const ExpressionNode& node, std::string_view text);

/// The same as text. A tree whose texts are its own (`ExpressionTree`) has no such place.
std::string_view TextOf(const ExpressionNode& node, std::string_view text);

}  // namespace tessal
