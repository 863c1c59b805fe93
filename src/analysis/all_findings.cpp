#include "analysis/all_findings.h"

#include <iterator>
#include <utility>

#include "analysis/lint.h"
#include "analysis/mass_balance.h"
#include "analysis/unit_check.h"
#include "core/template_core.h"

namespace tessal {

namespace {

AnalysisFinding AboutUnknownUnit(const CEL_Element& element, const UnknownUnit& unknown) {
  AnalysisFinding finding = FindingAbout(element, {"unit-unknown", {unknown.unit}});
  finding.symbol = unknown.symbol;
  finding.field = "Unit";
  return finding;
}

}  // namespace

std::vector<AnalysisFinding> AllFindings(const TemplateCore& core) {
  std::vector<AnalysisFinding> findings;
  UnitReport units = CheckUnits(core, Substances::Ignored);
  for (UnitFinding& unit : units.findings) findings.push_back(std::move(unit.finding));
  for (const UnknownUnit& unknown : units.unknown) {
    if (const CEL_Element* element = core.GetElement(unknown.uid))
      findings.push_back(AboutUnknownUnit(*element, unknown));
  }
  const std::vector<PoolBalance> balances = CheckMassBalance(core, PoolsOf(core).pools);
  for (auto more : {BalanceFindings(core, balances), Lint(core)}) {
    std::move(more.begin(), more.end(), std::back_inserter(findings));
  }
  return findings;
}

}  // namespace tessal
