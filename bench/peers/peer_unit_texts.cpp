// Unit texts as the project reads them beside what UDUNITS alone makes of the same text, for the units of the
// examples, the catalogues and the cases of the tests: how many agree, and where they do not. Each reading is
// in base units.
#include <udunits2.h>

#include <algorithm>
#include <cmath>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "analysis/unit_check.h"
#include "analysis/unit_spelling.h"
#include "analysis/unit_text.h"
#include "analysis/unit_words.h"
#include "core/template_core.h"
#include "elements/choices.h"
#include "expr/builtin_catalogue.h"
#include "platform/ascii.h"
#include "text_table.h"

namespace {

using namespace tessal;

struct FreeSystem {
  void operator()(ut_system* system) const { ut_free_system(system); }
};
struct FreeUnit {
  void operator()(ut_unit* unit) const { ut_free(unit); }
};
using System = std::unique_ptr<ut_system, FreeSystem>;
using PeerUnit = std::unique_ptr<ut_unit, FreeUnit>;

/// Every text once.
class Texts final {
 public:
  void Add(const std::string& text) {
    if (std::find(texts.begin(), texts.end(), text) == texts.end()) texts.push_back(text);
  }
  const std::vector<std::string>& All() const { return texts; }

 private:
  std::vector<std::string> texts;
};

void AddExamples(Texts& texts) {
  for (const auto& file : std::filesystem::directory_iterator(TESSAL_SOURCE_DIR "/examples")) {
    if (file.path().extension() != ".tessal") continue;
    TemplateCore core;
    core.LoadWrapper(file.path().string());
    for (const UnitReading& reading : ListUnits(core)) texts.Add(reading.text);
  }
}

void AddCatalogues(Texts& texts) {
  for (const CatalogueBuiltin& row : Builtins()) texts.Add(std::string(row.unit));
  for (const UnitTypes* types :
       {&kPlainUnitTypes, &kInputUnitTypes, &kStateVariableUnitTypes, &kParticleUnitTypes}) {
    for (const UnitTypeRow& row : types->rows) texts.Add(std::string(row.unit));
  }
}

/// The inputs of the file of cases; those with escaped bytes are left out.
void AddCases(Texts& texts) {
  std::ifstream file(TESSAL_SOURCE_DIR "/tests/analysis/cases/unit_texts.txt");
  bool isInput = false;
  for (std::string line; std::getline(file, line);) {
    if (line.starts_with("==")) isInput = true;
    if (line.starts_with(">")) isInput = false;
    if (isInput && !line.empty() && !line.starts_with("==") && line.find('\\') == std::string::npos)
      texts.Add(line);
  }
}

std::string PeerText(const ut_unit* unit) {
  if (unit == nullptr) return "not read";
  constexpr std::size_t kLongest = 200;
  std::string text(kLongest, '\0');
  const int size = ut_format(unit, text.data(), text.size(), UT_ASCII | UT_DEFINITION);
  text.resize(size < 0 ? 0 : static_cast<std::size_t>(size));
  return text.empty() ? "1" : text;
}

/// Whether the peer reads the text as what we have read it as: ours goes to it in base units.
bool Agrees(const System& system, const PeerUnit& peer, const std::optional<Unit>& ours) {
  if (!ours || peer == nullptr) return !ours && peer == nullptr;
  const PeerUnit written(ut_parse(system.get(), InBaseUnits(*ours).c_str(), UT_ASCII));
  if (written == nullptr || ut_are_convertible(peer.get(), written.get()) == 0) return false;
  cv_converter* converter = ut_get_converter(peer.get(), written.get());
  // The zero of a temperature scale does not count.
  const double factor = cv_convert_double(converter, 1) - cv_convert_double(converter, 0);
  cv_free(converter);
  constexpr double kTolerance = 1e-4;
  return std::abs(factor - 1) < kTolerance;
}

/// Where our tables or our arithmetic make the difference.
std::string ReasonOf(const std::string& text, const std::optional<Unit>& ours, bool peerReads) {
  if (ours && !ours->substances.empty()) return "a substance, " + SubstanceText(*ours);
  for (std::size_t start = 0; start < text.size();) {
    std::size_t end = start;
    while (end < text.size() && IsAsciiLetter(text[end])) ++end;
    const UnitWord* row = UnitWordOf(std::string_view(text).substr(start, end - start));
    if (row != nullptr && !row->reason.empty()) return std::string(row->reason);
    if (row != nullptr) return "a spelling of the table";
    start = end + 1;
  }
  if (!ours) return "no unit to us";
  return peerReads ? "arithmetic, or words that belong together" : "a way of writing";
}

int Run() {
  ut_set_error_message_handler(ut_ignore);
  const System system(ut_read_xml(nullptr));
  if (system == nullptr) {
    std::cerr << "peer_unit_texts: UDUNITS has no database\n";
    return 1;
  }
  Texts texts;
  AddExamples(texts);
  AddCatalogues(texts);
  AddCases(texts);
  std::size_t agreed = 0;
  constexpr std::size_t kTextWidth = 22;
  constexpr std::size_t kReadingWidth = 26;
  const bench::TextTable table(kTextWidth, {std::string(kReadingWidth, ' ') + "ours",
                                            std::string(kReadingWidth, ' ') + "UDUNITS", "why"});
  for (const std::string& text : texts.All()) {
    const PeerUnit peer(ut_parse(system.get(), text.c_str(), UT_UTF8));
    const std::optional<Unit> ours = ReadUnitText(text);
    if (Agrees(system, peer, ours)) {
      ++agreed;
      continue;
    }
    table.PrintRow({text, ours ? InBaseUnits(*ours) : "not read", PeerText(peer.get()),
                    ReasonOf(text, ours, peer != nullptr)});
  }
  std::cout << agreed << " of " << texts.All().size() << " texts are read alike\n";
  return 0;
}

}  // namespace

int main() {
  return Run();
}
