#include "core/scope_rule.h"

#include <algorithm>
#include <array>
#include <optional>

#include "core/error_registry.h"
#include "core/template_core.h"

namespace tessal {

namespace {

struct CodeRow {
  std::string_view text;
  std::int32_t code;
};

constexpr std::array<CodeRow, 5> kScopes = {{
    {"Global", scope_code::kGlobal},
    {"WS", scope_code::kWaterSurface},
    {"WB", scope_code::kWaterBottom},
    {"SED", scope_code::kSediment},
    {"WC", scope_code::kWaterColumn},
}};

// Spelt as the files spell them: "HORIZONTAL" is no known value.
constexpr std::array<CodeRow, 3> kSpatialVariations = {{
    {"NONE", spatial_code::kNone},
    {"HORISONTAL", spatial_code::kHorizontal},
    {"HORISONTAL_AND_VERTICAL", spatial_code::kHorizontalAndVertical},
}};

template <std::size_t Count>
std::int32_t CodeOf(const std::array<CodeRow, Count>& rows, std::string_view text, std::int32_t otherwise) {
  const auto hit =
      std::find_if(rows.begin(), rows.end(), [text](const CodeRow& row) { return row.text == text; });
  return hit == rows.end() ? otherwise : hit->code;
}

/// What does not vary in space uses nothing that does; what varies horizontally in the water column uses
/// nothing of the water column that varies in all three dimensions.
bool ViolatesScopeRule(const SymbolRecord& user, const SymbolRecord& used) {
  const bool bothInColumn = user.scope == scope_code::kWaterColumn && used.scope == scope_code::kWaterColumn;
  if (bothInColumn && user.spatial == spatial_code::kHorizontal) {
    return used.spatial == spatial_code::kHorizontalAndVertical;
  }
  return user.spatial == spatial_code::kNone && used.spatial != spatial_code::kNone;
}

/// What a use violates of the process rule; nothing when it is allowed.
std::optional<Message> ProcessRuleViolation(const SymbolRecord& user, const SymbolRecord& used) {
  constexpr std::optional<Message> kAllowed;
  constexpr Message kNoProcess = "no-process-by-rule";
  constexpr Message kInvalidScope = "scope-violated-by-rule";
  const ElementKind userKind = user.element->Kind();
  const ElementKind usedKind = used.element->Kind();
  if (userKind == ElementKind::StateVariable) return usedKind == ElementKind::Process ? kAllowed : kNoProcess;
  if (userKind != ElementKind::Auxiliary && userKind != ElementKind::Process) return {};
  switch (usedKind) {
    case ElementKind::Constant:
    case ElementKind::Forcing:
    case ElementKind::Auxiliary:
      return used.spatial <= user.spatial ? kAllowed : kInvalidScope;
    case ElementKind::Process:
      if (userKind == ElementKind::Auxiliary) return {};
      return used.scope != scope_code::kGlobal ? kAllowed : kInvalidScope;
    case ElementKind::StateVariable:
      return used.scope != scope_code::kGlobal ? kAllowed : kInvalidScope;
    default:
      return {};
  }
}

}  // namespace

std::int32_t ScopeFromText(std::string_view text) {
  return CodeOf(kScopes, text, scope_code::kNone);
}

std::int32_t SpatialFromText(std::string_view text) {
  return CodeOf(kSpatialVariations, text, spatial_code::kUnknown);
}

std::int32_t SpatialFromScope(std::int32_t scope) {
  switch (scope) {
    case scope_code::kGlobal:
      return spatial_code::kNone;
    case scope_code::kWaterSurface:
    case scope_code::kWaterBottom:
    case scope_code::kSediment:
      return spatial_code::kHorizontal;
    case scope_code::kWaterColumn:
      return spatial_code::kHorizontalAndVertical;
    default:
      return spatial_code::kUnknown;
  }
}

bool TemplateCore::CheckScopeRule() const {
  bool good = true;
  for (const SymbolRecord& user : symbolTable) {
    if (user.element->Kind() >= ElementKind::Specie) continue;
    for (const std::uint32_t sequence : user.references) {
      const SymbolRecord& used = Record(sequence);
      if (!ViolatesScopeRule(user, used)) continue;
      Errors().ReportCheck(user.element->symbol.Text(), user.element->GetUid(),
                           {"scope-violated", {RecordSymbol(used)}});
      good = false;
    }
  }
  return good;
}

bool TemplateCore::CheckProcessRule() const {
  bool good = true;
  for (const SymbolRecord& user : symbolTable) {
    for (const std::uint32_t sequence : user.references) {
      const SymbolRecord& used = Record(sequence);
      const std::optional<Message> violation = ProcessRuleViolation(user, used);
      if (!violation) continue;
      Errors().ReportCheck(user.element->symbol.Text(), user.element->GetUid(),
                           {*violation, {RecordSymbol(used)}});
      good = false;
    }
  }
  return good;
}

}  // namespace tessal
