#include "expr/carbonate/speciation.h"

#include <cmath>

#include "expr/carbonate/carbonate_water.h"
#include "expr/carbonate/units.h"

namespace tessal {

namespace {

/// The last sample and its species. No revision of the settings has the number 0.
struct SpeciationCache {
  WaterSample sample{};
  std::uint64_t revision = 0;
  std::uint64_t computed = 0;
  Speciation species{};
};

SpeciationCache& LastSpeciation() {
  static SpeciationCache cache;
  return cache;
}

/// Total carbon whose carbonate alkalinity is the given one.
double CarbonOf(double carbonateAlkalinity, double hydrogen, const EquilibriumConstants& k) {
  return carbonateAlkalinity * CarbonateDenominator(hydrogen, k) / ((2 * k.k2 + hydrogen) * k.k1);
}

double SquaredDistance(const Speciation& species, const WaterSample& sample) {
  const double alkalinity = species.alkalinityEstimate - sample.alkalinity;
  const double dic = species.dicEstimate - sample.dic;
  return alkalinity * alkalinity + dic * dic;
}

}  // namespace

double ComputeSpeciation(const WaterSample& sample, Speciation& result) {
  const CarbonateWater water =
      CarbonateWaterAt(sample.dic, sample.alkalinity, sample.salinity, sample.temperature, sample.depth);
  const EquilibriumConstants& k = water.constants;
  const double hydrogen = std::pow(10, -sample.ph);
  const AlkalinityTerms terms = AlkalinityAt(hydrogen, water);
  const double denominator = CarbonateDenominator(hydrogen, k);

  const bool alkalinityGiven = sample.alkalinity > 0;
  const bool carbonWanted = alkalinityGiven && !(sample.dic > 0);
  const double carbonate = alkalinityGiven ? water.alkalinity - terms.WithoutCarbonate() : terms.carbonate;
  const double carbon = carbonWanted ? CarbonOf(carbonate, hydrogen, k) : water.carbon;
  const double alkalinity = alkalinityGiven ? water.alkalinity : terms.carbonate + terms.WithoutCarbonate();
  // The species share the given carbon, not its estimate.
  const double carbonDioxide = water.carbon * hydrogen * hydrogen / denominator;

  result = {
      .hydroxide = MicromolesFromMoles(terms.hydroxide),
      .bicarbonate = MicromolesFromMoles(water.carbon * k.k1 * hydrogen / denominator),
      .carbonate = MicromolesFromMoles(water.carbon * k.k1 * k.k2 / denominator),
      .carbonDioxide = MicromolesFromMoles(carbonDioxide),
      .fugacity = MicromolesFromMoles(carbonDioxide / GetK0(sample.salinity, sample.temperature)),
      .dicEstimate = MicromolesFromMoles(carbon) / Carbonate().dicFactor,
      .alkalinityEstimate = MicromolesFromMoles(alkalinity) / Carbonate().alkalinityFactor,
      .carbonateAlkalinity = MicromolesFromMoles(carbonate),
      .borateAlkalinity = MicromolesFromMoles(terms.borate),
      .silicateAlkalinity = MicromolesFromMoles(terms.silicate),
      .phosphateAlkalinity = MicromolesFromMoles(terms.phosphate),
      .hydrogenFluoride = MicromolesFromMoles(terms.hydrogenFluoride),
      .freeHydrogen = MicromolesFromMoles(terms.freeHydrogen),
      .bisulphate = MicromolesFromMoles(terms.bisulphate),
  };
  return SquaredDistance(result, sample);
}

const Speciation& SpeciationOf(const WaterSample& sample) {
  SpeciationCache& last = LastSpeciation();
  if (last.revision != CarbonateRevision() || last.sample != sample) {
    ComputeSpeciation(sample, last.species);
    last.sample = sample;
    last.revision = CarbonateRevision();
    ++last.computed;
  }
  return last.species;
}

std::uint64_t ComputedSpeciations() {
  return LastSpeciation().computed;
}

}  // namespace tessal
