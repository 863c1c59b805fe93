// The saturation concentration of dissolved oxygen under one atmosphere of moist air, in mg/l.
// Salinity in g/kg, 0 to 40; temperature in degrees Celsius, 0 to 36. Nothing stops at these ranges.
#pragma once

namespace tessal {

/// `OXYGENSATURATION`: the cubic in temperature for fresh water of Elmore and Hayes 1960, J. Sanit. Eng. Div.
/// ASCE 86(SA4):41-53, with linear terms for salinity. Within 2 per cent of `OxygenSaturationWeiss` up to 25
/// degrees, and up to 4.5 per cent below it at 30.
double OxygenSaturation(double salinity, double temperature);

/// `OXYGENSATURATION_WEISS`: Weiss 1970, Deep-Sea Res. 17:721-735, equation 4, turned from ml/l to mg/l.
/// NaN at and below -273.15 degrees.
double OxygenSaturationWeiss(double salinity, double temperature);

}  // namespace tessal
