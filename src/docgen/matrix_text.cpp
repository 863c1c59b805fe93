#include "docgen/matrix_text.h"

#include <algorithm>
#include <string_view>
#include <vector>

#include "analysis/process_matrix.h"
#include "docgen/csv_text.h"
#include "docgen/latex.h"

namespace tessal {

namespace {

using Cells = std::vector<std::string>;

constexpr std::string_view kProcess = "Process";
constexpr std::string_view kOther = "other";

Cells RowOf(const ProcessMatrix& matrix, const MatrixRow& row) {
  Cells cells(matrix.states.size() + 1);
  cells.front() = row.process.symbol;
  for (const MatrixCell& cell : row.cells) cells[cell.column + 1] = cell.factor;
  return cells;
}

/// The matrix as rows of cells, with the symbols above and at the left.
std::vector<Cells> Table(const ProcessMatrix& matrix) {
  std::vector<Cells> table{{std::string(kProcess)}};
  for (const MatrixElement& state : matrix.states) table.front().push_back(state.symbol);
  for (const MatrixRow& row : matrix.rows) table.push_back(RowOf(matrix, row));
  const bool hasOther = std::any_of(matrix.other.begin(), matrix.other.end(),
                                    [](const std::string& rest) { return !rest.empty(); });
  if (hasOther) {
    table.push_back({std::string(kOther)});
    table.back().insert(table.back().end(), matrix.other.begin(), matrix.other.end());
  }
  return table;
}

/// A factor as a formula; a text that is no expression of the language as it is.
std::string Formula(const std::string& factor) {
  if (factor.empty()) return {};
  const std::string latex = ExpressionToLatex(factor, "", false);
  return latex.empty() ? LatexText(factor) : "$" + latex + "$";
}

}  // namespace

std::string MatrixAsText(const ProcessMatrix& matrix) {
  const std::vector<Cells> table = Table(matrix);
  std::vector<std::size_t> widths(matrix.states.size() + 1, 0);
  for (const Cells& row : table) {
    for (std::size_t column = 0; column < row.size(); ++column) {
      widths[column] = std::max(widths[column], row[column].size());
    }
  }
  std::string text;
  for (const Cells& row : table) {
    std::string line;
    for (std::size_t column = 0; column < row.size(); ++column) {
      const std::string padding(widths[column] - row[column].size(), ' ');
      line += column == 0 ? row[column] + padding : "  " + padding + row[column];
    }
    text += line.substr(0, line.find_last_not_of(' ') + 1) + '\n';
  }
  return text;
}

std::string MatrixAsCsv(const ProcessMatrix& matrix) {
  std::vector<Cells> table = Table(matrix);
  table.front().emplace_back("Rate");
  for (std::size_t place = 0; place < matrix.rows.size(); ++place) {
    table[place + 1].push_back(matrix.rows[place].rate);
  }
  std::string text;
  for (Cells& row : table) {
    row.resize(matrix.states.size() + 2);
    text += CsvLine(row);
  }
  return text;
}

std::string MatrixAsLatex(const ProcessMatrix& matrix) {
  std::string text = "\\begin{tabular}{l" + std::string(matrix.states.size(), 'c') + "}\n\\hline\n";
  const std::vector<Cells> table = Table(matrix);
  for (std::size_t place = 0; place < table.size(); ++place) {
    for (std::size_t column = 0; column < table[place].size(); ++column) {
      const std::string& cell = table[place][column];
      text += column == 0 ? "" : " & ";
      text += place == 0 || column == 0 ? LatexText(cell) : Formula(cell);
    }
    text += place == 0 ? " \\\\\n\\hline\n" : " \\\\\n";
  }
  return text + "\\hline\n\\end{tabular}\n";
}

}  // namespace tessal
