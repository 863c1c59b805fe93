#include "expr/carbonate/formula.h"

#include <cmath>
#include <numbers>

namespace tessal {

namespace {

template <typename Function>
constexpr std::size_t Index(Function function) {
  return static_cast<std::size_t>(function);
}

}  // namespace

double IonicStrength(double salinity) {
  return 19.924 * salinity / (1000 - 1.005 * salinity);
}

FormulaBasis::FormulaBasis(double salinity, double temperature) : waterPerSolution(1 - 0.001005 * salinity) {
  const double kelvin = temperature + 273.15;
  const double x = kelvin / 100;
  const double logKelvin = std::log(kelvin);
  thermal[Index(Thermal::AnyT)] = 1;
  thermal[Index(Thermal::T)] = temperature;
  thermal[Index(Thermal::T2)] = temperature * temperature;
  thermal[Index(Thermal::TK)] = kelvin;
  thermal[Index(Thermal::InverseTK)] = 1 / kelvin;
  thermal[Index(Thermal::LnTK)] = logKelvin;
  thermal[Index(Thermal::Log10TK)] = logKelvin / std::numbers::ln10;
  thermal[Index(Thermal::X)] = x;
  thermal[Index(Thermal::X2)] = x * x;
  thermal[Index(Thermal::InverseX)] = 1 / x;
  thermal[Index(Thermal::LnX)] = logKelvin - 2 * std::numbers::ln10;

  const double root = std::sqrt(salinity);
  const double strength = IonicStrength(salinity);
  const double strengthRoot = std::sqrt(strength);
  saline[Index(Saline::AnyS)] = 1;
  saline[Index(Saline::Q)] = root;
  saline[Index(Saline::S)] = salinity;
  saline[Index(Saline::SQ)] = salinity * root;
  saline[Index(Saline::S2)] = salinity * salinity;
  saline[Index(Saline::Log10S)] = std::log10(salinity);
  saline[Index(Saline::RootI)] = strengthRoot;
  saline[Index(Saline::I)] = strength;
  saline[Index(Saline::IRootI)] = strength * strengthRoot;
  saline[Index(Saline::I2)] = strength * strength;
}

double FormulaBasis::Evaluate(const Formula& formula) const {
  double sum = 0;
  for (const Term& term : formula.terms) {
    sum += term.coefficient * thermal[Index(term.thermal)] * saline[Index(term.saline)];
  }
  const double massFactor = formula.per == PerKilogram::Water ? waterPerSolution : 1;
  switch (formula.form) {
    case Form::Value:
      return massFactor * sum;
    case Form::NaturalLog:
      return massFactor * std::exp(sum);
    case Form::Log10:
      return massFactor * std::exp(sum * std::numbers::ln10);
    case Form::NegativeLog10:
      return massFactor * std::exp(-sum * std::numbers::ln10);
  }
  return 0;
}

}  // namespace tessal
