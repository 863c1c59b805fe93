#include "expr/carbonate/options.h"

#include <array>
#include <cmath>
#include <cstddef>
#include <string_view>

#include "expr/carbonate/option_tables.h"
#include "expr/carbonate/settings.h"
#include "expr/carbonate/settings_log.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

constexpr double kNoSuchSpecie = -1;

/// One total: where it is kept and how the log calls it. The log has no line for the factor of silicate.
struct SpecieRow {
  double PerSpecie::*specie;
  bool comesFromSalinity;
  std::string_view totalLabel;
  std::string_view factorLabel;
};

/// In the order of the ids, which begin at 1.
constexpr std::array<SpecieRow, 5> kSpecies{{
    {&PerSpecie::boron, true, "TB  =", "TB conversion factor"},
    {&PerSpecie::fluoride, true, "TF  =", "TF conversion factor"},
    {&PerSpecie::sulphate, true, "TS  =", "TS conversion factor"},
    {&PerSpecie::phosphate, false, "TP  =", "TP conversion factor"},
    {&PerSpecie::silicate, false, "TSi =", ""},
}};

void LogTotal(const SpecieRow& row, double total) {
  const std::string_view origin = row.comesFromSalinity && total < 0 ? " (from salinity)" : "";
  CarbonateLog().WriteLine(std::string(row.totalLabel) + " " + ShortestNumberText(total) +
                           std::string(origin));
}

void LogFactor(std::string_view label, double factor) {
  if (!label.empty()) CarbonateLog().WriteLine(std::string(label) + " " + ShortestNumberText(factor));
}

std::size_t OptionInRange(double option, std::size_t options) {
  const double number = std::floor(option);
  const bool inRange = number >= 1 && number <= static_cast<double>(options);
  return inRange ? static_cast<std::size_t>(number) : 1;
}

/// Puts a row of an option table into effect.
template <typename Row, std::size_t Options>
double Select(double option, const std::array<Row, Options>& rows, const Row* CarbonateSettings::*selected,
              std::string_view name) {
  const std::size_t number = OptionInRange(option, Options);
  const Row& row = rows[number - 1];
  ChangeCarbonate().*selected = &row;
  CarbonateLog().WriteLine("Using " + std::string(name) + " option " + std::to_string(number) + ": " +
                           std::string(row.source));
  return static_cast<double>(number);
}

}  // namespace

void SetCarbonateDefaults() {
  ChangeCarbonate() = CarbonateSettings{};
}

void ReleaseCarbonate() {
  SetCarbonateDefaults();
}

double SetK1K2Option(double option) {
  return Select(option, kCarbonicAcidOptions, &CarbonateSettings::carbonicAcid, "K1K2");
}

double SetKWOption(double option) {
  return Select(option, kWaterOptions, &CarbonateSettings::water, "KW");
}

double SetKBOption(double option) {
  return Select(option, kBoricAcidOptions, &CarbonateSettings::boricAcid, "KB");
}

double SetKSOption(double option) {
  return Select(option, kBisulphateOptions, &CarbonateSettings::bisulphate, "KS");
}

double SetFHOption(double option) {
  return Select(option, kActivityOptions, &CarbonateSettings::activity, "fH");
}

double SetTBOption(double option) {
  return Select(option, kBoronOptions, &CarbonateSettings::boron, "TB");
}

double SetKOption(double option) {
  SetK1K2Option(option);
  SetKWOption(option);
  SetKBOption(option);
  return SetFHOption(option);
}

double SetSpecies(double boron, double fluoride, double sulphate, double phosphate, double silicate) {
  const PerSpecie given{boron, fluoride, sulphate, phosphate, silicate};
  CarbonateSettings& settings = ChangeCarbonate();
  for (const SpecieRow& row : kSpecies) {
    double& total = settings.totals.*row.specie;
    total = given.*row.specie * settings.factors.*row.specie;
    LogTotal(row, total);
  }
  return 0;
}

double SetSpeciesFactors(double boron, double fluoride, double sulphate, double phosphate, double silicate) {
  const PerSpecie factors{boron, fluoride, sulphate, phosphate, silicate};
  ChangeCarbonate().factors = factors;
  for (const SpecieRow& row : kSpecies) LogFactor(row.factorLabel, factors.*row.specie);
  return 0;
}

double SetDicAlkFactors(double dic, double alkalinity) {
  CarbonateSettings& settings = ChangeCarbonate();
  settings.dicFactor = dic;
  settings.alkalinityFactor = alkalinity;
  LogFactor("DIC conversion factor", dic);
  LogFactor("ALK conversion factor", alkalinity);
  return 0;
}

double SetGetSpecie(double id, double value) {
  const double number = std::floor(id);
  if (!(number >= 1 && number <= static_cast<double>(kSpecies.size()))) return kNoSuchSpecie;
  const SpecieRow& row = kSpecies.at(static_cast<std::size_t>(number) - 1);
  const double factor = Carbonate().factors.*row.specie;
  const bool backToSalinity = row.comesFromSalinity && value == kFromSalinity;
  if (!(value < 0) || backToSalinity) {
    const double total = backToSalinity ? kFromSalinity : value * factor;
    // An engine may repeat this call in each of its steps, so the log takes changes only.
    if (total != Carbonate().totals.*row.specie) LogTotal(row, total);
    ChangeCarbonate().totals.*row.specie = total;
  }
  return backToSalinity ? kFromSalinity : Carbonate().totals.*row.specie / factor;
}

}  // namespace tessal
