#include "analysis/unit_value.h"

#include <algorithm>
#include <cmath>

namespace tessal {

void MultiplyBy(Unit& unit, const Unit& other, double power) {
  for (std::size_t base = 0; base < kBaseUnits; ++base) unit.powers[base] += power * other.powers[base];
  unit.logFactor += power * other.logFactor;
  unit.isFactorOpen |= other.isFactorOpen;
  unit.hasUnnamedAmount |= other.hasUnnamedAmount;
  for (const SubstancePower& factor : other.substances) {
    auto place = std::lower_bound(
        unit.substances.begin(), unit.substances.end(), factor.substance,
        [](const SubstancePower& entry, std::string_view name) { return entry.substance < name; });
    if (place == unit.substances.end() || place->substance != factor.substance) {
      place = unit.substances.insert(place, {factor.substance, 0});
    }
    place->power += power * factor.power;
    if (IsNear(place->power, 0)) unit.substances.erase(place);
  }
}

Unit RaisedTo(const Unit& unit, double power) {
  Unit raised;
  MultiplyBy(raised, unit, power);
  return raised;
}

bool IsNear(double left, double right) {
  // Texts of units have six digits.
  constexpr double kTolerance = 1e-4;
  return std::abs(left - right) < kTolerance;
}

bool IsDimensionless(const Unit& unit) {
  return std::all_of(unit.powers.begin(), unit.powers.end(), [](double power) { return IsNear(power, 0); });
}

bool HaveSameDimension(const Unit& left, const Unit& right) {
  return std::equal(left.powers.begin(), left.powers.end(), right.powers.begin(), IsNear);
}

bool HaveSameFactor(const Unit& left, const Unit& right) {
  return left.isFactorOpen || right.isFactorOpen || IsNear(left.logFactor, right.logFactor);
}

bool HaveSameSubstances(const Unit& left, const Unit& right) {
  if (left.hasUnnamedAmount || right.hasUnnamedAmount) return true;
  return std::equal(left.substances.begin(), left.substances.end(), right.substances.begin(),
                    right.substances.end(), [](const SubstancePower& one, const SubstancePower& other) {
                      return one.substance == other.substance && IsNear(one.power, other.power);
                    });
}

bool AreSame(const Unit& left, const Unit& right) {
  return HaveSameDimension(left, right) && HaveSameFactor(left, right) && HaveSameSubstances(left, right);
}

}  // namespace tessal
