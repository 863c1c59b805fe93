// How much of each acid there is in sea water.
#pragma once

#include "expr/carbonate/settings.h"

namespace tessal {

/// Totals from salinity, in mol/kg, whatever is fixed. Boron by the selected option; fluoride: Riley 1965,
/// Deep-Sea Res. 12:219-220; sulphate: Morris and Riley 1966, Deep-Sea Res. 13:699-705.
double BoronFromSalinity(double salinity);
double FluorideFromSalinity(double salinity);
double SulphateFromSalinity(double salinity);

/// All totals in effect at a salinity, in mol/kg: the fixed ones where they are set.
PerSpecie TotalsInEffect(double salinity);

/// `GET_TB`, `GET_TF` and `GET_TS`: the totals from salinity, in micromol/kg over their factors. Fixed totals
/// do not act here; `SETGET_SPECIE` reads those.
double GetTotalBoron(double salinity);
double GetTotalFluoride(double salinity);
double GetTotalSulphate(double salinity);

}  // namespace tessal
