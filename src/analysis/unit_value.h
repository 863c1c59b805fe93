// A unit as a value: powers of base units and a factor. Powers need not be whole, which UDUNITS does not
// allow: the root of an area is a length.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

namespace tessal {

/// The base units, in the order of the SI brochure (BIPM 2019, 9th edition, table 2). Angles have none: a
/// radian is 1.
enum class BaseUnit : std::uint8_t { Second, Metre, Kilogram, Ampere, Kelvin, Mole, Candela };
inline constexpr std::size_t kBaseUnits = 7;

/// What an amount is one of, "mmol N", with the power of it.
struct SubstancePower {
  std::string_view substance;  ///< a name of the table of substances
  double power;
};

struct Unit {
  std::array<double, kBaseUnits> powers{};
  double logFactor = 0;  ///< natural logarithm of how many base units it is
  /// Whether nobody can say what the factor is: practical salinity, or a product with a number that may turn
  /// one unit into another.
  bool isFactorOpen = false;
  /// Whether one of its amounts is that of no substance, "mg/l", so that nothing follows from the others.
  bool hasUnnamedAmount = false;
  std::vector<SubstancePower> substances;  ///< in the order of their names; empty where they are ignored

  double& Power(BaseUnit base) { return powers[static_cast<std::size_t>(base)]; }
  double Power(BaseUnit base) const { return powers[static_cast<std::size_t>(base)]; }
};

/// The unit times a power of another.
void MultiplyBy(Unit& unit, const Unit& other, double power = 1);
Unit RaisedTo(const Unit& unit, double power);

bool IsNear(double left, double right);
bool IsDimensionless(const Unit& unit);
bool HaveSameDimension(const Unit& left, const Unit& right);
/// Whether a number in one of them is the same number in the other; true where a factor is open.
bool HaveSameFactor(const Unit& left, const Unit& right);
/// Whether the substances agree; true where an amount is that of none.
bool HaveSameSubstances(const Unit& left, const Unit& right);
/// All three.
bool AreSame(const Unit& left, const Unit& right);

}  // namespace tessal
