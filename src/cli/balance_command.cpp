// The process matrix of a template, and whether its pools keep their amount.
#include <algorithm>
#include <array>
#include <cmath>
#include <nlohmann/json.hpp>
#include <optional>

#include "analysis/mass_balance.h"
#include "analysis/process_matrix.h"
#include "cli/commands.h"
#include "cli/template_files.h"
#include "cli/template_messages.h"
#include "core/template_core.h"
#include "docgen/matrix_text.h"
#include "platform/file_replacement.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

// The matrix.

const CEL_Lagrange_Specie* ClassOfName(const TemplateCore& core, const std::string& name) {
  const auto hit = std::find_if(core.Species().begin(), core.Species().end(),
                                [&name](const auto& specie) { return specie->symbol.Text() == name; });
  return hit == core.Species().end() ? nullptr : hit->get();
}

Json ToJson(const ProcessMatrix& matrix) {
  Json states = Json::array();
  for (const MatrixElement& state : matrix.states) states.push_back(JsonText(state.symbol));
  Json processes = Json::array();
  for (const MatrixRow& row : matrix.rows) {
    Json cells = Json::object();
    for (const MatrixCell& cell : row.cells) {
      cells[JsonText(matrix.states[cell.column].symbol)] = JsonText(cell.factor);
    }
    processes.push_back({{"symbol", JsonText(row.process.symbol)}, {"cells", std::move(cells)}});
  }
  Json other = Json::object();
  for (std::size_t column = 0; column < matrix.other.size(); ++column) {
    if (matrix.other[column].empty()) continue;
    other[JsonText(matrix.states[column].symbol)] = JsonText(matrix.other[column]);
  }
  return {{"states", std::move(states)}, {"processes", std::move(processes)}, {"other", std::move(other)}};
}

// The balance.

/// The pools of a call: those of the template's own file, or of another one, and those of the command line,
/// of which one with a name that is there already takes its place. False, with the reason, when one cannot be
/// read.
bool CollectPools(const TemplateCore& core, const BalanceCall& call, std::vector<Pool>& pools) {
  PoolsRead read = PoolsOf(core);
  if (!call.poolsFile.empty()) {
    std::string failure;
    const std::optional<std::string> text = ReadWholeFile(call.poolsFile, failure);
    if (!text) {
      Complain(OnOneLine(failure));
      return false;
    }
    read = ReadPools(*text);
  }
  if (!read.faults.empty()) {
    Complain(OnOneLine(call.poolsFile + ": " + read.faults.front()));
    return false;
  }
  for (const std::string& ignored : read.notPools) {
    if (!call.poolsFile.empty())
      Complain(OnOneLine(call.poolsFile + ": " + ignored + " is no part of a pool"));
  }
  pools = std::move(read.pools);
  return true;
}

Pool* PoolOfName(std::vector<Pool>& pools, const std::string& name) {
  const auto hit =
      std::find_if(pools.begin(), pools.end(), [&name](const Pool& pool) { return pool.name == name; });
  return hit == pools.end() ? nullptr : &*hit;
}

std::vector<std::string> NamesIn(const std::string& list) {
  std::vector<std::string> names;
  std::size_t start = 0;
  while (start <= list.size()) {
    const std::size_t end = std::min(list.find(',', start), list.size());
    if (end > start) names.push_back(list.substr(start, end - start));
    start = end + 1;
  }
  return names;
}

void AddBoundary(Pool& pool, const std::string& list) {
  for (std::string& process : NamesIn(list)) pool.boundary.push_back(std::move(process));
}

/// The name and the value of "NAME=VALUE". False, with a complaint, without an equals sign or a name.
bool Divide(const std::string& option, const std::string& text, std::string& name, std::string& value) {
  const std::size_t sign = text.find('=');
  if (sign == std::string::npos || sign == 0) {
    Complain(OnOneLine(option + ": '" + text + "' is no NAME=VALUE"));
    return false;
  }
  name = text.substr(0, sign);
  value = text.substr(sign + 1);
  return true;
}

bool TakeOptions(const BalanceCall& call, std::vector<Pool>& pools) {
  std::string name;
  std::string value;
  for (const std::string& text : call.pools) {
    if (!Divide("--pool", text, name, value)) return false;
    if (Pool* pool = PoolOfName(pools, name)) {
      pool->expression = value;
    } else {
      pools.push_back({name, value, {}, {}});
    }
  }
  for (const std::string& text : call.boundaries) {
    // A list without a name is for all pools.
    if (text.find('=') == std::string::npos) {
      for (Pool& pool : pools) AddBoundary(pool, text);
      continue;
    }
    if (!Divide("--boundary", text, name, value)) return false;
    Pool* pool = PoolOfName(pools, name);
    if (pool == nullptr) {
      Complain(OnOneLine("--boundary: there is no pool '" + name + "'"));
      return false;
    }
    AddBoundary(*pool, value);
  }
  return true;
}

constexpr std::string_view VerdictWord(PoolVerdict verdict) {
  constexpr std::array<std::string_view, 3> kWords = {"closed", "open", "unknown"};
  return kWords[static_cast<std::size_t>(verdict)];
}

Json ToJson(const PoolBalance& balance) {
  Json leaks = Json::array();
  for (const PoolLeak& leak : balance.leaks) {
    leaks.push_back({{"process", JsonText(leak.process)},
                     {"net", JsonText(leak.net)},
                     {"value", std::isfinite(leak.value) ? Json(leak.value) : Json(nullptr)}});
  }
  return {{"name", JsonText(balance.name)},
          {"verdict", VerdictWord(balance.verdict)},
          {"leaks", std::move(leaks)},
          {"reason", JsonText(balance.reason)}};
}

void PrintText(const PoolBalance& balance) {
  const std::string verdict = balance.verdict == PoolVerdict::Unknown
                                  ? "could not judge: " + OnOneLine(balance.reason)
                                  : std::string(VerdictWord(balance.verdict));
  PrintLine(ForTerminal(OnOneLine(balance.name) + ": " + verdict));
  for (const PoolLeak& leak : balance.leaks) {
    const std::string process = leak.process.empty() ? "(no process)" : OnOneLine(leak.process);
    PrintLine(ForTerminal("  " + process + ": " + OnOneLine(leak.net)));
  }
}

}  // namespace

ExitCode RunMatrix(const MatrixCall& call) {
  TemplateCore& core = TheTemplate();
  if (!LoadOrComplain(core, call.file)) return kCallFault;
  const auto processes = call.isElementary ? MatrixProcesses::Elementary : MatrixProcesses::AsWritten;
  ProcessMatrix matrix;
  if (call.className.empty()) {
    matrix = BuildProcessMatrix(core, processes);
  } else if (const CEL_Lagrange_Specie* specie = ClassOfName(core, call.className)) {
    matrix = BuildProcessMatrix(core, *specie, processes);
  } else {
    Complain(OnOneLine(call.file + " has no particle class '" + call.className + "'"));
    return kCallFault;
  }
  const EndsWithoutMemory end;
  switch (call.format) {
    case Format::Json:
      PrintLine(ToJson(matrix).dump());
      break;
    case Format::Csv:
      Print(MatrixAsCsv(matrix));
      break;
    case Format::Latex:
      Print(MatrixAsLatex(matrix));
      break;
    default:
      Print(ForTerminal(MatrixAsText(matrix)));
  }
  for (const MatrixFault& fault : matrix.faults) {
    Complain(OnOneLine(matrix.states[fault.column].symbol + ": " + fault.reason));
  }
  return matrix.faults.empty() ? kFine : kContentFault;
}

ExitCode RunBalance(const BalanceCall& call) {
  TemplateCore& core = TheTemplate();
  if (!LoadOrComplain(core, call.file)) return kCallFault;
  const EndsWithoutMemory end;
  std::vector<Pool> pools;
  if (!CollectPools(core, call, pools) || !TakeOptions(call, pools)) return kCallFault;
  if (pools.empty()) {
    Complain(OnOneLine(call.file + " has no pools; --pool NAME=EXPR names one"));
    return kCallFault;
  }
  const std::vector<PoolBalance> balances = CheckMassBalance(core, pools);
  if (call.format == Format::Json) {
    Json list = Json::array();
    for (const PoolBalance& balance : balances) list.push_back(ToJson(balance));
    PrintLine(Json{{"pools", std::move(list)}}.dump());
  } else {
    for (const PoolBalance& balance : balances) PrintText(balance);
  }
  const bool allClosed = std::all_of(balances.begin(), balances.end(), [](const PoolBalance& balance) {
    return balance.verdict == PoolVerdict::Closed;
  });
  return allClosed ? kFine : kContentFault;
}

}  // namespace tessal::cli
