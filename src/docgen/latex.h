// Expressions as LaTeX, for papers and reports. The text needs the package amsmath, and a mathematical
// environment of its reader's around it.
#pragma once

#include <string>
#include <string_view>

namespace tessal {

class ExpressionNode;

/// The expression as the right side of the symbol or of its time derivative, or alone when the symbol is
/// empty. Empty when the expression does not parse.
std::string ExpressionToLatex(const std::string& expression, const std::string& symbol, bool isDerivative);

/// The same of an expression that is parsed already. Brackets are set where the tree's grouping needs them;
/// conditions that the grammar has put into nested conditionals are conditions again.
std::string TreeToLatex(const ExpressionNode& tree, std::string_view symbol, bool isDerivative);

/// A text, such as a symbol or a description, in which LaTeX finds no command.
std::string LatexText(std::string_view text);

}  // namespace tessal
