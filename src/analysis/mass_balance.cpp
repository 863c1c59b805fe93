#include "analysis/mass_balance.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <map>
#include <set>
#include <utility>

#include "analysis/algebra_values.h"
#include "analysis/flows.h"
#include "core/template_core.h"
#include "expr/parser.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

constexpr std::uint64_t kPoints = 16;
/// What is left of a sum, relative to its absolute terms, counts as nothing.
constexpr double kTolerance = 1e-9;
/// Auxiliaries within auxiliaries of a pool that are looked into.
constexpr int kMostLevels = 20;

/// Whether a sum is zero whatever the values of its symbols.
enum class Vanishes : std::uint8_t {
  Always,
  Never,
  ByFunctions,   ///< only as its functions are computed
  ByConditions,  ///< only as its comparisons come out
  Unknown
};

/// Judges one pool.
class PoolJudging final {
 public:
  PoolJudging(const SymbolIndex& symbolIndex, const Pool& judgedPool)
      : index(symbolIndex),
        algebra(index, Brackets::MultipliedOut),
        flows(algebra, [this](const SymbolRecord& flow) { return IsBoundary(flow); }),
        pool(judgedPool) {}

  PoolBalance Judge() {
    balance.name = pool.name;
    if (const std::optional<ProductSum> rate = RateOfChange()) Decide(WithoutBoundary(*rate));
    return std::move(balance);
  }

 private:
  std::nullopt_t CanNot(std::string reason) {
    balance.verdict = PoolVerdict::Unknown;
    balance.reason = std::move(reason);
    return std::nullopt;
  }

  bool IsBoundary(const SymbolRecord& flow) const {
    const std::string_view symbol = flow.element->symbol.Text();
    return std::find(pool.boundary.begin(), pool.boundary.end(), symbol) != pool.boundary.end();
  }

  /// The names of the boundary must mean something, or a slip in one would look like a leak.
  bool KnowsBoundary() {
    for (const std::string& name : pool.boundary) {
      const SymbolRecord* record = index.Find(name);
      if (record != nullptr && IsFlow(index.Template(), *record)) continue;
      CanNot("its boundary " + name + (record == nullptr ? " is not defined" : " is no process"));
      return false;
    }
    return true;
  }

  std::optional<ProductSum> RateOfChange() {
    if (!KnowsBoundary()) return std::nullopt;
    const std::optional<ProductSum> amount = Amount();
    if (!amount) return std::nullopt;
    std::set<AtomId> states;
    for (const ProductSum& sum : {*amount}) CollectStates(sum, states);
    if (states.empty()) return CanNot("its expression uses no state variable");
    ProductSum rate;
    for (const AtomId state : states) {
      const std::optional<ProductSum> slope = algebra.Derivative(*amount, state);
      if (!slope) return CanNot(algebra.Failure());
      const std::optional<ProductSum> equation = EquationOf(*algebra.At(state).record);
      if (!equation) return std::nullopt;
      const std::optional<ProductSum> part = algebra.Times(*slope, *equation);
      if (!part) return CanNot(algebra.Failure());
      Append(rate, *part);
    }
    Settle(rate);
    return flows.Elementary(rate);
  }

  /// The pool's expression, with auxiliaries that are made of state variables written out.
  std::optional<ProductSum> Amount() {
    if (pool.expression.find_first_not_of(" \t\r\n") == std::string::npos) {
      return CanNot("it has no expression");
    }
    const ScannerRest rest;
    const auto parsed = ParseExpression(pool.expression);
    if (parsed->Tree() == nullptr) {
      std::string reason = parsed->Failure()->finding.text;
      while (!reason.empty() && reason.back() == '\n') reason.pop_back();
      return CanNot("its expression does not parse: " + reason);
    }
    for (const LexemeSpan& name : parsed->Identifiers()) {
      const std::string_view symbol = std::string_view(pool.expression).substr(name.start, name.length);
      if (index.Find(symbol) == nullptr && !index.Template().CountsAsDefined(symbol)) {
        return CanNot(std::string(symbol) + " is not defined");
      }
    }
    std::optional<ProductSum> amount = algebra.Expand(pool.expression, *parsed->Tree());
    for (int level = 0; amount && level < kMostLevels; ++level) {
      const std::optional<AtomId> auxiliary = AuxiliaryOfStates(*amount);
      if (!auxiliary) return amount;
      amount = WrittenOut(*amount, *auxiliary);
    }
    return CanNot(amount ? "its auxiliaries nest too deeply" : algebra.Failure());
  }

  static bool IsState(const Atom& atom) {
    return atom.record != nullptr && (atom.record->kind == ElementKind::StateVariable ||
                                      atom.record->kind == ElementKind::SpecieStateVariable);
  }

  void CollectStates(const ProductSum& sum, std::set<AtomId>& states) const {
    std::vector<const ProductSum*> open{&sum};
    while (!open.empty()) {
      const ProductSum& next = *open.back();
      open.pop_back();
      for (const Product& product : next) {
        for (const AtomPower& each : product.atoms) {
          const Atom& atom = algebra.At(each.atom);
          if (IsState(atom)) states.insert(each.atom);
          for (const ProductSum& part : atom.parts) open.push_back(&part);
        }
      }
    }
  }

  /// An auxiliary or process among the factors whose value follows from state variables.
  std::optional<AtomId> AuxiliaryOfStates(const ProductSum& sum) {
    for (const Product& product : sum) {
      for (const AtomPower& each : product.atoms) {
        const Atom& atom = algebra.At(each.atom);
        if (atom.record != nullptr && atom.record->expression != nullptr && !IsState(atom) &&
            FollowsFromStates(*atom.record)) {
          return each.atom;
        }
      }
    }
    return std::nullopt;
  }

  bool FollowsFromStates(const SymbolRecord& record) {
    const auto [known, isNew] = followers.try_emplace(record.sequence, false);
    if (!isNew) return known->second;
    std::vector<const SymbolRecord*> open{&record};
    std::set<std::uint32_t> seen;
    while (!open.empty()) {
      const SymbolRecord& next = *open.back();
      open.pop_back();
      for (const std::uint32_t used : next.references) {
        const SymbolRecord& source = *index.Template().FindRecordBySequence(used);
        if (source.kind == ElementKind::StateVariable || source.kind == ElementKind::SpecieStateVariable) {
          return followers[record.sequence] = true;
        }
        if (seen.insert(used).second) open.push_back(&source);
      }
    }
    return false;
  }

  std::optional<ProductSum> WrittenOut(const ProductSum& sum, AtomId auxiliary) {
    const std::optional<ProductSum>& body = algebra.BodyOf(*algebra.At(auxiliary).record);
    if (!body) return CanNot(algebra.At(auxiliary).text + " can not be expanded");
    ProductSum written;
    for (Product product : sum) {
      const auto place = std::find_if(product.atoms.begin(), product.atoms.end(),
                                      [auxiliary](const AtomPower& each) { return each.atom == auxiliary; });
      if (place == product.atoms.end()) {
        written.push_back(std::move(product));
        continue;
      }
      const std::int32_t power = place->power;
      product.atoms.erase(place);
      std::optional<ProductSum> part = ProductSum{std::move(product)};
      if (power < 0) return CanNot("it divides by " + algebra.At(auxiliary).text);
      for (std::int32_t factor = 0; part && factor < power; ++factor) part = algebra.Times(*part, *body);
      if (!part) return std::nullopt;
      Append(written, *part);
    }
    Settle(written);
    return written;
  }

  std::optional<ProductSum> EquationOf(const SymbolRecord& state) {
    const RecordExpression equation = ExpressionOf(state);
    const std::string name = state.element->symbol.TextOf();
    if (equation.tree == nullptr) return CanNot("the equation of " + name + " does not parse");
    std::optional<ProductSum> sum = algebra.Expand(equation.text, *equation.tree);
    if (!sum) return CanNot("the equation of " + name + " can not be expanded: " + algebra.Failure());
    return sum;
  }

  ProductSum WithoutBoundary(const ProductSum& rate) {
    ProductSum inner;
    for (const Product& product : rate) {
      const bool crosses =
          std::any_of(product.atoms.begin(), product.atoms.end(), [this](const AtomPower& each) {
            const Atom& atom = algebra.At(each.atom);
            return atom.record != nullptr && atom.mentionsFlow && each.power == 1 && IsBoundary(*atom.record);
          });
      if (!crosses) inner.push_back(product);
    }
    return inner;
  }

  void Decide(const ProductSum& rate) {
    if (rate.empty()) {
      balance.verdict = PoolVerdict::Closed;
      return;
    }
    switch (AtPoints(rate)) {
      case Vanishes::Always:
        balance.verdict = PoolVerdict::Closed;
        return;
      case Vanishes::Never:
        balance.verdict = PoolVerdict::Open;
        FindLeaks(rate);
        return;
      case Vanishes::ByFunctions:
        CanNot("it is closed at the values that were tried, but not by algebra: " + FirstText(rate, "("));
        return;
      case Vanishes::ByConditions:
        CanNot("it is closed or not as conditions hold: " + FirstText(rate, "IF"));
        return;
      case Vanishes::Unknown:
        CanNot("a value is not finite: a division by zero, or an expression that can not be expanded");
    }
  }

  /// Judges by values. A counter-example by the values themselves makes a pool open; one that supposes
  /// functions that are other than they are, or outcomes of comparisons that may exclude each other, does
  /// not.
  Vanishes AtPoints(const ProductSum& sum) {
    const Counts byValues = CountPoints(sum, PointKind::Random);
    if (byValues.nonZero > 0) return Vanishes::Never;
    const Counts byFunctions = CountPoints(sum, PointKind::RandomFunctions);
    if (byFunctions.nonZero > 0) return Vanishes::ByFunctions;
    const Counts byTruths = CountPoints(sum, PointKind::RandomTruths);
    if (byTruths.nonZero > 0) return Vanishes::ByConditions;
    return byFunctions.zero + byTruths.zero > 0 ? Vanishes::Always : Vanishes::Unknown;
  }

  struct Counts {
    std::uint64_t zero = 0;
    std::uint64_t nonZero = 0;  ///< one is enough
  };

  Counts CountPoints(const ProductSum& sum, PointKind kind) {
    Counts counts;
    for (std::uint64_t point = 1; point <= kPoints; ++point) {
      PointValues values(algebra, kind, point);
      const double value = values.ValueOf(sum);
      const double size = values.SizeOf(sum);
      if (!std::isfinite(value) || !std::isfinite(size)) continue;
      if (std::abs(value) > kTolerance * size) return {counts.zero, 1};
      ++counts.zero;
    }
    return counts;
  }

  /// The first part of a sum whose text holds a mark, with the expression after its name.
  std::string FirstText(const ProductSum& rate, std::string_view mark) {
    for (const Product& product : rate) {
      for (const AtomPower& each : product.atoms) {
        const Atom& atom = algebra.At(each.atom);
        if (atom.text.find(mark) != std::string::npos) return atom.text;
        if (atom.record == nullptr || atom.record->expression == nullptr) continue;
        const std::string_view text = ExpressionOf(*atom.record).text;
        if (text.find(mark) != std::string_view::npos) return atom.text + " = " + std::string(text);
      }
    }
    return algebra.Text(rate);
  }

  /// The processes whose own contributions do not cancel: each is written out, and what is left of the sum
  /// says which of them it comes from.
  void FindLeaks(const ProductSum& rate) {
    const FlowForm form = FlowFormOf(algebra, rate);
    std::map<AtomId, ProductSum> parts;
    ProductSum total = form.rest;
    for (const auto& [flow, factor] : form.factors) {
      if (AtPoints(factor) == Vanishes::Always) continue;
      parts[flow] = WrittenOutRate(flow, factor);
      Append(total, parts[flow]);
    }
    Settle(total);
    for (const auto& [flow, part] : parts) {
      const bool leaks = total.empty() || std::any_of(part.begin(), part.end(), [&total](const Product& one) {
                           return HasProduct(total, one);
                         });
      if (leaks) AddLeak(*algebra.At(flow).record, form.factors.at(flow));
    }
    if (!form.rest.empty()) AddLeak(nullptr, {}, form.rest);
    std::stable_sort(order.begin(), order.end(),
                     [](const auto& one, const auto& other) { return one.first < other.first; });
    for (auto& [sequence, leak] : order) balance.leaks.push_back(std::move(leak));
  }

  ProductSum WrittenOutRate(AtomId flow, const ProductSum& factor) {
    const std::optional<ProductSum>& body = algebra.BodyOf(*algebra.At(flow).record);
    const std::optional<ProductSum> part = body ? algebra.Times(factor, *body) : std::nullopt;
    if (part) return *part;
    return algebra.Times(factor, {{1, {{flow, 1}}}}).value_or(ProductSum());
  }

  void AddLeak(const SymbolRecord& process, const ProductSum& net) {
    AddLeak(&process, process.element->symbol.TextOf(), net);
  }
  void AddLeak(const SymbolRecord* process, std::string symbol, const ProductSum& net) {
    order.emplace_back(process == nullptr ? UINT32_MAX : process->sequence,
                       PoolLeak{process == nullptr ? Uid::None : process->uid, std::move(symbol),
                                algebra.Text(net), defaults.ValueOf(net)});
  }

  const SymbolIndex& index;
  Algebra algebra;
  Flows flows;
  const Pool& pool;
  PoolBalance balance;
  PointValues defaults{algebra, PointKind::Defaults, 0};
  std::map<std::uint32_t, bool> followers;
  std::vector<std::pair<std::uint32_t, PoolLeak>> order;  ///< leaks with the numbers of their records
};

std::string LeaksInWords(const PoolBalance& balance) {
  std::string text;
  for (const PoolLeak& leak : balance.leaks) {
    if (!text.empty()) text += ", ";
    text += (leak.process.empty() ? "the equations" : leak.process) + " yields " + leak.net;
  }
  return text;
}

}  // namespace

std::vector<PoolBalance> CheckMassBalance(const TemplateCore& core, std::span<const Pool> pools) {
  const SymbolIndex index(core);
  std::vector<PoolBalance> balances;
  for (const Pool& pool : pools) balances.push_back(PoolJudging(index, pool).Judge());
  return balances;
}

std::vector<AnalysisFinding> BalanceFindings(const TemplateCore& core,
                                             std::span<const PoolBalance> balances) {
  std::vector<AnalysisFinding> findings;
  for (const PoolBalance& balance : balances) {
    if (balance.verdict != PoolVerdict::Open) continue;
    const Finding finding("pool-open", {balance.name, LeaksInWords(balance)});
    const CEL_Element* first = balance.leaks.empty() ? nullptr : core.GetElement(balance.leaks.front().uid);
    if (first != nullptr) {
      findings.push_back(FindingAbout(*first, finding));
    } else {
      findings.push_back({finding.message, finding.text});
    }
  }
  return findings;
}

}  // namespace tessal
