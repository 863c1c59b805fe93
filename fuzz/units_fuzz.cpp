// Units of any text, and templates whose units and expressions are any text: the first three lines are units,
// the rest an expression over elements that have them. What was read is the same when it is written and read
// again, and what is found lies in the expression.
#include <cmath>
#include <cstdint>
#include <string>
#include <string_view>

#include "analysis/unit_check.h"
#include "analysis/unit_spelling.h"
#include "analysis/unit_text.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "template_file.h"

namespace {

using namespace tessal;
using fuzz::Require;
using fuzz::TakeLine;

bool HasLargePower(const Unit& unit) {
  constexpr double kLargest = 20;
  for (const double power : unit.powers) {
    if (std::abs(power) > kLargest) return true;
  }
  return false;
}

/// Texts have six digits, in the powers of days too.
bool IsAbout(double left, double right) {
  constexpr double kTolerance = 2e-3;
  return std::abs(left - right) < kTolerance;
}

void CheckText(const std::string& text) {
  const std::optional<Unit> unit = ReadUnitText(text);
  if (!unit || HasLargePower(*unit)) return;
  for (const std::string& written : {InBaseUnits(*unit), AsModellersWrite(*unit)}) {
    const std::optional<Unit> again = ReadUnitText(written);
    Require(again.has_value(), "what is written can be read");
    Require(HaveSameDimension(*unit, *again), "what is written has the same dimension");
    Require(unit->isFactorOpen || IsAbout(unit->logFactor, again->logFactor), "it has the same factor");
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  constexpr std::size_t kLongest = 2048;
  if (size == 0 || size > kLongest) return 0;
  std::string_view rest(reinterpret_cast<const char*>(data), size);
  TemplateCore core;
  for (const char* symbol : {"a", "b", "c"}) {
    auto& constant = core.AddConstant();
    constant.symbol.SetText(symbol);
    const std::string unit = TakeLine(rest);
    CheckText(unit);
    constant.unit.SetText(unit);
  }
  auto& state = core.AddStateVariable();
  state.symbol.SetText("s");
  state.equation.SetText(rest);
  core.RebuildSymbolTable();
  for (const Substances substances : {Substances::Ignored, Substances::Dimensions}) {
    for (const UnitFinding& unit : CheckUnits(core, substances).findings) {
      const LexemeSpan place = unit.finding.place;
      Require(place.start + place.length <= StripExpressionQuotes(state.equation.Text()).size(),
              "a finding is in its expression");
    }
  }
  return 0;
}
