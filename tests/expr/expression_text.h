// Trees and expressions as text, for tests.
#pragma once

#include <string>

#include "expr/expression_node.h"

namespace tessal::test {

/// A tree as nested lists: (kind text child child).
std::string TreeText(const ExpressionNode& node);

/// The tree of an expression, or the parser's message.
std::string ParsedText(const std::string& expression);

/// A random expression of bounded depth, as text.
std::string RandomExpression(unsigned seed);

}  // namespace tessal::test
