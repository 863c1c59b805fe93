// Look-up in tables of five entries: a value's place among breakpoints, and the value at a place.
// One function after the other carries a value through a piecewise linear curve.
#pragma once

namespace tessal {

/// `TABLE_INDEX`: the place of the value among the breakpoints a to e, which ascend: 1 at a and below, 5
/// above e, in between the number of the breakpoint before plus the fraction of the way to the next. NaN for
/// NaN.
double TableIndex(double value, double a, double b, double c, double d, double e);

/// `TABLE_VALUE`: the linear interpolation between the entries a to e at a place from 1 to 5; 0 outside.
double TableValue(double index, double a, double b, double c, double d, double e);

}  // namespace tessal
