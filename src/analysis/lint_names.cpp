// Rules about symbols that are easily taken for others.
#include <string>
#include <unordered_map>

#include "analysis/declared_values.h"
#include "analysis/lint_rules.h"
#include "core/template_core.h"
#include "expr/function_catalogue.h"
#include "expr/user_function_names.h"
#include "platform/ascii.h"

namespace tessal {

namespace {

constexpr std::string_view kDigits = "0123456789";

/// Calls the visitor with each record that has a symbol, and the symbol.
template <class Visitor>
void ForEachSymbol(const LintSubject& subject, Visitor visit) {
  for (const SymbolRecord& record : subject.Records()) {
    const std::string_view symbol = record.element->symbol.Text();
    if (HasUsableSymbol(record) && !symbol.empty()) visit(record, symbol);
  }
}

/// What the numbered symbols of one name are: the only one, while there is only one.
struct NumberedSymbols {
  const SymbolRecord* first = nullptr;
  std::size_t count = 0;
};

/// The function that a symbol is the name of in other letters' case; empty for none.
std::string_view FunctionLike(std::string_view symbol) {
  const CatalogueFunction* function = FindFunction(symbol);
  if (function != nullptr) return function->traits.isDeprecated ? std::string_view() : function->name;
  return IsUserFunctionName(symbol) ? symbol : std::string_view();
}

}  // namespace

void FindSymbolsThatDifferByCase(const LintSubject& subject, const Message& message, LintFindings& findings) {
  std::unordered_map<std::string, std::string_view> met;
  ForEachSymbol(subject, [&](const SymbolRecord& record, std::string_view symbol) {
    const auto [place, isNew] = met.emplace(UpperCase(symbol), symbol);
    if (!isNew && place->second != symbol) findings.Add(record, {message, {symbol, place->second}});
  });
}

void FindSymbolsThatDifferByDigit(const LintSubject& subject, const Message& message,
                                  LintFindings& findings) {
  std::unordered_map<std::string_view, NumberedSymbols> numbered;
  ForEachSymbol(subject, [&](const SymbolRecord& record, std::string_view symbol) {
    const std::size_t last = symbol.find_last_not_of(kDigits);
    if (last == std::string_view::npos || last + 1 == symbol.size()) return;
    NumberedSymbols& family = numbered[symbol.substr(0, last + 1)];
    if (family.count++ == 0) family.first = &record;
  });
  ForEachSymbol(subject, [&](const SymbolRecord& record, std::string_view symbol) {
    const auto family = numbered.find(symbol);
    // Several numbers are a family, and a zero marks a first or a reference value.
    if (family == numbered.end() || family->second.count != 1) return;
    const SymbolRecord& other = *family->second.first;
    const std::string_view otherSymbol = other.element->symbol.Text();
    // Units that differ, and kinds that do, keep the two apart.
    if (otherSymbol.substr(symbol.size()) == "0" || other.kind != record.kind ||
        DeclaredUnit(*other.element) != DeclaredUnit(*record.element)) {
      return;
    }
    findings.Add(other, {message, {otherSymbol, symbol}});
  });
}

void FindSymbolsOfFunctions(const LintSubject& subject, const Message& message, LintFindings& findings) {
  ForEachSymbol(subject, [&](const SymbolRecord& record, std::string_view symbol) {
    const std::string_view function = FunctionLike(symbol);
    if (!function.empty()) findings.Add(record, {message, {symbol, function}});
  });
}

}  // namespace tessal
