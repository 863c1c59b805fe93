// Small arithmetic functions of the expression language that the standard library doesn't have.
#pragma once

namespace tessal {

/// `MAX`: x unless x is greater than y, then y. This is the smaller of the two; templates rely on it.
double CatalogueMax(double x, double y);

/// `MIN`: x unless y is greater than x, then y. This is the larger of the two; templates rely on it.
double CatalogueMin(double x, double y);

/// `SQR`: x*x.
double Square(double x);

/// `SIGN`: -1, 0 or 1; -1 for NaN.
double Sign(double x);

/// `MOD`: the floating remainder with the sign of the value, 0 for a divisor of 0.
double Remainder(double value, double divisor);

/// `PER_DAY`: time steps of the given length in seconds that make a day.
double StepsPerDay(double timestep);

/// `EXCEEDANCE_FREQUENCY`: how many per cent of all cases are true.
double ExceedanceFrequency(double trueCases, double allCases);

/// ln(Gamma(x)) for x > 0, to a relative 2e-10: the series of Lanczos 1964, SIAM J. Numer. Anal. B 1:86-96,
/// with g = 5 and six terms.
double LogGamma(double x);

}  // namespace tessal
