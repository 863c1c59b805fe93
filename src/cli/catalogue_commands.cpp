// Commands on the catalogues: their rows, and the values of their functions.
#include <optional>

#include "cli/commands.h"
#include "cli/numbers.h"
#include "expr/builtin_catalogue.h"
#include "expr/evaluate.h"
#include "expr/function_catalogue.h"

namespace tessal::cli {

namespace {

/// The catalogues, set up for as long as a command needs them.
class CatalogueUse final {
 public:
  CatalogueUse() { InitCatalogues(); }
  CatalogueUse(const CatalogueUse&) = delete;
  CatalogueUse& operator=(const CatalogueUse&) = delete;
  ~CatalogueUse() { ReleaseCatalogues(); }
};

std::string FunctionRow(const CatalogueFunction& function) {
  return std::to_string(function.id) + '\t' + function.name + '\t' + std::to_string(function.functionClass) +
         '\t' + std::to_string(function.argumentCount) + '\t' + JoinedArguments(function);
}

std::string BuiltinRow(const CatalogueBuiltin& row) {
  std::string text = std::to_string(row.id) + '\t' + std::string(row.name) + '\t' + std::to_string(row.kind);
  for (const std::string_view part : {LayerText(row.layer), VariationText(row.variation), row.unit}) {
    text += '\t';
    text += part;
  }
  for (const double number : {row.defaultValue, row.minimum, row.maximum}) text += '\t' + NumberText(number);
  return text + '\t' + (IsDeprecatedBuiltin(row.id) ? "1" : "0");
}

/// Calls the evaluator of a row; nothing, with a diagnostic, when that cannot be done.
std::optional<double> CallRow(const std::string& name, const std::vector<double>& values) {
  const CatalogueFunction* function = FindFunction(name);
  if (function == nullptr) {
    Complain("no function '" + name + "'");
    return std::nullopt;
  }
  if (function->argumentCount != static_cast<std::int32_t>(values.size())) {
    Complain(function->name + " takes " + std::to_string(function->argumentCount) + " values, not " +
             std::to_string(values.size()));
    return std::nullopt;
  }
  if (function->evaluator == nullptr) {
    Complain(function->name + " has no evaluator: the simulation engine computes it");
    return std::nullopt;
  }
  return function->evaluator(values);
}

/// A setting of the form NAME=V,V...
bool ApplySetting(const std::string& setting, ExitCode& exitCode) {
  const std::size_t sign = setting.find('=');
  const auto values = sign == std::string::npos
                          ? std::nullopt
                          : NumbersOf(SplitAtCommas(std::string_view(setting).substr(sign + 1)));
  if (!values) {
    Complain("a setting is NAME=VALUE,VALUE...: '" + setting + "'");
    exitCode = kCallFault;
    return false;
  }
  exitCode = kContentFault;
  return CallRow(setting.substr(0, sign), *values).has_value();
}

std::optional<std::vector<double>> ValuesOrComplain(const std::vector<std::string>& texts) {
  auto values = NumbersOf(texts);
  if (!values) Complain("a value is no number");
  return values;
}

}  // namespace

ExitCode RunFunctions() {
  for (const CatalogueFunction& function : Functions()) PrintLine(FunctionRow(function));
  return kFine;
}

ExitCode RunFunction(const std::string& name) {
  const CatalogueFunction* function = FindFunction(name);
  if (function == nullptr) return kContentFault;
  PrintLine(FunctionRow(*function));
  return kFine;
}

ExitCode RunBuiltins() {
  for (const CatalogueBuiltin& row : Builtins()) PrintLine(BuiltinRow(row));
  return kFine;
}

ExitCode RunEval(const std::string& name, const std::vector<std::string>& values) {
  const CatalogueUse catalogues;
  const auto numbers = ValuesOrComplain(values);
  if (!numbers) return kCallFault;
  double value = 0.0;
  if (EvaluateFunction(name, *numbers, value) == 0) return kContentFault;
  PrintLine(NumberText(value));
  return kFine;
}

ExitCode RunCall(const std::string& name, const std::vector<std::string>& values,
                 const std::vector<std::string>& settings) {
  const CatalogueUse catalogues;
  const auto numbers = ValuesOrComplain(values);
  if (!numbers) return kCallFault;
  for (const std::string& setting : settings) {
    ExitCode exitCode = kFine;
    if (!ApplySetting(setting, exitCode)) return exitCode;
  }
  const std::optional<double> value = CallRow(name, *numbers);
  if (!value) return kContentFault;
  PrintLine(NumberText(*value));
  return kFine;
}

}  // namespace tessal::cli
