// How pressure changes equilibrium constants: the molal volume and compressibility of each dissociation.
#pragma once

namespace tessal {

/// Coefficients of dV = v0 + v1 T + v2 T^2 in cm3/mol and of dk = (k0 + k1 T + k2 T^2)/1000 in cm3/(mol bar),
/// with T in degrees Celsius.
struct PressureCoefficients {
  double v0;
  double v1;
  double v2 = 0;
  double k0 = 0;
  double k1 = 0;
  double k2 = 0;
};

/// Sea water. Millero 1995, Geochim. Cosmochim. Acta 59:661-677, table 9, with the misprints corrected as in
/// Lewis and Wallace 1998, ORNL/CDIAC-105. For silicic acid nothing is published; the values of boric acid
/// are used.
namespace sea_water_pressure {
inline constexpr PressureCoefficients kK1{-25.50, 0.1271, 0, -3.08, 0.0877};
inline constexpr PressureCoefficients kK2{-15.82, -0.0219, 0, 1.13, -0.1475};
inline constexpr PressureCoefficients kKB{-29.48, 0.1622, -0.002608, -2.84};
inline constexpr PressureCoefficients kKW{-20.02, 0.1119, -0.001409, -5.13, 0.0794};
inline constexpr PressureCoefficients kKS{-18.03, 0.0466, 0.000316, -4.53, 0.09};
inline constexpr PressureCoefficients kKF{-9.78, -0.009, -0.000942, -3.91, 0.054};
inline constexpr PressureCoefficients kKP1{-14.51, 0.1211, -0.000321, -2.67, 0.0427};
inline constexpr PressureCoefficients kKP2{-23.12, 0.1758, -0.002647, -5.15, 0.09};
inline constexpr PressureCoefficients kKP3{-26.57, 0.2020, -0.003042, -4.08, 0.0714};
inline constexpr PressureCoefficients kKSi = kKB;
}  // namespace sea_water_pressure

/// GEOSECS. Edmond and Gieskes 1970, Geochim. Cosmochim. Acta 34:1261-1291, after Culberson and Pytkowicz
/// 1968, Limnol. Oceanogr. 13:403-417. Takahashi et al. 1982 print 26.4 for K2; 16.4 is what their results
/// follow.
namespace geosecs_pressure {
inline constexpr PressureCoefficients kK1{-24.2, 0.085};
inline constexpr PressureCoefficients kK2{-16.4, 0.04};
inline constexpr PressureCoefficients kKB{-27.5, 0.095};
}  // namespace geosecs_pressure

/// Fresh water. Millero 1983, in Chemical Oceanography vol. 8, eds. Riley and Chester.
namespace fresh_water_pressure {
inline constexpr PressureCoefficients kK1{-30.54, 0.1849, -0.0023366, -6.22, 0.1368, -0.001233};
inline constexpr PressureCoefficients kK2{-29.81, 0.115, -0.001816, -5.74, 0.093, -0.001896};
inline constexpr PressureCoefficients kKW{-25.60, 0.2324, -0.0036246, -7.33, 0.1368, -0.001233};
}  // namespace fresh_water_pressure

/// What a constant is multiplied by: exp((-dV + dk P/2) P/(R TK)), with the temperature in degrees Celsius
/// and the pressure in bar above one atmosphere. R = 83.1451 cm3 bar/(mol K), DOE 1994, ORNL/CDIAC-74.
double PressureFactor(const PressureCoefficients& coefficients, double temperature, double pressure);

}  // namespace tessal
