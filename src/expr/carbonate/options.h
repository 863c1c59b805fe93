// The settings of the carbonate system: which published formula gives each equilibrium constant, fixed
// totals, and conversion factors. They are set by catalogue functions and, at set-up, by the option file.
// Every setter empties the caches of computed species.
//
// Option numbers are floored. A number outside its range, and NaN, counts as option 1; the setters return the
// option that took effect.
#pragma once

#include <string>

namespace tessal {

/// Puts every setting to its default, silently: option 1 everywhere, totals from salinity, factors 1.
void SetCarbonateDefaults();

/// Reads settings from a text file of keywords and values, and applies them. A file that isn't there changes
/// nothing. A faulty one is read up to its fault; then the defaults for a failed reading take the place of
/// the factors, the totals and the common option. `CarbonateProblem` says what was wrong.
void ReadOptionFile(const std::string& path);

/// What the last reading of the option file, or writing of the log since, met with; empty if nothing.
const std::string& CarbonateProblem();

/// Frees the state: settings are defaults again and caches empty. An open log stays open.
void ReleaseCarbonate();

/// `SET_K1K2_OPTION`, 1 to 14: the dissociation of carbonic acid.
double SetK1K2Option(double option);

/// `SET_KW_OPTION`, 1 to 14: the ion product of water.
double SetKWOption(double option);

/// `SET_KB_OPTION`, 1 to 14: boric acid.
double SetKBOption(double option);

/// `SET_KS_OPTION`, 1 to 2: bisulphate.
double SetKSOption(double option);

/// `SET_FH_OPTION`, 1 to 14: the activity coefficient of hydrogen.
double SetFHOption(double option);

/// `SET_B_OPTION`, 1 to 4: total boron from salinity; 4 gives none.
double SetTBOption(double option);

/// `SET_K_OPTION`, 1 to 14: the same option for K1 and K2, KW, KB and fH.
double SetKOption(double option);

/// `SET_SPECIES`: fixed totals, each stored times its factor. A stored negative value of boron, fluoride or
/// sulphate means: from salinity. Returns 0.
double SetSpecies(double boron, double fluoride, double sulphate, double phosphate, double silicate);

/// `SET_SPECIE_FACTORS`: the conversion factors of the totals, applied on the way in and taken off on the way
/// out. Totals that are already stored stay as they are. Returns 0.
double SetSpeciesFactors(double boron, double fluoride, double sulphate, double phosphate, double silicate);

/// `SET_DICALK_FACTORS`: the same for dissolved inorganic carbon and alkalinity. Returns 0.
double SetDicAlkFactors(double dic, double alkalinity);

/// `SETGET_SPECIE`: reads or stores one total. The floor of the id selects 1 boron, 2 fluoride, 3 sulphate,
/// 4 phosphate, 5 silicate; -1 for any other id. Exactly -1 for the first three: from salinity again, and -1
/// comes back. Another negative value only reads. Returns the stored value over its factor.
double SetGetSpecie(double id, double value);

}  // namespace tessal
