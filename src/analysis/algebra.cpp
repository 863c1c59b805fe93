#include "analysis/algebra.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <utility>

#include "core/template_core.h"
#include "expr/expression_shape.h"
#include "expr/node_span.h"
#include "platform/ascii.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

/// Parts within parts beyond this are not looked at: each level is a call.
constexpr int kMostLevels = 150;
/// What is left of a coefficient, relative to what was added, counts as nothing.
constexpr double kRounding = 1e-12;
/// Powers of calls that are written out.
constexpr std::int32_t kMostPower = 6;

/// The atoms of two products, united.
std::vector<AtomPower> United(const std::vector<AtomPower>& left, const std::vector<AtomPower>& right) {
  std::vector<AtomPower> united;
  united.reserve(left.size() + right.size());
  auto one = left.begin();
  auto other = right.begin();
  while (one != left.end() || other != right.end()) {
    if (other == right.end() || (one != left.end() && one->atom < other->atom)) {
      united.push_back(*one++);
    } else if (one == left.end() || other->atom < one->atom) {
      united.push_back(*other++);
    } else {
      const std::int32_t power = one->power + other->power;
      if (power != 0) united.push_back({one->atom, power});
      ++one;
      ++other;
    }
  }
  return united;
}

bool ComesBefore(const Product& left, const Product& right) {
  return std::lexicographical_compare(left.atoms.begin(), left.atoms.end(), right.atoms.begin(),
                                      right.atoms.end(), [](const AtomPower& one, const AtomPower& other) {
                                        return one.atom != other.atom ? one.atom < other.atom
                                                                      : one.power > other.power;
                                      });
}

std::optional<double> NumberOf(const ProductSum& sum) {
  if (sum.empty()) return 0.0;
  if (sum.size() == 1 && sum.front().atoms.empty()) return sum.front().coefficient;
  return std::nullopt;
}

ProductSum NumberSum(double value) {
  return value == 0 ? ProductSum() : ProductSum{{value, {}}};
}

/// A part of a chain of sums or of products: a sum's with its sign, a product's as factor or divisor.
struct Link {
  const ExpressionNode* node;
  bool isInverse;
};

bool IsTerm(const ExpressionNode& node) {
  return node.Kind() == NodeKind::Arithmetic && !IsSum(node);
}

/// Takes a chain apart that may be as long as the expression.
template <class IsChain>
std::vector<Link> LinksOf(const ExpressionNode& chain, IsChain isChain, std::string_view inverse) {
  std::vector<Link> links;
  std::vector<Link> open{{&chain, false}};
  while (!open.empty()) {
    const Link link = open.back();
    open.pop_back();
    if (isChain(*link.node)) {
      open.push_back({link.node->Child(2), link.isInverse != (link.node->Text() == inverse)});
      open.push_back({link.node->Child(1), link.isInverse});
    } else {
      links.push_back(link);
    }
  }
  return links;
}

}  // namespace

/// The expansion of one expression.
class Algebra::Expansion final {
 public:
  Expansion(Algebra& owner, std::string_view expression) : algebra(owner), text(expression) {}

  std::optional<ProductSum> Of(const ExpressionNode& node) {
    if (level >= kMostLevels) return algebra.Fail("an expression nests too deeply");
    ++level;
    std::optional<ProductSum> sum = OfSum(node);
    --level;
    return sum;
  }

 private:
  std::optional<ProductSum> OfSum(const ExpressionNode& node) {
    ProductSum sum;
    for (const Link& link : LinksOf(node, IsSum, "-")) {
      const std::optional<ProductSum> product = OfProduct(*link.node);
      if (!product) return std::nullopt;
      Append(sum, *product, link.isInverse ? -1 : 1);
      if (sum.size() > kMostProducts * 2) Settle(sum);
      if (sum.size() > kMostProducts * 2) break;
    }
    Settle(sum);
    if (sum.size() > kMostProducts) return algebra.Fail("an expression has too many terms");
    return sum;
  }

  std::optional<ProductSum> OfProduct(const ExpressionNode& node) {
    ProductSum product = NumberSum(1);
    for (const Link& link : LinksOf(node, IsTerm, "/")) {
      const ExpressionNode* factor = link.node;
      double sign = 1;
      for (; factor->Kind() == NodeKind::Negate; factor = factor->Child(1)) sign = -sign;
      std::optional<ProductSum> sum = OfFactor(*factor);
      if (sum) sum = AsFactor(*sum, *factor, link.isInverse);
      if (sum) sum = algebra.Times(product, *sum);
      if (!sum) return std::nullopt;
      product = std::move(*sum);
      if (sign < 0) {
        for (Product& each : product) each.coefficient = -each.coefficient;
      }
    }
    return product;
  }

  /// A factor or divisor, in brackets where it is to stay so.
  std::optional<ProductSum> AsFactor(const ProductSum& sum, const ExpressionNode& node, bool isDivisor) {
    if (isDivisor && sum.empty()) return algebra.Fail("an expression divides by zero");
    if (sum.size() <= 1) {
      if (!isDivisor) return sum;
      ProductSum inverse = sum;
      inverse.front().coefficient = 1 / inverse.front().coefficient;
      for (AtomPower& each : inverse.front().atoms) each.power = -each.power;
      return inverse;
    }
    const bool isKept = algebra.brackets == Brackets::Kept && !algebra.MentionsFlow(sum);
    if (!isDivisor && !isKept) return sum;
    if (algebra.brackets == Brackets::Kept) {
      return ProductSum{{1, {{algebra.BracketAtom(sum, TextOf(node, text)), isDivisor ? -1 : 1}}}};
    }
    // 1/(2*a + 2*b) is half of 1/(a + b).
    const double first = sum.front().coefficient;
    ProductSum bracket;
    Append(bracket, sum, 1 / first);
    return ProductSum{{1 / first, {{algebra.BracketAtom(bracket, {}), -1}}}};
  }

  std::optional<ProductSum> OfFactor(const ExpressionNode& node) {
    switch (node.Kind()) {
      case NodeKind::Number:
        return OfNumber(node);
      case NodeKind::Identifier: {
        const SymbolRecord* record = algebra.index.Find(node.Text());
        if (record != nullptr) return Single(algebra.SymbolAtom(*record));
        return Single(algebra.Intern("name " + std::string(node.Text()),
                                     {.kind = Atom::Kind::Symbol, .text = std::string(node.Text())}));
      }
      case NodeKind::Arithmetic:
        return Of(node);
      case NodeKind::Call:
        return OfCall(node);
      case NodeKind::Conditional:
        return OfConditional(node);
      default: {
        const std::string written(TextOf(node, text));
        return Single(algebra.Intern("other " + written, {.text = written}));
      }
    }
  }

  std::optional<ProductSum> OfNumber(const ExpressionNode& node) {
    const std::optional<double> value = ValueOfNumber(node);
    if (!value) return algebra.Fail("a number is too large or too small");
    return NumberSum(*value);
  }

  static ProductSum Single(AtomId atom) { return {{1, {{atom, 1}}}}; }

  std::optional<ProductSum> OfCall(const ExpressionNode& node) {
    Atom atom{.kind = Atom::Kind::Call};
    std::string key = UpperCase(node.Text());
    const std::string name = key;
    for (const ExpressionNode* argument : ArgumentsOf(node)) {
      std::optional<ProductSum> sum = Of(*argument);
      if (!sum) return std::nullopt;
      key += '(' + algebra.KeyOf(*sum) + ')';
      atom.mentionsFlow = atom.mentionsFlow || algebra.MentionsFlow(*sum);
      atom.parts.push_back(std::move(*sum));
    }
    if (const std::int32_t power = PowerOf(name, atom.parts); power > 0) {
      std::optional<ProductSum> result = AsFactor(atom.parts.front(), *ArgumentsOf(node).front(), false);
      const std::optional<ProductSum> base = result;
      for (std::int32_t factor = 1; result && factor < power; ++factor)
        result = algebra.Times(*result, *base);
      return result;
    }
    atom.text = TextOf(node, text);
    return Single(algebra.Intern("call " + key, std::move(atom)));
  }

  /// The exponent of a call that is a whole power of its first argument; 0 for any other.
  static std::int32_t PowerOf(std::string_view name, const std::vector<ProductSum>& arguments) {
    if (name == "SQR" && arguments.size() == 1) return 2;
    if (name != "POW" || arguments.size() != 2) return 0;
    const std::optional<double> exponent = NumberOf(arguments[1]);
    if (!exponent || *exponent < 1 || *exponent > kMostPower || *exponent != std::floor(*exponent)) return 0;
    return static_cast<std::int32_t>(*exponent);
  }

  std::optional<ProductSum> OfConditional(const ExpressionNode& node) {
    const Branches branches = BranchesOf(node);
    const std::optional<AtomId> condition = OfCondition(branches.condition);
    if (!condition) return std::nullopt;
    std::optional<ProductSum> then = Of(branches.then);
    if (!then) return std::nullopt;
    std::optional<ProductSum> otherwise = Of(branches.otherwise);
    if (!otherwise) return std::nullopt;
    if (*then == *otherwise) return then;
    std::string key = "if " + std::to_string(*condition) + '(' + algebra.KeyOf(*then) + ")(" +
                      algebra.KeyOf(*otherwise) + ')';
    const bool mentionsFlow = algebra.At(*condition).mentionsFlow || algebra.MentionsFlow(*then) ||
                              algebra.MentionsFlow(*otherwise);
    return Single(algebra.Intern(std::move(key), {.kind = Atom::Kind::Conditional,
                                                  .parts = {std::move(*then), std::move(*otherwise)},
                                                  .conditions = {*condition},
                                                  .text = std::string(TextOf(node, text)),
                                                  .mentionsFlow = mentionsFlow}));
  }

  /// A condition as an atom: a comparison is "bigger" or "equal", or the contrary of one.
  std::optional<AtomId> OfCondition(const ExpressionNode& node) {
    if (level >= kMostLevels) return algebra.Fail("a condition nests too deeply");
    ++level;
    std::optional<AtomId> condition = LogicOf(node) ? OfLogic(*LogicOf(node)) : OfComparison(node);
    --level;
    return condition;
  }

  std::optional<AtomId> OfLogic(const Logic& logic) {
    const std::optional<AtomId> left = OfCondition(logic.left);
    if (!left) return std::nullopt;
    if (logic.which == Logic::Operator::Not) return Negated(*left);
    const std::optional<AtomId> right = OfCondition(logic.right);
    if (!right) return std::nullopt;
    const bool isAnd = logic.which == Logic::Operator::And;
    return Condition(isAnd ? Atom::Kind::And : Atom::Kind::Or, {}, {*left, *right});
  }

  std::optional<AtomId> OfComparison(const ExpressionNode& node) {
    std::optional<ProductSum> left = Of(*node.Child(1));
    if (!left) return std::nullopt;
    std::optional<ProductSum> right = Of(*node.Child(2));
    if (!right) return std::nullopt;
    const std::string_view sign = node.Text();
    const bool isEquality = sign == "==" || sign == "!=";
    if (sign == "<" || sign == ">=") std::swap(left, right);
    const AtomId condition = Condition(isEquality ? Atom::Kind::Equal : Atom::Kind::Bigger,
                                       {std::move(*left), std::move(*right)}, {});
    return sign == "!=" || sign == "<=" || sign == ">=" ? Negated(condition) : condition;
  }

  AtomId Negated(AtomId condition) { return Condition(Atom::Kind::Not, {}, {condition}); }

  AtomId Condition(Atom::Kind kind, std::vector<ProductSum> parts, std::vector<AtomId> conditions) {
    std::string key = "condition " + std::to_string(static_cast<int>(kind));
    bool mentionsFlow = false;
    for (const ProductSum& part : parts) {
      key += '(' + algebra.KeyOf(part) + ')';
      mentionsFlow = mentionsFlow || algebra.MentionsFlow(part);
    }
    for (const AtomId condition : conditions) {
      key += ' ' + std::to_string(condition);
      mentionsFlow = mentionsFlow || algebra.At(condition).mentionsFlow;
    }
    return algebra.Intern(std::move(key), {.kind = kind,
                                           .parts = std::move(parts),
                                           .conditions = std::move(conditions),
                                           .mentionsFlow = mentionsFlow});
  }

  Algebra& algebra;
  std::string_view text;
  int level = 0;
};

std::optional<ProductSum> Algebra::Expand(std::string_view text, const ExpressionNode& tree) {
  return Expansion(*this, text).Of(tree);
}

const std::optional<ProductSum>& Algebra::BodyOf(const SymbolRecord& record) {
  const auto [place, isNew] = bodies.try_emplace(record.sequence);
  if (isNew) {
    const RecordExpression expression = ExpressionOf(record);
    if (expression.tree != nullptr) place->second = Expand(expression.text, *expression.tree);
  }
  return place->second;
}

AtomId Algebra::SymbolAtom(const SymbolRecord& record) {
  const auto [place, isNew] = symbols.try_emplace(record.sequence, static_cast<AtomId>(atoms.size()));
  if (isNew) {
    atoms.push_back({.kind = Atom::Kind::Symbol,
                     .record = &record,
                     .text = record.element->symbol.TextOf(),
                     .mentionsFlow = IsFlow(index.Template(), record)});
  }
  return place->second;
}

AtomId Algebra::BracketAtom(const ProductSum& sum, std::string_view text) {
  return Intern("bracket " + KeyOf(sum), {.kind = Atom::Kind::Bracket,
                                          .parts = {sum},
                                          .text = text.empty() ? Text(sum) : std::string(text),
                                          .mentionsFlow = MentionsFlow(sum)});
}

AtomId Algebra::Intern(std::string key, Atom atom) {
  const auto [place, isNew] = numbers.try_emplace(std::move(key), static_cast<AtomId>(atoms.size()));
  if (isNew) atoms.push_back(std::move(atom));
  return place->second;
}

std::string Algebra::KeyOf(const ProductSum& sum) const {
  std::string key;
  for (const Product& product : sum) {
    key += ShortestNumberText(product.coefficient);
    for (const AtomPower& each : product.atoms) {
      key += '*' + std::to_string(each.atom) + '^' + std::to_string(each.power);
    }
    key += ';';
  }
  return key;
}

bool Algebra::MentionsFlow(const ProductSum& sum) const {
  return std::any_of(sum.begin(), sum.end(), [this](const Product& product) {
    return std::any_of(product.atoms.begin(), product.atoms.end(),
                       [this](const AtomPower& each) { return atoms[each.atom].mentionsFlow; });
  });
}

std::nullopt_t Algebra::Fail(std::string reason) {
  failure = std::move(reason);
  return std::nullopt;
}

std::optional<ProductSum> Algebra::Times(const ProductSum& left, const ProductSum& right) {
  if (left.size() * right.size() > kMostProducts) return Fail("an expression has too many terms");
  ProductSum product;
  product.reserve(left.size() * right.size());
  for (const Product& one : left) {
    for (const Product& other : right) {
      product.push_back({one.coefficient * other.coefficient, United(one.atoms, other.atoms)});
      if (product.back().atoms.size() > kMostAtoms) return Fail("a term has too many factors");
    }
  }
  Settle(product);
  return product;
}

bool Algebra::Contains(AtomId atom, AtomId symbol) const {
  std::vector<AtomId> open{atom};
  while (!open.empty()) {
    const AtomId next = open.back();
    open.pop_back();
    if (next == symbol) return true;
    const Atom& whole = atoms[next];
    open.insert(open.end(), whole.conditions.begin(), whole.conditions.end());
    for (const ProductSum& part : whole.parts) {
      for (const Product& product : part) {
        for (const AtomPower& each : product.atoms) open.push_back(each.atom);
      }
    }
  }
  return false;
}

std::optional<ProductSum> Algebra::Derivative(const ProductSum& sum, AtomId symbol) {
  ProductSum derivative;
  for (const Product& product : sum) {
    for (std::size_t place = 0; place < product.atoms.size(); ++place) {
      const AtomPower factor = product.atoms[place];
      if (factor.atom != symbol) {
        if (atoms[factor.atom].kind == Atom::Kind::Symbol || !Contains(factor.atom, symbol)) continue;
        return Fail("it has no simple derivative by " + atoms[symbol].text + " in " +
                    atoms[factor.atom].text);
      }
      Product slope = product;
      slope.coefficient *= factor.power;
      slope.atoms[place].power -= 1;
      if (slope.atoms[place].power == 0) {
        slope.atoms.erase(slope.atoms.begin() + static_cast<std::ptrdiff_t>(place));
      }
      derivative.push_back(std::move(slope));
    }
  }
  Settle(derivative);
  return derivative;
}

std::string Algebra::FactorText(const AtomPower& factor) const {
  const Atom& atom = atoms[factor.atom];
  const bool needsBrackets = atom.kind == Atom::Kind::Bracket || atom.kind == Atom::Kind::Conditional;
  const std::string once = needsBrackets ? '(' + atom.text + ')' : atom.text;
  std::string text = once;
  for (std::int32_t power = 1; power < std::abs(factor.power); ++power) text += '*' + once;
  return text;
}

/// Without the sign, which the sum puts before it.
std::string Algebra::ProductText(const Product& product) const {
  std::string above;
  std::string below;
  std::size_t divisors = 0;
  for (const AtomPower& each : product.atoms) {
    std::string& side = each.power > 0 ? above : below;
    if (!side.empty()) side += '*';
    side += FactorText(each);
    if (each.power < 0) divisors += static_cast<std::size_t>(-each.power);
  }
  const double coefficient = std::abs(product.coefficient);
  // A third is written as it was, and not with sixteen digits.
  const double inverse = 1 / coefficient;
  const bool isFraction =
      coefficient < 1 && ShortestNumberText(inverse).size() < ShortestNumberText(coefficient).size();
  if (isFraction) {
    below = ShortestNumberText(inverse) + (below.empty() ? "" : "*") + below;
    ++divisors;
  } else if (coefficient != 1 || above.empty()) {
    above = ShortestNumberText(coefficient) + (above.empty() ? "" : "*") + above;
  }
  if (above.empty()) above = "1";
  if (below.empty()) return above;
  return above + '/' + (divisors > 1 ? '(' + below + ')' : below);
}

std::string Algebra::Text(const ProductSum& sum) const {
  if (sum.empty()) return "0";
  // A bracket alone needs none.
  if (sum.size() == 1 && sum.front().coefficient == 1 && sum.front().atoms.size() == 1 &&
      sum.front().atoms.front().power == 1) {
    return atoms[sum.front().atoms.front().atom].text;
  }
  std::string text;
  for (const Product& product : sum) {
    const bool isNegative = product.coefficient < 0;
    if (text.empty()) {
      text += isNegative ? "-" : "";
    } else {
      text += isNegative ? " - " : " + ";
    }
    text += ProductText(product);
  }
  return text;
}

bool IsFlow(const TemplateCore& core, const SymbolRecord& record) {
  if (record.kind != ElementKind::ArithmeticExpression) return record.kind == ElementKind::Process;
  return std::any_of(record.referencedBy.begin(), record.referencedBy.end(), [&core](std::uint32_t user) {
    return core.FindRecordBySequence(user)->kind == ElementKind::SpecieStateVariable;
  });
}

void Append(ProductSum& sum, const ProductSum& added, double factor) {
  for (const Product& product : added) sum.push_back({product.coefficient * factor, product.atoms});
}

void Settle(ProductSum& sum) {
  std::stable_sort(sum.begin(), sum.end(), ComesBefore);
  ProductSum settled;
  for (auto first = sum.begin(); first != sum.end();) {
    double total = 0;
    double size = 0;
    auto next = first;
    for (; next != sum.end() && next->atoms == first->atoms; ++next) {
      total += next->coefficient;
      size += std::abs(next->coefficient);
    }
    if (std::abs(total) > kRounding * size) settled.push_back({total, std::move(first->atoms)});
    first = next;
  }
  sum = std::move(settled);
}

bool HasProduct(const ProductSum& sum, const Product& likeThis) {
  const auto place = std::lower_bound(sum.begin(), sum.end(), likeThis, ComesBefore);
  return place != sum.end() && place->atoms == likeThis.atoms;
}

}  // namespace tessal
