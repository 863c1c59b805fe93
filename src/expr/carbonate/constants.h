// The equilibrium constants of sea water by the selected formulae.
// All are at one atmosphere unless corrected, in mol/kg of sea water ((mol/kg)^2 for KW), and on the total pH
// scale; KS and KF are on the free scale, which is where they are used. Salinity in g/kg, temperature in
// degrees Celsius.
//
// Scales are converted with sulphate and fluoride from salinity even where totals are fixed, so that a
// constant depends on salinity, temperature and the options only.
#pragma once

namespace tessal {

struct EquilibriumConstants {
  double k1;
  double k2;
  double kb;
  double kw;
  double ks;
  double kf;
  double kp1;
  double kp2;
  double kp3;
  double ksi;
};

/// All constants at once, corrected for pressure where the depth in m is above 0.
EquilibriumConstants ConstantsAt(double salinity, double temperature, double depth);

/// `GET_KO`: the solubility of CO2 in mol/(kg atm). The only one of the functions here without options or
/// scale.
double GetK0(double salinity, double temperature);

/// `GET_K1` and `GET_K2`: carbonic acid.
double GetK1(double salinity, double temperature);
double GetK2(double salinity, double temperature);

/// `GET_KB`: boric acid.
double GetKB(double salinity, double temperature);

/// `GET_KW`: the ion product of water.
double GetKW(double salinity, double temperature);

/// `GET_KS` and `GET_KF`: bisulphate and hydrogen fluoride, on the free scale.
double GetKS(double salinity, double temperature);
double GetKF(double salinity, double temperature);

/// `GET_KP1`, `GET_KP2` and `GET_KP3`: phosphoric acid.
double GetKP1(double salinity, double temperature);
double GetKP2(double salinity, double temperature);
double GetKP3(double salinity, double temperature);

/// `GET_KSI`: silicic acid.
double GetKSi(double salinity, double temperature);

/// fH, the activity coefficient of hydrogen by the selected formula: the activity on the NBS scale over the
/// concentration on the sea water scale.
double ActivityCoefficient(double salinity, double temperature);

}  // namespace tessal
