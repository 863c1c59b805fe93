#include "ui/item_data.h"

#include <algorithm>
#include <iterator>

namespace tessal {

void CNavigationHistory::Add(Uid id, const std::string& caption) {
  const bool hasPresent = position >= 0 && position < static_cast<std::ptrdiff_t>(entries.size());
  const auto before = hasPresent ? std::next(entries.begin(), position) : entries.begin();
  const auto entered = entries.insert(before, {id, caption});
  for (auto entry = entries.begin(); entry != entries.end();) {
    entry = entry != entered && entry->id == id ? entries.erase(entry) : std::next(entry);
  }
  while (entries.size() > kMostEntries) entries.pop_back();
  const auto present = std::find_if(entries.begin(), entries.end(),
                                    [id](const CHistoryData& entry) { return entry.id == id; });
  position = present == entries.end() ? -1 : std::distance(entries.begin(), present);
}

Uid CNavigationHistory::Back() {
  if (CanGoBack()) ++position;
  return IdAtPosition();
}

Uid CNavigationHistory::Forward() {
  if (CanGoForward()) --position;
  return IdAtPosition();
}

Uid CNavigationHistory::IdAtPosition() const {
  if (position < 0 || position >= static_cast<std::ptrdiff_t>(entries.size())) return Uid::None;
  return std::next(entries.begin(), position)->id;
}

}  // namespace tessal
