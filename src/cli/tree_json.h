// A parse tree as one line of JSON. Trees may be a million levels deep, so nothing recurses.
#pragma once

#include <string>

namespace tessal {
class ExpressionNode;
}

namespace tessal::cli {

/// {"kind":5,"text":"+","children":[...]}, without children at a leaf.
std::string TreeJson(const ExpressionNode& tree);

}  // namespace tessal::cli
