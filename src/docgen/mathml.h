// Expressions as MathML, for the documentation page.
#pragma once

#include <string>
#include <string_view>

namespace tessal {

class ExpressionNode;

/// The MathML block of an expression, as the right side of the symbol or of its time derivative. Empty when
/// the expression does not parse.
std::string ExpressionToMathML(const std::string& expression, const std::string& symbol, bool isDerivative);

/// The same of an expression that is parsed already.
std::string TreeToMathML(const ExpressionNode& tree, std::string_view symbol, bool isDerivative);

}  // namespace tessal
