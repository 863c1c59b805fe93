// The tables that a paper or a report shows of a model, as data: its state variables, parameters, inputs,
// processes and equations, the process matrix and the nomenclature. Printers (table_text.h) set them.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace tessal {

class TemplateCore;

/// What the cells of a column hold, which decides how they are set.
enum class CellKind : std::uint8_t {
  Symbol,
  Text,
  Number,
  Expression,
  Derivative  ///< the right side of the equation of the row's symbol, which is in the first column
};

struct TableColumn {
  std::string name;  ///< as people read it; texts that are symbols of the template among them
  CellKind kind;
  bool isSymbol = false;  ///< whether the name is one
};

/// Texts are in UTF-8, on one line each. A row has a cell for each column; an empty one has no value.
struct ModelTable {
  std::string name;  ///< for machines: "parameters"
  std::string title;
  std::vector<TableColumn> columns;
  std::vector<std::vector<std::string>> rows;
  std::vector<std::string> notes;  ///< what the table does not show, and why
};

/// All tables, in the order of a report; those that the template has nothing for have no rows.
std::vector<ModelTable> BuildModelTables(const TemplateCore& core);

}  // namespace tessal
