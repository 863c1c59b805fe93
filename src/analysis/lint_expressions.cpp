// Rules about what expressions say.
#include <algorithm>
#include <charconv>
#include <cmath>
#include <map>
#include <string>
#include <unordered_set>

#include "analysis/default_values.h"
#include "analysis/lint_rules.h"
#include "analysis/tree_nodes.h"
#include "core/template_core.h"
#include "expr/expression_shape.h"
#include "expr/function_catalogue.h"
#include "expr/node_span.h"

namespace tessal {

namespace {

std::unordered_set<std::string_view> NamesIn(const ExpressionNode& part) {
  std::unordered_set<std::string_view> names;
  ForEachNode(part, [&names](const ExpressionNode& node) {
    if (node.Kind() == NodeKind::Identifier) names.insert(node.Text());
    return true;
  });
  return names;
}

bool MentionsOneOf(const ExpressionNode& part, const std::unordered_set<std::string_view>& names) {
  bool mentions = false;
  ForEachNode(part, [&](const ExpressionNode& node) {
    mentions = mentions || (node.Kind() == NodeKind::Identifier && names.contains(node.Text()));
    return !mentions;
  });
  return mentions;
}

/// Whether an IF keeps a division from being computed: one that takes the other branch at the defaults, or
/// one of unknown outcome that looks at what the divisor is made of.
bool IsGuarded(const ExpressionNode& division, const NodeValues& values) {
  const std::unordered_set<std::string_view> names = NamesIn(*division.Child(2));
  bool isInElse = false;
  const ExpressionNode* below = &division;
  for (const ExpressionNode* node = division.Parent(); node != nullptr; below = node, node = node->Parent()) {
    if (node->Kind() != NodeKind::Conditional) continue;
    if (!IsWholeIf(*node)) {
      // A node for THEN has the branch and the node for ELSE, which has the other branch.
      isInElse = node->ChildCount() == 1 || below == node->Child(2);
      continue;
    }
    const ExpressionNode& condition = *node->Child(1);
    if (below == &condition) continue;
    const double chosen = values.Of(condition);
    if (std::isnan(chosen) ? MentionsOneOf(condition, names) : isInElse == (chosen != 0.0)) return true;
  }
  return false;
}

/// Whether a part has a value of its own that nothing can change.
bool IsConstantTree(const ExpressionNode& tree) {
  bool isConstant = true;
  ForEachNode(tree, [&isConstant](const ExpressionNode& node) {
    switch (node.Kind()) {
      case NodeKind::Number:
      case NodeKind::Argument:
      case NodeKind::Arithmetic:
      case NodeKind::Comparison:
      case NodeKind::Conditional:
      case NodeKind::Negate:
        break;
      case NodeKind::Call: {
        const CatalogueFunction* function = FindFunction(node.Text());
        constexpr std::int32_t kPlainMathematics = 1;
        isConstant = isConstant && function != nullptr && function->functionClass == kPlainMathematics &&
                     !function->traits.drawsRandomNumbers && !function->traits.keepsState &&
                     !function->traits.needsEngine;
        break;
      }
      default:
        isConstant = false;
    }
    return isConstant;
  });
  return isConstant;
}

bool IsSameNode(const ExpressionNode& left, const ExpressionNode& right) {
  return left.Kind() == right.Kind() && left.Text() == right.Text() &&
         left.ChildCount() == right.ChildCount();
}

/// Whether two parts are the same but for blanks and brackets. Ends at the first difference.
bool IsSameTree(const ExpressionNode& left, const ExpressionNode& right) {
  std::vector<std::pair<const ExpressionNode*, const ExpressionNode*>> open{{&left, &right}};
  while (!open.empty()) {
    const auto [one, other] = open.back();
    open.pop_back();
    if (!IsSameNode(*one, *other)) return false;
    for (std::int32_t slot = one->ChildCount(); slot > 0; --slot) {
      open.emplace_back(one->Child(slot), other->Child(slot));
    }
  }
  return true;
}

/// How many digits of a number's text matter: neither zeros at its start nor, in any case, at its end.
std::size_t SignificantDigits(std::string_view text) {
  std::string digits;
  for (const char character : text.substr(0, text.find_first_of("eE"))) {
    if (character != '.' && (character != '0' || !digits.empty())) digits += character;
  }
  return digits.find_last_not_of('0') + 1;
}

/// Where a number is, and in how many expressions.
struct LiteralUses {
  const LintExpression* first = nullptr;
  const ExpressionNode* node = nullptr;
  const LintExpression* last = nullptr;
  std::size_t expressions = 0;
};

}  // namespace

void FindDivisionsByZero(const LintSubject& subject, const Message& message, LintFindings& findings) {
  // More are only looked at in texts that a program has made.
  constexpr int kMostInExpression = 100;
  const DefaultValues defaults(subject.Symbols());
  for (const LintExpression& expression : subject.Expressions()) {
    const NodeValues values = defaults.Evaluate(*expression.tree);
    const ExpressionNode* found = nullptr;
    int looked = 0;
    ForEachNode(*expression.tree, [&](const ExpressionNode& node) {
      const bool isDivision = node.Kind() == NodeKind::Arithmetic && node.Text() == "/";
      if (isDivision && values.Of(*node.Child(2)) == 0.0 && ++looked <= kMostInExpression &&
          found == nullptr && !IsGuarded(node, values)) {
        found = &node;
      }
      return found == nullptr;
    });
    if (found == nullptr) continue;
    const ExpressionNode& divisor = *found->Child(2);
    findings.Add(expression, divisor, {message, {Excerpt(TextOf(divisor, expression.text))}});
  }
}

void FindConstantExpressions(const LintSubject& subject, const Message& message, LintFindings& findings) {
  for (const LintExpression& expression : subject.Expressions()) {
    const ElementKind kind = expression.record->kind;
    // An equation or a movement may well be 0.
    const bool isValue = kind == ElementKind::Auxiliary || kind == ElementKind::Process ||
                         kind == ElementKind::DerivedOutput || kind == ElementKind::ArithmeticExpression;
    if (!isValue || !IsConstantTree(*expression.tree)) continue;
    findings.Add(*expression.record, {message, {Excerpt(expression.text)}}, expression.field);
  }
}

void FindEqualBranches(const LintSubject& subject, const Message& message, LintFindings& findings) {
  for (const LintExpression& expression : subject.Expressions()) {
    const ExpressionNode* found = nullptr;
    ForEachNode(*expression.tree, [&found](const ExpressionNode& node) {
      if (found == nullptr && IsWholeIf(node)) {
        const Branches branches = BranchesOf(node);
        if (IsSameTree(branches.then, branches.otherwise)) found = &node;
      }
      return found == nullptr;
    });
    if (found == nullptr) continue;
    const std::string branch = Excerpt(TextOf(BranchesOf(*found).then, expression.text));
    findings.Add(expression, *found, {message, {branch}});
  }
}

void FindRepeatedLiterals(const LintSubject& subject, const Message& message, LintFindings& findings) {
  constexpr std::size_t kFewestExpressions = 3;
  constexpr std::size_t kFewestDigits = 2;
  std::map<double, LiteralUses> literals;
  for (const LintExpression& expression : subject.Expressions()) {
    ForEachNode(*expression.tree, [&](const ExpressionNode& node) {
      if (node.Kind() != NodeKind::Number || SignificantDigits(node.Text()) < kFewestDigits) return true;
      double value = 0.0;
      std::from_chars(node.Text().data(), node.Text().data() + node.Text().size(), value);
      LiteralUses& uses = literals[value];
      if (uses.expressions == 0) {
        uses.first = &expression;
        uses.node = &node;
      }
      if (std::exchange(uses.last, &expression) != &expression) ++uses.expressions;
      return true;
    });
  }
  for (const auto& [value, uses] : literals) {
    if (uses.expressions < kFewestExpressions) continue;
    findings.Add(*uses.first, *uses.node, {message, {uses.node->Text(), std::to_string(uses.expressions)}});
  }
}

}  // namespace tessal
