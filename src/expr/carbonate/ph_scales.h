// Conversion between pH scales.
#pragma once

namespace tessal {

/// `CONVERT_PH`: from one scale to another at one atmosphere: 1 total, 2 sea water, 3 free, 4 NBS. Scale
/// numbers are floored; any other number, and NaN, counts as the total scale. The totals in effect act, fixed
/// ones too. Zeebe and Wolf-Gladrow 2001, CO2 in Seawater, chapter 1.3.
double ConvertPh(double ph, double salinity, double temperature, double scaleIn, double scaleOut);

}  // namespace tessal
