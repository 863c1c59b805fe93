#include "expr/carbonate/option_tables.h"

namespace tessal {

namespace {

using enum Thermal;
using enum Saline;

// K1 and K2 of carbonic acid. The ranges are the authors', T in degrees Celsius.

// Roy et al. 1993: T 0 to 45, S 5 to 45, artificial sea water.
constexpr Term kRoyK1Terms[] = {
    {2.83655},
    {-2307.1266, InverseTK},
    {-1.5529413, LnTK},
    {-0.20760841, AnyT, Q},
    {-4.0484, InverseTK, Q},
    {0.08468345, AnyT, S},
    {-0.00654208, AnyT, SQ},
};
constexpr Term kRoyK2Terms[] = {
    {-9.226508},
    {-3351.6106, InverseTK},
    {-0.2005743, LnTK},
    {-0.106901773, AnyT, Q},
    {-23.9722, InverseTK, Q},
    {0.1130822, AnyT, S},
    {-0.00846934, AnyT, SQ},
};
constexpr Formula kRoyK1{Form::NaturalLog, PhScale::Total, PerKilogram::Water, kRoyK1Terms};
constexpr Formula kRoyK2{Form::NaturalLog, PhScale::Total, PerKilogram::Water, kRoyK2Terms};

// Goyet and Poisson 1989: T -1 to 40, S 10 to 50, artificial sea water.
constexpr Term kGoyetPoissonPK1Terms[] = {
    {812.27, InverseTK}, {3.356}, {-0.00171, LnTK, S}, {0.000091, AnyT, S2}};
constexpr Term kGoyetPoissonPK2Terms[] = {
    {1450.87, InverseTK}, {4.604}, {-0.00385, LnTK, S}, {0.000182, AnyT, S2}};

// Hansson 1973, refit by Dickson and Millero 1987: T 2 to 35, S 20 to 40, artificial sea water.
constexpr Term kHanssonPK1Terms[] = {{851.4, InverseTK}, {3.237}, {-0.0106, AnyT, S}, {0.000105, AnyT, S2}};
constexpr Term kHanssonPK2Terms[] = {
    {-3885.4, InverseTK}, {125.844}, {-18.141, LnTK}, {-0.0192, AnyT, S}, {0.000132, AnyT, S2}};

// Mehrbach et al. 1973, refit by Dickson and Millero 1987: T 2 to 35, S 20 to 40.
constexpr Term kMehrbachRefitPK1Terms[] = {
    {3670.7, InverseTK}, {-62.008}, {9.7944, LnTK}, {-0.0118, AnyT, S}, {0.000116, AnyT, S2}};
constexpr Term kMehrbachRefitPK2Terms[] = {
    {1394.7, InverseTK}, {4.777}, {-0.0184, AnyT, S}, {0.000118, AnyT, S2}};

// Both together, refit by Dickson and Millero 1987: T 2 to 35, S 20 to 40.
constexpr Term kHanssonMehrbachPK1Terms[] = {
    {845.0, InverseTK}, {3.248}, {-0.0098, AnyT, S}, {0.000087, AnyT, S2}};
constexpr Term kHanssonMehrbachPK2Terms[] = {
    {1377.3, InverseTK}, {4.824}, {-0.0185, AnyT, S}, {0.000122, AnyT, S2}};

// Mehrbach et al. 1973 as published: T 2 to 35, S 19 to 43. K2 has no value at a salinity of 0.
constexpr Term kMehrbachPK1Terms[] = {
    {-13.7201}, {0.031334, TK}, {3235.76, InverseTK}, {1.3e-5, TK, S}, {-0.1032, AnyT, Q}};
constexpr Term kMehrbachPK2Terms[] = {
    {5371.9645},
    {1.671221, TK},
    {0.22913, AnyT, S},
    {18.3802, AnyT, Log10S},
    {-128375.28, InverseTK},
    {-2194.3055, Log10TK},
    {-8.0944e-4, TK, S},
    {-5617.11, InverseTK, Log10S},
    {2.136, InverseTK, S},
};
constexpr Formula kMehrbachK1{Form::NegativeLog10, PhScale::Nbs, PerKilogram::Solution, kMehrbachPK1Terms};
constexpr Formula kMehrbachK2{Form::NegativeLog10, PhScale::Nbs, PerKilogram::Solution, kMehrbachPK2Terms};

// Millero 1979, fresh water: T 0 to 50. All scales agree at a salinity of 0, for which it holds.
constexpr Term kFreshWaterK1Terms[] = {{290.9097}, {-14554.21, InverseTK}, {-45.0575, LnTK}};
constexpr Term kFreshWaterK2Terms[] = {{207.6548}, {-11843.79, InverseTK}, {-33.6485, LnTK}};
constexpr Formula kFreshWaterK1{Form::NaturalLog, PhScale::Unscaled, PerKilogram::Solution,
                                kFreshWaterK1Terms};
constexpr Formula kFreshWaterK2{Form::NaturalLog, PhScale::Unscaled, PerKilogram::Solution,
                                kFreshWaterK2Terms};

// Cai and Wang 1998, estuaries: T 0.2 to 30, S 0 to 40. The terms in Q are products of two printed factors.
constexpr Term kCaiWangPK1Terms[] = {
    {3404.71, InverseTK},          {0.032786, TK},       {-14.8435}, {-0.071692 * 200.1, InverseTK, Q},
    {-0.071692 * 0.3220, AnyT, Q}, {0.0021487, AnyT, S},
};
constexpr Term kCaiWangPK2Terms[] = {
    {2902.39, InverseTK},        {0.02379, TK},     {-6.4980}, {-0.3191 * -129.24, InverseTK, Q},
    {-0.3191 * 1.4381, AnyT, Q}, {0.0198, AnyT, S},
};
constexpr Formula kCaiWangK1{Form::NegativeLog10, PhScale::Nbs, PerKilogram::Solution, kCaiWangPK1Terms};
constexpr Formula kCaiWangK2{Form::NegativeLog10, PhScale::Nbs, PerKilogram::Solution, kCaiWangPK2Terms};

// Lueker et al. 2000: T 2 to 35, S 19 to 43.
constexpr Term kLuekerPK1Terms[] = {
    {3633.86, InverseTK}, {-61.2172}, {9.6777, LnTK}, {-0.011555, AnyT, S}, {0.0001152, AnyT, S2}};
constexpr Term kLuekerPK2Terms[] = {
    {471.78, InverseTK}, {25.929}, {-3.16967, LnTK}, {-0.01781, AnyT, S}, {0.0001122, AnyT, S2}};
constexpr Formula kLuekerK1{Form::NegativeLog10, PhScale::Total, PerKilogram::Solution, kLuekerPK1Terms};
constexpr Formula kLuekerK2{Form::NegativeLog10, PhScale::Total, PerKilogram::Solution, kLuekerPK2Terms};

// Mojica Prieto and Millero 2002: T 0 to 45, S 5 to 42.
constexpr Term kMojicaPrietoPK1Terms[] = {
    {-43.6977}, {-0.0129037, AnyT, S}, {1.364e-4, AnyT, S2}, {2885.378, InverseTK}, {7.045159, LnTK}};
constexpr Term kMojicaPrietoPK2Terms[] = {
    {-452.0940},       {13.142162, AnyT, S},      {-8.101e-4, AnyT, S2},     {21263.61, InverseTK},
    {68.483143, LnTK}, {-581.4428, InverseTK, S}, {0.259601, InverseTK, S2}, {-1.967035, LnTK, S},
};

// Millero et al. 2002: T -1.6 to 35, S 34 to 37. In degrees Celsius.
constexpr Term kMillero2002PK1Terms[] = {{6.359}, {-0.00664, AnyT, S}, {-0.01322, T}, {4.989e-5, T2}};
constexpr Term kMillero2002PK2Terms[] = {{9.867}, {-0.01314, AnyT, S}, {-0.01904, T}, {2.448e-5, T2}};

// Millero et al. 2006: T 0 to 50, S 1 to 50.
constexpr Term kMillero2006PK1Terms[] = {
    {-126.34048},        {6320.813, InverseTK}, {19.568224, LnTK},        {13.4191, AnyT, Q},
    {0.0331, AnyT, S},   {-5.33e-5, AnyT, S2},  {-530.123, InverseTK, Q}, {-6.103, InverseTK, S},
    {-2.06950, LnTK, Q},
};
constexpr Term kMillero2006PK2Terms[] = {
    {-90.18333},        {5143.692, InverseTK}, {14.613358, LnTK},        {21.0894, AnyT, Q},
    {0.1248, AnyT, S},  {-3.687e-4, AnyT, S2}, {-772.483, InverseTK, Q}, {-20.051, InverseTK, S},
    {-3.3336, LnTK, Q},
};

// Millero 2010: T 0 to 50, S 1 to 50.
constexpr Term kMillero2010PK1Terms[] = {
    {-126.34048},       {6320.813, InverseTK}, {19.568224, LnTK},        {13.4038, AnyT, Q},
    {0.03206, AnyT, S}, {-5.242e-5, AnyT, S2}, {-530.659, InverseTK, Q}, {-5.8210, InverseTK, S},
    {-2.0664, LnTK, Q},
};
constexpr Term kMillero2010PK2Terms[] = {
    {-90.18333},       {5143.692, InverseTK}, {14.613358, LnTK},        {21.3728, AnyT, Q},
    {0.1218, AnyT, S}, {-3.688e-4, AnyT, S2}, {-788.289, InverseTK, Q}, {-19.189, InverseTK, S},
    {-3.374, LnTK, Q},
};

/// Most pairs give pK on the sea water scale, per kilogram of sea water.
constexpr Formula SeaWaterPK(std::span<const Term> terms) {
  return {Form::NegativeLog10, PhScale::SeaWater, PerKilogram::Solution, terms};
}

constexpr Formula kGoyetPoissonK1 = SeaWaterPK(kGoyetPoissonPK1Terms);
constexpr Formula kGoyetPoissonK2 = SeaWaterPK(kGoyetPoissonPK2Terms);
constexpr Formula kHanssonK1 = SeaWaterPK(kHanssonPK1Terms);
constexpr Formula kHanssonK2 = SeaWaterPK(kHanssonPK2Terms);
constexpr Formula kMehrbachRefitK1 = SeaWaterPK(kMehrbachRefitPK1Terms);
constexpr Formula kMehrbachRefitK2 = SeaWaterPK(kMehrbachRefitPK2Terms);
constexpr Formula kHanssonMehrbachK1 = SeaWaterPK(kHanssonMehrbachPK1Terms);
constexpr Formula kHanssonMehrbachK2 = SeaWaterPK(kHanssonMehrbachPK2Terms);
constexpr Formula kMojicaPrietoK1 = SeaWaterPK(kMojicaPrietoPK1Terms);
constexpr Formula kMojicaPrietoK2 = SeaWaterPK(kMojicaPrietoPK2Terms);
constexpr Formula kMillero2002K1 = SeaWaterPK(kMillero2002PK1Terms);
constexpr Formula kMillero2002K2 = SeaWaterPK(kMillero2002PK2Terms);
constexpr Formula kMillero2006K1 = SeaWaterPK(kMillero2006PK1Terms);
constexpr Formula kMillero2006K2 = SeaWaterPK(kMillero2006PK2Terms);
constexpr Formula kMillero2010K1 = SeaWaterPK(kMillero2010PK1Terms);
constexpr Formula kMillero2010K2 = SeaWaterPK(kMillero2010PK2Terms);

// A constant that the option leaves out.
constexpr Formula kNone{Form::Value, PhScale::Unscaled, PerKilogram::Solution, {}};

// KW, in (mol/kg)^2.

constexpr Term kMillero1995KWTerms[] = {
    {148.9802},        {-13847.26, InverseTK}, {-23.6521, LnTK}, {-5.977, AnyT, Q}, {118.67, InverseTK, Q},
    {1.0495, LnTK, Q}, {-0.01615, AnyT, S},
};
constexpr Term kMillero1979KWTerms[] = {
    {148.9802},           {-13847.26, InverseTK},  {-23.6521, LnTK},
    {-79.2447, AnyT, Q},  {3298.72, InverseTK, Q}, {12.0408, LnTK, Q},
    {-0.019813, AnyT, S},
};
constexpr Term kFreshWaterKWTerms[] = {{148.9802}, {-13847.26, InverseTK}, {-23.6521, LnTK}};
constexpr Formula kMillero1995KW{Form::NaturalLog, PhScale::SeaWater, PerKilogram::Solution,
                                 kMillero1995KWTerms};
constexpr Formula kMillero1979KW{Form::NaturalLog, PhScale::SeaWater, PerKilogram::Solution,
                                 kMillero1979KWTerms};
constexpr Formula kFreshWaterKW{Form::NaturalLog, PhScale::Unscaled, PerKilogram::Solution,
                                kFreshWaterKWTerms};

// KB.

constexpr Term kDicksonKBTerms[] = {
    {-8966.9, InverseTK},   {-2890.53, InverseTK, Q}, {-77.942, InverseTK, S},
    {1.728, InverseTK, SQ}, {-0.0996, InverseTK, S2}, {148.0248},
    {137.1942, AnyT, Q},    {1.62142, AnyT, S},       {-24.4344, LnTK},
    {-25.085, LnTK, Q},     {-0.2474, LnTK, S},       {0.053105, TK, Q},
};
constexpr Term kLymanKBTerms[] = {{-9.26}, {0.00886, AnyT, S}, {0.01, T}};
constexpr Formula kDicksonKB{Form::NaturalLog, PhScale::Total, PerKilogram::Solution, kDicksonKBTerms};
constexpr Formula kLymanKB{Form::Log10, PhScale::Nbs, PerKilogram::Solution, kLymanKBTerms};

// KS.

constexpr Term kDicksonKSTerms[] = {
    {-4276.1, InverseTK},  {141.328},
    {-23.093, LnTK},       {-13856, InverseTK, RootI},
    {324.57, AnyT, RootI}, {-47.986, LnTK, RootI},
    {35474, InverseTK, I}, {-771.54, AnyT, I},
    {114.723, LnTK, I},    {-2698, InverseTK, IRootI},
    {1776, InverseTK, I2},
};
constexpr Term kKhooPKSTerms[] = {{647.59, InverseTK}, {-6.3451}, {0.019085, TK}, {-0.5208, AnyT, RootI}};
constexpr Formula kDicksonKS{Form::NaturalLog, PhScale::Free, PerKilogram::Water, kDicksonKSTerms};
constexpr Formula kKhooKS{Form::NegativeLog10, PhScale::Free, PerKilogram::Water, kKhooPKSTerms};

// fH.

constexpr Term kGeosecsActivityTerms[] = {
    {1.2948}, {-0.002036, TK}, {0.0004607, AnyT, S2}, {-0.000001475, TK, S2}};
constexpr Term kPengActivityTerms[] = {{1.29}, {-0.00204, TK}, {0.00046, AnyT, S2}, {-0.00000148, TK, S2}};
constexpr Term kFreshWaterActivityTerms[] = {{1}};
constexpr Formula kGeosecsActivity{Form::Value, PhScale::Unscaled, PerKilogram::Solution,
                                   kGeosecsActivityTerms};
constexpr Formula kPengActivity{Form::Value, PhScale::Unscaled, PerKilogram::Solution, kPengActivityTerms};
constexpr Formula kFreshWaterActivity{Form::Value, PhScale::Unscaled, PerKilogram::Solution,
                                      kFreshWaterActivityTerms};

// Constants without a choice.

constexpr Term kKFTerms[] = {{1590.2, InverseTK}, {-12.641}, {1.525, AnyT, RootI}};
constexpr Term kKP1Terms[] = {
    {-4576.752, InverseTK},   {115.54},           {-18.453, LnTK},
    {-106.736, InverseTK, Q}, {0.69171, AnyT, Q}, {-0.65643, InverseTK, S},
    {-0.01844, AnyT, S},
};
constexpr Term kKP2Terms[] = {
    {-8814.715, InverseTK},  {172.1033},          {-27.927, LnTK}, {-160.34, InverseTK, Q}, {1.3566, AnyT, Q},
    {0.37335, InverseTK, S}, {-0.05778, AnyT, S},
};
constexpr Term kKP3Terms[] = {
    {-3070.75, InverseTK},     {-18.126},           {17.27039, InverseTK, Q}, {2.81197, AnyT, Q},
    {-44.99486, InverseTK, S}, {-0.09984, AnyT, S},
};
constexpr Term kKSiTerms[] = {
    {-8904.2, InverseTK},  {117.4},
    {-19.334, LnTK},       {-458.79, InverseTK, RootI},
    {3.5913, AnyT, RootI}, {188.74, InverseTK, I},
    {-1.5998, AnyT, I},    {-12.1652, InverseTK, I2},
    {0.07871, AnyT, I2},
};
constexpr Term kK0Terms[] = {{93.4517, InverseX}, {-60.2409},        {23.3585, LnX},
                             {0.023517, AnyT, S}, {-0.023656, X, S}, {0.0047036, X2, S}};

namespace sea = sea_water_pressure;
namespace geosecs = geosecs_pressure;
namespace fresh = fresh_water_pressure;

constexpr ConstantOption kDefaultKW{kMillero1995KW, sea::kKW,
                                    "Millero 1995, Geochim. Cosmochim. Acta 59:661-677"};
constexpr ConstantOption kDefaultKB{kDicksonKB, sea::kKB, "Dickson 1990, Deep-Sea Res. A 37:755-766"};
constexpr ConstantOption kGeosecsKB{kLymanKB, geosecs::kKB,
                                    "Lyman 1957, thesis, Univ. of California, fit by Li, Takahashi, Broecker "
                                    "1969, J. Geophys. Res. 74:5507-5525"};
constexpr ActivityOption kDefaultActivity{
    kGeosecsActivity, "Takahashi, Williams, Bos 1982, GEOSECS Pacific Expedition vol. 3, chapter 3, p. 80"};

}  // namespace

constexpr std::array<CarbonicAcidOption, 14> kCarbonicAcidOptions{{
    {kRoyK1, kRoyK2, sea::kK1, sea::kK2,
     "Roy et al. 1993, Mar. Chem. 44:249-267 (errata 45:337, 1994; 52:183, 1996)"},
    {kGoyetPoissonK1, kGoyetPoissonK2, sea::kK1, sea::kK2,
     "Goyet and Poisson 1989, Deep-Sea Res. A 36:1635-1654"},
    {kHanssonK1, kHanssonK2, sea::kK1, sea::kK2,
     "Hansson 1973, Deep-Sea Res. 20:461-478 and Acta Chem. Scand. 27:931-944, refit by Dickson and Millero "
     "1987, Deep-Sea Res. A 34:1733-1743 (corrigenda 36:983, 1989)"},
    {kMehrbachRefitK1, kMehrbachRefitK2, sea::kK1, sea::kK2,
     "Mehrbach et al. 1973, Limnol. Oceanogr. 18:897-907, refit by Dickson and Millero 1987, Deep-Sea Res. A "
     "34:1733-1743 (corrigenda 36:983, 1989)"},
    {kHanssonMehrbachK1, kHanssonMehrbachK2, sea::kK1, sea::kK2,
     "Hansson 1973 and Mehrbach et al. 1973, refit by Dickson and Millero 1987, Deep-Sea Res. A 34:1733-1743 "
     "(corrigenda 36:983, 1989)"},
    {kMehrbachK1, kMehrbachK2, geosecs::kK1, geosecs::kK2,
     "Mehrbach et al. 1973, Limnol. Oceanogr. 18:897-907, as used by Takahashi, Williams, Bos 1982, GEOSECS "
     "Pacific Expedition vol. 3, chapter 3"},
    {kMehrbachK1, kMehrbachK2, geosecs::kK1, geosecs::kK2,
     "Mehrbach et al. 1973, Limnol. Oceanogr. 18:897-907, as used by Peng et al. 1987, Tellus 39B:439-458"},
    {kFreshWaterK1, kFreshWaterK2, fresh::kK1, fresh::kK2,
     "Millero 1979, Geochim. Cosmochim. Acta 43:1651-1661, from Harned and Davis 1943, J. Am. Chem. Soc. "
     "65:2030-2037 and Harned and Scholes 1941, J. Am. Chem. Soc. 63:1706-1709 (fresh water)"},
    {kCaiWangK1, kCaiWangK2, sea::kK1, sea::kK2, "Cai and Wang 1998, Limnol. Oceanogr. 43:657-668"},
    {kLuekerK1, kLuekerK2, sea::kK1, sea::kK2, "Lueker, Dickson, Keeling 2000, Mar. Chem. 70:105-119"},
    {kMojicaPrietoK1, kMojicaPrietoK2, sea::kK1, sea::kK2,
     "Mojica Prieto and Millero 2002, Geochim. Cosmochim. Acta 66:2529-2540"},
    {kMillero2002K1, kMillero2002K2, sea::kK1, sea::kK2, "Millero et al. 2002, Deep-Sea Res. I 49:1705-1723"},
    {kMillero2006K1, kMillero2006K2, sea::kK1, sea::kK2, "Millero et al. 2006, Mar. Chem. 100:80-94"},
    {kMillero2010K1, kMillero2010K2, sea::kK1, sea::kK2, "Millero 2010, Mar. Freshwater Res. 61:139-142"},
}};

constexpr std::array<ConstantOption, 14> kWaterOptions{{
    kDefaultKW,
    kDefaultKW,
    kDefaultKW,
    kDefaultKW,
    kDefaultKW,
    {kNone, sea::kKW,
     "KW=0.0, as Takahashi, Williams, Bos 1982, GEOSECS Pacific Expedition vol. 3, chapter 3, leave the "
     "hydroxide out"},
    {kMillero1979KW, sea::kKW, "Millero 1979, Geochim. Cosmochim. Acta 43:1651-1661"},
    {kFreshWaterKW, fresh::kKW,
     "Millero 1979, Geochim. Cosmochim. Acta 43:1651-1661, from Harned and Owen 1958, The Physical Chemistry "
     "of Electrolyte Solutions (fresh water)"},
    kDefaultKW,
    kDefaultKW,
    kDefaultKW,
    kDefaultKW,
    kDefaultKW,
    kDefaultKW,
}};

constexpr std::array<ConstantOption, 14> kBoricAcidOptions{{
    kDefaultKB,
    kDefaultKB,
    kDefaultKB,
    kDefaultKB,
    kDefaultKB,
    kGeosecsKB,
    kGeosecsKB,
    {kNone, sea::kKB, "KB=0.0"},
    kDefaultKB,
    kDefaultKB,
    kDefaultKB,
    kDefaultKB,
    kDefaultKB,
    kDefaultKB,
}};

constexpr std::array<ConstantOption, 2> kBisulphateOptions{{
    {kDicksonKS, sea::kKS, "Dickson 1990, J. Chem. Thermodyn. 22:113-127"},
    {kKhooKS, sea::kKS, "Khoo, Ramette, Culberson, Bates 1977, Anal. Chem. 49:29-34"},
}};

constexpr std::array<ActivityOption, 14> kActivityOptions{{
    kDefaultActivity,
    kDefaultActivity,
    kDefaultActivity,
    kDefaultActivity,
    kDefaultActivity,
    kDefaultActivity,
    {kPengActivity, "Peng, Takahashi, Broecker, Olafsson 1987, Tellus 39B:439-458"},
    {kFreshWaterActivity, "fH=1.0 (fresh water)"},
    kDefaultActivity,
    kDefaultActivity,
    kDefaultActivity,
    kDefaultActivity,
    kDefaultActivity,
    kDefaultActivity,
}};

constexpr std::array<BoronOption, 4> kBoronOptions{{
    {0.0004157 / 35, "Uppstroem 1974, Deep-Sea Res. 21:161-162"},
    {0.0004326 / 35, "Lee et al. 2010, Geochim. Cosmochim. Acta 74:1801-1811"},
    {0.0004106 / 35, "Culkin 1965, in Chemical Oceanography, eds. Riley and Skirrow, 121-161"},
    {0, "no boron"},
}};

constexpr Formula kHydrogenFluoride{Form::NaturalLog, PhScale::Free, PerKilogram::Water, kKFTerms};
constexpr Formula kPhosphoricAcid1{Form::NaturalLog, PhScale::SeaWater, PerKilogram::Solution, kKP1Terms};
constexpr Formula kPhosphoricAcid2{Form::NaturalLog, PhScale::SeaWater, PerKilogram::Solution, kKP2Terms};
constexpr Formula kPhosphoricAcid3{Form::NaturalLog, PhScale::SeaWater, PerKilogram::Solution, kKP3Terms};
constexpr Formula kSilicicAcid{Form::NaturalLog, PhScale::SeaWater, PerKilogram::Water, kKSiTerms};
constexpr Formula kCarbonDioxideSolubility{Form::NaturalLog, PhScale::Unscaled, PerKilogram::Solution,
                                           kK0Terms};

}  // namespace tessal
