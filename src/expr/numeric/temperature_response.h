// How rates of growth and decay depend on temperature. Temperatures are in degrees Celsius.
#pragma once

namespace tessal {

/// `ARRHENIUS20`: the factor of a rate known at 20 degrees, coefficient^(temperature - 20). The coefficient
/// is usually between 1 and 1.2. The modified Arrhenius equation of Streeter and Phelps 1925, Public Health
/// Bulletin 146.
double Arrhenius20(double coefficient, double temperature);

/// `ARRHENIUS5`: the same for a rate known at 5 degrees.
double Arrhenius5(double coefficient, double temperature);

/// `LASSITER`: growth that rises to its optimum temperature and falls to 0 at the inhibition temperature, in
/// the unit of the growth rate; it equals the growth rate at the optimum. NaN above the inhibition
/// temperature unless the exponent is whole. Lassiter and Kearns 1974, in Modeling the Eutrophication
/// Process, eds. Middlebrooks, Falkenborg, Maloney.
double Lassiter(double lassiterConstant, double growthRate, double optimum, double inhibition,
                double temperature);

}  // namespace tessal
