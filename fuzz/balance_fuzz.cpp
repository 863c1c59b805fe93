// The matrix and the balance of any equations. The first line is a pool, the second lists the processes at
// its boundary, the next three are processes, and what follows are equations. The matrix is the equations in
// another form, and a multiple of a closed pool is no open one.
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "analysis/algebra.h"
#include "analysis/mass_balance.h"
#include "analysis/process_matrix.h"
#include "core/template_core.h"
#include "expr/parser.h"
#include "template_file.h"

namespace {

using namespace tessal;
using fuzz::Require;
using fuzz::TakeLine;

std::vector<std::string> WordsOf(const std::string& line) {
  std::vector<std::string> words(1);
  for (const char character : line) {
    if (character == ' ') {
      words.emplace_back();
    } else {
      words.back() += character;
    }
  }
  return words;
}

/// The equation of a column as the matrix has it.
std::string EquationOf(const ProcessMatrix& matrix, std::size_t column) {
  std::string text = matrix.other[column].empty() ? "0" : "(" + matrix.other[column] + ")";
  for (const MatrixRow& row : matrix.rows) {
    for (const MatrixCell& cell : row.cells) {
      if (cell.column == column) text += " + (" + cell.factor + ")*" + row.process.symbol;
    }
  }
  return text;
}

void CheckMatrix(const TemplateCore& core) {
  const ProcessMatrix matrix = BuildProcessMatrix(core, MatrixProcesses::AsWritten);
  BuildProcessMatrix(core, MatrixProcesses::Elementary);
  const SymbolIndex index(core);
  Algebra algebra(index, Brackets::MultipliedOut);
  for (std::size_t column = 0; column < matrix.states.size(); ++column) {
    bool isFaulty = false;
    for (const MatrixFault& fault : matrix.faults) isFaulty = isFaulty || fault.column == column;
    if (isFaulty) continue;
    const std::string text = EquationOf(matrix, column);
    const ScannerRest rest;
    const auto parsed = ParseExpression(text);
    Require(parsed->Tree() != nullptr, "the cells of a matrix are expressions");
    const RecordExpression equation = ExpressionOf(*core.RecordOfElement(core.GetStateVariable(column)));
    const auto again = algebra.Expand(text, *parsed->Tree());
    const auto original = algebra.Expand(equation.text, *equation.tree);
    if (!again || !original) continue;
    ProductSum difference = *original;
    Append(difference, *again, -1);
    Settle(difference);
    Require(difference.empty(), "the matrix is the equations");
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  constexpr std::size_t kLongest = 2048;
  if (size == 0 || size > kLongest) return 0;
  std::string_view rest(reinterpret_cast<const char*>(data), size);
  Pool pool{"pool", TakeLine(rest), WordsOf(TakeLine(rest)), {}};
  TemplateCore core;
  for (const char* symbol : {"k", "m"}) core.AddConstant().symbol.SetText(symbol);
  core.AddForcing().symbol.SetText("dz");
  for (const char* symbol : {"p", "q", "r"}) {
    CEL_Process& process = core.AddProcess();
    process.symbol.SetText(symbol);
    process.expression.SetText(TakeLine(rest));
  }
  for (const char* symbol : {"A", "B", "C"}) {
    CEL_StateVariable& state = core.AddStateVariable();
    state.symbol.SetText(symbol);
    state.equation.SetText(TakeLine(rest));
  }
  core.RebuildSymbolTable();
  CheckMatrix(core);
  const PoolVerdict verdict = CheckMassBalance(core, {&pool, 1}).front().verdict;
  pool.expression = "2*(" + pool.expression + ")";
  const PoolVerdict doubled = CheckMassBalance(core, {&pool, 1}).front().verdict;
  Require(verdict != PoolVerdict::Closed || doubled != PoolVerdict::Open, "twice a closed pool is not open");
  // Any text is read as pools, or refused.
  ReadPools(std::string(reinterpret_cast<const char*>(data), size));
  return 0;
}
