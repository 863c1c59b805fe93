// Expressions as MathML, for the documentation page.
#pragma once

#include <string>

namespace tessal {

/// The MathML block of an expression, as the right side of the symbol or of its time derivative. Empty when
/// the expression does not parse.
std::string ExpressionToMathML(const std::string& expression, const std::string& symbol, bool isDerivative);

}  // namespace tessal
