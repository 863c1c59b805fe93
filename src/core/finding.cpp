// Looking elements and symbols up. The searches are linear, see the symbol table.
#include <algorithm>
#include <iterator>
#include <unordered_set>

#include "core/template_core.h"

namespace tessal {

CEL_Element* TemplateCore::GetElement(Uid uid, ElementKind kindFilter) const {
  if (const SymbolRecord* record = FindRecordByUid(uid)) {
    const bool fits = kindFilter == ElementKind::None || record->element->Kind() == kindFilter;
    return fits ? record->element : nullptr;
  }
  for (const auto& specie : Species()) {
    for (const auto& head : specie->Heads()) {
      if (head->GetUid() == uid) return head.get();
    }
  }
  for (const auto& function : state.misc.ExternalFunctions()) {
    if (function->GetUid() == uid) return function.get();
  }
  return nullptr;
}

CEL_Element* TemplateCore::GetElementBySequence(std::uint32_t sequence) const {
  const SymbolRecord* record = FindRecordBySequence(sequence);
  return record == nullptr ? nullptr : record->element;
}

bool TemplateCore::FindSymbol(std::string_view symbol, std::uint32_t& sequence) const {
  const SymbolRecord* record = state.table.BySymbol(symbol);
  if (record == nullptr) return false;
  sequence = record->sequence;
  return true;
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
  return std::any_of(SymbolTable().begin(), SymbolTable().end(), [uid, symbol](const SymbolRecord& record) {
    return record.uid != uid && tessal::RecordSymbol(record) == symbol;
  });
}

bool TemplateCore::IsReferenced(Uid uid) const {
  const SymbolRecord* record = FindRecordByUid(uid);
  return record != nullptr && !record->referencedBy.empty();
}

bool TemplateCore::GetReferrerUids(Uid uid, std::vector<Uid>& uids) const {
  const SymbolRecord* record = FindRecordByUid(uid);
  if (record == nullptr) return false;
  uids = state.table.UidsOf(record->referencedBy);
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
  state.table.ForEachElement(record.referencedBy, [&symbols](const SymbolRecord& user) {
    symbols.push_back(tessal::RecordSymbol(user));
  });
  return symbols;
}

bool TemplateCore::FindElementBySymbol(std::string_view symbol, std::int32_t& id,
                                       ElementKind& elementKind) const {
  const CEL_Element* found = nullptr;
  ForEachNamedElement(Elements(), [symbol, &found](const CEL_Element& element) {
    if (found == nullptr && element.symbol.Text() == symbol) found = &element;
  });
  elementKind = found == nullptr ? ElementKind::Unknown : found->Kind();
  if (found == nullptr) return false;
  id = found->id.IntValue();
  return true;
}

CEL_Lagrange_Specie* TemplateCore::GetParentSpecie(Uid headUid) const {
  for (const auto& specie : Species()) {
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
  std::vector<std::uint32_t> numbers(record->references.begin(), record->references.end());
  const SymbolRecord* next = FindRecordBySequence(record->sequence + 1);
  if (next != nullptr && next->element == &element) {
    std::unordered_set<std::uint32_t> known(numbers.begin(), numbers.end());
    std::copy_if(next->references.begin(), next->references.end(), std::back_inserter(numbers),
                 [&known](std::uint32_t number) { return known.insert(number).second; });
  }
  elements.reserve(numbers.size());
  for (const std::uint32_t used : numbers) elements.push_back(state.table.Used(used).element);
  return elements;
}

std::map<Uid, std::int32_t> TemplateCore::RecordNumbers(const std::set<Uid>& uids) const {
  std::map<Uid, std::int32_t> numbers;
  if (uids.empty()) return numbers;
  // The second record of a movement counts as its first.
  state.table.ForEachElement([&uids, &numbers](const SymbolRecord& record) {
    if (uids.contains(record.uid)) numbers.emplace(record.uid, static_cast<std::int32_t>(record.sequence));
  });
  return numbers;
}

}  // namespace tessal
