// The model that the benchmarks are about: which variables there are and what their expressions say, without
// the language that somebody writes them in.
#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace tessal::bench {

/// A variable of the model by the name of its kind and its place from 1; place 0 is the number 1.5.
struct Operand {
  std::string_view kind;
  int place = 0;
};

/// An expression as its form and what it is about. A form that needs two operands leaves the others.
struct GeneratedExpression {
  enum class Form : std::uint8_t { Limitation, Threshold, Balance };
  static constexpr std::size_t kMostOperands = 4;

  Form form;
  std::array<Operand, kMostOperands> operands;
};

/// How a language writes the expressions: a pattern for each form, in which $1 to $4 are the operands, and
/// what surrounds a name and a number.
struct Dialect {
  std::array<std::string_view, 3> patterns;
  std::string_view nameStart;
  std::string_view nameEnd;
  std::string_view numberStart;
  std::string_view numberEnd;
};

/// The language of the templates.
inline constexpr Dialect kTemplateDialect = {
    .patterns = {"$1*EXP(-$2/($3+1)) + $4", "IF $1 > 0.5 THEN $2*$3 ELSE $4", "$1 - $2"},
    .nameStart = {},
    .nameEnd = {},
    .numberStart = {},
    .numberEnd = {}};

std::string Write(const GeneratedExpression& expression, const Dialect& dialect);

/// The name of a variable: "constant7".
std::string NameOf(std::string_view kind, int place);

/// What a variable of that name is described as.
std::string DescriptionOf(const std::string& name);

/// The names that occur in an expression, each once.
std::vector<std::string> NamesIn(const GeneratedExpression& expression);

namespace kind {
inline constexpr std::string_view kStateVariable = "S";
inline constexpr std::string_view kConstant = "constant";
inline constexpr std::string_view kForcing = "forcing";
inline constexpr std::string_view kAuxiliary = "factor";
inline constexpr std::string_view kProcess = "rate";
}  // namespace kind

/// Of 100 elements 6 are state variables, 30 constants, 14 forcings, 25 auxiliaries and 25 processes. An
/// auxiliary and a process have an expression with four symbols, a state variable one with two; each uses
/// only what is declared before it. The same number of elements gives the same model.
struct GeneratedModel {
  explicit GeneratedModel(int elements);
  /// Nothing but constants.
  static GeneratedModel OfConstants(int count);

  /// All expressions, in the order of the file.
  std::vector<GeneratedExpression> Expressions() const;

  int stateVariables;
  int constants;
  int forcings;
  std::vector<GeneratedExpression> auxiliaries;
  std::vector<GeneratedExpression> processes;
  std::vector<GeneratedExpression> equations;  ///< one for each state variable
};

}  // namespace tessal::bench
