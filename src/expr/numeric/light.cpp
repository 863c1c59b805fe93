#include "expr/numeric/light.h"

#include <cmath>

namespace tessal {

double LightBelowLayer(double surfaceLight, double layerHeight, double extinction) {
  return surfaceLight * std::exp(-(layerHeight * extinction));
}

double MeanLightInLayer(double surfaceLight, double depth, double extinction) {
  if (!(depth > 0) || !(extinction > 0)) return 0;
  const double opticalDepth = depth * extinction;
  return (1 - std::exp(-opticalDepth)) * surfaceLight / opticalDepth;
}

}  // namespace tessal
