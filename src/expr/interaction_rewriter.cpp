#include "expr/interaction_rewriter.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <string_view>
#include <utility>
#include <vector>

#include "expr/expression_node.h"

namespace tessal {

namespace {

/// Names that the engine knows as functions without arguments.
constexpr std::array<std::string_view, 6> kTimeParts = {"YEAR", "MONTH", "DAY", "HOUR", "MINUTE", "SECOND"};

bool IsAdditive(const std::string& operatorText) {
  return operatorText == "+" || operatorText == "-";
}

/// One rewriting. Brackets surround each additive chain at a level; a product or a call opens a new level.
class Rewriter final {
 public:
  void Before(std::int32_t kind, const std::string& text) {
    switch (kind) {
      case NODE_CALL:
        output += text + "(";
        savedArguments.push_back(arguments);
        savedBrackets.push_back(brackets);
        arguments = brackets = 0;
        break;
      case NODE_ARITHMETIC:
        if (!IsAdditive(text)) {
          savedBrackets.push_back(brackets);
          brackets = 0;
        } else if (++brackets == 1) {
          output += '(';
        }
        break;
      case NODE_CONDITIONAL:
        output += text == "IF" ? "IF((" : text == "THEN" ? ")," : ",";
        break;
      case NODE_ARGUMENT:
        ++arguments;
        break;
      case NODE_INTERACTION:
        output += "_ABMInteract_" + text + "(";
        break;
      case NODE_NEGATE:
        output += '-';
        break;
      default:
        break;
    }
  }

  void Between(std::int32_t kind, const std::string& text) {
    switch (kind) {
      case NODE_IDENTIFIER:
        output += text;
        if (std::find(kTimeParts.begin(), kTimeParts.end(), text) != kTimeParts.end()) output += "()";
        break;
      case NODE_NUMBER:
      case NODE_ARITHMETIC:
      case NODE_COMPARISON:
      // The target of a direct modification stands behind its value, with nothing between them.
      case NODE_DIRECT_ASSIGN:
      case NODE_DIRECT_PLUS:
      case NODE_DIRECT_MINUS:
      case NODE_DIRECT_MULTIPLY:
      case NODE_DIRECT_DIVIDE:
        output += text;
        break;
      case NODE_PROPERTY:
        output += "_GetProperty(" + text + ")";
        break;
      default:
        break;
    }
  }

  void After(std::int32_t kind, const std::string& text) {
    switch (kind) {
      case NODE_CALL:
        output += ')';
        arguments = Take(savedArguments);
        brackets = Take(savedBrackets);
        break;
      case NODE_ARITHMETIC:
        if (!IsAdditive(text)) {
          brackets = Take(savedBrackets);
        } else if (brackets-- == 1) {
          output += ')';
        }
        break;
      case NODE_CONDITIONAL:
        if (text == "ELSE") output += ')';
        break;
      case NODE_ARGUMENT:
        if (--arguments > 0) output += ',';
        break;
      case NODE_INTERACTION:
        output += ')';
        break;
      default:
        break;
    }
  }

  std::string& Output() { return output; }

 private:
  static std::int32_t Take(std::vector<std::int32_t>& saved) {
    const std::int32_t value = saved.back();
    saved.pop_back();
    return value;
  }

  std::string output;
  std::int32_t arguments = 0;
  std::int32_t brackets = 0;
  std::vector<std::int32_t> savedArguments;
  std::vector<std::int32_t> savedBrackets;
};

}  // namespace

std::string RewriteExpressionText(const ExpressionNode& tree) {
  Rewriter rewriter;
  tree.WalkInOrder(
      [&rewriter](std::int32_t kind, const std::string& text, std::int32_t) { rewriter.Before(kind, text); },
      [&rewriter](std::int32_t kind, const std::string& text, std::int32_t) { rewriter.Between(kind, text); },
      [&rewriter](std::int32_t kind, const std::string& text, std::int32_t) { rewriter.After(kind, text); });
  return std::move(rewriter.Output());
}

}  // namespace tessal
