#include "expr/numeric/saturation_kinetics.h"

namespace tessal {

double MichaelisMenten1(double concentration, double halfSaturation) {
  return concentration / (concentration + halfSaturation);
}

double MichaelisMenten2(double concentration, double constant) {
  const double squared = concentration * concentration;
  return squared / (squared + constant);
}

double ReverseMichaelisMenten(double concentration) {
  return 1 / (concentration + 1);
}

}  // namespace tessal
