// The structural pass over a template: it numbers the elements, makes their records and finds who uses whom.
// The expressions are only scanned, so the answer exists also for one that does not parse.
#include <algorithm>
#include <array>
#include <numeric>
#include <unordered_map>
#include <unordered_set>
#include <utility>

#include "core/collections.h"
#include "core/search_functions.h"
#include "core/symbol_index.h"
#include "core/symbol_table.h"
#include "elements/miscellaneous.h"
#include "expr/identifiers.h"
#include "expr/scanner.h"
#include "expr/semantic_checks.h"

namespace tessal {

/// One rebuild: what it works on, and what it looks names up in.
class SymbolTable::RebuildSteps final {
 public:
  RebuildSteps(SymbolTable& table, const Collections& all, const CEL_Miscanellous& misc)
      : records(table.records), undefined(table.undefined), collections(all), settings(misc) {}

  void Run() {
    MarkUndefinedStale();
    ResolveReferencesToNames(collections);
    NumberTemplateElements();
    NumberParticleElements();
    records.resize(count);
    ExtractReferences();
    BuildReverseReferences();
    ClassifyArithmeticExpressions();
    ResolveNamesToReferences(collections);
    std::erase_if(undefined, [](const auto& name) { return name->stale; });
  }

 private:
  void MarkUndefinedStale();
  SymbolRecord& Append(CEL_Element& element, std::size_t index, std::int32_t specieIndex,
                       std::string_view text);
  SymbolRecord& AppendElement(CEL_Element& element, std::size_t index, std::int32_t specieIndex);
  void NumberTemplateElements();
  void NumberParticleElements();
  void ExtractReferences();
  void ExtractRecordReferences(SymbolRecord& record, SymbolIndex& symbols);
  void Refer(SymbolRecord& record, std::string_view name, SymbolIndex& symbols);
  void NoteUndefined(std::string_view name, Uid uid);
  bool CountsAsDefined(std::string_view name) const;
  void BuildReverseReferences();
  void ClassifyArithmeticExpressions();

  std::vector<SymbolRecord>& records;
  std::vector<std::unique_ptr<UndefinedSymbol>>& undefined;
  const Collections& collections;
  const CEL_Miscanellous& settings;
  std::size_t count = 0;  ///< records made so far
  std::vector<const CEL_Property*> expressions;
  std::unordered_map<std::string_view, UndefinedSymbol*> undefinedByName;
  /// For each record the last one that was noted to use it: an expression's second use of a symbol adds
  /// nothing.
  std::vector<std::uint32_t> lastUser;
  std::vector<std::string_view> identifiers;
};

void SymbolTable::Rebuild(const Collections& collections, const CEL_Miscanellous& settings) {
  RebuildSteps(*this, collections, settings).Run();
}

void SymbolTable::RebuildSteps::MarkUndefinedStale() {
  for (const auto& name : undefined) {
    name->stale = true;
    name->usedBy.clear();
  }
}

SymbolRecord& SymbolTable::RebuildSteps::Append(CEL_Element& element, std::size_t index,
                                                std::int32_t specieIndex, std::string_view text) {
  // A record is made in the place of the one before the rebuild, whose buffers it takes over.
  if (count == records.size()) records.emplace_back();
  SymbolRecord& record = records[count];
  const SymbolRecord* before = count == 0 ? nullptr : &records[count - 1];
  ++count;
  record.sequence = static_cast<std::uint32_t>(count);
  record.scope = before == nullptr ? Scope::Global : before->scope;
  record.spatial = before == nullptr ? SpatialVariation::None : before->spatial;
  record.index = index;
  record.specieIndex = specieIndex;
  record.text = text;
  for (auto* list : {&record.references, &record.referencedBy}) list->clear();
  for (auto* list : {&record.referenceUids, &record.referencedByUids}) list->clear();
  record.element = &element;
  record.uid = element.GetUid();
  element.id.SetInt(static_cast<std::int32_t>(record.sequence));
  return record;
}

/// Appends a record for each expression of the element, or one without; the last one appended.
SymbolRecord& SymbolTable::RebuildSteps::AppendElement(CEL_Element& element, std::size_t index,
                                                       std::int32_t specieIndex) {
  expressions.clear();
  element.ForEachExpression(
      [this](const PropertyRow&, const CEL_Property& expression) { expressions.push_back(&expression); });
  if (expressions.empty()) return Append(element, index, specieIndex, element.RecordText());
  // Against the order of the file: a movement's direction is numbered before its speed.
  for (std::size_t left = expressions.size(); left > 1; --left) {
    Append(element, index, specieIndex, expressions[left - 1]->Text());
  }
  return Append(element, index, specieIndex, expressions.front()->Text());
}

void SymbolTable::RebuildSteps::NumberTemplateElements() {
  ForEachHeadedCollection([this](const auto& row) {
    std::size_t index = 0;
    for (const auto& element : collections.*row.elements) {
      if constexpr (requires { element->scope; }) {
        SymbolRecord& record = AppendElement(*element, index++, -1);
        record.scope = ScopeFromText(element->scope.Text());
        if constexpr (requires { element->spatialVariation; }) {
          record.spatial = SpatialFromText(element->spatialVariation.Text());
        } else {
          record.spatial = SpatialFromScope(record.scope);
        }
      }
    }
  });
}

void SymbolTable::RebuildSteps::NumberParticleElements() {
  const auto& species = collections.species;
  const auto append = [this, &species](bool withHead, std::size_t place) {
    ForEachMemberList([this, &species, withHead, place](const auto& list) {
      if (list.hasHead != withHead) return;
      std::size_t index = 0;
      for (const auto& member : (*species[place]).*list.members) {
        AppendElement(*member, index++, static_cast<std::int32_t>(place));
      }
    });
  };
  for (std::size_t place = 0; place < species.size(); ++place) append(true, place);
  for (std::size_t place = 0; place < species.size(); ++place) {
    const auto specieIndex = static_cast<std::int32_t>(place);
    AppendElement(*species[place], place, specieIndex);
    append(false, place);
    AppendElement(*species[place]->verticalEquation, 0, specieIndex);
  }
}

void SymbolTable::RebuildSteps::ExtractReferences() {
  SymbolIndex symbols(records.size());
  lastUser.assign(records.size() + 1, 0);
  for (const SymbolRecord& record : records) {
    record.element->AppendFullSymbol(symbols.NextName());
    symbols.AddNext(record.uid);
  }
  for (const auto& name : undefined) undefinedByName.emplace(name->symbol, name.get());
  for (SymbolRecord& record : records) ExtractRecordReferences(record, symbols);
}

void SymbolTable::RebuildSteps::ExtractRecordReferences(SymbolRecord& record, SymbolIndex& symbols) {
  if (record.element->Kind() == ElementKind::SpatialFunction) {
    const auto& function = static_cast<const CEL_Lagrange_Spatial_Function&>(*record.element);
    if (function.variableId.IntValue() >= 1) Refer(record, function.VariableName(), symbols);
    return;
  }
  if (!record.element->HasExpression()) return;
  ScanIdentifiers(StripExpressionQuotes(record.text), identifiers);
  for (const std::string_view name : identifiers) Refer(record, name, symbols);
}

void SymbolTable::RebuildSteps::Refer(SymbolRecord& record, std::string_view name, SymbolIndex& symbols) {
  const std::uint32_t used = symbols.Find(name);
  if (used == 0) {
    NoteUndefined(name, record.uid);
    return;
  }
  if (std::exchange(lastUser[used], record.sequence) == record.sequence) return;
  record.references.push_back(used);
  record.referenceUids.push_back(symbols.UidOf(used));
}

bool SymbolTable::RebuildSteps::CountsAsDefined(std::string_view name) const {
  if (IsReservedName(name) || IsPropertyName(name)) return true;
  const auto& functions = settings.ExternalFunctions();
  return std::any_of(functions.begin(), functions.end(),
                     [name](const auto& function) { return function->publicName.Text() == name; });
}

void SymbolTable::RebuildSteps::NoteUndefined(std::string_view name, Uid uid) {
  const auto known = undefinedByName.find(name);
  if (known == undefinedByName.end()) {
    if (CountsAsDefined(name)) return;
    auto added = std::make_unique<UndefinedSymbol>();
    added->symbol = name;
    added->usedBy.push_back(uid);
    undefinedByName.emplace(added->symbol, added.get());
    undefined.push_back(std::move(added));
    return;
  }
  UndefinedSymbol& entry = *known->second;
  // A name may have become a reserved one since the last rebuild: a user function has taken it.
  if (entry.stale && CountsAsDefined(name)) return;
  entry.stale = false;
  // The uses of one element come one after the other, so a repeat can only be the last entry.
  if (entry.usedBy.empty() || entry.usedBy.back() != uid) entry.usedBy.push_back(uid);
}

void SymbolTable::RebuildSteps::BuildReverseReferences() {
  // The uses are sorted by the symbol used in lists of plain numbers before they go to the records: in a
  // large template a step from record to record is expensive.
  std::vector<Uid> uids(1, Uid::None);
  std::vector<std::size_t> ends(records.size() + 2, 0);  // of a symbol's uses in the list, by sequence
  for (const SymbolRecord& user : records) {
    uids.push_back(user.uid);
    for (const std::uint32_t sequence : user.references) ++ends[sequence + 1];
  }
  std::partial_sum(ends.begin(), ends.end(), ends.begin());
  std::vector<std::uint32_t> users(ends.back());
  for (const SymbolRecord& user : records) {
    for (const std::uint32_t sequence : user.references) users[ends[sequence]++] = user.sequence;
  }
  auto use = users.cbegin();
  for (SymbolRecord& used : records) {
    const auto end = users.cbegin() + static_cast<std::ptrdiff_t>(ends[used.sequence]);
    used.referencedBy.assign(use, end);
    for (; use != end; ++use) {
      // The two records of a movement share an identity and lie side by side.
      const Uid uid = uids[*use];
      if (used.referencedByUids.empty() || used.referencedByUids.back() != uid) {
        used.referencedByUids.push_back(uid);
      }
    }
  }
}

void SymbolTable::RebuildSteps::ClassifyArithmeticExpressions() {
  for (const auto& specie : collections.species) {
    std::unordered_set<const CEL_Element*> usedByEquations;
    for (const auto& variable : specie->stateVariables) {
      for (const std::uint32_t used :
           records[static_cast<std::size_t>(variable->id.IntValue() - 1)].references) {
        usedByEquations.insert(records[used - 1].element);
      }
    }
    for (const auto& expression : specie->arithmeticExpressions) {
      expression->Classify(usedByEquations.contains(expression.get()));
    }
  }
}

}  // namespace tessal
