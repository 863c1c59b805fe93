// The shape that all published formulae of equilibrium constants share: a sum of terms, each a coefficient
// times a function of temperature times a function of salinity. The formulae themselves are tables of such
// terms.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>

namespace tessal {

/// Functions of temperature: T in degrees Celsius, TK in kelvin, X = TK/100.
enum class Thermal : std::uint8_t { AnyT, T, T2, TK, InverseTK, LnTK, Log10TK, X, X2, InverseX, LnX };

/// Functions of salinity S, with Q its root and I the ionic strength.
enum class Saline : std::uint8_t { AnyS, Q, S, SQ, S2, Log10S, RootI, I, IRootI, I2 };

inline constexpr std::size_t kThermalFunctions = static_cast<std::size_t>(Thermal::LnX) + 1;
inline constexpr std::size_t kSalineFunctions = static_cast<std::size_t>(Saline::I2) + 1;

struct Term {
  double coefficient;
  Thermal thermal = Thermal::AnyT;
  Saline saline = Saline::AnyS;
};

/// What the sum of terms is.
enum class Form : std::uint8_t { Value, NaturalLog, Log10, NegativeLog10 };

/// The pH scale on which a formula was published. `Unscaled` is for what holds on every scale.
enum class PhScale : std::uint8_t { Total, SeaWater, Free, Nbs, Unscaled };

/// What the moles of a published formula refer to.
enum class PerKilogram : std::uint8_t { Solution, Water };

struct Formula {
  Form form;
  PhScale scale;
  PerKilogram per;
  std::span<const Term> terms;
};

/// Ionic strength of sea water in mol/kg-H2O. DOE 1994, ORNL/CDIAC-74.
double IonicStrength(double salinity);

/// The functions of temperature and salinity at one place, computed once for many formulae.
class FormulaBasis final {
 public:
  /// Salinity in g/kg, temperature in degrees Celsius. Where a function isn't defined it is NaN or infinite.
  FormulaBasis(double salinity, double temperature);

  /// The value of a formula, in mol/kg of sea water and on the scale on which it was published.
  double Evaluate(const Formula& formula) const;

 private:
  double waterPerSolution;
  std::array<double, kThermalFunctions> thermal{};
  std::array<double, kSalineFunctions> saline{};
};

}  // namespace tessal
