#include "tessal/analysis.h"

#include <utility>

#include "analysis/lint.h"
#include "analysis/mass_balance.h"
#include "analysis/process_matrix.h"
#include "analysis/unit_check.h"
#include "core/pools.h"
#include "library/messages_of.h"
#include "library/template_data.h"

namespace tessal {
inline namespace v1 {

namespace {

std::vector<TemplateMessage> MessagesOfUnits(const Template& model, Substances substances) {
  std::vector<AnalysisFinding> findings;
  for (UnitFinding& clash : CheckUnits(DataOf(model).Core(), substances).findings) {
    findings.push_back(std::move(clash.finding));
  }
  return MessagesOf(findings);
}

Verdict VerdictOf(PoolVerdict verdict) {
  switch (verdict) {
    case PoolVerdict::Closed:
      return Verdict::Closed;
    case PoolVerdict::Open:
      return Verdict::Open;
    case PoolVerdict::Unknown:
      break;
  }
  return Verdict::Unknown;
}

}  // namespace

std::vector<TemplateMessage> UnitMessages(const Template& model) {
  return MessagesOfUnits(model, Substances::Ignored);
}

std::vector<TemplateMessage> StrictUnitMessages(const Template& model) {
  return MessagesOfUnits(model, Substances::Dimensions);
}

std::vector<TemplateMessage> LintMessages(const Template& model) {
  return MessagesOf(Lint(DataOf(model).Core()));
}

std::vector<BalanceOfPool> Balance(const Template& model) {
  const TemplateCore& core = DataOf(model).Core();
  const PoolsRead read = PoolsOf(core);
  std::vector<BalanceOfPool> balances;
  for (const PoolBalance& balance : CheckMassBalance(core, read.pools)) {
    BalanceOfPool shown{balance.name, VerdictOf(balance.verdict), {}, balance.reason};
    for (const PoolLeak& leak : balance.leaks) shown.leaks.push_back({leak.process, leak.net, leak.value});
    balances.push_back(std::move(shown));
  }
  // A pool that can not be read is one that nobody has judged.
  for (const std::string& fault : read.faults) balances.push_back({{}, Verdict::Unknown, {}, fault});
  return balances;
}

MatrixOfProcesses ProcessesOf(const Template& model) {
  const ProcessMatrix matrix = BuildProcessMatrix(DataOf(model).Core(), MatrixProcesses::AsWritten);
  MatrixOfProcesses shown;
  for (const MatrixElement& state : matrix.states) shown.states.push_back(state.symbol);
  for (const MatrixRow& row : matrix.rows) {
    shown.processes.push_back(row.process.symbol);
    shown.rates.push_back(row.rate);
    std::vector<std::string>& factors = shown.factors.emplace_back(matrix.states.size());
    for (const MatrixCell& cell : row.cells) factors[cell.column] = cell.factor;
  }
  shown.other = matrix.other;
  return shown;
}

}  // namespace v1
}  // namespace tessal
