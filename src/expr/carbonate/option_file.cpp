// Reading of the option file: words separated by white space, keywords followed by their values.

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <ios>
#include <istream>
#include <limits>
#include <locale>
#include <optional>
#include <string>
#include <string_view>
#include <system_error>

#include "expr/carbonate/options.h"
#include "expr/carbonate/settings.h"
#include "expr/carbonate/settings_log.h"

namespace tessal {

namespace {

/// No keyword and no file name is longer; a longer word is an unknown one.
constexpr std::size_t kLongestWord = 4096;
constexpr std::string_view kComment = "#";
constexpr std::string_view kLogKeyword = "Logfile";
constexpr std::int32_t kOptionAfterFailure = 14;

/// What the file says. An option of 0 is one that isn't set.
struct OptionRecord {
  std::int32_t k = 0;
  std::int32_t ks = 0;
  std::int32_t kb = 0;
  std::int32_t tb = 0;
  std::int32_t k1k2 = 0;
  std::int32_t kw = 0;
  std::int32_t fh = 0;
  PerSpecie factors = CarbonateSettings{}.factors;
  PerSpecie totals = CarbonateSettings{}.totals;
  double dicFactor = 1;
  double alkalinityFactor = 1;
  std::string logName;
};

struct OptionKeyword {
  std::string_view keyword;
  std::int32_t OptionRecord::*option;
};

constexpr OptionKeyword kOptionKeywords[] = {
    {"KOption", &OptionRecord::k},       {"KSOption", &OptionRecord::ks}, {"KBOption", &OptionRecord::kb},
    {"TBOption", &OptionRecord::tb},     {"KWOption", &OptionRecord::kw}, {"FHOption", &OptionRecord::fh},
    {"K1K2Option", &OptionRecord::k1k2},
};

struct FactorKeyword {
  std::string_view keyword;
  double OptionRecord::*factor;
};

constexpr FactorKeyword kFactorKeywords[] = {
    {"ConvertDIC", &OptionRecord::dicFactor},
    {"ConvertALK", &OptionRecord::alkalinityFactor},
};

struct SpecieKeyword {
  std::string_view keyword;
  PerSpecie OptionRecord::*group;
  double PerSpecie::*specie;
};

constexpr SpecieKeyword kSpecieKeywords[] = {
    {"ConvertTB", &OptionRecord::factors, &PerSpecie::boron},
    {"ConvertTF", &OptionRecord::factors, &PerSpecie::fluoride},
    {"ConvertTS", &OptionRecord::factors, &PerSpecie::sulphate},
    {"ConvertTP", &OptionRecord::factors, &PerSpecie::phosphate},
    {"ConvertTSi", &OptionRecord::factors, &PerSpecie::silicate},
    {"TB", &OptionRecord::totals, &PerSpecie::boron},
    {"TF", &OptionRecord::totals, &PerSpecie::fluoride},
    {"TS", &OptionRecord::totals, &PerSpecie::sulphate},
    {"TP", &OptionRecord::totals, &PerSpecie::phosphate},
    {"TSi", &OptionRecord::totals, &PerSpecie::silicate},
};

struct ReadingFailure {
  std::string keyword;
  std::string reason;
  std::streamoff position;
};

/// The next word; false at the end of the file. Of an over-long word the first bytes are given, all of it is
/// read.
bool ReadWord(std::istream& file, std::string& word) {
  word.clear();
  file >> std::ws;
  const auto isEnd = [&file](std::istream::int_type byte) {
    return byte == std::istream::traits_type::eof() ||
           std::isspace(std::istream::traits_type::to_char_type(byte), file.getloc());
  };
  for (auto byte = file.peek(); !isEnd(byte); byte = file.peek()) {
    if (word.size() < kLongestWord) word += std::istream::traits_type::to_char_type(byte);
    file.ignore();
  }
  return !word.empty();
}

template <typename Number>
bool ReadNumber(std::istream& file, Number& number) {
  Number value{};
  if (!(file >> value)) return false;
  number = value;
  return true;
}

template <typename Keywords>
auto FindKeyword(const Keywords& keywords, std::string_view word) {
  const auto* const row = std::find_if(std::begin(keywords), std::end(keywords),
                                       [word](const auto& candidate) { return candidate.keyword == word; });
  return row == std::end(keywords) ? nullptr : row;
}

/// Reads what follows a keyword; an unknown word has no value. False if the value can't be read.
bool ReadValue(std::istream& file, std::string_view keyword, OptionRecord& record) {
  if (const auto* row = FindKeyword(kOptionKeywords, keyword)) return ReadNumber(file, record.*row->option);
  if (const auto* row = FindKeyword(kFactorKeywords, keyword)) return ReadNumber(file, record.*row->factor);
  if (const auto* row = FindKeyword(kSpecieKeywords, keyword)) {
    return ReadNumber(file, record.*row->group.*row->specie);
  }
  if (keyword == kLogKeyword) return ReadWord(file, record.logName);
  return true;
}

/// Reads the record up to the end of the file or the first value that can't be read.
std::optional<ReadingFailure> ReadValues(std::istream& file, std::string& lastKeyword, OptionRecord& record) {
  std::string word;
  while (ReadWord(file, word)) {
    if (word == kComment) {
      file.ignore(std::numeric_limits<std::streamsize>::max(), '\n');
      continue;
    }
    lastKeyword = word;
    if (ReadValue(file, word, record)) continue;
    const bool ended = file.eof();
    file.clear();
    return ReadingFailure{
        .keyword = word,
        .reason = ended ? "the value is missing or cut off" : "the value is not a number in range",
        .position = file.tellg()};
  }
  return std::nullopt;
}

std::optional<ReadingFailure> ReadRecord(std::istream& file, OptionRecord& record) {
  std::string lastKeyword;
  try {
    return ReadValues(file, lastKeyword, record);
  } catch (const std::ios_base::failure&) {
    return ReadingFailure{
        .keyword = lastKeyword, .reason = "the file cannot be read further", .position = -1};
  }
}

void SettleAfterFailure(OptionRecord& record) {
  const CarbonateSettings defaults;
  record.k = kOptionAfterFailure;
  record.factors = defaults.factors;
  record.totals = defaults.totals;
  record.dicFactor = defaults.dicFactor;
  record.alkalinityFactor = defaults.alkalinityFactor;
}

void ReportFailure(const std::string& path, const ReadingFailure& failure) {
  const std::string position = std::to_string(failure.position);
  SettingsLog& log = CarbonateLog();
  log.WriteLine("Error reading file " + path);
  log.WriteLine("              Line " + position);
  log.WriteLine("Last read option   " + failure.keyword);
  log.WriteLine("Exception          " + failure.reason);
  log.WriteLine("Using default settings!");
  NoteCarbonateProblem("Error reading file '" + path + "' at byte " + position + ", after '" +
                       failure.keyword + "': " + failure.reason + "; default settings are used");
}

void NameLog(const std::string& optionPath, const std::string& logPath) {
  std::error_code error;
  if (std::filesystem::equivalent(optionPath, logPath, error)) {
    NoteCarbonateProblem("The option file '" + optionPath +
                         "' names itself as its log file; nothing is logged");
    return;
  }
  CarbonateLog().Name(logPath);
}

void ApplyOptions(const OptionRecord& record) {
  struct Step {
    std::int32_t OptionRecord::*option;
    double (*set)(double);
  };
  // The order decides: a later step overrides what an earlier one has set.
  constexpr Step kSteps[] = {
      {&OptionRecord::fh, SetFHOption},     {&OptionRecord::k, SetKOption},
      {&OptionRecord::ks, SetKSOption},     {&OptionRecord::kb, SetKBOption},
      {&OptionRecord::tb, SetTBOption},     {&OptionRecord::kw, SetKWOption},
      {&OptionRecord::k1k2, SetK1K2Option},
  };
  for (const Step& step : kSteps) {
    if (record.*step.option != 0) step.set(record.*step.option);
  }
}

/// Factors come before the totals, which are stored times their factor.
void ApplyNumbers(const OptionRecord& record) {
  const PerSpecie& factors = record.factors;
  const PerSpecie& totals = record.totals;
  SetSpeciesFactors(factors.boron, factors.fluoride, factors.sulphate, factors.phosphate, factors.silicate);
  SetDicAlkFactors(record.dicFactor, record.alkalinityFactor);
  SetSpecies(totals.boron, totals.fluoride, totals.sulphate, totals.phosphate, totals.silicate);
}

void ReadAndApply(const std::string& path, std::istream& file) {
  OptionRecord record;
  const std::optional<ReadingFailure> failure = ReadRecord(file, record);
  if (!record.logName.empty()) NameLog(path, record.logName);
  if (failure) {
    SettleAfterFailure(record);
    ReportFailure(path, *failure);
  }
  ApplyOptions(record);
  ApplyNumbers(record);
}

}  // namespace

void ReadOptionFile(const std::string& path) {
  ForgetCarbonateProblems();
  std::error_code error;
  if (!std::filesystem::exists(path, error)) return;
  std::ifstream file;
  if (std::filesystem::is_regular_file(path, error)) file.open(path, std::ios::binary);
  if (!file.is_open()) {
    NoteCarbonateProblem("The option file '" + path + "' cannot be opened; default settings are used");
    return;
  }
  file.imbue(std::locale::classic());
  // A stream that only noted a lack of memory would seem to hold no number.
  file.exceptions(std::ios::badbit);
  CarbonateLog().BeginReading();
  ReadAndApply(path, file);
  CarbonateLog().EndReading();
}

}  // namespace tessal
