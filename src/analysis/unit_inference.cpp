#include "analysis/unit_inference.h"

#include <algorithm>
#include <cmath>
#include <span>

#include "analysis/declared_values.h"
#include "analysis/unit_spelling.h"
#include "elements/element.h"
#include "expr/expression_node.h"
#include "expr/expression_shape.h"
#include "expr/node_span.h"
#include "expr/word_reference.h"
#include "platform/ascii.h"

namespace tessal {

namespace {

constexpr std::size_t kMostClashes = 20;
/// A sum with more different units than that is compared with the first of them only.
constexpr std::size_t kMostGroups = 8;

/// Factors that count and have no unit: "2*x" is in the unit of x.
constexpr double kCounts[] = {0.5, 2, 3, 4};
/// Factors between units of time, and to percent: the dimension stays, the factor may change.
constexpr double kConversions[] = {24, 60, 100, 365, 365.25, 1440, 3600, 86400};
/// Arguments that are numbers of years, months and days, whose unit a template may well give as that of time.
constexpr std::string_view kCalendarNumbers[] = {"YEAR", "MONTH", "DAY"};
/// Functions of fitted formulae, whose numbers may give the result a unit: "EXP(7.7 - 1.3*LN(temp + 46))".
constexpr std::string_view kFittedFunctions[] = {"EXP", "LN", "LOG10"};
constexpr std::string_view kPowerFunction = "POW";
constexpr std::string_view kPlainAngle = "radian";

template <class Values, class Value>
bool Contains(const Values& values, const Value& wanted) {
  return std::find(std::begin(values), std::end(values), wanted) != std::end(values);
}

ExpressionUnit NumberValue(std::optional<double> number) {
  ExpressionUnit value;
  value.kind = ExpressionUnit::Kind::Number;
  value.number = number;
  return value;
}

ExpressionUnit KnownValue(Unit unit) {
  ExpressionUnit value;
  value.kind = ExpressionUnit::Kind::Known;
  value.unit = std::move(unit);
  return value;
}

bool IsNumberValue(const ExpressionUnit& value) {
  return value.kind == ExpressionUnit::Kind::Number;
}

bool IsUnknown(const ExpressionUnit& value) {
  return value.kind == ExpressionUnit::Kind::Unknown;
}

/// A number that changes nothing as a factor or a term.
bool IsNeutral(const std::optional<double>& number) {
  return number && (*number == 0 || *number == 1);
}

/// A known unit with a number as a factor.
void TakeFactor(ExpressionUnit& value, const std::optional<double>& number) {
  if (number && std::abs(*number) == 1) return;
  value.hasNumber = true;
  if (number && Contains(kCounts, std::abs(*number))) return;
  value.spelling = {};
  value.unit.isFactorOpen = true;
  if (!number || !Contains(kConversions, std::abs(*number))) value.isGuess = true;
}

ExpressionUnit ProductOf(const ExpressionUnit& left, const ExpressionUnit& right, bool isDivision) {
  if (IsNumberValue(left) && IsNumberValue(right)) {
    if (!left.number || !right.number) return NumberValue(std::nullopt);
    return NumberValue(isDivision ? *left.number / *right.number : *left.number * *right.number);
  }
  if (IsUnknown(left) || IsUnknown(right)) return {};
  // Nothing has any unit.
  if (IsNumberValue(left) && left.number == 0.0) return NumberValue(0);
  if (IsNumberValue(right) && right.number == 0.0) return isDivision ? ExpressionUnit() : NumberValue(0);
  if (IsNumberValue(right)) {
    ExpressionUnit value = left;
    TakeFactor(value, right.number);
    return value;
  }
  ExpressionUnit value = KnownValue(IsNumberValue(left) ? Unit() : left.unit);
  MultiplyBy(value.unit, right.unit, isDivision ? -1 : 1);
  value.isGuess = left.isGuess || right.isGuess;
  value.hasNumber = left.hasNumber || right.hasNumber;
  if (IsNumberValue(left)) {
    if (!isDivision) value.spelling = right.spelling;
    TakeFactor(value, left.number);
  }
  return value;
}

/// The text with a node's, from the first to the last of two nodes when that is a whole with its brackets.
LexemeSpan SpanOfTwo(const ExpressionNode& one, const ExpressionNode& other, std::string_view text) {
  const LexemeSpan first = SpanOf(one, text);
  const LexemeSpan second = SpanOf(other, text);
  const std::uint32_t start = std::min(first.start, second.start);
  const std::uint32_t end = std::max(first.start + first.length, second.start + second.length);
  int open = 0;
  for (const char sign : text.substr(start, end - start)) {
    if (sign == '(') ++open;
    if (sign == ')' && --open < 0) return second;
  }
  return open == 0 ? LexemeSpan{start, end - start} : second;
}

}  // namespace

std::string ShownUnit(const ExpressionUnit& value) {
  return value.spelling.empty() ? AsModellersWrite(value.unit) : std::string(value.spelling);
}

/// One walk over a tree, from the leaves up. A node takes the values of its children from the stack and
/// leaves its own; the links of lists and the inner nodes of sums leave those of all their items, so that a
/// sum is judged as a whole.
class UnitInference::Walk final {
 public:
  Walk(UnitInference& owner, std::string_view expression, std::vector<UnitClash>& found)
      : inference(owner), text(expression), clashes(found) {}

  ExpressionUnit Run(const ExpressionNode& root) {
    const ExpressionNode* node = FirstLeaf(&root);
    for (;;) {
      Visit(*node);
      if (node == &root) break;
      const ExpressionNode* parent = node->Parent();
      const bool isFirst = parent->Child(1) == node;
      node = isFirst && parent->ChildCount() > 1 ? FirstLeaf(parent->Child(2)) : parent;
    }
    return stack.empty() ? ExpressionUnit() : std::move(stack.front());
  }

 private:
  using Values = std::span<const ExpressionUnit>;

  static const ExpressionNode* FirstLeaf(const ExpressionNode* node) {
    while (node->ChildCount() > 0) node = node->Child(1);
    return node;
  }

  void Visit(const ExpressionNode& node) {
    std::size_t count = 0;
    for (std::int32_t child = 0; child < node.ChildCount(); ++child) {
      count += counts.back();
      counts.pop_back();
    }
    if (LeavesItems(node)) {
      counts.push_back(count);
      return;
    }
    ExpressionUnit value = ValueOf(node, Values(stack).last(count));
    value.node = &node;
    stack.resize(stack.size() - count);
    stack.push_back(std::move(value));
    counts.push_back(1);
  }

  /// Whether the node above wants the items, not what becomes of them.
  static bool LeavesItems(const ExpressionNode& node) {
    if (node.Kind() == NodeKind::Argument) return true;
    if (node.Kind() == NodeKind::Conditional) return !IsIfNode(node);
    return IsSum(node) && node.Parent() != nullptr && IsSum(*node.Parent());
  }

  static bool IsIfNode(const ExpressionNode& node) { return node.Text() == "IF"; }

  ExpressionUnit ValueOf(const ExpressionNode& node, Values values) {
    switch (node.Kind()) {
      case NodeKind::Identifier:
        return OfName(node.Text());
      case NodeKind::Number:
        return NumberValue(ValueOfNumber(node));
      case NodeKind::Property:
        return OfProperty(node.Text());
      case NodeKind::Negate:
        return Negated(values.front());
      case NodeKind::Arithmetic:
        return IsSum(node) ? OfSum(node, values) : ProductOf(values[0], values[1], node.Text() == "/");
      case NodeKind::Comparison:
        Compare(node, values);
        return NumberValue(std::nullopt);
      case NodeKind::Conditional:
        return OfBranches(node, values);
      case NodeKind::Call:
        return OfCall(node, values);
      case NodeKind::Exceedance:
        return OfResult(inference.Function("EXCEEDANCE_FREQUENCY"));
      case NodeKind::DirectAssign:
      case NodeKind::DirectPlus:
      case NodeKind::DirectMinus:
        CheckAssignment(node, values.front());
        return {};
      default:
        return {};
    }
  }

  ExpressionUnit OfName(std::string_view name) const {
    const SymbolRecord* record = inference.index.Find(name);
    if (record == nullptr) return {};
    const std::optional<Unit> unit = inference.DeclaredOf(*record->element);
    if (!unit) return {};
    ExpressionUnit value = KnownValue(*unit);
    value.spelling = DeclaredUnit(*record->element).value_or("");
    return value;
  }

  ExpressionUnit OfProperty(std::string_view name) const {
    const WordReference* word = ReferenceOfWord(name);
    if (word == nullptr) return {};
    const std::optional<Unit> unit = inference.Read(word->unit);
    return unit ? KnownValue(*unit) : ExpressionUnit();
  }

  static ExpressionUnit Negated(const ExpressionUnit& value) {
    ExpressionUnit negated = value;
    if (negated.number) negated.number = -*negated.number;
    return negated;
  }

  void Add(UnitClash clash) {
    if (clashes.size() < kMostClashes) clashes.push_back(std::move(clash));
  }

  /// Terms of the same unit.
  struct Group {
    const ExpressionUnit* first;
    std::size_t size = 1;
  };

  static std::vector<Group> GroupsOf(Values terms) {
    std::vector<Group> groups;
    for (const ExpressionUnit& term : terms) {
      if (!term.IsCertain()) continue;
      const auto hit = std::find_if(groups.begin(), groups.end(), [&term](const Group& group) {
        return AreSame(group.first->unit, term.unit);
      });
      if (hit != groups.end()) {
        ++hit->size;
        if (hit->first->unit.isFactorOpen) hit->first = &term;
      } else if (groups.size() < kMostGroups) {
        groups.push_back({&term});
      }
    }
    return groups;
  }

  /// The unit that most terms have. Where no unit has more than the others, it is unknown which is meant.
  ExpressionUnit OfSum(const ExpressionNode& node, Values terms) {
    const std::vector<Group> groups = GroupsOf(terms);
    if (groups.empty()) return OfGuesses(node, terms);
    const auto most =
        std::max_element(groups.begin(), groups.end(),
                         [](const Group& one, const Group& other) { return one.size < other.size; });
    bool isTied = false;
    for (const Group& group : groups) {
      if (&group == &*most) continue;
      isTied |= group.size == most->size;
      Add({UnitClash::Kind::Sum,
           SpanOfTwo(*NearestOf(*most, *group.first, terms).node, *group.first->node, text),
           ShownUnit(*most->first), ShownUnit(*group.first)});
    }
    if (isTied) return {};
    ExpressionUnit value = *most->first;
    value.hasNumber = std::any_of(terms.begin(), terms.end(), HasNumberAsTerm);
    return value;
  }

  static bool HasNumberAsTerm(const ExpressionUnit& term) {
    return term.hasNumber || (IsNumberValue(term) && !IsNeutral(term.number));
  }

  /// The term of a group that is the last before another term, or the first after it.
  static const ExpressionUnit& NearestOf(const Group& group, const ExpressionUnit& other, Values terms) {
    const ExpressionUnit* nearest = nullptr;
    for (const ExpressionUnit& term : terms) {
      if (&term == &other && nearest != nullptr) break;
      if (term.IsCertain() && AreSame(term.unit, group.first->unit)) {
        nearest = &term;
        if (nearest > &other) break;
      }
    }
    return nearest == nullptr ? *group.first : *nearest;
  }

  /// The unit of a sum none of whose terms has a certain one.
  static ExpressionUnit OfGuesses(const ExpressionNode& node, Values terms) {
    const ExpressionUnit* guess = nullptr;
    for (const ExpressionUnit& term : terms) {
      if (IsUnknown(term)) return {};
      if (IsNumberValue(term)) continue;
      if (guess != nullptr && !HaveSameDimension(guess->unit, term.unit)) return {};
      guess = &term;
    }
    if (guess != nullptr) return *guess;
    if (terms.size() != 2 || !terms[0].number || !terms[1].number) return NumberValue(std::nullopt);
    return NumberValue(node.Text() == "+" ? *terms[0].number + *terms[1].number
                                          : *terms[0].number - *terms[1].number);
  }

  bool Clash(const ExpressionUnit& left, const ExpressionUnit& right) const {
    return left.IsCertain() && right.IsCertain() && !AreSame(left.unit, right.unit);
  }

  void Compare(const ExpressionNode& node, Values sides) {
    if (sides.size() != 2 || !Clash(sides[0], sides[1])) return;
    Add({UnitClash::Kind::Comparison, SpanOf(node, text), ShownUnit(sides[0]), ShownUnit(sides[1])});
  }

  ExpressionUnit OfBranches(const ExpressionNode& node, Values parts) {
    const ExpressionUnit& then = parts[1];
    const ExpressionUnit& otherwise = parts[2];
    if (Clash(then, otherwise)) {
      Add({UnitClash::Kind::Branches, SpanOf(node, text), ShownUnit(then), ShownUnit(otherwise)});
      return {};
    }
    if (then.IsCertain()) return then;
    if (otherwise.IsCertain()) return otherwise;
    if (IsUnknown(then) || IsUnknown(otherwise)) return {};
    if (IsNumberValue(then)) return otherwise;
    if (IsNumberValue(otherwise)) return then;
    return HaveSameDimension(then.unit, otherwise.unit) ? then : ExpressionUnit();
  }

  void CheckAssignment(const ExpressionNode& node, const ExpressionUnit& value) {
    const ExpressionUnit target = OfName(node.Text());
    if (!Clash(value, target)) return;
    Add({UnitClash::Kind::Assignment, SpanOf(*value.node, text), ShownUnit(value), ShownUnit(target)});
  }

  /// A function's result of a fixed unit.
  ExpressionUnit OfResult(const FunctionReference* function) const {
    if (function == nullptr) return {};
    std::optional<Unit> unit = inference.Read(function->resultUnit);
    if (!unit) return {};
    // The settings say which angles the engine takes.
    if (function->resultUnit == kPlainAngle) unit->isFactorOpen = true;
    return KnownValue(std::move(*unit));
  }

  ExpressionUnit OfCall(const ExpressionNode& node, Values arguments) {
    const FunctionReference* function = inference.Function(node.Text());
    if (function == nullptr || function->arguments.size() != arguments.size()) return {};
    for (std::size_t place = 0; place < arguments.size(); ++place) {
      CheckArgument(*function, place, arguments);
    }
    const std::optional<UnitRule> rule = RuleOfUnit(*function, function->resultUnit);
    if (!rule) return {};
    if (rule->kind == UnitRule::Kind::OfArgument) return RaisedArgument(*function, *rule, arguments);
    if (rule->kind != UnitRule::Kind::Fixed) return {};
    ExpressionUnit value = OfResult(function);
    if (Contains(kFittedFunctions, function->name))
      value.isGuess |= arguments[0].hasNumber || arguments[0].isGuess;
    return value;
  }

  /// The unit that an argument has: its own, or that of another one that has the same.
  static const ExpressionUnit& Standing(const FunctionReference& function, std::size_t place,
                                        Values arguments) {
    if (!IsNumberValue(arguments[place])) return arguments[place];
    for (std::size_t other = 0; other < arguments.size(); ++other) {
      const std::optional<UnitRule> rule = RuleOfUnit(function, function.arguments[other].unit);
      if (rule && rule->kind == UnitRule::Kind::OfArgument && rule->argument == place && rule->power == 1 &&
          !rule->powerArgument && !IsNumberValue(arguments[other])) {
        return arguments[other];
      }
    }
    return arguments[place];
  }

  /// The unit of an argument to the power that a rule says.
  static ExpressionUnit RaisedArgument(const FunctionReference& function, const UnitRule& rule,
                                       Values arguments) {
    const ExpressionUnit& base = Standing(function, rule.argument, arguments);
    if (IsUnknown(base)) return {};
    std::optional<double> power = rule.power;
    if (rule.powerArgument) power = arguments[*rule.powerArgument].number;
    if (IsNumberValue(base)) {
      if (rule.power == 1 && !rule.powerArgument) return base;
      return OfNumberToPower(arguments, rule);
    }
    if (power == 1.0) return base;
    ExpressionUnit value = base;
    value.spelling = {};
    if (power && IsNear(*power * 2, std::round(*power * 2))) {
      value.unit = RaisedTo(base.unit, *power);
      return value;
    }
    // The power of a number is one; of a quantity it is a fit, "0.0986*POW(wind, 1.64)".
    if (!IsDimensionless(base.unit)) return {};
    value.unit.isFactorOpen = true;
    return value;
  }

  static bool IsTemperature(const Unit& unit) {
    Unit other = unit;
    other.Power(BaseUnit::Kelvin) -= 1;
    return IsDimensionless(other);
  }

  /// "POW(1.08, temp - 20)" is a plain number; what "POW(10, 2.3 - 0.1*x)" is, the fit alone says.
  static ExpressionUnit OfNumberToPower(Values arguments, const UnitRule& rule) {
    if (!rule.powerArgument) return NumberValue(std::nullopt);
    const ExpressionUnit& exponent = arguments[*rule.powerArgument];
    if (exponent.kind != ExpressionUnit::Kind::Known) return NumberValue(std::nullopt);
    ExpressionUnit value = KnownValue(Unit());
    value.isGuess = (exponent.hasNumber || exponent.isGuess) && !IsTemperature(exponent.unit);
    return value;
  }

  void CheckArgument(const FunctionReference& function, std::size_t place, Values arguments) {
    const ExpressionUnit& value = arguments[place];
    const ArgumentReference& argument = function.arguments[place];
    if (!value.IsCertain()) return;
    const std::optional<UnitRule> rule = RuleOfUnit(function, argument.unit);
    if (!rule) return;
    if (rule->kind == UnitRule::Kind::OfArgument) {
      const ExpressionUnit expected = RaisedArgument(function, *rule, arguments);
      if (Clash(value, expected)) AddArgument(function, argument, value, ShownUnit(expected));
    }
    if (rule->kind == UnitRule::Kind::Fixed && !value.hasNumber &&
        !FitsFixed(function, argument, value.unit)) {
      AddArgument(function, argument, value, argument.unit == "1" ? "-" : std::string(argument.unit));
    }
  }

  bool FitsFixed(const FunctionReference& function, const ArgumentReference& argument,
                 const Unit& unit) const {
    const std::optional<Unit> expected = inference.Read(argument.unit);
    if (!expected) return true;
    if (!HaveSameDimension(unit, *expected)) {
      // A base to the power of a difference of temperatures: Arrhenius as it is fitted.
      if (function.name == kPowerFunction) return IsTemperature(unit);
      Unit other = unit;
      if (Contains(kCalendarNumbers, UpperCase(argument.name))) other.Power(BaseUnit::Second) -= 1;
      return IsDimensionless(other);
    }
    if (AreSame(unit, *expected)) return true;
    // An angle or a salinity may be declared as a plain number, and the settings say which angles are taken.
    if (!IsDimensionless(unit) || argument.unit == "1") return false;
    return IsNear(unit.logFactor, 0) ||
           (argument.unit == kPlainAngle && AreSame(unit, *inference.Read("degree")));
  }

  void AddArgument(const FunctionReference& function, const ArgumentReference& argument,
                   const ExpressionUnit& value, std::string expected) {
    Add({.kind = UnitClash::Kind::Argument,
         .place = SpanOf(*value.node, text),
         .left = ShownUnit(value),
         .right = std::move(expected),
         .argument = std::string(argument.name),
         .function = std::string(function.name)});
  }

  UnitInference& inference;
  std::string_view text;
  std::vector<UnitClash>& clashes;
  std::vector<ExpressionUnit> stack;
  std::vector<std::size_t> counts;  ///< of the items that each node has left
};

UnitInference::UnitInference(const TemplateCore& core, Substances meaning)
    : index(core), substances(meaning) {}

std::optional<Unit> UnitInference::Read(std::string_view text) {
  const Unit* unit = reader.Read(text);
  if (unit == nullptr) return std::nullopt;
  Unit taken = *unit;
  if (substances == Substances::Ignored) {
    taken.substances.clear();
    taken.hasUnnamedAmount = false;
  }
  return taken;
}

std::optional<Unit> UnitInference::DeclaredOf(const CEL_Element& element) {
  const std::optional<std::string_view> text = DeclaredUnit(element);
  return text ? Read(*text) : std::nullopt;
}

const FunctionReference* UnitInference::Function(std::string_view name) {
  const auto [place, isNew] = functions.try_emplace(name, nullptr);
  if (isNew) place->second = ReferenceOfFunction(name);
  return place->second;
}

ExpressionUnit UnitInference::Infer(const RecordExpression& expression, std::vector<UnitClash>& clashes) {
  if (expression.tree == nullptr) return {};
  return Walk(*this, expression.text, clashes).Run(*expression.tree);
}

}  // namespace tessal
