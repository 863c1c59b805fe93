// pH, on the total scale, from dissolved inorganic carbon and alkalinity: the full solver and a simple one.
// DIC and alkalinity in micromol/kg times their factors, salinity in g/kg, temperature in degrees Celsius,
// depth in m.
#pragma once

namespace tessal {

/// `CALC_PH`: with all acids and the totals in effect; pressure acts on all constants where the depth is
/// above 0. Newton iteration in pH until a step is at most 0.0001, which leaves about 1e-6. -1 where no pH is
/// found: 1000 steps, or a step that isn't finite. Lewis and Wallace 1998, ORNL/CDIAC-105.
double CalculatePh(double dic, double alkalinity, double salinity, double temperature, double depth);

/// `_CALC_PH`: with carbonate, borate and water only, boron from salinity, and pressure on K1, K2 and KB
/// only. Iterates on the root of a quadratic. NaN where the alkalinity lies outside about 0 to twice the DIC.
double CalculatePhSimply(double dic, double alkalinity, double salinity, double temperature, double depth);

}  // namespace tessal
