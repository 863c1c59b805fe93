#include "expr/carbonate/totals.h"

#include "expr/carbonate/units.h"

namespace tessal {

namespace {

/// Chlorinity from salinity.
constexpr double kChlorinityPerSalinity = 0.5535412803409814;
constexpr double kFluoridePerChlorinity = 3.5266870196862827e-06;
constexpr double kSulphatePerChlorinity = 0.001457392100934813;

double InEffect(double fixedTotal, double fromSalinity) {
  return fixedTotal < 0 ? fromSalinity : MolesFromMicromoles(fixedTotal);
}

}  // namespace

double BoronFromSalinity(double salinity) {
  return Carbonate().boron->perSalinity * salinity;
}

double FluorideFromSalinity(double salinity) {
  return salinity * kChlorinityPerSalinity * kFluoridePerChlorinity;
}

double SulphateFromSalinity(double salinity) {
  return salinity * kChlorinityPerSalinity * kSulphatePerChlorinity;
}

PerSpecie TotalsInEffect(double salinity) {
  const PerSpecie& fixed = Carbonate().totals;
  return {.boron = InEffect(fixed.boron, BoronFromSalinity(salinity)),
          .fluoride = InEffect(fixed.fluoride, FluorideFromSalinity(salinity)),
          .sulphate = InEffect(fixed.sulphate, SulphateFromSalinity(salinity)),
          .phosphate = MolesFromMicromoles(fixed.phosphate),
          .silicate = MolesFromMicromoles(fixed.silicate)};
}

double GetTotalBoron(double salinity) {
  return MicromolesFromMoles(BoronFromSalinity(salinity)) / Carbonate().factors.boron;
}

double GetTotalFluoride(double salinity) {
  return MicromolesFromMoles(FluorideFromSalinity(salinity)) / Carbonate().factors.fluoride;
}

double GetTotalSulphate(double salinity) {
  return MicromolesFromMoles(SulphateFromSalinity(salinity)) / Carbonate().factors.sulphate;
}

}  // namespace tessal
