#include "core/expression_faults.h"

#include <algorithm>
#include <optional>
#include <unordered_map>
#include <unordered_set>

#include "core/completion.h"
#include "core/template_core.h"
#include "expr/builtin_catalogue.h"
#include "expr/token_spans.h"

namespace tessal {

namespace {

/// The names of an expression, looked up in one pass over the template.
class NameFaults final {
 public:
  NameFaults(const TemplateCore& templateCore, const CEL_Element& userElement, std::string_view checked)
      : core(templateCore), user(userElement), text(checked) {}

  std::vector<ExpressionFault> Find() {
    for (const TokenSpan& token : TokenSpans(text)) {
      if (token.code == TokenCode::Identifier) names.emplace(TextOf(text, token), token.span);
    }
    if (names.empty()) return {};
    LookUp();
    std::vector<ExpressionFault> faults;
    for (const auto& [name, span] : names) {
      if (auto fault = FaultOf(name)) {
        fault->at = span;
        faults.push_back(*fault);
      }
    }
    return faults;
  }

 private:
  void LookUp() {
    for (const SymbolRecord& record : core.SymbolTable()) {
      const std::string_view symbol = record.element->symbol.Text();
      // The first of a shared symbol counts.
      if (names.contains(symbol)) known.emplace(symbol, &record);
    }
  }

  std::optional<ExpressionFault> FaultOf(std::string_view name) const {
    if (const auto hit = known.find(name); hit != known.end()) return FaultOfUse(*hit->second);
    if (core.CountsAsDefined(name)) return std::nullopt;
    ExpressionFault fault;
    fault.plain = "Nothing has the symbol " + std::string(name) + "." + Nearest(name);
    return fault;
  }

  std::optional<ExpressionFault> FaultOfUse(const SymbolRecord& used) const {
    const SymbolRecord* record = core.RecordOfElement(user);
    if (record == nullptr) return std::nullopt;
    const std::optional<Finding> finding = core.FindUseFault(*record, used);
    if (!finding) return std::nullopt;
    ExpressionFault fault;
    fault.words = finding->text;
    fault.plain = finding->message->meaning;
    return fault;
  }

  std::string Nearest(std::string_view name) const {
    std::vector<std::string_view> symbols;
    for (const Completion& completion : CompletionsFor(core, user, CaretPlace::Value)) {
      const bool isName =
          completion.group == CompletionGroup::Symbol || completion.group == CompletionGroup::Builtin;
      if (isName) symbols.push_back(completion.text);
    }
    const bool isBuiltin = std::any_of(Builtins().begin(), Builtins().end(),
                                       [name](const CatalogueBuiltin& row) { return row.name == name; });
    return isBuiltin ? " It is a built-in, which a constant or a forcing can represent."
                     : NearNamesText(name, symbols);
  }

  const TemplateCore& core;
  const CEL_Element& user;
  std::string_view text;
  std::unordered_map<std::string_view, LexemeSpan> names;  ///< where each is first
  std::unordered_map<std::string_view, const SymbolRecord*> known;
};

}  // namespace

std::vector<ExpressionFault> FindExpressionFaults(const TemplateCore& core, const CEL_Element& user,
                                                  std::string_view text) {
  std::vector<ExpressionFault> faults = FindLanguageFaults(text);
  if (!faults.empty() && faults.front().isSyntax) return faults;
  for (ExpressionFault& fault : NameFaults(core, user, text).Find()) {
    // A call is judged by the language.
    const bool isKnown = std::any_of(faults.begin(), faults.end(), [&fault](const ExpressionFault& other) {
      return other.at.start == fault.at.start;
    });
    if (!isKnown) faults.push_back(std::move(fault));
  }
  std::stable_sort(faults.begin(), faults.end(),
                   [](const ExpressionFault& left, const ExpressionFault& right) {
                     return left.at.start < right.at.start;
                   });
  return faults;
}

}  // namespace tessal
