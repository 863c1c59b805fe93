// Commands on the catalogues: their rows, and the values of their functions.
#include <nlohmann/json.hpp>
#include <optional>

#include "cli/commands.h"
#include "cli/numbers.h"
#include "docgen/reference_pages.h"
#include "expr/builtin_catalogue.h"
#include "expr/builtin_reference.h"
#include "expr/evaluate.h"
#include "expr/function_catalogue.h"
#include "expr/function_reference.h"
#include "platform/ascii.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

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

Json Described(const CatalogueFunction& function) {
  const FunctionReference& row = *ReferenceOfFunction(function.name);
  Json arguments = Json::array();
  for (const ArgumentReference& argument : row.arguments) {
    arguments.push_back({{"name", argument.name}, {"meaning", argument.meaning}, {"unit", argument.unit}});
  }
  return {{"name", row.name},
          {"group", GroupOfFunction(row).title},
          {"purpose", row.purpose},
          {"arguments", arguments},
          {"result", {{"meaning", row.result}, {"unit", row.resultUnit}, {"range", row.range}}},
          {"source", row.source},
          {"formulae", FormulaeOf(row)},
          {"deprecated", function.traits.isDeprecated}};
}

Json Described(const CatalogueBuiltin& builtin) {
  const BuiltinReference& row = *ReferenceOfBuiltin(builtin.name);
  return {{"name", row.name},
          {"kind", builtin.kind},
          {"purpose", row.purpose},
          {"use", row.use},
          {"unit", row.unit},
          {"default", builtin.defaultValue},
          {"minimum", builtin.minimum},
          {"maximum", builtin.maximum},
          {"deprecated", IsDeprecatedBuiltin(builtin.id)}};
}

ReferenceEntry EntryOfRow(const CatalogueFunction& function) {
  return EntryOf(*ReferenceOfFunction(function.name));
}

ReferenceEntry EntryOfRow(const CatalogueBuiltin& builtin) {
  return EntryOf(builtin);
}

/// One of the catalogues, as the commands that list and describe it see it.
template <class Row>
struct Catalogue {
  std::string_view kind;  ///< what a row is called
  const std::vector<Row>& (*rows)();
  std::string (*line)(const Row& row);
  ReferencePage (*page)();
};

constexpr Catalogue<CatalogueFunction> kFunctions{"function", Functions, FunctionRow, PageOfFunctions};
constexpr Catalogue<CatalogueBuiltin> kBuiltins{"built-in variable", Builtins, BuiltinRow, PageOfBuiltins};

/// A diagnostic that no row has the name, with the names that may have been meant.
template <class Row>
void ComplainOfName(const Catalogue<Row>& catalogue, const std::string& name) {
  std::vector<std::string_view> names;
  for (const Row& row : catalogue.rows()) names.emplace_back(row.name);
  std::string complaint = "no " + std::string(catalogue.kind) + " '" + OnOneLine(name) + "'";
  std::string_view separator = "; did you mean ";
  for (const std::string_view nearest : NearestNames(name, names)) {
    complaint += separator;
    complaint += nearest;
    separator = ", ";
  }
  Complain(complaint);
}

/// The rows that a question is about: all, or the one of a name in any case, if there is one.
template <class Row>
std::vector<const Row*> RowsAskedFor(const Catalogue<Row>& catalogue, const CatalogueQuestion& question) {
  std::vector<const Row*> rows;
  for (const Row& row : catalogue.rows()) {
    if (!question.name || EqualIgnoringCase(row.name, *question.name)) rows.push_back(&row);
  }
  return rows;
}

template <class Row>
void PrintDescriptions(const std::vector<const Row*>& rows, Format format) {
  if (format == Format::Json) {
    const EndsWithoutMemory end;
    Json list = Json::array();
    for (const Row* row : rows) list.push_back(Described(*row));
    PrintLine(list.dump());
    return;
  }
  for (const Row* row : rows) {
    if (row != rows.front()) PrintLine("");
    const ReferenceEntry entry = EntryOfRow(*row);
    Print(format == Format::Markdown ? EntryMarkdown(entry)
          : format == Format::Html   ? EntryHtml(entry)
                                     : EntryText(entry));
  }
}

template <class Row>
ExitCode AnswerFrom(const Catalogue<Row>& catalogue, const CatalogueQuestion& question) {
  const std::vector<const Row*> rows = RowsAskedFor(catalogue, question);
  if (rows.empty()) {
    ComplainOfName(catalogue, *question.name);
    return kContentFault;
  }
  const bool isPage =
      !question.name && (question.format == Format::Markdown || question.format == Format::Html);
  if (!question.describe) {
    for (const Row* row : rows) PrintLine(catalogue.line(*row));
  } else if (isPage) {
    const ReferencePage page = catalogue.page();
    Print(question.format == Format::Html ? PageHtml(page) : PageMarkdown(page));
  } else {
    PrintDescriptions(rows, question.format);
  }
  return kFine;
}

/// Calls the evaluator of a row; nothing, with a diagnostic, when that cannot be done.
std::optional<double> CallRow(const std::string& name, const std::vector<double>& values) {
  const CatalogueFunction* function = FindFunction(name);
  if (function == nullptr) {
    ComplainOfName(kFunctions, name);
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

ExitCode RunFunctions(const CatalogueQuestion& question) {
  return AnswerFrom(kFunctions, question);
}

ExitCode RunBuiltins(const CatalogueQuestion& question) {
  return AnswerFrom(kBuiltins, question);
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
