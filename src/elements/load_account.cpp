#include "elements/load_account.h"

#include <algorithm>
#include <functional>
#include <iterator>
#include <utility>

namespace tessal {

namespace {

bool CanBeTakenOver(const AccountEntry& entry) {
  return entry.value != nullptr || entry.ofVisibility;
}

}  // namespace

void LoadAccount::Note(AccountKind kind, std::string_view symbol, int line, const Finding& finding) {
  entries.push_back({kind, finding.message->code, std::string(symbol), finding.text, line, nullptr, false});
}

void LoadAccount::NotePassedOver(std::string_view symbol, int line, const Finding& finding,
                                 PassedOverValue value) {
  Note(AccountKind::Unread, symbol, line, finding);
  entries.back().value = std::make_shared<const PassedOverValue>(std::move(value));
}

void LoadAccount::NoteOfVisibility(std::string_view symbol, int line, const Finding& finding) {
  Note(AccountKind::Unread, symbol, line, finding);
  entries.back().ofVisibility = true;
}

void LoadAccount::AddEntriesOf(const LoadAccount& other) {
  for (AccountEntry entry : other.entries) {
    entry.value.reset();
    entry.ofVisibility = false;
    entries.push_back(std::move(entry));
  }
}

void LoadAccount::SortByLine() {
  std::stable_sort(entries.begin(), entries.end(), [](const AccountEntry& left, const AccountEntry& right) {
    return left.line < right.line;
  });
}

bool LoadAccount::Loses() const {
  return std::any_of(entries.begin(), entries.end(),
                     [](const AccountEntry& entry) { return entry.kind != AccountKind::Absent; });
}

std::size_t LoadAccount::Count(AccountKind kind) const {
  return static_cast<std::size_t>(std::count_if(
      entries.begin(), entries.end(), [kind](const AccountEntry& entry) { return entry.kind == kind; }));
}

bool LoadAccount::HasPassedOver() const {
  return std::any_of(entries.begin(), entries.end(), CanBeTakenOver);
}

std::vector<AccountEntry> LoadAccount::TakePassedOver() {
  const auto taken = std::stable_partition(entries.begin(), entries.end(), std::not_fn(CanBeTakenOver));
  std::vector<AccountEntry> result(std::make_move_iterator(taken), std::make_move_iterator(entries.end()));
  entries.erase(taken, entries.end());
  return result;
}

}  // namespace tessal
