#include "core/scope_rule.h"

#include "core/error_registry.h"
#include "core/symbol_table.h"
#include "elements/element.h"

namespace tessal {

// What does not vary in space uses nothing that does; what varies horizontally in the water column uses
// nothing of the water column that varies in all three dimensions.
std::optional<Message> ScopeRuleViolation(const SymbolRecord& user, const SymbolRecord& used) {
  if (user.kind >= ElementKind::Specie) return std::nullopt;
  const bool bothInColumn = user.scope == Scope::WaterColumn && used.scope == Scope::WaterColumn;
  constexpr Message kViolated = "scope-violated";
  const bool violated =
      bothInColumn && user.spatial == SpatialVariation::Horizontal
          ? used.spatial == SpatialVariation::HorizontalAndVertical
          : user.spatial == SpatialVariation::None && used.spatial != SpatialVariation::None;
  return violated ? std::optional(kViolated) : std::nullopt;
}

std::optional<Message> ProcessRuleViolation(const SymbolRecord& user, const SymbolRecord& used) {
  constexpr std::optional<Message> kAllowed;
  constexpr Message kNoProcess = "no-process-by-rule";
  constexpr Message kInvalidScope = "scope-violated-by-rule";
  const ElementKind userKind = user.kind;
  const ElementKind usedKind = used.kind;
  if (userKind == ElementKind::StateVariable) return usedKind == ElementKind::Process ? kAllowed : kNoProcess;
  if (userKind != ElementKind::Auxiliary && userKind != ElementKind::Process) return kAllowed;
  switch (usedKind) {
    case ElementKind::Constant:
    case ElementKind::Forcing:
    case ElementKind::Auxiliary:
      return used.spatial <= user.spatial ? kAllowed : kInvalidScope;
    case ElementKind::Process:
      if (userKind == ElementKind::Auxiliary) return kAllowed;
      return used.scope != Scope::Global ? kAllowed : kInvalidScope;
    case ElementKind::StateVariable:
      return used.scope != Scope::Global ? kAllowed : kInvalidScope;
    default:
      return kAllowed;
  }
}

namespace {

/// Reports what the rule finds in any use of the table.
template <class Rule>
bool CheckUses(const SymbolTable& table, Rule violation) {
  bool good = true;
  for (const SymbolRecord& user : table.Records()) {
    for (const std::uint32_t sequence : user.references) {
      const SymbolRecord& used = table.Used(sequence);
      const std::optional<Message> found = violation(user, used);
      if (!found) continue;
      Errors().ReportCheck(user.element->symbol.Text(), user.uid, {*found, {RecordSymbol(used)}});
      good = false;
    }
  }
  return good;
}

}  // namespace

bool CheckScopeRule(const SymbolTable& table) {
  return CheckUses(table, ScopeRuleViolation);
}

bool CheckProcessRule(const SymbolTable& table) {
  return CheckUses(table, ProcessRuleViolation);
}

}  // namespace tessal
