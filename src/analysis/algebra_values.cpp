#include "analysis/algebra_values.h"

#include <bit>
#include <cmath>
#include <functional>
#include <limits>
#include <vector>

#include "analysis/declared_values.h"
#include "core/template_core.h"
#include "expr/evaluate.h"
#include "platform/ascii.h"

namespace tessal {

namespace {

constexpr double kNoValue = std::numeric_limits<double>::quiet_NaN();
/// Arguments that differ by less, relative to their size, are the same.
constexpr double kSameArgument = 1e-9;

/// Values far from the defaults lie between these powers of two times the default.
constexpr double kWideSpread = 16;

/// The finishing steps of a 64-bit mix: Steele, G. L., Lea, D. and Flood, C. H. (2014), Fast splittable
/// pseudorandom number generators, OOPSLA 2014.
std::uint64_t Mixed(std::uint64_t bits) {
  bits = (bits ^ (bits >> 30U)) * 0xbf58476d1ce4e5b9U;
  bits = (bits ^ (bits >> 27U)) * 0x94d049bb133111ebU;
  return bits ^ (bits >> 31U);
}

/// The argument with as many digits as count.
std::uint64_t DigitsOf(double argument) {
  if (argument == 0 || !std::isfinite(argument)) return std::bit_cast<std::uint64_t>(argument);
  const double step = std::exp2(std::ceil(std::log2(std::abs(argument)))) * kSameArgument;
  return std::bit_cast<std::uint64_t>(std::round(argument / step) * step);
}

}  // namespace

double PointValues::RandomFor(std::uint64_t subject) const {
  const std::uint64_t bits = Mixed(Mixed(subject + 0x9e3779b97f4a7c15U) + seed);
  return static_cast<double>(bits >> 11U) * 0x1.0p-53;
}

double PointValues::ValueOf(const Product& product) {
  double value = product.coefficient;
  for (const AtomPower& each : product.atoms) value *= std::pow(ValueOf(each.atom), each.power);
  return value;
}

double PointValues::ValueOf(const ProductSum& sum) {
  double value = 0;
  for (const Product& product : sum) value += ValueOf(product);
  return value;
}

double PointValues::SizeOf(const ProductSum& sum) {
  double size = 0;
  for (const Product& product : sum) size += std::abs(ValueOf(product));
  return size;
}

double PointValues::ValueOf(AtomId number) {
  if (const auto hit = known.find(number); hit != known.end()) return hit->second;
  // The expression of a symbol may bring new atoms, and move the old ones.
  const Atom atom = algebra.At(number);
  double value = kNoValue;
  switch (atom.kind) {
    case Atom::Kind::Symbol:
      value = ValueOfSymbol(number);
      break;
    case Atom::Kind::Bracket:
      value = ValueOf(atom.parts.front());
      break;
    case Atom::Kind::Call:
      value = ValueOfCall(atom);
      break;
    case Atom::Kind::Conditional:
      value = ValueOf(atom.parts[Holds(atom.conditions.front()) ? 0 : 1]);
      break;
    case Atom::Kind::Other:
      if (kind != PointKind::Defaults) value = RandomFor(number) + 0.5;
      break;
    default:
      value = Holds(number) ? 1 : 0;
  }
  known[number] = value;
  return value;
}

bool PointValues::Holds(AtomId number) {
  const Atom condition = algebra.At(number);
  switch (condition.kind) {
    case Atom::Kind::Not:
      return !Holds(condition.conditions[0]);
    case Atom::Kind::And:
      return Holds(condition.conditions[0]) && Holds(condition.conditions[1]);
    case Atom::Kind::Or:
      return Holds(condition.conditions[0]) || Holds(condition.conditions[1]);
    default:
      break;
  }
  if (kind == PointKind::RandomTruths) return RandomFor(number) < 0.5;
  const double left = ValueOf(condition.parts[0]);
  const double right = ValueOf(condition.parts[1]);
  return condition.kind == Atom::Kind::Equal ? left == right : left > right;
}

double PointValues::ValueOfSymbol(AtomId number) {
  const SymbolRecord* record = algebra.At(number).record;
  if (record == nullptr) return kind == PointKind::Defaults ? kNoValue : RandomFor(number) + 0.5;
  // What a symbol is computed from comes first: a chain of definitions may be as long as the template.
  std::vector<const SymbolRecord*> open{record};
  while (!open.empty()) {
    const SymbolRecord& next = *open.back();
    if (entered.insert(next.sequence).second) {
      if (DeclaredValueOf(*next.element)) continue;
      for (const std::uint32_t used : next.references) {
        if (!entered.contains(used)) open.push_back(algebra.Index().Template().FindRecordBySequence(used));
      }
      continue;
    }
    open.pop_back();
    const AtomId atom = algebra.SymbolAtom(next);
    // A symbol that is computed from itself has no value.
    if (known.try_emplace(atom, kNoValue).second) known[atom] = ValueOfRecord(next);
  }
  return known[number];
}

double PointValues::ValueOfRecord(const SymbolRecord& record) {
  const std::optional<DeclaredValue> declared = DeclaredValueOf(*record.element);
  if (!declared) return ValueOfBody(record);
  if (kind == PointKind::Defaults) return declared->value;
  // Every other point is far from the defaults, where other conditions hold.
  const double random = RandomFor(record.sequence);
  const double share = seed % 2 == 0 ? std::exp2(kWideSpread * (random - 0.5)) : random + 0.5;
  return declared->value == 0 ? share : declared->value * share;
}

double PointValues::ValueOfBody(const SymbolRecord& record) {
  const std::optional<ProductSum>& body = algebra.BodyOf(record);
  return body ? ValueOf(*body) : kNoValue;
}

double PointValues::ValueOfCall(const Atom& call) {
  std::vector<double> arguments;
  for (const ProductSum& part : call.parts) arguments.push_back(ValueOf(part));
  const std::string name = call.text.substr(0, call.text.find('('));
  if (kind == PointKind::Defaults || kind == PointKind::Random) {
    double value = kNoValue;
    if (EvaluateFunction(name, arguments, value) == 1) return value;
    if (kind == PointKind::Defaults) return kNoValue;
  }
  std::uint64_t subject = std::hash<std::string>()(UpperCase(name));
  for (const double argument : arguments) {
    if (std::isnan(argument)) return kNoValue;
    subject = Mixed(subject ^ DigitsOf(argument));
  }
  return RandomFor(subject) + 0.5;
}

}  // namespace tessal
