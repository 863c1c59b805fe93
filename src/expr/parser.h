// The parser of the expression language.
#pragma once

#include <cstdint>
#include <string>

namespace tessal {

class ExpressionNode;

/// Parses a text without its quotes. On success gives 1, the tree, line and position -1 and "no error". On
/// failure gives 0 and leaves the tree alone; line (from 0) and position tell how far the scan had come, and
/// the message ends in a line feed. The parser keeps nothing between calls but the scanner's start state.
int ParseExpressionText(const std::string& text, ExpressionNode& node, std::int32_t& line,
                        std::int32_t& position, std::string& message);

}  // namespace tessal
