// Who uses whom. The expressions are only scanned, so the answer exists also for one that does not parse.
#include <algorithm>
#include <string_view>
#include <unordered_map>
#include <unordered_set>

#include "core/error_registry.h"
#include "core/template_core.h"
#include "expr/identifiers.h"
#include "expr/scanner.h"
#include "expr/semantic_checks.h"

namespace tessal {

namespace {

/// The marker of a lost reference, as it has always been spelt.
constexpr std::string_view kLostName = "unkown";
constexpr std::string_view kUnresolvedName = "unknown";

bool HoldsExpression(std::int32_t elementKind) {
  switch (elementKind) {
    case kind::kStateVariable:
    case kind::kAuxiliary:
    case kind::kProcess:
    case kind::kDerivedOutput:
    case kind::kSpecieStateVariable:
    case kind::kArithmeticExpression:
    case kind::kHorizontalVector:
    case kind::kVerticalEquation:
      return true;
    default:
      return false;
  }
}

template <class Visitor>
void ForEachSearchFunction(const Sequence<CEL_Lagrange_Specie>& species, Visitor visit) {
  for (const auto& specie : species) {
    for (const auto& function : specie->spatialFunctions) visit(*function);
  }
}

bool HasSearchFunction(const Sequence<CEL_Lagrange_Specie>& species) {
  return std::any_of(species.begin(), species.end(),
                     [](const auto& specie) { return !specie->spatialFunctions.empty(); });
}

}  // namespace

/// What the extraction looks names up in. It lives as long as the step.
struct TemplateCore::ReferenceLookup {
  std::unordered_map<std::string, std::uint32_t>
      composed;  ///< symbols of movements, which have no text of their own
  std::unordered_map<std::string_view, std::uint32_t> sequences;
  std::unordered_map<std::string_view, UndefinedSymbol*> undefined;
  /// For each record the last one that was noted to use it: an expression's second use of a symbol adds
  /// nothing.
  std::vector<std::uint32_t> lastUser;
  std::vector<std::string_view> identifiers;
};

void TemplateCore::ExtractReferences() {
  ReferenceLookup lookup;
  lookup.sequences.reserve(symbolTable.size());
  lookup.lastUser.assign(symbolTable.size() + 1, 0);
  for (const SymbolRecord& record : symbolTable) {
    const std::int32_t elementKind = record.element->Kind();
    if (elementKind == kind::kHorizontalVector || elementKind == kind::kVerticalEquation) {
      const auto entry = lookup.composed.emplace(RecordSymbol(record), record.sequence).first;
      lookup.sequences.emplace(entry->first, record.sequence);
    } else {
      lookup.sequences.emplace(record.element->symbol.Text(), record.sequence);
    }
  }
  for (const auto& undefined : undefinedSymbols) lookup.undefined.emplace(undefined->symbol, undefined.get());
  for (SymbolRecord& record : symbolTable) ExtractRecordReferences(record, lookup);
}

void TemplateCore::ExtractRecordReferences(SymbolRecord& record, ReferenceLookup& lookup) {
  const std::int32_t elementKind = record.element->Kind();
  if (elementKind == kind::kSpatialFunction) {
    const auto& function = static_cast<const CEL_Lagrange_Spatial_Function&>(*record.element);
    if (function.variableId.IntValue() >= 1) Refer(record, function.VariableName(), lookup);
    return;
  }
  if (!HoldsExpression(elementKind)) return;
  ScanIdentifiers(StripExpressionQuotes(record.text), lookup.identifiers);
  for (const std::string_view name : lookup.identifiers) Refer(record, name, lookup);
}

void TemplateCore::Refer(SymbolRecord& record, std::string_view name, ReferenceLookup& lookup) {
  const auto hit = lookup.sequences.find(name);
  if (hit == lookup.sequences.end()) {
    NoteUndefined(name, record.element->GetUid(), lookup);
    return;
  }
  std::uint32_t& lastUser = lookup.lastUser[hit->second];
  if (lastUser == record.sequence) return;
  lastUser = record.sequence;
  record.references.push_back(hit->second);
  record.referenceUids.push_back(Record(hit->second).element->GetUid());
}

bool TemplateCore::CountsAsDefined(std::string_view name) const {
  if (IsReservedName(name) || IsPropertyName(name)) return true;
  const auto& functions = misc.ExternalFunctions();
  return std::any_of(functions.begin(), functions.end(),
                     [name](const auto& function) { return function->publicName.Text() == name; });
}

void TemplateCore::NoteUndefined(std::string_view name, std::uint32_t uid, ReferenceLookup& lookup) {
  const auto known = lookup.undefined.find(name);
  if (known == lookup.undefined.end()) {
    if (CountsAsDefined(name)) return;
    auto undefined = std::make_unique<UndefinedSymbol>();
    undefined->symbol = name;
    undefined->usedBy.push_back(uid);
    lookup.undefined.emplace(undefined->symbol, undefined.get());
    undefinedSymbols.push_back(std::move(undefined));
    return;
  }
  UndefinedSymbol& undefined = *known->second;
  // A name may have become a reserved one since the last rebuild: a user function has taken it.
  if (undefined.stale && CountsAsDefined(name)) return;
  undefined.stale = false;
  // The uses of one element come one after the other, so a repeat can only be the last entry.
  if (undefined.usedBy.empty() || undefined.usedBy.back() != uid) undefined.usedBy.push_back(uid);
}

void TemplateCore::BuildReverseReferences() {
  for (const SymbolRecord& user : symbolTable) {
    const std::uint32_t uid = user.element == nullptr ? kNoUid : user.element->GetUid();
    for (const std::uint32_t sequence : user.references) {
      SymbolRecord& used = Record(sequence);
      used.referencedBy.push_back(user.sequence);
      // The two records of a movement share an identity and stand side by side.
      if (used.referencedByUids.empty() || used.referencedByUids.back() != uid) {
        used.referencedByUids.push_back(uid);
      }
    }
  }
}

void TemplateCore::ClassifyArithmeticExpressions() {
  for (const auto& specie : species) {
    std::unordered_set<const CEL_Element*> usedByEquations;
    for (const auto& variable : specie->stateVariables) {
      for (const std::uint32_t sequence :
           Record(static_cast<std::uint32_t>(variable->id.IntValue())).references) {
        usedByEquations.insert(Record(sequence).element);
      }
    }
    for (const auto& expression : specie->arithmeticExpressions) {
      expression->Classify(usedByEquations.contains(expression.get()));
    }
  }
}

void TemplateCore::ResolveReferencesToNames() {
  if (!HasSearchFunction(species)) return;
  std::unordered_map<std::int32_t, const CEL_Element*> byId;
  ForEachNamedElement([&byId](const CEL_Element& element) { byId.emplace(element.id.IntValue(), &element); });
  ForEachSearchFunction(species, [&byId](CEL_Lagrange_Spatial_Function& function) {
    const std::int32_t number = function.variableId.IntValue();
    const auto hit = number > 0 ? byId.find(number) : byId.end();
    function.SetVariableName(hit == byId.end() ? kLostName : std::string_view(hit->second->symbol.Text()));
  });
}

void TemplateCore::ResolveNamesToReferences() {
  if (!HasSearchFunction(species)) return;
  std::unordered_map<std::string_view, const CEL_Element*> byName;
  ForEachNamedElement(
      [&byName](const CEL_Element& element) { byName.emplace(element.symbol.Text(), &element); });
  ForEachSearchFunction(species, [&byName](CEL_Lagrange_Spatial_Function& function) {
    if (function.VariableName() == kUnresolvedName) return;
    const auto hit = byName.find(function.VariableName());
    if (hit != byName.end()) function.variableId.SetInt(hit->second->id.IntValue());
  });
}

bool TemplateCore::CheckElementOrder(std::uint32_t uid) const {
  const SymbolRecord* record = FindRecordByUid(uid);
  return record == nullptr || CheckRecordOrder(*record);
}

bool TemplateCore::CheckRecordOrder(const SymbolRecord& record) const {
  const CEL_Element& user = *record.element;
  bool good = true;
  for (const std::uint32_t sequence : record.references) {
    const CEL_Element& used = *Record(sequence).element;
    std::string text;
    if (user.Kind() == kind::kStateVariable) {
      if (used.Kind() == kind::kProcess) continue;
      text = "The symbol '" + used.symbol.Text() + "' is not a process!";
    } else {
      if (sequence <= static_cast<std::uint32_t>(user.id.IntValue())) continue;
      text = "The symbol '" + used.symbol.Text() + "' can not be used as it is declared after '" +
             RecordSymbol(record) + "'!";
    }
    Errors().AddError(ErrorLevel::Critical, RecordSymbol(record), user.MessageUid(), text);
    good = false;
  }
  return good;
}

bool TemplateCore::CheckDeclarationOrder() const {
  bool good = true;
  for (const SymbolRecord& record : symbolTable) {
    switch (record.element->Kind()) {
      case kind::kStateVariable:
      case kind::kAuxiliary:
      case kind::kProcess:
      case kind::kDerivedOutput:
        good = CheckRecordOrder(record) && good;
        break;
      default:
        break;
    }
  }
  return good;
}

}  // namespace tessal
