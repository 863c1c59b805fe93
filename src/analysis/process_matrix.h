// The process matrix of a template: which process changes which state variable, and by which factor. Rows are
// processes, columns state variables; the sum over the rows of process times factor, and what is in "other",
// is the equation. Gujer, W. and Larsen, T. A. (1995), Water Science and Technology 31(2), 257-266.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "platform/uid.h"

namespace tessal {

class CEL_Lagrange_Specie;
class TemplateCore;

/// An element that a row or a column belongs to.
struct MatrixElement {
  Uid uid = Uid::None;
  std::string symbol;
  std::string unit;
  std::string description;
};

/// What a process contributes to the equation of a state variable.
struct MatrixCell {
  std::size_t column;
  std::string factor;  ///< an expression: "1", "-aNC", "1/dz"
};

struct MatrixRow {
  MatrixElement process;
  std::vector<MatrixCell> cells;  ///< those that are not empty, in the order of the columns
  std::string rate;               ///< the process's own expression
};

/// Why the equation of a column is in no row.
struct MatrixFault {
  std::size_t column;
  std::string reason;
};

struct ProcessMatrix {
  std::vector<MatrixElement> states;  ///< the columns, in the order of the template
  std::vector<MatrixRow> rows;        ///< processes that an equation uses, in the order of the template
  /// Of each column what is no multiple of a process, as an expression; empty where there is none.
  std::vector<std::string> other;
  std::vector<MatrixFault> faults;  ///< equations that do not parse or are too large to expand
};

/// How far equations are expanded.
enum class MatrixProcesses : std::uint8_t {
  AsWritten,  ///< a row for each process that an equation names
  Elementary  ///< processes that are sums of multiples of other processes are replaced by those
};

/// The matrix of the template's own state variables.
ProcessMatrix BuildProcessMatrix(const TemplateCore& core, MatrixProcesses processes);
/// The matrix of a particle class: its state variables and arithmetic expressions.
ProcessMatrix BuildProcessMatrix(const TemplateCore& core, const CEL_Lagrange_Specie& specie,
                                 MatrixProcesses processes);

}  // namespace tessal
