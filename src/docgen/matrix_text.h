// The process matrix as text: aligned for a screen, as comma-separated values, and as a LaTeX table.
#pragma once

#include <string>

namespace tessal {

struct ProcessMatrix;

/// A row for each process, a column for each state variable, and a last row for what is no multiple of a
/// process where there is any.
std::string MatrixAsText(const ProcessMatrix& matrix);

/// The same as comma-separated values after RFC 4180, with the rates in a last column.
std::string MatrixAsCsv(const ProcessMatrix& matrix);

/// The same as a table of LaTeX, with its factors as formulae. It needs the package amsmath.
std::string MatrixAsLatex(const ProcessMatrix& matrix);

}  // namespace tessal
