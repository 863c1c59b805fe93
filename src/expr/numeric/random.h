// Random deviates, all drawn from the one generator of the process.
// The generator is the minimal standard of Park and Miller 1988, Commun. ACM 31:1192-1201 (multiplier 16807,
// modulus 2^31 - 1, in the way of Schrage 1979, ACM Trans. Math. Softw. 5:132-138), shuffled as in Bays and
// Durham 1976, ACM Trans. Math. Softw. 2:59-64. Its period is about 2e9: for simulation, not for secrets. A
// process starts with the same seed each time, so that a run can be repeated.
#pragma once

namespace tessal {

/// Puts the generator back to its start, for tests.
void ResetRandomNumbers();

/// `RAND` and `U_RAND`: uniform between 0 and 1, both excluded.
double UniformDeviate();

/// `U_RAND2`: uniform between two bounds.
double UniformDeviateBetween(double minimum, double maximum);

/// `N_RAND`: standard normal. The polar method: Box and Muller 1958, Ann. Math. Stat. 29:610-611; Marsaglia
/// and Bray 1964, SIAM Rev. 6:260-264. Deviates come in pairs; every second call draws nothing.
double NormalDeviate();

/// `N_RAND2`: normal; NaN for a negative variance.
double NormalDeviateOf(double mean, double variance);

/// `E_RAND`: exponential with mean 1.
double ExponentialDeviate();

/// `P_RAND`: Poisson, in whole numbers; 0 for a mean of 0 or less, NaN for NaN. Rejection from 12 on: Ahrens
/// and Dieter 1974, Computing 12:223-246.
double PoissonDeviate(double mean);

/// `G_RAND`: the waiting time for the n-th event of a Poisson process of unit rate: gamma of whole order, cut
/// off; 0 for an order below 1, NaN for NaN. Rejection from 6 on: Ahrens and Dieter 1974.
double GammaDeviate(double order);

/// `B_RAND`: binomial, in whole numbers from 0 to the number of events, which is cut off. A probability
/// outside 0 to 1 counts as 0 or 1; NaN for NaN. Event by event below 25 events; rejection for more (Ahrens
/// and Dieter 1974), but waiting times where less than one success is expected (Devroye 1986).
double BinomialDeviate(double probability, double events);

}  // namespace tessal
