// The check pass: every element checks itself, and the rules of order and scope run over the symbol table.
// All findings go to the error registry; nothing stops at its first one.
#include "core/declaration_order.h"
#include "core/error_registry.h"
#include "core/scope_rule.h"
#include "core/template_core.h"
#include "elements/element_checks.h"
#include "expr/scanner.h"
#include "expr/user_function_names.h"

namespace tessal {

namespace {

/// Whether what a check finds depends on the element and the names of user functions alone.
bool IsCheckedAlone(ElementKind kind) {
  return kind != ElementKind::Specie && kind != ElementKind::SpatialFunction;
}

/// Checks an element, unless a check of it as it is has found nothing. Checks that start in a comment, or
/// leave one open for the next, are always made.
bool CheckElement(CEL_Element& element) {
  const auto isAtRest = [] { return ExpressionScannerStart() == ScannerStart::Text; };
  const bool startsAtRest = isAtRest();
  const std::uint32_t names = UserFunctionNamesVersion();
  if (startsAtRest && element.Facts().cleanSince == names) return true;
  const std::size_t messages = Errors().Records().size();
  const bool good = element.Check();
  const bool foundNothing = good && Errors().Records().size() == messages;
  if (foundNothing && startsAtRest && isAtRest() && IsCheckedAlone(element.Kind())) {
    element.Facts().cleanSince = names;
  }
  return good;
}

/// Runs one check of each element of a sequence; the result of all together.
template <class Elements>
bool CheckAll(const Elements& elements) {
  bool good = true;
  for (const auto& element : elements) good = CheckElement(*element) && good;
  return good;
}

template <class Elements>
bool ParseAll(const Elements& elements) {
  bool good = true;
  for (const auto& element : elements) good = element->ParseExpression() && good;
  return good;
}

bool CheckSpecie(CEL_Lagrange_Specie& specie) {
  bool good = specie.Check();
  specie.ForEachMember([&good](CEL_Element& member) {
    // The forcings of a class stay unchecked, unlike those of the template.
    if (member.Kind() != ElementKind::SpecieForcing) good = CheckElement(member) && good;
  });
  return good;
}

bool CheckRootText(const CEL_Element& root) {
  if (!HoldsIllegalText(root)) return true;
  Errors().ReportCheck("Tessal Setup", root.GetUid(), {"illegal-text"});
  return false;
}

}  // namespace

bool TemplateCore::ValidateTemplate() {
  Errors().ResetExpressionWarningCount();
  bool good = true;
  ForEachHeadedCollection(
      [this, &good](const auto& row) { good = CheckAll(Elements().*row.elements) && good; });
  good = CheckDeclarationOrder() && good;
  for (const auto& specie : Species()) good = CheckSpecie(*specie) && good;
  good = (state.flags.strictScopeRule ? CheckScopeRule() : CheckProcessRule()) && good;
  good = CheckRootText(state.root) && good;
  // Also for a template without settings, on their default values.
  return state.misc.Check() && good;
}

bool TemplateCore::ParseAllExpressions() {
  bool good = true;
  ForEachHeadedCollection([this, &good](const auto& row) {
    if (row.kind != ElementKind::StateVariable) good = ParseAll(Elements().*row.elements) && good;
  });
  // Equations come after what they use.
  good = ParseAll(StateVariables()) && good;
  return ParseAll(Species()) && good;
}

std::optional<Finding> TemplateCore::FindUseFault(const SymbolRecord& user, const SymbolRecord& used) const {
  if (user.kind > ElementKind::Specie)
    return ClassOf(Elements(), user).FindUseFault(*user.element, *used.element);
  if (auto fault = OrderViolation(user, used)) return fault;
  const auto message =
      state.flags.strictScopeRule ? ScopeRuleViolation(user, used) : ProcessRuleViolation(user, used);
  return message ? std::optional(Finding(*message, {RecordSymbol(used)})) : std::nullopt;
}

bool TemplateCore::CheckElementOrder(Uid uid) const {
  const SymbolRecord* record = FindRecordByUid(uid);
  return record == nullptr || CheckRecordOrder(state.table, *record);
}

bool TemplateCore::CheckDeclarationOrder() const {
  return tessal::CheckDeclarationOrder(state.table);
}

bool TemplateCore::CheckScopeRule() const {
  return tessal::CheckScopeRule(state.table);
}

bool TemplateCore::CheckProcessRule() const {
  return tessal::CheckProcessRule(state.table);
}

}  // namespace tessal
