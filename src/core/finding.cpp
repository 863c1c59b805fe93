// Looking elements and symbols up. The sizes are those of hand-written templates: the searches are linear,
// and no index is kept between rebuilds.
#include <algorithm>

#include "core/template_core.h"

namespace tessal {

namespace {

template <class Records, class Matches>
const SymbolRecord* FindRecord(const Records& records, Matches matches) {
  const auto hit = std::find_if(records.begin(), records.end(), matches);
  return hit == records.end() ? nullptr : &*hit;
}

bool IsMovement(const CEL_Element& element) {
  return element.Kind() == ElementKind::HorizontalVector || element.Kind() == ElementKind::VerticalEquation;
}

}  // namespace

const SymbolRecord* TemplateCore::FindRecordBySequence(std::uint32_t sequence) const {
  // The sequence is the place in the table.
  return sequence >= 1 && sequence <= symbolTable.size() ? &symbolTable[sequence - 1] : nullptr;
}

const SymbolRecord* TemplateCore::FindRecordByUid(Uid uid) const {
  return FindRecord(symbolTable, [uid](const SymbolRecord& record) { return record.uid == uid; });
}

const SymbolRecord* TemplateCore::RecordOfElement(const CEL_Element& element) const {
  // Behind a rebuild the element's number is the place of its (for a movement with two, its second) record.
  const auto place = static_cast<std::uint32_t>(element.id.IntValue());
  for (const std::uint32_t sequence : {place - 1, place}) {
    const SymbolRecord* record = FindRecordBySequence(sequence);
    if (record != nullptr && record->element == &element) return record;
  }
  return FindRecordByUid(element.GetUid());
}

void TemplateCore::AppendRecordSymbol(const SymbolRecord& record, std::string& text) const {
  if (record.element == nullptr) {
    text += "unknown";
    return;
  }
  if (IsMovement(*record.element)) {
    text += "(" + At(species, static_cast<std::size_t>(record.specieIndex)).symbol.Text() + ")";
  }
  text += record.element->symbol.Text();
}

std::string TemplateCore::RecordSymbol(const SymbolRecord& record) const {
  std::string symbol;
  AppendRecordSymbol(record, symbol);
  return symbol;
}

CEL_Element* TemplateCore::GetElement(Uid uid, ElementKind kindFilter) const {
  if (const SymbolRecord* record = FindRecordByUid(uid)) {
    const bool fits = kindFilter == ElementKind::None || record->element->Kind() == kindFilter;
    return fits ? record->element : nullptr;
  }
  for (const auto& specie : species) {
    for (const auto& head : specie->Heads()) {
      if (head->GetUid() == uid) return head.get();
    }
  }
  for (const auto& function : misc.ExternalFunctions()) {
    if (function->GetUid() == uid) return function.get();
  }
  return nullptr;
}

CEL_Element* TemplateCore::GetElementBySequence(std::uint32_t sequence) const {
  const SymbolRecord* record = FindRecordBySequence(sequence);
  return record == nullptr ? nullptr : record->element;
}

bool TemplateCore::FindSymbol(std::string_view symbol, std::uint32_t& sequence) const {
  const SymbolRecord* record = FindRecord(symbolTable, [this, symbol](const SymbolRecord& candidate) {
    if (candidate.element != nullptr && !IsMovement(*candidate.element)) {
      return candidate.element->symbol.Text() == symbol;
    }
    return RecordSymbol(candidate) == symbol;
  });
  if (record == nullptr) return false;
  sequence = record->sequence;
  return true;
}

bool TemplateCore::SymbolExists(std::string_view symbol) const {
  std::uint32_t sequence = 0;
  return FindSymbol(symbol, sequence);
}

bool TemplateCore::GetSymbolOfUid(Uid uid, std::string& symbol) const {
  const SymbolRecord* record = FindRecordByUid(uid);
  if (record == nullptr) return false;
  symbol = RecordSymbol(*record);
  return true;
}

bool TemplateCore::GetSequenceOfUid(Uid uid, std::uint32_t& sequence) const {
  const SymbolRecord* record = FindRecordByUid(uid);
  if (record == nullptr) return false;
  sequence = record->sequence;
  return true;
}

bool TemplateCore::IsSymbolTakenByOther(Uid uid, std::string_view symbol) const {
  return FindRecord(symbolTable, [this, uid, symbol](const SymbolRecord& record) {
           return record.uid != uid && RecordSymbol(record) == symbol;
         }) != nullptr;
}

bool TemplateCore::IsReferenced(Uid uid) const {
  const SymbolRecord* record = FindRecordByUid(uid);
  return record != nullptr && !record->referencedByUids.empty();
}

bool TemplateCore::GetReferrerUids(Uid uid, std::vector<Uid>& uids) const {
  const SymbolRecord* record = FindRecordByUid(uid);
  if (record == nullptr) return false;
  uids = record->referencedByUids;
  return true;
}

bool TemplateCore::GetReferrerSymbols(Uid uid, std::vector<std::string>& symbols) const {
  symbols.clear();
  const SymbolRecord* record = FindRecordByUid(uid);
  if (record == nullptr) return false;
  symbols = ReferrerSymbols(*record);
  return true;
}

std::vector<std::string> TemplateCore::ReferrerSymbols(const SymbolRecord& record) const {
  std::vector<std::string> symbols;
  // By record number, which is at hand; a movement whose two expressions both use the symbol stands once.
  const CEL_Element* previous = nullptr;
  for (const std::uint32_t sequence : record.referencedBy) {
    const SymbolRecord* referrer = FindRecordBySequence(sequence);
    if (referrer == nullptr || referrer->element == previous) continue;
    previous = referrer->element;
    symbols.push_back(RecordSymbol(*referrer));
  }
  return symbols;
}

bool TemplateCore::FindElementBySymbol(std::string_view symbol, std::int32_t& id,
                                       ElementKind& elementKind) const {
  const CEL_Element* found = nullptr;
  ForEachNamedElement([symbol, &found](const CEL_Element& element) {
    if (found == nullptr && element.symbol.Text() == symbol) found = &element;
  });
  elementKind = found == nullptr ? ElementKind::Unknown : found->Kind();
  if (found == nullptr) return false;
  id = found->id.IntValue();
  return true;
}

CEL_Lagrange_Specie* TemplateCore::GetParentSpecie(Uid headUid) const {
  for (const auto& specie : species) {
    for (const auto& head : specie->Heads()) {
      if (head->GetUid() == headUid) return specie.get();
    }
  }
  return nullptr;
}

std::vector<const CEL_Element*> TemplateCore::ReferencedElements(const CEL_Element& element) const {
  std::vector<const CEL_Element*> elements;
  const SymbolRecord* record = RecordOfElement(element);
  if (record == nullptr) return elements;
  elements.reserve(record->references.size());
  for (const std::uint32_t sequence : record->references) elements.push_back(Record(sequence).element);
  return elements;
}

std::vector<NamedNumber> TemplateCore::SpecieNames() const {
  std::vector<NamedNumber> names;
  names.reserve(species.size());
  for (const auto& specie : species) names.push_back({specie->symbol.Text(), specie->Index()});
  return names;
}

std::set<std::int32_t> TemplateCore::ItemsToRecordNumbers(const std::set<Uid>& uids) const {
  std::set<std::int32_t> numbers;
  if (uids.empty()) return numbers;
  const CEL_Element* previous = nullptr;
  for (const SymbolRecord& record : symbolTable) {
    // The second record of a movement counts as its first.
    if (record.element == nullptr || record.element == previous) continue;
    previous = record.element;
    if (uids.contains(record.element->GetUid())) numbers.insert(static_cast<std::int32_t>(record.sequence));
  }
  return numbers;
}

}  // namespace tessal
