#include "expr/function_reference_rows.h"

namespace tessal {

namespace {

// ---- Arguments that several functions take

constexpr ArgumentReference kSurfaceWater[] = {{"Salinity", "the salinity", "g/kg"},
                                               {"Temperature", "the temperature", "degC"}};
constexpr ArgumentReference kSalinity[] = {{"Salinity", "the salinity", "g/kg"}};
constexpr ArgumentReference kCarbonateWater[] = {
    {"DIC", "dissolved inorganic carbon, before its conversion factor", "umol/kg"},
    {"Alkalinity", "total alkalinity, before its conversion factor", "umol/kg"},
    {"Salinity", "the salinity", "g/kg"},
    {"Temperature", "the temperature", "degC"},
    {"Depth", "the depth, for the pressure; 0 or below for the surface", "m"}};
constexpr ArgumentReference kWaterSample[] = {
    {"pH", "the pH, on the total scale", "1"},
    {"DIC", "dissolved inorganic carbon, before its conversion factor", "umol/kg"},
    {"Alkalinity", "total alkalinity, before its conversion factor; 0 or below where it is not known",
     "umol/kg"},
    {"Salinity", "the salinity", "g/kg"},
    {"Temperature", "the temperature", "degC"},
    {"Depth", "the depth, for the pressure; 0 or below for the surface", "m"}};
constexpr ArgumentReference kFourteen[] = {
    {"Option (1-14)", "the number of the formula; any other number counts as 1", "1"}};
constexpr ArgumentReference kTwo[] = {
    {"Option (1-2)", "the number of the formula; any other number counts as 1", "1"}};
constexpr ArgumentReference kFour[] = {
    {"Option (1-4)", "the number of the formula; any other number counts as 1", "1"}};

constexpr std::string_view kOptionTaken = "the option that took effect";
constexpr std::string_view kCo2sys = "Lewis and Wallace 1998, ORNL/CDIAC-105";
constexpr std::string_view kYaoMillero = "Yao and Millero 1995, Aquat. Geochem. 1:53-88";
constexpr std::string_view kRiley = "Riley 1965, Deep-Sea Res. 12:219-220";
constexpr std::string_view kMorrisRiley = "Morris and Riley 1966, Deep-Sea Res. 13:699-705";
constexpr std::string_view kDicksonRiley = "Dickson and Riley 1979, Mar. Chem. 7:89-99";
constexpr std::string_view kWeiss = "Weiss 1974, Mar. Chem. 2:203-215";
constexpr std::string_view kDicksonAlkalinity = "Dickson 1981, Deep-Sea Res. 28A:609-623";

// ---- Density and pressure

constexpr ArgumentReference kDensityWater[] = {{"Salinity", "the salinity, 0 to 42", "g/kg"},
                                               {"Temperature", "the temperature, -2 to 40", "degC"}};
constexpr ArgumentReference kDepthOfWater[] = {{"Depth", "the depth", "m"},
                                               {"Salinity", "the salinity, 0 to 42", "g/kg"},
                                               {"Temperature", "the temperature, -2 to 40", "degC"}};

constexpr std::string_view kStateEquation =
    "Millero and Poisson 1981, Deep-Sea Res. 28A:625-629; Fofonoff and Millard 1983, UNESCO Tech. Pap. Mar. "
    "Sci. 44";

constexpr FunctionReference kDensity[] = {
    {"GET_WATER_DENSITY", "The density of sea water at one atmosphere, by the equation of state of 1980.",
     kDensityWater, "the density", "kg/m3", "", kStateEquation},
    {"GET_DEPTH_PRESSURE",
     "The pressure at a depth, with the 1 bar of the atmosphere. The density is that at the surface.",
     kDepthOfWater, "the pressure", "bar", "1 at the surface", kStateEquation},
};

// ---- Settings of the carbonate system

constexpr ArgumentReference kTotals[] = {
    {"TB", "total boron, before its factor; a negative one means from salinity", "umol/kg"},
    {"TF", "total fluoride, likewise", "umol/kg"},
    {"TS", "total sulphate, likewise", "umol/kg"},
    {"TP", "total phosphate, before its factor", "umol/kg"},
    {"TSi", "total silicate, before its factor", "umol/kg"}};
constexpr ArgumentReference kTotalFactors[] = {{"fTB", "the factor of boron", "1"},
                                               {"fTF", "the factor of fluoride", "1"},
                                               {"fTS", "the factor of sulphate", "1"},
                                               {"fTP", "the factor of phosphate", "1"},
                                               {"fTSi", "the factor of silicate", "1"}};
constexpr ArgumentReference kCarbonFactors[] = {{"fDIC", "the factor of dissolved inorganic carbon", "1"},
                                                {"fALK", "the factor of alkalinity", "1"}};
constexpr ArgumentReference kOneTotal[] = {
    {"SpecieID", "1 boron, 2 fluoride, 3 sulphate, 4 phosphate, 5 silicate", "1"},
    {"Value",
     "the new total, before its factor; a negative one only reads, but -1 sets 1 to 3 back to from salinity",
     "umol/kg"}};

constexpr FunctionReference kSettings[] = {
    {"SET_SPECIES", "Fixes the totals of the acids besides carbonic acid, each times its factor.", kTotals,
     "0", "1", "0", ""},
    {"SETGET_SPECIE", "Fixes or reads one of the totals of SET_SPECIES.", kOneTotal,
     "the stored total, before its factor; negative for one from salinity, -1 for any other SpecieID",
     "umol/kg", "", ""},
    {"SET_SPECIE_FACTORS",
     "The factors by which totals are multiplied on their way in and divided on their way out: what makes "
     "umol/kg of the template's unit. Totals that are stored already stay.",
     kTotalFactors, "0", "1", "0", ""},
    {"SET_DICALK_FACTORS",
     "The factors of dissolved inorganic carbon and alkalinity: what makes umol/kg of the template's units.",
     kCarbonFactors, "0", "1", "0", ""},
    {"SET_K_OPTION",
     "Chooses the formulae of K1 and K2, KW, KB and fH at once, by one number. For what it means see "
     "SET_K1K2_OPTION, SET_KW_OPTION, SET_KB_OPTION and SET_FH_OPTION.",
     kFourteen, kOptionTaken, "1", "1 to 14", kCo2sys},
    {"SET_K1K2_OPTION", "Chooses the formulae for the dissociation of carbonic acid.", kFourteen,
     kOptionTaken, "1", "1 to 14", kCo2sys},
    {"SET_KW_OPTION", "Chooses the formula for the ion product of water.", kFourteen, kOptionTaken, "1",
     "1 to 14", kCo2sys},
    {"SET_KB_OPTION", "Chooses the formula for the dissociation of boric acid.", kFourteen, kOptionTaken, "1",
     "1 to 14", kCo2sys},
    {"SET_KS_OPTION", "Chooses the formula for the dissociation of bisulphate.", kTwo, kOptionTaken, "1",
     "1 or 2", kCo2sys},
    {"SET_FH_OPTION",
     "Chooses the formula for the activity coefficient of hydrogen, by which the NBS scale differs.",
     kFourteen, kOptionTaken, "1", "1 to 14", kCo2sys},
    {"SET_B_OPTION", "Chooses the formula for total boron from salinity.", kFour, kOptionTaken, "1", "1 to 4",
     kCo2sys},
};

// ---- Equilibrium constants

constexpr FunctionReference kConstants[] = {
    {"GET_KO", "The solubility of carbon dioxide. The last character of the name is the letter O.",
     kSurfaceWater, "the solubility", "mol/kg/atm", "", kWeiss},
    {"GET_K1", "The first dissociation constant of carbonic acid, by the formula of SET_K1K2_OPTION.",
     kSurfaceWater, "the constant at one atmosphere, on the total scale", "mol/kg", "", kCo2sys},
    {"GET_K2", "The second dissociation constant of carbonic acid, by the formula of SET_K1K2_OPTION.",
     kSurfaceWater, "the constant at one atmosphere, on the total scale", "mol/kg", "", kCo2sys},
    {"_GET_K1", "The first dissociation constant of carbonic acid in the simulation engine. See GET_K1.",
     kSurfaceWater, "the constant", "mol/kg", "", ""},
    {"_GET_K2", "The second dissociation constant of carbonic acid in the simulation engine. See GET_K2.",
     kSurfaceWater, "the constant", "mol/kg", "", ""},
    {"GET_KB", "The dissociation constant of boric acid, by the formula of SET_KB_OPTION.", kSurfaceWater,
     "the constant at one atmosphere, on the total scale", "mol/kg", "", kCo2sys},
    {"GET_KW", "The ion product of water, by the formula of SET_KW_OPTION.", kSurfaceWater,
     "the product at one atmosphere, on the total scale", "mol2/kg2", "", kCo2sys},
    {"GET_KS", "The dissociation constant of bisulphate, by the formula of SET_KS_OPTION.", kSurfaceWater,
     "the constant at one atmosphere, on the free scale", "mol/kg", "", kCo2sys},
    {"GET_KF", "The dissociation constant of hydrogen fluoride.", kSurfaceWater,
     "the constant at one atmosphere, on the free scale", "mol/kg", "", kDicksonRiley},
    {"GET_KP1", "The first dissociation constant of phosphoric acid.", kSurfaceWater,
     "the constant at one atmosphere, on the total scale", "mol/kg", "", kYaoMillero},
    {"GET_KP2", "The second dissociation constant of phosphoric acid.", kSurfaceWater,
     "the constant at one atmosphere, on the total scale", "mol/kg", "", kYaoMillero},
    {"GET_KP3", "The third dissociation constant of phosphoric acid.", kSurfaceWater,
     "the constant at one atmosphere, on the total scale", "mol/kg", "", kYaoMillero},
    {"GET_KSI", "The dissociation constant of silicic acid.", kSurfaceWater,
     "the constant at one atmosphere, on the total scale", "mol/kg", "", kYaoMillero},
    {"GET_TB", "Total boron from salinity, by the formula of SET_B_OPTION, whatever total is fixed.",
     kSalinity, "the total, before its factor", "umol/kg", "", kCo2sys},
    {"GET_TF", "Total fluoride from salinity, whatever total is fixed.", kSalinity,
     "the total, before its factor", "umol/kg", "", kRiley},
    {"GET_TS", "Total sulphate from salinity, whatever total is fixed.", kSalinity,
     "the total, before its factor", "umol/kg", "", kMorrisRiley},
};

// ---- pH and species

constexpr ArgumentReference kScales[] = {
    {"pH", "the pH on the scale Scale_in", "1"},
    {"Salinity", "the salinity", "g/kg"},
    {"Temperature", "the temperature", "degC"},
    {"Scale_in", "1 total, 2 sea water, 3 free, 4 NBS; any other number counts as 1", "1"},
    {"Scale_out", "the scale of the result, numbered in the same way", "1"}};

constexpr FunctionReference kSpecies[] = {
    {"CALC_PH",
     "The pH from dissolved inorganic carbon and alkalinity, with all acids and the totals in effect; "
     "pressure acts on all constants.",
     kCarbonateWater, "the pH on the total scale, to about 1e-6; -1 where none is found", "1", "", kCo2sys},
    {"_CALC_PH",
     "The pH from dissolved inorganic carbon and alkalinity, with carbonate, borate and water only. Boron "
     "comes from salinity; pressure acts on K1, K2 and KB.",
     kCarbonateWater,
     "the pH on the total scale; NaN where the alkalinity is outside about 0 to twice the carbon", "1", "",
     ""},
    {"CONVERT_PH", "Takes a pH from one scale to another, at one atmosphere, with the totals in effect.",
     kScales, "the pH on the scale Scale_out", "1", "",
     "Zeebe and Wolf-Gladrow 2001, CO2 in Seawater, chapter 1.3"},
    {"GET_CO2", "Dissolved carbon dioxide, as a part of the given carbon.", kWaterSample, "the concentration",
     "umol/kg", "", kCo2sys},
    {"GET_HCO3", "Bicarbonate, as a part of the given carbon.", kWaterSample, "the concentration", "umol/kg",
     "", kCo2sys},
    {"GET_CO3", "Carbonate, as a part of the given carbon.", kWaterSample, "the concentration", "umol/kg", "",
     kCo2sys},
    {"GET_FCO2", "The fugacity of carbon dioxide: what GET_CO2 gives over the solubility.", kWaterSample,
     "the fugacity", "uatm", "", kWeiss},
    {"GET_OH", "Hydroxide: what water adds to alkalinity.", kWaterSample, "the concentration", "umol/kg", "",
     kDicksonAlkalinity},
    {"GET_HFREE", "Free hydrogen ions. They count against alkalinity.", kWaterSample, "the concentration",
     "umol/kg", "", kDicksonAlkalinity},
    {"GET_HSO4", "Bisulphate. It counts against alkalinity.", kWaterSample, "the concentration", "umol/kg",
     "", kDicksonAlkalinity},
    {"GET_HF", "Hydrogen fluoride. It counts against alkalinity.", kWaterSample, "the concentration",
     "umol/kg", "", kDicksonAlkalinity},
    {"GET_CALK",
     "Carbonate alkalinity: total alkalinity less that of the other acids, or, where alkalinity is not "
     "known, that of the carbon.",
     kWaterSample, "the alkalinity", "umol/kg", "", kDicksonAlkalinity},
    {"GET_BALK", "What borate adds to alkalinity.", kWaterSample, "the alkalinity", "umol/kg", "",
     kDicksonAlkalinity},
    {"GET_SIALK", "What silicate adds to alkalinity.", kWaterSample, "the alkalinity", "umol/kg", "",
     kDicksonAlkalinity},
    {"GET_PALK", "What phosphate adds to alkalinity.", kWaterSample, "the alkalinity", "umol/kg", "",
     kDicksonAlkalinity},
    {"GET_DIC_EST",
     "Dissolved inorganic carbon as given, or, where it is 0 or below and the alkalinity is above, as pH and "
     "alkalinity ask for.",
     kWaterSample, "dissolved inorganic carbon, before its conversion factor", "umol/kg", "", kCo2sys},
    {"GET_ALK_EST", "Total alkalinity as given, or, where it is 0 or below, as pH and carbon ask for.",
     kWaterSample, "total alkalinity, before its conversion factor", "umol/kg", "", kCo2sys},
};

constexpr FunctionGroup kGroups[] = {
    {"Density and pressure of water", kDensity},
    {"Carbonate system: settings", kSettings},
    {"Carbonate system: constants and totals", kConstants},
    {"Carbonate system: pH and species", kSpecies},
};

}  // namespace

std::span<const FunctionGroup> SeaWaterFunctionGroups() {
  return kGroups;
}

}  // namespace tessal
