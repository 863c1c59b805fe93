#include "core/symbol_table.h"

#include <algorithm>

#include "elements/element.h"

namespace tessal {

namespace {

template <class Matches>
const SymbolRecord* FindRecord(const std::vector<SymbolRecord>& records, Matches matches) {
  const auto hit = std::find_if(records.begin(), records.end(), matches);
  return hit == records.end() ? nullptr : &*hit;
}

}  // namespace

std::string RecordSymbol(const SymbolRecord& record) {
  return record.element->FullSymbol();
}

std::string RecordText(const SymbolRecord& record) {
  return record.expression != nullptr ? record.expression->TextOf() : record.element->RecordText();
}

void SymbolTable::Clear() {
  records.clear();
  uses.clear();
  users.clear();
  names.Clear();
  mentions.clear();
  mentioned.clear();
  undefined.clear();
}

std::vector<Uid> SymbolTable::UidsOf(std::span<const std::uint32_t> sequences) const {
  std::vector<Uid> uids;
  for (const std::uint32_t sequence : sequences) {
    // The records of a movement lie side by side.
    const Uid uid = Used(sequence).uid;
    if (uids.empty() || uids.back() != uid) uids.push_back(uid);
  }
  return uids;
}

const SymbolRecord* SymbolTable::BySequence(std::uint32_t sequence) const {
  // The sequence is the place in the table.
  return sequence >= 1 && sequence <= records.size() ? &records[sequence - 1] : nullptr;
}

const SymbolRecord* SymbolTable::ByUid(Uid uid) const {
  return FindRecord(records, [uid](const SymbolRecord& record) { return record.uid == uid; });
}

const SymbolRecord* SymbolTable::OfElement(const CEL_Element& element) const {
  // After a rebuild the element's number is the place of its (for a movement with two, its second) record.
  const auto place = static_cast<std::uint32_t>(element.id.IntValue());
  for (const std::uint32_t sequence : {place - 1, place}) {
    const SymbolRecord* record = BySequence(sequence);
    if (record != nullptr && record->element == &element) return record;
  }
  return ByUid(element.GetUid());
}

const SymbolRecord* SymbolTable::BySymbol(std::string_view symbol) const {
  // The full symbol ends in the element's own, so that few have to be made.
  return FindRecord(records, [symbol](const SymbolRecord& record) {
    return symbol.ends_with(record.element->symbol.Text()) && record.element->FullSymbol() == symbol;
  });
}

}  // namespace tessal
