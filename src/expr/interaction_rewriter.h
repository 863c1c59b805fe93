// Writes a parse tree as one line of plain expression text, as the simulation engine reads it: interactions
// and particle properties become calls, conditionals take the function form.
#pragma once

#include <string>

namespace tessal {

class ExpressionNode;

std::string RewriteExpressionText(const ExpressionNode& tree);

}  // namespace tessal
