#include "analysis/unit_spelling.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <span>
#include <string_view>
#include <vector>

#include "platform/ascii.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

/// A unit that modellers use for a base unit.
struct UsedUnit {
  std::string_view symbol;
  double factor;
};

// The first whose product gives the unit is taken.
constexpr UsedUnit kTimes[] = {{"d", 86400}, {"s", 1}, {"h", 3600}, {"min", 60}, {"year", 31556925.9747}};
constexpr UsedUnit kMasses[] = {{"g", 1e-3}, {"mg", 1e-6}, {"kg", 1}, {"ug", 1e-9}, {"tonne", 1e3}};
constexpr UsedUnit kMoles[] = {{"mmol", 1e-3}, {"mol", 1}, {"umol", 1e-6}};
constexpr UsedUnit kLengths[] = {{"m", 1}, {"cm", 1e-2}, {"mm", 1e-3}, {"km", 1e3}};
constexpr UsedUnit kAlone[] = {{"", 1}};

/// Derived units that are written whole, "W/m2".
struct DerivedUnit {
  std::string_view symbol;
  std::array<double, kBaseUnits> powers;  ///< in the order of the base units
};
constexpr DerivedUnit kDerived[] = {
    {"W", {-3, 2, 1, 0, 0, 0, 0}},
    {"J", {-2, 2, 1, 0, 0, 0, 0}},
    {"Pa", {-2, -1, 1, 0, 0, 0, 0}},
    {"N", {-2, 1, 1, 0, 0, 0, 0}},
};

/// Units without a dimension that have names.
constexpr UsedUnit kRatios[] = {{"-", 1}, {"percent", 1e-2}, {"degree", 0.017453292519943295}};

/// "m2", "m^0.5"; nothing for the first power.
std::string PowerText(double power) {
  if (IsNear(power, 1)) return {};
  const bool isWhole = IsNear(power, std::round(power));
  return (isWhole ? "" : "^") + SixDigitNumberText(isWhole ? std::round(power) : power);
}

/// Factors with powers, as one text.
class ProductText final {
 public:
  void Add(std::string_view symbol, double power) {
    if (IsNear(power, 0) || symbol.empty()) return;
    if (power > 0) {
      above += (above.empty() ? "" : " ") + std::string(symbol) + PowerText(power);
    } else {
      below += "/" + std::string(symbol) + PowerText(-power);
    }
  }
  /// "1/d" where nothing is above the line.
  std::string Text() const { return (above.empty() ? "1" : above) + below; }
  bool IsEmpty() const { return above.empty() && below.empty(); }

 private:
  std::string above;
  std::string below;
};

/// The name of an amount with its share of the substances: "mmol N", "g".
void AddAmount(ProductText& text, std::string_view symbol, const Unit& unit, double power) {
  double named = 0;
  for (const SubstancePower& entry : unit.substances) named += entry.power;
  if (unit.substances.empty() || !IsNear(named, power)) {
    text.Add(symbol, power);
    return;
  }
  for (const SubstancePower& entry : unit.substances) {
    const std::string exponent = PowerText(std::abs(entry.power));
    // The power is at both words: "mmol2 N2".
    const bool endsInDigit =
        IsAsciiDigit(entry.substance.back()) && !exponent.empty() && exponent.front() != '^';
    std::string name(symbol);
    name.append(exponent).append(" ").append(entry.substance).append(endsInDigit ? "^" : "").append(exponent);
    text.Add(name, entry.power > 0 ? 1 : -1);
  }
}

/// The used units of a product, which together have the factor of the unit.
struct Choice {
  const UsedUnit* time = nullptr;
  const UsedUnit* mass = nullptr;
  const UsedUnit* moles = nullptr;
  const UsedUnit* length = nullptr;
};

std::span<const UsedUnit> RowsFor(double power, std::span<const UsedUnit> rows) {
  return IsNear(power, 0) ? std::span<const UsedUnit>(kAlone) : rows;
}

/// Whether there is a choice with exactly that factor; otherwise the first of each row.
bool FindChoice(const Unit& unit, Choice& choice) {
  auto lengths = RowsFor(unit.Power(BaseUnit::Metre), kLengths);
  // Nobody writes mm3 for a small volume.
  if (!IsNear(std::abs(unit.Power(BaseUnit::Metre)), 1)) lengths = lengths.first(1);
  const auto moles = RowsFor(unit.Power(BaseUnit::Mole), kMoles);
  const auto masses = RowsFor(unit.Power(BaseUnit::Kilogram), kMasses);
  const auto times = RowsFor(unit.Power(BaseUnit::Second), kTimes);
  choice = {&times.front(), &masses.front(), &moles.front(), &lengths.front()};
  if (unit.isFactorOpen) return true;
  for (const UsedUnit& length : lengths) {
    for (const UsedUnit& mole : moles) {
      for (const UsedUnit& mass : masses) {
        for (const UsedUnit& time : times) {
          const double logFactor = unit.Power(BaseUnit::Metre) * std::log(length.factor) +
                                   unit.Power(BaseUnit::Mole) * std::log(mole.factor) +
                                   unit.Power(BaseUnit::Kilogram) * std::log(mass.factor) +
                                   unit.Power(BaseUnit::Second) * std::log(time.factor);
          if (!IsNear(logFactor, unit.logFactor)) continue;
          choice = {&time, &mass, &mole, &length};
          return true;
        }
      }
    }
  }
  return false;
}

/// A unit without a power of a derived one.
Unit Without(const Unit& unit, const DerivedUnit& derived, double power) {
  Unit rest = unit;
  for (std::size_t base = 0; base < kBaseUnits; ++base) rest.powers[base] -= power * derived.powers[base];
  return rest;
}

double Complexity(const Unit& unit) {
  double sum = 0;
  for (const double power : unit.powers) sum += std::abs(power);
  return sum;
}

/// The derived unit that makes the text short, which has the power of the mass; none where there is no such.
const DerivedUnit* BestDerived(const Unit& unit) {
  const double power = unit.Power(BaseUnit::Kilogram);
  if (IsNear(power, 0)) return nullptr;
  const DerivedUnit* best = nullptr;
  Choice choice;
  bool isExact = FindChoice(unit, choice);
  double least = Complexity(unit);
  for (const DerivedUnit& row : kDerived) {
    const Unit rest = Without(unit, row, power);
    const bool restIsExact = FindChoice(rest, choice);
    const double complexity = Complexity(rest) + std::abs(power);
    if (restIsExact < isExact || (restIsExact == isExact && complexity >= least)) continue;
    best = &row;
    isExact = restIsExact;
    least = complexity;
  }
  return best;
}

std::string RatioText(const Unit& unit) {
  if (unit.isFactorOpen) return "-";
  for (const UsedUnit& row : kRatios) {
    if (IsNear(std::log(row.factor), unit.logFactor)) return std::string(row.symbol);
  }
  return SixDigitNumberText(std::exp(unit.logFactor));
}

std::string FactorText(double logFactor) {
  return SixDigitNumberText(std::exp(logFactor)) + " ";
}

}  // namespace

std::string InBaseUnits(const Unit& unit) {
  static constexpr std::array<std::string_view, kBaseUnits> kSymbols = {"s", "m",   "kg", "A",
                                                                        "K", "mol", "cd"};
  std::string text = IsNear(unit.logFactor, 0) ? std::string() : SixDigitNumberText(std::exp(unit.logFactor));
  for (std::size_t base = 0; base < kBaseUnits; ++base) {
    if (IsNear(unit.powers[base], 0)) continue;
    if (!text.empty()) text += ' ';
    text += kSymbols[base];
    text += PowerText(unit.powers[base]);
  }
  return text.empty() ? "1" : text;
}

std::string SubstanceText(const Unit& unit) {
  if (unit.substances.empty()) return {};
  ProductText text;
  for (const SubstancePower& entry : unit.substances) {
    // "N^2", as "N2" is a substance.
    const double size = std::abs(entry.power);
    const std::string power = IsNear(size, 1) ? "" : "^" + SixDigitNumberText(size);
    text.Add(std::string(entry.substance) + power, entry.power > 0 ? 1 : -1);
  }
  return text.Text();
}

std::string AsModellersWrite(const Unit& unit) {
  const DerivedUnit* derived = BestDerived(unit);
  const double derivedPower = unit.Power(BaseUnit::Kilogram);
  const Unit rest = derived == nullptr ? unit : Without(unit, *derived, derivedPower);
  Choice choice;
  const bool isExact = FindChoice(rest, choice);
  ProductText text;
  if (derived != nullptr) text.Add(derived->symbol, derivedPower);
  // Before the amounts, as "Chl A" is a substance.
  text.Add("A", rest.Power(BaseUnit::Ampere));
  text.Add("cd", rest.Power(BaseUnit::Candela));
  const double mass = rest.Power(BaseUnit::Kilogram);
  const double moles = rest.Power(BaseUnit::Mole);
  if (!IsNear(moles, 0)) AddAmount(text, choice.moles->symbol, rest, moles);
  // Of "g N/g C" the names alone are left.
  if (IsNear(moles, 0) || !IsNear(mass, 0)) {
    AddAmount(text, IsNear(mass, 0) ? "g" : choice.mass->symbol, rest, mass);
  }
  text.Add(choice.length->symbol, rest.Power(BaseUnit::Metre));
  text.Add("degC", rest.Power(BaseUnit::Kelvin));
  text.Add(choice.time->symbol, rest.Power(BaseUnit::Second));
  if (text.IsEmpty()) return RatioText(unit);
  if (isExact) return text.Text();
  double logFactor = unit.logFactor;
  logFactor -= rest.Power(BaseUnit::Metre) * std::log(choice.length->factor);
  logFactor -= rest.Power(BaseUnit::Mole) * std::log(choice.moles->factor);
  logFactor -= rest.Power(BaseUnit::Kilogram) * std::log(choice.mass->factor);
  logFactor -= rest.Power(BaseUnit::Second) * std::log(choice.time->factor);
  return FactorText(logFactor) + text.Text();
}

}  // namespace tessal
