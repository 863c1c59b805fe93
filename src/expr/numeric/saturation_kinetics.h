// Saturation kinetics: how a rate depends on the concentration of what it consumes. Concentrations and
// half-saturation constants share one unit; results are fractions of the maximal rate.
#pragma once

namespace tessal {

/// `MICHAELIS_MENTEN1`: c/(c + k), one half at c = k. Michaelis and Menten 1913, Biochem. Z. 49:333-369.
double MichaelisMenten1(double concentration, double halfSaturation);

/// `MICHAELIS_MENTEN2`: c^2/(c^2 + k). The constant is the square of the half-saturation concentration: the
/// Hill equation of order 2, Hill 1910, J. Physiol. 40:iv-vii.
double MichaelisMenten2(double concentration, double constant);

/// `REVERSE_MICHAELIS_MENTEN`: 1/(c + 1), inhibition with the half at c = 1.
double ReverseMichaelisMenten(double concentration);

}  // namespace tessal
