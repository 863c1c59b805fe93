// Who uses whom. The expressions are only scanned, so the answer exists also for one that does not parse.
#include <algorithm>
#include <bit>
#include <functional>
#include <numeric>
#include <string>
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

bool HoldsExpression(ElementKind elementKind) {
  switch (elementKind) {
    case ElementKind::StateVariable:
    case ElementKind::Auxiliary:
    case ElementKind::Process:
    case ElementKind::DerivedOutput:
    case ElementKind::SpecieStateVariable:
    case ElementKind::ArithmeticExpression:
    case ElementKind::HorizontalVector:
    case ElementKind::VerticalEquation:
      return true;
    default:
      return false;
  }
}

bool HasSearchFunction(const Sequence<CEL_Lagrange_Specie>& species) {
  return std::any_of(species.begin(), species.end(),
                     [](const auto& specie) { return !specie->spatialFunctions.empty(); });
}

/// The symbols of the table by name. In a large template every step through memory counts: the names stand
/// side by side, and so do the slots of the hash table, probed one after the other.
class SymbolIndex final {
 public:
  explicit SymbolIndex(std::size_t records) : slots(std::bit_ceil(2 * records + 1)) {
    ends.reserve(records + 1);
    uids.reserve(records + 1);
  }

  /// Where the name of the next symbol is to be appended.
  std::string& NextName() { return names; }
  /// Adds the symbol whose name was appended last. Of equal names the first one counts.
  void AddNext(Uid uid) {
    ends.push_back(names.size());
    uids.push_back(uid);
    const auto sequence = static_cast<std::uint32_t>(ends.size() - 1);
    const std::string_view name = NameOf(sequence);
    Slot& slot = slots[SlotOf(name)];
    if (slot.sequence == 0) slot = {ShortHash(name), sequence};
  }

  /// The sequence number of the symbol of that name; 0 when there is none.
  std::uint32_t Find(std::string_view name) const { return slots[SlotOf(name)].sequence; }
  Uid UidOf(std::uint32_t sequence) const { return uids[sequence]; }

 private:
  struct Slot {
    std::uint32_t hash = 0;
    std::uint32_t sequence = 0;  ///< 0 for an empty slot
  };

  static std::uint32_t ShortHash(std::string_view name) {
    return static_cast<std::uint32_t>(std::hash<std::string_view>()(name));
  }
  std::string_view NameOf(std::uint32_t sequence) const {
    const std::size_t start = ends[sequence - 1];
    return std::string_view(names).substr(start, ends[sequence] - start);
  }
  /// The slot that holds the name, or the empty one that would take it.
  std::size_t SlotOf(std::string_view name) const {
    const std::uint32_t hash = ShortHash(name);
    std::size_t place = hash & (slots.size() - 1);
    while (slots[place].sequence != 0 &&
           (slots[place].hash != hash || NameOf(slots[place].sequence) != name)) {
      place = (place + 1) & (slots.size() - 1);
    }
    return place;
  }

  std::string names;
  std::vector<std::size_t> ends{0};  // of the names, by sequence number
  std::vector<Uid> uids{Uid::None};  // by sequence number
  std::vector<Slot> slots;
};

}  // namespace

/// What the extraction looks names up in. It lives as long as the step.
struct TemplateCore::ReferenceLookup {
  explicit ReferenceLookup(std::size_t records) : symbols(records), lastUser(records + 1, 0) {}

  SymbolIndex symbols;
  std::unordered_map<std::string_view, UndefinedSymbol*> undefined;
  /// For each record the last one that was noted to use it: an expression's second use of a symbol adds
  /// nothing.
  std::vector<std::uint32_t> lastUser;
  std::vector<std::string_view> identifiers;
};

void TemplateCore::ExtractReferences() {
  ReferenceLookup lookup(symbolTable.size());
  for (const SymbolRecord& record : symbolTable) {
    AppendRecordSymbol(record, lookup.symbols.NextName());
    lookup.symbols.AddNext(record.uid);
  }
  for (const auto& undefined : undefinedSymbols) lookup.undefined.emplace(undefined->symbol, undefined.get());
  for (SymbolRecord& record : symbolTable) ExtractRecordReferences(record, lookup);
}

void TemplateCore::ExtractRecordReferences(SymbolRecord& record, ReferenceLookup& lookup) {
  const ElementKind elementKind = record.element->Kind();
  if (elementKind == ElementKind::SpatialFunction) {
    const auto& function = static_cast<const CEL_Lagrange_Spatial_Function&>(*record.element);
    if (function.variableId.IntValue() >= 1) Refer(record, function.VariableName(), lookup);
    return;
  }
  if (!HoldsExpression(elementKind)) return;
  ScanIdentifiers(StripExpressionQuotes(record.text), lookup.identifiers);
  for (const std::string_view name : lookup.identifiers) Refer(record, name, lookup);
}

void TemplateCore::Refer(SymbolRecord& record, std::string_view name, ReferenceLookup& lookup) {
  const std::uint32_t used = lookup.symbols.Find(name);
  if (used == 0) {
    NoteUndefined(name, record.uid, lookup);
    return;
  }
  std::uint32_t& lastUser = lookup.lastUser[used];
  if (lastUser == record.sequence) return;
  lastUser = record.sequence;
  record.references.push_back(used);
  record.referenceUids.push_back(lookup.symbols.UidOf(used));
}

bool TemplateCore::CountsAsDefined(std::string_view name) const {
  if (IsReservedName(name) || IsPropertyName(name)) return true;
  const auto& functions = misc.ExternalFunctions();
  return std::any_of(functions.begin(), functions.end(),
                     [name](const auto& function) { return function->publicName.Text() == name; });
}

void TemplateCore::NoteUndefined(std::string_view name, Uid uid, ReferenceLookup& lookup) {
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
  // The uses are sorted by the symbol used in lists of plain numbers before they go to the records: in a
  // large template a step from record to record is dear.
  std::vector<Uid> uids(1, Uid::None);
  std::vector<std::size_t> ends(symbolTable.size() + 2, 0);  // of a symbol's uses in the list, by sequence
  for (const SymbolRecord& user : symbolTable) {
    uids.push_back(user.uid);
    for (const std::uint32_t sequence : user.references) ++ends[sequence + 1];
  }
  std::partial_sum(ends.begin(), ends.end(), ends.begin());
  std::vector<std::uint32_t> users(ends.back());
  for (const SymbolRecord& user : symbolTable) {
    for (const std::uint32_t sequence : user.references) users[ends[sequence]++] = user.sequence;
  }
  auto use = users.cbegin();
  for (SymbolRecord& used : symbolTable) {
    const auto end = users.cbegin() + static_cast<std::ptrdiff_t>(ends[used.sequence]);
    used.referencedBy.assign(use, end);
    for (; use != end; ++use) {
      // The two records of a movement share an identity and stand side by side.
      const Uid uid = uids[*use];
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
  ForEachSearchFunction([&byId](CEL_Lagrange_Spatial_Function& function) {
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
  ForEachSearchFunction([&byName](CEL_Lagrange_Spatial_Function& function) {
    if (function.VariableName() == kUnresolvedName) return;
    const auto hit = byName.find(function.VariableName());
    if (hit != byName.end()) function.variableId.SetInt(hit->second->id.IntValue());
  });
}

bool TemplateCore::CheckElementOrder(Uid uid) const {
  const SymbolRecord* record = FindRecordByUid(uid);
  return record == nullptr || CheckRecordOrder(*record);
}

bool TemplateCore::CheckRecordOrder(const SymbolRecord& record) const {
  const CEL_Element& user = *record.element;
  bool good = true;
  for (const std::uint32_t sequence : record.references) {
    const CEL_Element& used = *Record(sequence).element;
    if (user.Kind() == ElementKind::StateVariable) {
      if (used.Kind() == ElementKind::Process) continue;
      Errors().Report(RecordSymbol(record), user.GetUid(), {"not-a-process", {used.symbol.Text()}});
    } else {
      if (sequence <= static_cast<std::uint32_t>(user.id.IntValue())) continue;
      const std::string symbol = RecordSymbol(record);
      Errors().Report(symbol, user.GetUid(), {"order-violated", {used.symbol.Text(), symbol}});
    }
    good = false;
  }
  return good;
}

bool TemplateCore::CheckDeclarationOrder() const {
  bool good = true;
  for (const SymbolRecord& record : symbolTable) {
    switch (record.element->Kind()) {
      case ElementKind::StateVariable:
      case ElementKind::Auxiliary:
      case ElementKind::Process:
      case ElementKind::DerivedOutput:
        good = CheckRecordOrder(record) && good;
        break;
      default:
        break;
    }
  }
  return good;
}

}  // namespace tessal
