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

bool IsAdditive(std::string_view operatorText) {
  return operatorText == "+" || operatorText == "-";
}

/// One rewriting. Brackets surround each additive chain at a level; a product or a call opens a new level.
class Rewriter final {
 public:
  void Before(NodeKind kind, std::string_view text) {
    switch (kind) {
      case NodeKind::Call:
        output += text;
        output += '(';
        savedArguments.push_back(arguments);
        savedBrackets.push_back(brackets);
        arguments = brackets = 0;
        break;
      case NodeKind::Arithmetic:
        if (!IsAdditive(text)) {
          savedBrackets.push_back(brackets);
          brackets = 0;
        } else if (++brackets == 1) {
          output += '(';
        }
        break;
      case NodeKind::Conditional:
        output += text == "IF" ? "IF((" : text == "THEN" ? ")," : ",";
        break;
      case NodeKind::Argument:
        ++arguments;
        break;
      case NodeKind::Interaction:
        output += "_ABMInteract_";
        output += text;
        output += '(';
        break;
      case NodeKind::Negate:
        output += '-';
        break;
      default:
        break;
    }
  }

  void Between(NodeKind kind, std::string_view text) {
    switch (kind) {
      case NodeKind::Identifier:
        output += text;
        if (std::find(kTimeParts.begin(), kTimeParts.end(), text) != kTimeParts.end()) output += "()";
        break;
      case NodeKind::Number:
      case NodeKind::Arithmetic:
      case NodeKind::Comparison:
      // The target of a direct modification comes after its value, with nothing between them.
      case NodeKind::DirectAssign:
      case NodeKind::DirectPlus:
      case NodeKind::DirectMinus:
      case NodeKind::DirectMultiply:
      case NodeKind::DirectDivide:
        output += text;
        break;
      case NodeKind::Property:
        output += "_GetProperty(";
        output += text;
        output += ')';
        break;
      default:
        break;
    }
  }

  void After(NodeKind kind, std::string_view text) {
    switch (kind) {
      case NodeKind::Call:
        output += ')';
        arguments = Take(savedArguments);
        brackets = Take(savedBrackets);
        break;
      case NodeKind::Arithmetic:
        if (!IsAdditive(text)) {
          brackets = Take(savedBrackets);
        } else if (brackets-- == 1) {
          output += ')';
        }
        break;
      case NodeKind::Conditional:
        if (text == "ELSE") output += ')';
        break;
      case NodeKind::Argument:
        if (--arguments > 0) output += ',';
        break;
      case NodeKind::Interaction:
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
      [&rewriter](NodeKind kind, std::string_view text, std::int32_t) { rewriter.Before(kind, text); },
      [&rewriter](NodeKind kind, std::string_view text, std::int32_t) { rewriter.Between(kind, text); },
      [&rewriter](NodeKind kind, std::string_view text, std::int32_t) { rewriter.After(kind, text); });
  return std::move(rewriter.Output());
}

}  // namespace tessal
