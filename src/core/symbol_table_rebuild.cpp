// The structural pass over a template: it numbers the elements, makes their records and finds who uses whom.
// The expressions are only scanned, so the answer exists also for one that does not parse.
#include <algorithm>
#include <array>
#include <numeric>
#include <span>
#include <unordered_map>
#include <unordered_set>
#include <utility>

#include "core/collections.h"
#include "core/search_functions.h"
#include "core/symbol_table.h"
#include "elements/miscellaneous.h"
#include "expr/identifiers.h"
#include "expr/parser.h"
#include "expr/scanner.h"
#include "expr/semantic_checks.h"

namespace tessal {

/// One rebuild: what it works on, and what it knows of names.
class SymbolTable::RebuildSteps final {
 public:
  RebuildSteps(SymbolTable& rebuilt, const Collections& all, const CEL_Miscanellous& misc)
      : table(rebuilt),
        records(rebuilt.records),
        undefined(rebuilt.undefined),
        collections(all),
        settings(misc) {}

  void Run() {
    ResolveReferencesToNames(collections);
    Number();
    Finish();
  }

  void RunUnderLinks() {
    Number();
    ResolveReferencesToNames(collections);
    Finish();
  }

 private:
  void Number() {
    records.clear();
    NumberTemplateElements();
    NumberParticleElements();
  }

  void Finish() {
    MarkUndefinedStale();
    ExtractReferences();
    BuildReverseReferences();
    ClassifyArithmeticExpressions();
    ResolveNamesToReferences(collections);
    std::erase_if(undefined, [](const auto& name) { return name->stale; });
  }

  /// What a name means: 0 before anybody asked, the number of its record, or one of the two kinds after them.
  using Meaning = std::uint32_t;
  Meaning DefinedElsewhere() const { return static_cast<Meaning>(records.size() + 1); }
  Meaning FirstUndefined() const { return static_cast<Meaning>(records.size() + 2); }

  void MarkUndefinedStale();
  SymbolRecord& Append(CEL_Element& element, std::size_t index, std::int32_t specieIndex,
                       const CEL_Property* expression);
  SymbolRecord& AppendElement(CEL_Element& element, std::size_t index, std::int32_t specieIndex);
  void NumberTemplateElements();
  void NumberParticleElements();
  NameNumber NameOf(const SymbolRecord& record);
  void GiveNamesToRecords();
  void ExtractReferences();
  void ExtractRecordReferences(const SymbolRecord& record);
  bool TakeMentionsOver(std::size_t place, Mentions& taken);
  void FindMentions(const SymbolRecord& record, Mentions& found);
  void Refer(const SymbolRecord& record, NameNumber name);
  Meaning MeaningOf(NameNumber name);
  Meaning MeaningOfUnknown(std::string_view name);
  void BuildReverseReferences();
  void ClassifyArithmeticExpressions();

  SymbolTable& table;
  std::vector<SymbolRecord>& records;
  std::vector<std::unique_ptr<UndefinedSymbol>>& undefined;
  const Collections& collections;
  const CEL_Miscanellous& settings;
  std::vector<Meaning> meanings;  ///< by the numbers of names
  /// The undefined symbols of the rebuilds before this one.
  std::unordered_map<std::string_view, std::size_t> undefinedByName;
  /// For each record the last one that was noted to use it: an expression's second use of a symbol adds
  /// nothing.
  std::vector<std::uint32_t> lastUser;
  std::vector<std::string_view> identifiers;
  std::vector<std::uint32_t> formerSequences;  ///< of the records before the rebuild; 0 for none
  std::vector<Mentions> formerMentions;
  std::vector<NameNumber> formerlyMentioned;
};

void SymbolTable::Rebuild(const Collections& collections, const CEL_Miscanellous& settings) {
  RebuildSteps(*this, collections, settings).Run();
}

void SymbolTable::RebuildUnderLinks(const Collections& collections, const CEL_Miscanellous& settings) {
  RebuildSteps(*this, collections, settings).RunUnderLinks();
}

void SymbolTable::RebuildSteps::MarkUndefinedStale() {
  for (const auto& name : undefined) {
    name->stale = true;
    name->usedBy.clear();
  }
}

SymbolRecord& SymbolTable::RebuildSteps::Append(CEL_Element& element, std::size_t index,
                                                std::int32_t specieIndex, const CEL_Property* expression) {
  SymbolRecord record;
  record.sequence = static_cast<std::uint32_t>(records.size() + 1);
  record.uid = element.GetUid();
  record.element = &element;
  record.expression = expression;
  record.kind = element.Kind();
  record.index = static_cast<std::uint32_t>(index);
  record.specieIndex = specieIndex;
  if (!records.empty()) {
    record.scope = records.back().scope;
    record.spatial = records.back().spatial;
  }
  element.Renumber(static_cast<std::int32_t>(record.sequence));
  return records.emplace_back(record);
}

/// Appends a record for each expression of the element, or one without; the last one appended.
SymbolRecord& SymbolTable::RebuildSteps::AppendElement(CEL_Element& element, std::size_t index,
                                                       std::int32_t specieIndex) {
  const auto rows = element.ExpressionRows();
  const std::uint32_t former = element.Facts().sequence;
  for (std::size_t left = std::max<std::size_t>(rows.size(), 1); left > 0; --left) {
    formerSequences.push_back(former < left ? 0 : former + 1 - static_cast<std::uint32_t>(left));
  }
  element.Facts().sequence = static_cast<std::uint32_t>(formerSequences.size());
  if (rows.empty()) return Append(element, index, specieIndex, nullptr);
  // Against the order of the file: a movement's direction is numbered before its speed.
  for (std::size_t left = rows.size(); left > 1; --left) {
    Append(element, index, specieIndex, &(element.*rows[left - 1].place));
  }
  return Append(element, index, specieIndex, &(element.*rows.front().place));
}

namespace {

/// What is known of an element, its place in the water body among it.
template <class Element>
const ElementFacts& WithPlace(Element& element) {
  ElementFacts& facts = element.Facts();
  if (facts.knowsPlace) return facts;
  facts.scope = ScopeFromText(element.scope.Text());
  if constexpr (requires { element.spatialVariation; }) {
    facts.spatial = SpatialFromText(element.spatialVariation.Text());
  } else {
    facts.spatial = SpatialFromScope(facts.scope);
  }
  facts.knowsPlace = true;
  return facts;
}

bool IsMovement(ElementKind kind) {
  return kind == ElementKind::HorizontalVector || kind == ElementKind::VerticalEquation;
}

}  // namespace

void SymbolTable::RebuildSteps::NumberTemplateElements() {
  ForEachHeadedCollection([this](const auto& row) {
    std::size_t index = 0;
    for (const auto& element : collections.*row.elements) {
      if constexpr (requires { element->scope; }) {
        const ElementFacts& place = WithPlace(*element);
        SymbolRecord& record = AppendElement(*element, index++, -1);
        record.scope = place.scope;
        record.spatial = place.spatial;
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

NameNumber SymbolTable::RebuildSteps::NameOf(const SymbolRecord& record) {
  // A class is renamed without its movements, whose names begin with its.
  if (IsMovement(record.kind)) return table.names.NumberOf(record.element->FullSymbol());
  ElementFacts& facts = record.element->Facts();
  if (facts.symbolName == 0) facts.symbolName = table.names.NumberOf(record.element->symbol.Text());
  return facts.symbolName;
}

/// Of equal names the first record has the meaning.
void SymbolTable::RebuildSteps::GiveNamesToRecords() {
  table.hasSharedSymbols = false;
  for (const SymbolRecord& record : records) {
    const NameNumber name = NameOf(record);
    if (name >= meanings.size()) meanings.resize(name + 1 + records.size());
    if (meanings[name] == 0) {
      meanings[name] = record.sequence;
    } else {
      // The records of a movement share theirs, and lie side by side.
      const bool isOther = records[meanings[name] - 1].element != record.element;
      table.hasSharedSymbols = table.hasSharedSymbols || isOther;
    }
  }
}

void SymbolTable::RebuildSteps::ExtractReferences() {
  meanings.assign(table.names.End() + records.size(), 0);
  GiveNamesToRecords();
  lastUser.assign(records.size() + 1, 0);
  for (std::size_t place = 0; place < undefined.size(); ++place) {
    undefinedByName.emplace(undefined[place]->symbol, place);
  }
  formerMentions = std::exchange(table.mentions, {});
  formerlyMentioned = std::exchange(table.mentioned, {});
  table.mentions.reserve(records.size());
  table.mentioned.reserve(formerlyMentioned.size());
  // The lists move while they grow: the records get their parts of them at the end.
  std::vector<std::size_t> ends{0};
  ends.reserve(records.size() + 1);
  table.uses.clear();
  for (const SymbolRecord& record : records) {
    ExtractRecordReferences(record);
    ends.push_back(table.uses.size());
  }
  const std::span<const std::uint32_t> all(table.uses);
  for (std::size_t place = 0; place < records.size(); ++place) {
    records[place].references = all.subspan(ends[place], ends[place + 1] - ends[place]);
  }
}

void SymbolTable::RebuildSteps::ExtractRecordReferences(const SymbolRecord& record) {
  Mentions& found = table.mentions.emplace_back();
  found.element = record.element;
  found.start = static_cast<std::uint32_t>(table.mentioned.size());
  if (record.kind == ElementKind::SpatialFunction) {
    const auto& function = static_cast<const CEL_Lagrange_Spatial_Function&>(*record.element);
    if (function.variableId.IntValue() >= 1) Refer(record, table.names.NumberOf(function.VariableName()));
  } else if (record.expression != nullptr && !TakeMentionsOver(record.sequence - 1, found)) {
    FindMentions(record, found);
  }
  found.end = static_cast<std::uint32_t>(table.mentioned.size());
  for (std::uint32_t place = found.start; place < found.end; ++place) Refer(record, table.mentioned[place]);
}

/// Takes over what the rebuild before has found; false where there is nothing, or it may be different now.
bool SymbolTable::RebuildSteps::TakeMentionsOver(std::size_t place, Mentions& taken) {
  const std::uint32_t sequence = formerSequences[place];
  if (sequence == 0 || sequence > formerMentions.size()) return false;
  const Mentions& former = formerMentions[sequence - 1];
  if (former.element != taken.element || !former.isLasting) return false;
  if (ExpressionScannerStart() != ScannerStart::Text) return false;
  table.mentioned.insert(table.mentioned.end(), formerlyMentioned.begin() + former.start,
                         formerlyMentioned.begin() + former.end);
  taken.isLasting = true;
  return true;
}

void SymbolTable::RebuildSteps::FindMentions(const SymbolRecord& record, Mentions& found) {
  const ScannerStart start = ExpressionScannerStart();
  const ParsedExpression& parsed = record.expression->Parsed();
  const std::string_view text = StripExpressionQuotes(record.expression->Text());
  if (!parsed.KnowsIdentifiers()) {
    // What the parse left unread counts too, and decides where the next scan starts.
    SetExpressionScannerStart(start);
    ScanIdentifiers(text, identifiers);
    for (const std::string_view name : identifiers) table.mentioned.push_back(table.names.NumberOf(name));
    return;
  }
  for (const LexemeSpan span : parsed.Identifiers()) {
    table.mentioned.push_back(table.names.NumberOf(text.substr(span.start, span.length)));
  }
  found.isLasting = start == ScannerStart::Text && parsed.Left() == ScannerStart::Text;
}

void SymbolTable::RebuildSteps::Refer(const SymbolRecord& record, NameNumber name) {
  const Meaning meaning = MeaningOf(name);
  if (meaning == DefinedElsewhere()) return;
  if (meaning >= FirstUndefined()) {
    UndefinedSymbol& entry = *undefined[meaning - FirstUndefined()];
    // The uses of one element come one after the other, so a repeat can only be the last entry.
    if (entry.usedBy.empty() || entry.usedBy.back() != record.uid) entry.usedBy.push_back(record.uid);
    return;
  }
  if (std::exchange(lastUser[meaning], record.sequence) == record.sequence) return;
  table.uses.push_back(meaning);
}

SymbolTable::RebuildSteps::Meaning SymbolTable::RebuildSteps::MeaningOf(NameNumber name) {
  if (name >= meanings.size()) meanings.resize(name + 1 + meanings.size());
  if (meanings[name] == 0) meanings[name] = MeaningOfUnknown(table.names.NameOf(name));
  return meanings[name];
}

/// Of a name that no record has.
SymbolTable::RebuildSteps::Meaning SymbolTable::RebuildSteps::MeaningOfUnknown(std::string_view name) {
  // One that was undefined may have become a reserved one since: a user function has taken it.
  if (CountsAsDefined(name, settings)) return DefinedElsewhere();
  const auto known = undefinedByName.find(name);
  if (known != undefinedByName.end()) {
    undefined[known->second]->stale = false;
    return FirstUndefined() + static_cast<Meaning>(known->second);
  }
  auto added = std::make_unique<UndefinedSymbol>();
  added->symbol = name;
  undefined.push_back(std::move(added));
  return FirstUndefined() + static_cast<Meaning>(undefined.size() - 1);
}

bool CountsAsDefined(std::string_view name, const CEL_Miscanellous& settings) {
  if (IsReservedName(name) || IsPropertyName(name)) return true;
  const auto& functions = settings.ExternalFunctions();
  return std::any_of(functions.begin(), functions.end(),
                     [name](const auto& function) { return function->publicName.Text() == name; });
}

void SymbolTable::RebuildSteps::BuildReverseReferences() {
  // The uses are sorted by the symbol used: counted first, then put in their places.
  std::vector<std::uint32_t> ends(records.size() + 2, 0);  // of a symbol's uses in the list, by sequence
  for (const std::uint32_t used : table.uses) ++ends[used + 1];
  std::partial_sum(ends.begin(), ends.end(), ends.begin());
  table.users.resize(table.uses.size());
  for (const SymbolRecord& user : records) {
    for (const std::uint32_t used : user.references) table.users[ends[used]++] = user.sequence;
  }
  const std::span<const std::uint32_t> all(table.users);
  std::size_t start = 0;
  for (SymbolRecord& used : records) {
    used.referencedBy = all.subspan(start, ends[used.sequence] - start);
    start = ends[used.sequence];
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
