// Movement of particles in the plane. Speeds in any unit; directions are compass directions in degrees,
// clockwise from north, unless stated otherwise.
#pragma once

namespace tessal {

/// `GETX` and `GETY`: cosine and sine of the direction (degrees) times the speed.
double CosineComponent(double speed, double direction);
double SineComponent(double speed, double direction);

/// `GETDISTANCE`: between two points in space, in the unit of the coordinates.
double Distance(double x1, double y1, double z1, double x2, double y2, double z2);

/// `GETANGLE`: the compass direction from the first point to the second, in radians from above 0 to 2 pi;
/// due north is 2 pi.
double Bearing(double x1, double y1, double x2, double y2);

/// `RESULTINGSPEED`: the speed of two movements at once.
double ResultingSpeed(double speed1, double direction1, double speed2, double direction2);

/// `RESULTINGDIRECTION`: their compass direction, in radians like `Bearing`; pi/2 for no movement at all.
double ResultingDirection(double speed1, double direction1, double speed2, double direction2);

/// `ANGLEBETWEEN`: between two movements, in radians from 0 to pi: arc cosine of the ratio of the lesser to
/// the greater speed times the cosine of the difference of directions, but 0 for equal directions. NaN when
/// both speeds are 0.
double AngleBetween(double speed1, double direction1, double speed2, double direction2);

/// `TESTHITSTATE`: 1 if value and conditions, cut off to whole numbers, share a set bit among the lowest 8,
/// else 0.
double TestHitState(double value, double conditions);

}  // namespace tessal
