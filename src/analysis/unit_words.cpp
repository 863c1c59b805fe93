#include "analysis/unit_words.h"

#include <algorithm>
#include <span>

#include "platform/ascii.h"

namespace tessal {

namespace {

// Sequences of UTF-8 come before the single bytes of Windows-1252 that they end in.
constexpr SignSpelling kSigns[] = {
    {"\xC2\xB5", "u"},   // micro sign
    {"\xCE\xBC", "u"},   // Greek mu
    {"\xC2\xB2", "^2"},  // superscripts
    {"\xC2\xB3", "^3"},  //
    {"\xC2\xB9", "^1"},  //
    {"\xE2\x81\xBB\xC2\xB9", "^-1"},
    {"\xE2\x81\xBB\xC2\xB2", "^-2"},
    {"\xE2\x81\xBB\xC2\xB3", "^-3"},
    {"\xC2\xB0", " deg "},  // degree sign
    {"\xC2\xBA", " deg "},  // masculine ordinal, which keyboards have in its place
    {"\xC2\xB7", "*"},      // middle dot
    {"\xE2\x8B\x85", "*"},  // dot operator
    {"\xC3\x97", "*"},      // multiplication sign
    {"\xE2\x88\x92", "-"},  // minus sign
    {"\xE2\x80\x93", "-"},  // en dash
    {"\xE2\x80\xB0", "permille"},
    {"\xC2\xA0", " "},  // no-break space
    {"\xB5", "u"},
    {"\xB2", "^2"},
    {"\xB3", "^3"},
    {"\xB9", "^1"},
    {"\xB0", " deg "},
    {"\xBA", " deg "},
    {"\xB7", "*"},
    {"\xD7", "*"},
    {"\x96", "-"},
    {"\x89", "permille"},
    {"\xA0", " "},
};

constexpr std::string_view kPlainNumbers[] = {
    "-", "--", "()", "(-)", "[]", "[-]", "1", "none", "dimensionless", "no unit", "no dimension",
};

constexpr PhraseSpelling kPhrases[] = {
    {"degrees c", "degC"},
    {"degree c", "degC"},
    {"deg c", "degC"},
    {"degrees celsius", "degC"},
    {"degree celsius", "degC"},
    {"deg celsius", "degC"},
    {"degrees centigrade", "degC"},
    {"degrees k", "K"},
    {"deg k", "K"},
    {"degrees f", "degF"},
    {"deg f", "degF"},
    {"per cent", "percent"},
    {"per mille", "permille"},
    {"metric ton", "tonne"},
    {"metric tons", "tonne"},
    {"dry weight", "DW"},
    {"dry matter", "DW"},
    {"dry mass", "DW"},
    {"wet weight", "WW"},
    {"wet mass", "WW"},
    {"fresh weight", "WW"},
    {"ash free dry weight", "AFDW"},
    {"chlorophyll a", "Chl"},
    {"chl a", "Chl"},
    {"organic matter", "OM"},
    {"suspended solids", "SS"},
    {"suspended matter", "SS"},
};

constexpr UnitWord kUnitWords[] = {
    // Other meanings than UDUNITS'.
    {"C", "degC", WordMeaning::Unit, "a temperature; UDUNITS: coulomb"},
    {"F", "degF", WordMeaning::Unit, "a temperature; UDUNITS: farad"},
    {"ton", "tonne", WordMeaning::Unit, "metric; UDUNITS: the short ton"},
    {"tons", "tonne", WordMeaning::Unit, "metric; UDUNITS: the short ton"},
    {"kt", "1000 tonne", WordMeaning::Unit, "a mass; UDUNITS: knot"},
    {"ppt", "1e-3", WordMeaning::Unit, "parts per thousand; UDUNITS: per trillion"},
    {"pH", "1", WordMeaning::OpenFactor, "a logarithm; UDUNITS: picohenry"},
    {"dt", "", WordMeaning::NoUnit, "a time step of the engine; UDUNITS: decitonne"},
    {"a", "year", WordMeaning::Unit, "annum; UDUNITS: are"},
    {"Sv", "1e6 m3/s", WordMeaning::Unit, "the flow of an ocean current; UDUNITS: sievert"},
    {"gal", "", WordMeaning::NoUnit, "gallons differ; UDUNITS: an acceleration"},
    {"dB", "", WordMeaning::NoUnit, "a logarithm"},
    // Words that UDUNITS does not know.
    {"psu", "1e-3", WordMeaning::OpenFactor, "practical salinity: a ratio that is close to g/kg"},
    {"permille", "1e-3", WordMeaning::Unit, ""},
    {"promille", "1e-3", WordMeaning::Unit, ""},
    {"fraction", "1", WordMeaning::Unit, ""},
    {"ratio", "1", WordMeaning::Unit, ""},
    {"deg", "degree", WordMeaning::Unit, ""},
    {"degs", "degree", WordMeaning::Unit, ""},
    {"y", "year", WordMeaning::Unit, ""},
    {"yrs", "year", WordMeaning::Unit, ""},
    {"annum", "year", WordMeaning::Unit, ""},
    {"wk", "week", WordMeaning::Unit, ""},
    {"hrs", "hour", WordMeaning::Unit, ""},
    {"mins", "minute", WordMeaning::Unit, ""},
    {"secs", "second", WordMeaning::Unit, ""},
    {"mtr", "metre", WordMeaning::Unit, ""},
    {"ltr", "litre", WordMeaning::Unit, ""},
    {"gr", "gram", WordMeaning::Unit, ""},
    {"mole", "mol", WordMeaning::Unit, ""},
    {"moles", "mol", WordMeaning::Unit, ""},
    {"eq", "mol", WordMeaning::Unit, "an equivalent of charge"},
    {"meq", "mmol", WordMeaning::Unit, "an equivalent of charge"},
    {"ueq", "umol", WordMeaning::Unit, "an equivalent of charge"},
    {"E", "mol", WordMeaning::Unit, "einstein: a mole of photons"},
    {"uE", "umol", WordMeaning::Unit, "einstein: a mole of photons"},
    {"M", "mol/l", WordMeaning::Unit, "molar"},
    {"mM", "mmol/l", WordMeaning::Unit, "molar"},
    {"uM", "umol/l", WordMeaning::Unit, "molar"},
    {"nM", "nmol/l", WordMeaning::Unit, "molar"},
    {"ly", "langley", WordMeaning::Unit, ""},
    // What is counted.
    {"number", "1", WordMeaning::Unit, ""},
    {"numbers", "1", WordMeaning::Unit, ""},
    {"no", "1", WordMeaning::Unit, ""},
    {"nos", "1", WordMeaning::Unit, ""},
    {"counts", "1", WordMeaning::Unit, ""},
    {"cell", "1", WordMeaning::Unit, ""},
    {"cells", "1", WordMeaning::Unit, ""},
    {"ind", "1", WordMeaning::Unit, ""},
    {"individual", "1", WordMeaning::Unit, ""},
    {"individuals", "1", WordMeaning::Unit, ""},
    {"particle", "1", WordMeaning::Unit, ""},
    {"particles", "1", WordMeaning::Unit, ""},
    {"organisms", "1", WordMeaning::Unit, ""},
    {"eggs", "1", WordMeaning::Unit, ""},
    {"cfu", "1", WordMeaning::Unit, ""},
    {"mpn", "1", WordMeaning::Unit, ""},
};

struct SubstanceSpelling {
  std::string_view word;
  std::string_view substance;
};

// Symbols of one letter that are units after an amount, "J/kg K", are left out.
constexpr SubstanceSpelling kSubstances[] = {
    {"C", "C"},
    {"carbon", "C"},
    {"orgC", "C"},
    {"N", "N"},
    {"nitrogen", "N"},
    {"NO3-N", "N"},
    {"NH4-N", "N"},
    {"NO2-N", "N"},
    {"NOx-N", "N"},
    {"TN", "N"},
    {"orgN", "N"},
    {"P", "P"},
    {"phosphorus", "P"},
    {"PO4-P", "P"},
    {"TP", "P"},
    {"orgP", "P"},
    {"Si", "Si"},
    {"silicon", "Si"},
    {"silica", "Si"},
    {"SiO2-Si", "Si"},
    {"SiO2", "SiO2"},
    {"O2", "O2"},
    {"O", "O"},
    {"oxygen", "O2"},
    {"DO", "O2"},
    {"COD", "O2"},
    {"BOD", "O2"},
    {"BOD5", "O2"},
    {"NO3", "NO3"},
    {"nitrate", "NO3"},
    {"NO2", "NO2"},
    {"nitrite", "NO2"},
    {"NH4", "NH4"},
    {"ammonium", "NH4"},
    {"NH3", "NH3"},
    {"PO4", "PO4"},
    {"phosphate", "PO4"},
    {"N2", "N2"},
    {"N2O", "N2O"},
    {"CO2", "CO2"},
    {"DIC", "C"},
    {"DOC", "C"},
    {"POC", "C"},
    {"TOC", "C"},
    {"HCO3", "HCO3"},
    {"CO3", "CO3"},
    {"CaCO3", "CaCO3"},
    {"CH4", "CH4"},
    {"methane", "CH4"},
    {"H2S", "H2S"},
    {"S", "S"},
    {"SO4", "SO4"},
    {"sulphate", "SO4"},
    {"Fe", "Fe"},
    {"iron", "Fe"},
    {"Mn", "Mn"},
    {"Ca", "Ca"},
    {"Mg", "Mg"},
    {"Na", "Na"},
    {"Cl", "Cl"},
    {"chloride", "Cl"},
    {"Al", "Al"},
    {"Cu", "Cu"},
    {"Zn", "Zn"},
    {"Hg", "Hg"},
    {"Cd", "Cd"},
    {"Pb", "Pb"},
    {"Chl", "Chl"},
    {"chla", "Chl"},
    {"Chl-a", "Chl"},
    {"chlorophyll", "Chl"},
    {"DW", "DW"},
    {"DM", "DW"},
    {"TS", "DW"},
    {"WW", "WW"},
    {"FW", "WW"},
    {"AFDW", "AFDW"},
    {"OM", "OM"},
    {"SS", "SS"},
    {"TSS", "SS"},
    {"VSS", "VSS"},
    {"SPM", "SS"},
    {"sediment", "sediment"},
    {"sand", "sediment"},
    {"mud", "sediment"},
    {"water", "water"},
    {"H2O", "water"},
    {"salt", "salt"},
    {"biomass", "biomass"},
    {"photons", "photons"},
    {"quanta", "photons"},
};

/// Symbols differ by the case of their letters, words do not.
bool IsSpelling(std::string_view row, std::string_view word) {
  constexpr std::size_t kShortestWord = 3;
  return row == word || (word.size() >= kShortestWord && EqualIgnoringCase(row, word));
}

template <class Row>
const Row* RowSpelt(std::span<const Row> rows, std::string_view word) {
  const auto hit =
      std::find_if(rows.begin(), rows.end(), [word](const Row& row) { return IsSpelling(row.word, word); });
  return hit == rows.end() ? nullptr : &*hit;
}

}  // namespace

const SignSpelling* SignAt(std::string_view text) {
  const auto* const hit = std::find_if(std::begin(kSigns), std::end(kSigns), [text](const SignSpelling& row) {
    return text.starts_with(row.bytes);
  });
  return hit == std::end(kSigns) ? nullptr : hit;
}

bool SaysPlainNumber(std::string_view text) {
  return std::any_of(std::begin(kPlainNumbers), std::end(kPlainNumbers),
                     [text](std::string_view row) { return EqualIgnoringCase(row, text); });
}

const PhraseSpelling* PhraseOf(std::string_view phrase) {
  const auto* const hit =
      std::find_if(std::begin(kPhrases), std::end(kPhrases),
                   [phrase](const PhraseSpelling& row) { return EqualIgnoringCase(row.phrase, phrase); });
  return hit == std::end(kPhrases) ? nullptr : hit;
}

const UnitWord* UnitWordOf(std::string_view word) {
  return RowSpelt<UnitWord>(kUnitWords, word);
}

std::optional<std::string_view> SubstanceOf(std::string_view word) {
  const SubstanceSpelling* row = RowSpelt<SubstanceSpelling>(kSubstances, word);
  if (row == nullptr) return std::nullopt;
  return row->substance;
}

}  // namespace tessal
