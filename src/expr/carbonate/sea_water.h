// Density and pressure of sea water. Salinity in g/kg (practical salinity), temperature in degrees Celsius on
// the scale of 1968, taken as it is given.
#pragma once

namespace tessal {

/// `GET_WATER_DENSITY`: in kg/m3 at one atmosphere, for salinity 0 to 42 and temperature -2 to 40. The
/// international equation of state of 1980: Millero and Poisson 1981, Deep-Sea Res. 28A:625-629; Fofonoff and
/// Millard 1983, UNESCO Tech. Pap. Mar. Sci. 44.
double WaterDensity(double salinity, double temperature);

/// `GET_DEPTH_PRESSURE`: the pressure in bar at a depth in m, with the 1 bar of the atmosphere. The density
/// is that of the surface: that water yields to pressure is left out.
double DepthToPressure(double depth, double salinity, double temperature);

}  // namespace tessal
