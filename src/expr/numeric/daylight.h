// Sun and moon: the length of the day, sunrise and sunset, and the phase of the moon.
// Years, months and days are those of `DayNumber`; latitudes in degrees, north positive.
#pragma once

namespace tessal {

/// `RELATIVE_DAYLENGTH`: the part of the day between sunrise and sunset, 0 (polar night) to 1 (polar day),
/// for the centre of a sun without refraction. Declination of Cooper 1969, Sol. Energy 12:333-346; hour angle
/// as in Brock 1981, Ecol. Model. 14:1-19. The factor that turns the latitude to radians is 1.7 per cent too
/// large, and models are calibrated with it: close to the poles, from 88.5 degrees, the sign of the tangent
/// is reversed.
double RelativeDayLength(double year, double month, double day, double latitude);

/// `SUNRISE`: in hours of the day, not below `correction`. The formula is (1 - day length)*12 + correction;
/// the correction is that for summer time, in hours.
double Sunrise(double year, double month, double day, double latitude, double correction);

/// `SUNSET`: sunrise plus the day's length, in hours.
double Sunset(double year, double month, double day, double latitude, double correction);

/// `MOONPHASE`: the part of the moon's mean synodic month that has passed since the full moon, above 0 to 1;
/// full moon is 1, new moon about 0.5. The reference is the full moon of 31 December 2009, and a moment
/// before it has the phase of the moment as long after it.
double MoonPhase(double year, double month, double day, double hour, double minute, double second);

}  // namespace tessal
