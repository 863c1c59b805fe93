// Light under water: exponential extinction with depth, the Lambert-Beer law (Bouguer 1729, Lambert 1760,
// Beer 1852). Light in any unit of intensity, heights in m, extinction coefficients in 1/m.
#pragma once

namespace tessal {

/// `LAMBERT_BEER_1` and `LAMBERT_BEER_2`: the light left at the bottom of a layer.
double LightBelowLayer(double surfaceLight, double layerHeight, double extinction);

/// `LAMBERT_BEER_AVR`: the mean light in a layer from the surface down to the depth; 0 unless both the depth
/// and the extinction are above 0.
double MeanLightInLayer(double surfaceLight, double depth, double extinction);

}  // namespace tessal
