#include "expr/numeric/temperature_response.h"

#include <cmath>

namespace tessal {

double Arrhenius20(double coefficient, double temperature) {
  return std::pow(coefficient, temperature - 20);
}

double Arrhenius5(double coefficient, double temperature) {
  return std::pow(coefficient, temperature - 5);
}

double Lassiter(double lassiterConstant, double growthRate, double optimum, double inhibition,
                double temperature) {
  const double span = inhibition - optimum;
  const double inhibitionTerm = std::pow((inhibition - temperature) / span, span * lassiterConstant);
  return inhibitionTerm * std::exp((temperature - optimum) * lassiterConstant) * growthRate;
}

}  // namespace tessal
