#include "expr/evaluators.h"

#include <cmath>
#include <cstddef>
#include <limits>
#include <utility>

#include "expr/carbonate/constants.h"
#include "expr/carbonate/options.h"
#include "expr/carbonate/ph_scales.h"
#include "expr/carbonate/ph_solvers.h"
#include "expr/carbonate/sea_water.h"
#include "expr/carbonate/speciation.h"
#include "expr/carbonate/totals.h"
#include "expr/numeric/angles.h"
#include "expr/numeric/arithmetic.h"
#include "expr/numeric/calendar.h"
#include "expr/numeric/data_slots.h"
#include "expr/numeric/daylight.h"
#include "expr/numeric/engine_placeholders.h"
#include "expr/numeric/light.h"
#include "expr/numeric/movement.h"
#include "expr/numeric/oxygen.h"
#include "expr/numeric/random.h"
#include "expr/numeric/saturation_kinetics.h"
#include "expr/numeric/tables.h"
#include "expr/numeric/temperature_response.h"

namespace tessal {

namespace {

using OneArgument = double (*)(double);
using TwoArguments = double (*)(double, double);

/// Spreads the values over a function's arguments.
template <auto Function, typename... Arguments>
double CallWith(std::span<const double> values, double (* /*signature*/)(Arguments...)) {
  if (values.size() < sizeof...(Arguments)) return std::numeric_limits<double>::quiet_NaN();
  return [values]<std::size_t... Index>(std::index_sequence<Index...>) {
    return Function(values[Index]...);
  }
  (std::index_sequence_for<Arguments...>{});
}

/// The evaluator of an ordinary function. A name with overloads needs the wanted one:
/// `Of<OneArgument{std::sin}>`.
template <auto Function>
double Of(std::span<const double> values) {
  return CallWith<Function>(values, Function);
}

/// One species of the water that six arguments describe.
template <double Speciation::*Specie>
double SpecieOf(double ph, double dic, double alkalinity, double salinity, double temperature, double depth) {
  return SpeciationOf({.ph = ph,
                       .dic = dic,
                       .alkalinity = alkalinity,
                       .salinity = salinity,
                       .temperature = temperature,
                       .depth = depth}).*
         Specie;
}

constexpr EvaluatorRow kEvaluators[] = {
    {"ABS", Of<OneArgument{std::fabs}>},
    {"ARCCOS", Of<OneArgument{std::acos}>},
    {"ARCSIN", Of<OneArgument{std::asin}>},
    {"ARCTAN2", Of<TwoArguments{std::atan2}>},
    {"ARCTAN", Of<OneArgument{std::atan}>},
    {"COS", Of<OneArgument{std::cos}>},
    {"COSH", Of<OneArgument{std::cosh}>},
    {"EXP", Of<OneArgument{std::exp}>},
    {"LN", Of<OneArgument{std::log}>},
    {"LOG10", Of<OneArgument{std::log10}>},
    {"MAX", Of<CatalogueMax>},
    {"MIN", Of<CatalogueMin>},
    {"POW", Of<TwoArguments{std::pow}>},
    {"SIN", Of<OneArgument{std::sin}>},
    {"SINH", Of<OneArgument{std::sinh}>},
    {"SQR", Of<Square>},
    {"SQRT", Of<OneArgument{std::sqrt}>},
    {"TAN", Of<OneArgument{std::tan}>},
    {"TANH", Of<OneArgument{std::tanh}>},
    {"DAYNUMBER", Of<DayNumber>},
    {"ARRHENIUS20", Of<Arrhenius20>},
    {"OXYGENSATURATION", Of<OxygenSaturation>},
    {"ARRHENIUS5", Of<Arrhenius5>},
    {"LASSITER", Of<Lassiter>},
    {"MICHAELIS_MENTEN1", Of<MichaelisMenten1>},
    {"MICHAELIS_MENTEN2", Of<MichaelisMenten2>},
    {"REVERSE_MICHAELIS_MENTEN", Of<ReverseMichaelisMenten>},
    {"SUNRISE", Of<Sunrise>},
    {"SUNSET", Of<Sunset>},
    {"SECOND", Of<SecondOf>},
    {"MINUTE", Of<MinuteOf>},
    {"HOUR", Of<HourOf>},
    {"DAY", Of<DayOf>},
    {"MONTH", Of<MonthOf>},
    {"YEAR", Of<YearOf>},
    {"LAMBERT_BEER_1", Of<LightBelowLayer>},
    {"LAMBERT_BEER_2", Of<LightBelowLayer>},
    {"OXYGENSATURATION_WEISS", Of<OxygenSaturationWeiss>},
    {"RELATIVE_DAYLENGTH", Of<RelativeDayLength>},
    {"PI", Of<Pi>},
    {"EXCEEDANCE_FREQUENCY", Of<ExceedanceFrequency>},
    {"RAND", Of<UniformDeviate>},
    {"U_RAND", Of<UniformDeviate>},
    {"U_RAND2", Of<UniformDeviateBetween>},
    {"N_RAND", Of<NormalDeviate>},
    {"N_RAND2", Of<NormalDeviateOf>},
    {"E_RAND", Of<ExponentialDeviate>},
    {"P_RAND", Of<PoissonDeviate>},
    {"G_RAND", Of<GammaDeviate>},
    {"B_RAND", Of<BinomialDeviate>},
    {"GETX", Of<CosineComponent>},
    {"GETY", Of<SineComponent>},
    {"GETDISTANCE", Of<Distance>},
    {"GETANGLE", Of<Bearing>},
    {"RESULTINGSPEED", Of<ResultingSpeed>},
    {"RESULTINGDIRECTION", Of<ResultingDirection>},
    {"ANGLEBETWEEN", Of<AngleBetween>},
    {"TESTHITSTATE", Of<TestHitState>},
    {"MOD", Of<Remainder>},
    {"FLOOR", Of<OneArgument{std::floor}>},
    {"CEIL", Of<OneArgument{std::ceil}>},
    {"DEG2RAD", Of<DegreesToRadians>},
    {"RAD2DEG", Of<RadiansToDegrees>},
    {"SAVE", Of<SaveInSlot>},
    {"LOAD", Of<LoadFromSlot>},
    {"TERMINATE", WithoutEngine},
    {"_GET_LAYER", WithoutEngine},
    {"_GET_ELEMENT", WithoutEngine},
    {"_GET_ID", WithoutEngine},
    {"SET_RADIUS", Of<SetRadius>},
    {"SET_PROJECTION", WithoutEngine},
    {"SET_FOV", WithoutEngine},
    {"_GET_ENGINESTATE", WithoutEngine},
    {"_SET_ENGINESTATE", WithoutEngine},
    {"_CALC_PH", Of<CalculatePhSimply>},
    {"PEEK", Of<PeekAtSlot>},
    {"PER_DAY", Of<StepsPerDay>},
    {"TABLE_INDEX", Of<TableIndex>},
    {"TABLE_VALUE", Of<TableValue>},
    {"GET_WATER_DENSITY", Of<WaterDensity>},
    {"GET_DEPTH_PRESSURE", Of<DepthToPressure>},
    {"CONVERT_PH", Of<ConvertPh>},
    {"SETGET_SPECIE", Of<SetGetSpecie>},
    {"SET_SPECIES", Of<SetSpecies>},
    {"SET_SPECIE_FACTORS", Of<SetSpeciesFactors>},
    {"SET_DICALK_FACTORS", Of<SetDicAlkFactors>},
    {"SET_K_OPTION", Of<SetKOption>},
    {"SET_K1K2_OPTION", Of<SetK1K2Option>},
    {"SET_KW_OPTION", Of<SetKWOption>},
    {"SET_KB_OPTION", Of<SetKBOption>},
    {"SET_KS_OPTION", Of<SetKSOption>},
    {"SET_FH_OPTION", Of<SetFHOption>},
    {"GET_KO", Of<GetK0>},
    {"GET_K1", Of<GetK1>},
    {"GET_K2", Of<GetK2>},
    {"GET_KB", Of<GetKB>},
    {"GET_KW", Of<GetKW>},
    {"GET_KP1", Of<GetKP1>},
    {"GET_KP2", Of<GetKP2>},
    {"GET_KP3", Of<GetKP3>},
    {"GET_KSI", Of<GetKSi>},
    {"GET_KF", Of<GetKF>},
    {"GET_KS", Of<GetKS>},
    {"SET_B_OPTION", Of<SetTBOption>},
    {"GET_TB", Of<GetTotalBoron>},
    {"GET_TF", Of<GetTotalFluoride>},
    {"GET_TS", Of<GetTotalSulphate>},
    {"CALC_PH", Of<CalculatePh>},
    {"GET_OH", Of<SpecieOf<&Speciation::hydroxide>>},
    {"GET_HCO3", Of<SpecieOf<&Speciation::bicarbonate>>},
    {"GET_CO3", Of<SpecieOf<&Speciation::carbonate>>},
    {"GET_CO2", Of<SpecieOf<&Speciation::carbonDioxide>>},
    {"GET_FCO2", Of<SpecieOf<&Speciation::fugacity>>},
    {"GET_DIC_EST", Of<SpecieOf<&Speciation::dicEstimate>>},
    {"GET_ALK_EST", Of<SpecieOf<&Speciation::alkalinityEstimate>>},
    {"GET_CALK", Of<SpecieOf<&Speciation::carbonateAlkalinity>>},
    {"GET_BALK", Of<SpecieOf<&Speciation::borateAlkalinity>>},
    {"GET_SIALK", Of<SpecieOf<&Speciation::silicateAlkalinity>>},
    {"GET_PALK", Of<SpecieOf<&Speciation::phosphateAlkalinity>>},
    {"GET_HF", Of<SpecieOf<&Speciation::hydrogenFluoride>>},
    {"GET_HFREE", Of<SpecieOf<&Speciation::freeHydrogen>>},
    {"GET_HSO4", Of<SpecieOf<&Speciation::bisulphate>>},
    {"LAMBERT_BEER_AVR", Of<MeanLightInLayer>},
    {"SIGN", Of<Sign>},
    {"MOONPHASE", Of<MoonPhase>},
};

}  // namespace

std::span<const EvaluatorRow> Evaluators() {
  return kEvaluators;
}

}  // namespace tessal
