// Any bytes are read as an option file: they leave settings that can be computed with, the same each time,
// and the file itself as it was; a value that cannot be read is reported and brings the defaults of a failed
// reading.
#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <string_view>
#include <tuple>

#include "expr/carbonate/options.h"
#include "expr/carbonate/ph_solvers.h"
#include "expr/carbonate/settings.h"
#include "expr/carbonate/settings_log.h"
#include "template_file.h"

namespace {

using namespace tessal;
using fuzz::Require;

namespace fs = std::filesystem;

const fs::path& Folder() {
  static const fs::path kFolder = [] {
    fs::path folder = fuzz::ScratchFile("option_file");
    fs::create_directories(folder);
    return folder;
  }();
  return kFolder;
}

const std::string& OptionFile() {
  static const std::string kOptionFile = Folder() / "options.set";
  return kOptionFile;
}

/// The text with every log that it names moved into the folder: no input writes anywhere else.
std::string WithLogsInFolder(std::string_view text) {
  constexpr std::string_view kKeyword = "Logfile";
  std::string moved;
  for (std::size_t found = text.find(kKeyword); found != text.npos; found = text.find(kKeyword)) {
    moved += text.substr(0, found);
    moved += "Logfile " + Folder().string() + "/";
    text.remove_prefix(found + kKeyword.size());
    text.remove_prefix(std::min(text.find_first_not_of(" \t\n\v\f\r"), text.size()));
  }
  return moved.append(text);
}

void EmptyFolder() {
  CarbonateLog().Close();
  for (const auto& entry : fs::directory_iterator(Folder())) fs::remove(entry.path());
}

std::string BytesOf(const fs::path& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), {}};
}

template <typename Row, std::size_t Options>
bool IsRowOf(const Row* row, const std::array<Row, Options>& rows) {
  return row >= rows.data() && row < rows.data() + rows.size();
}

void CheckOptions(const CarbonateSettings& s) {
  Require(IsRowOf(s.carbonicAcid, kCarbonicAcidOptions) && IsRowOf(s.water, kWaterOptions) &&
              IsRowOf(s.boricAcid, kBoricAcidOptions) && IsRowOf(s.bisulphate, kBisulphateOptions) &&
              IsRowOf(s.activity, kActivityOptions) && IsRowOf(s.boron, kBoronOptions),
          "every option is one of its table");
}

auto Numbers(const CarbonateSettings& s) {
  const auto all = [](const PerSpecie& values) {
    return std::tuple(values.boron, values.fluoride, values.sulphate, values.phosphate, values.silicate);
  };
  return std::tuple(all(s.totals), all(s.factors), s.dicFactor, s.alkalinityFactor);
}

auto Options(const CarbonateSettings& s) {
  return std::tuple(s.carbonicAcid, s.water, s.boricAcid, s.bisulphate, s.activity, s.boron);
}

CarbonateSettings Read() {
  SetCarbonateDefaults();
  ReadOptionFile(OptionFile());
  return Carbonate();
}

void CheckLog() {
  if (!CarbonateLog().IsOpen()) return;
  CarbonateLog().WriteLine("the last line");
  for (const auto& entry : fs::directory_iterator(Folder())) {
    if (entry.path() == OptionFile()) continue;
    const std::string log = BytesOf(entry.path());
    Require(log.starts_with("# Tessal pH calcualtion log file\n# Constant settings\n") &&
                log.ends_with("\nthe last line\n"),
            "a log has its heading, and takes what is written at once");
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  EmptyFolder();
  std::string text = WithLogsInFolder({reinterpret_cast<const char*>(data), size});
  // A name may lead out of the folder still.
  for (std::size_t found = text.find(".."); found != std::string::npos; found = text.find(".."))
    text[found] = '_';
  std::ofstream(OptionFile(), std::ios::binary) << text;

  const CarbonateSettings settings = Read();
  CheckOptions(settings);
  CheckLog();
  if (CarbonateProblem().starts_with("Error reading") ||
      CarbonateProblem().find("; Error") != std::string::npos) {
    Require(Numbers(settings) == Numbers(CarbonateSettings{}), "a failed reading leaves no numbers");
  }
  Require(!std::isinf(CalculatePh(2100, 2300, 35, 25, 100)), "a pH, none, or no number");

  const CarbonateSettings again = Read();
  Require(Options(again) == Options(settings) && Numbers(again) == Numbers(settings),
          "a file means one thing");
  Require(BytesOf(OptionFile()) == text, "reading changes no option file");
  return 0;
}
