#include "expr/carbonate/constants.h"

#include "expr/carbonate/formula.h"
#include "expr/carbonate/option_tables.h"
#include "expr/carbonate/pressure_correction.h"
#include "expr/carbonate/sea_water.h"
#include "expr/carbonate/settings.h"
#include "expr/carbonate/totals.h"

namespace tessal {

namespace {

/// A place at the surface, with what brings every published formula to the total scale there.
class SurfaceWater final {
 public:
  SurfaceWater(double salinity, double temperature)
      : basis(salinity, temperature),
        ks(basis.Evaluate(Carbonate().bisulphate->formula)),
        kf(basis.Evaluate(kHydrogenFluoride)) {
    const double bisulphate = SulphateFromSalinity(salinity) / ks;
    const double hydrogenFluoride = FluorideFromSalinity(salinity) / kf;
    seaWaterToTotal = (1 + bisulphate) / (1 + bisulphate + hydrogenFluoride);
    nbsToTotal = seaWaterToTotal / basis.Evaluate(Carbonate().activity->formula);
  }

  double KS() const { return ks; }
  double KF() const { return kf; }

  double OnTotalScale(const Formula& formula) const {
    const double published = basis.Evaluate(formula);
    if (formula.scale == PhScale::SeaWater) return published * seaWaterToTotal;
    if (formula.scale == PhScale::Nbs) return published * nbsToTotal;
    return published;
  }

 private:
  FormulaBasis basis;
  double ks;
  double kf;
  double seaWaterToTotal = 1;
  double nbsToTotal = 1;
};

EquilibriumConstants SurfaceConstants(double salinity, double temperature) {
  const SurfaceWater water(salinity, temperature);
  const CarbonateSettings& selected = Carbonate();
  return {.k1 = water.OnTotalScale(selected.carbonicAcid->k1),
          .k2 = water.OnTotalScale(selected.carbonicAcid->k2),
          .kb = water.OnTotalScale(selected.boricAcid->formula),
          .kw = water.OnTotalScale(selected.water->formula),
          .ks = water.KS(),
          .kf = water.KF(),
          .kp1 = water.OnTotalScale(kPhosphoricAcid1),
          .kp2 = water.OnTotalScale(kPhosphoricAcid2),
          .kp3 = water.OnTotalScale(kPhosphoricAcid3),
          .ksi = water.OnTotalScale(kSilicicAcid)};
}

void CorrectForPressure(EquilibriumConstants& constants, double temperature, double pressure) {
  const auto correct = [temperature, pressure](double& constant, const PressureCoefficients& coefficients) {
    constant *= PressureFactor(coefficients, temperature, pressure);
  };
  const CarbonateSettings& selected = Carbonate();
  correct(constants.k1, selected.carbonicAcid->k1Pressure);
  correct(constants.k2, selected.carbonicAcid->k2Pressure);
  correct(constants.kb, selected.boricAcid->pressure);
  correct(constants.kw, selected.water->pressure);
  correct(constants.ks, selected.bisulphate->pressure);
  correct(constants.kf, sea_water_pressure::kKF);
  correct(constants.kp1, sea_water_pressure::kKP1);
  correct(constants.kp2, sea_water_pressure::kKP2);
  correct(constants.kp3, sea_water_pressure::kKP3);
  correct(constants.ksi, sea_water_pressure::kKSi);
}

double OnTotalScale(const Formula& formula, double salinity, double temperature) {
  return SurfaceWater(salinity, temperature).OnTotalScale(formula);
}

}  // namespace

EquilibriumConstants ConstantsAt(double salinity, double temperature, double depth) {
  EquilibriumConstants constants = SurfaceConstants(salinity, temperature);
  if (depth > 0) {
    CorrectForPressure(constants, temperature, DepthToPressure(depth, salinity, temperature) - 1);
  }
  return constants;
}

double GetK0(double salinity, double temperature) {
  return FormulaBasis(salinity, temperature).Evaluate(kCarbonDioxideSolubility);
}

double GetK1(double salinity, double temperature) {
  return OnTotalScale(Carbonate().carbonicAcid->k1, salinity, temperature);
}

double GetK2(double salinity, double temperature) {
  return OnTotalScale(Carbonate().carbonicAcid->k2, salinity, temperature);
}

double GetKB(double salinity, double temperature) {
  return OnTotalScale(Carbonate().boricAcid->formula, salinity, temperature);
}

double GetKW(double salinity, double temperature) {
  return OnTotalScale(Carbonate().water->formula, salinity, temperature);
}

double GetKS(double salinity, double temperature) {
  return OnTotalScale(Carbonate().bisulphate->formula, salinity, temperature);
}

double GetKF(double salinity, double temperature) {
  return OnTotalScale(kHydrogenFluoride, salinity, temperature);
}

double GetKP1(double salinity, double temperature) {
  return OnTotalScale(kPhosphoricAcid1, salinity, temperature);
}

double GetKP2(double salinity, double temperature) {
  return OnTotalScale(kPhosphoricAcid2, salinity, temperature);
}

double GetKP3(double salinity, double temperature) {
  return OnTotalScale(kPhosphoricAcid3, salinity, temperature);
}

double GetKSi(double salinity, double temperature) {
  return OnTotalScale(kSilicicAcid, salinity, temperature);
}

double ActivityCoefficient(double salinity, double temperature) {
  return FormulaBasis(salinity, temperature).Evaluate(Carbonate().activity->formula);
}

}  // namespace tessal
