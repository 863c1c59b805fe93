#include "core/symbol_ranking.h"

#include <algorithm>
#include <tuple>
#include <vector>

#include "core/template_core.h"
#include "platform/ascii.h"
#include "platform/text_encoding.h"

namespace tessal {

namespace {

constexpr std::size_t kLongestRanked = 256;
constexpr int kNoRank = -1'000'000;

// What a letter that fits is worth, by its place.
constexpr int kAtStart = 40;
constexpr int kAtWord = 24;
constexpr int kAfterFormer = 24;
constexpr int kElsewhere = 2;
constexpr int kSameCase = 1;
/// What each letter of the symbol that is passed over takes away.
constexpr int kSkipped = -1;

bool IsCapital(char character) {
  return character >= 'A' && character <= 'Z';
}

bool BeginsWord(std::string_view symbol, std::size_t place) {
  if (place == 0) return true;
  const char before = symbol[place - 1];
  const char here = symbol[place];
  if (!IsAsciiLetter(before) && !IsAsciiDigit(before)) return IsAsciiLetter(here) || IsAsciiDigit(here);
  return (IsCapital(here) && !IsCapital(before)) || (IsAsciiDigit(here) && !IsAsciiDigit(before));
}

bool AreInOrder(std::string_view symbol, std::string_view letters) {
  std::size_t found = 0;
  for (const char character : symbol) {
    if (found < letters.size() && UpperCase(character) == UpperCase(letters[found])) ++found;
  }
  return found == letters.size();
}

int WorthAt(std::string_view symbol, std::size_t place, char letter, bool isAfterFormer) {
  int worth = place == 0 ? kAtStart : kElsewhere;
  if (place > 0 && BeginsWord(symbol, place)) worth = kAtWord;
  if (isAfterFormer) worth = std::max(worth, kAfterFormer);
  return worth + (symbol[place] == letter ? kSameCase : 0);
}

}  // namespace

std::optional<int> RankSymbol(std::string_view symbol, std::string_view letters) {
  symbol = symbol.substr(0, kLongestRanked);
  if (letters.empty()) return 0;
  if (!AreInOrder(symbol, letters)) return std::nullopt;
  // For each place of the symbol the best sum of the letters so far, the last of them at that place; and the
  // best with the last of them at the place or before.
  std::vector<int> endsHere(symbol.size());
  std::vector<int> formerEndsHere;
  std::vector<int> formerBest;
  std::vector<int> best(symbol.size());
  for (std::size_t index = 0; index < letters.size(); ++index) {
    std::swap(formerEndsHere, endsHere);
    std::swap(formerBest, best);
    endsHere.assign(symbol.size(), kNoRank);
    best.assign(symbol.size(), kNoRank);
    for (std::size_t place = 0; place < symbol.size(); ++place) {
      if (UpperCase(symbol[place]) == UpperCase(letters[index])) {
        if (index == 0) {
          endsHere[place] = WorthAt(symbol, place, letters[index], false);
        } else if (place > 0) {
          endsHere[place] = std::max(formerEndsHere[place - 1] + WorthAt(symbol, place, letters[index], true),
                                     formerBest[place - 1] + WorthAt(symbol, place, letters[index], false));
        }
      }
      best[place] = std::max(endsHere[place], place == 0 ? kNoRank : best[place - 1]);
    }
  }
  return best.back() + kSkipped * static_cast<int>(symbol.size() - letters.size());
}

std::string NameToGoTo(const SymbolRecord& record) {
  const CEL_Element& element = *record.element;
  const bool hasCaption = element.Kind() == ElementKind::DerivedOutput && !element.description.Text().empty();
  return ToUtf8(hasCaption ? element.description.TextOf() : element.FullSymbol());
}

std::vector<const SymbolRecord*> SymbolsByRank(const TemplateCore& core, std::string_view letters,
                                               std::size_t most) {
  /// In the order of a list: the best rank first.
  struct Entry {
    int rank;
    std::size_t length;
    const SymbolRecord* record;
    bool operator<(const Entry& other) const {
      return std::tuple(-rank, length, record->sequence) <
             std::tuple(-other.rank, other.length, other.record->sequence);
    }
  };
  std::vector<Entry> entries;
  const CEL_Element* previous = nullptr;
  for (const SymbolRecord& record : core.SymbolTable()) {
    // The two records of a movement are side by side.
    if (record.element == previous) continue;
    previous = record.element;
    const std::string name = NameToGoTo(record);
    const std::optional<int> rank = RankSymbol(name, letters);
    // Without letters there is nothing to be better by: the order is that of the table.
    if (rank) entries.push_back({*rank, letters.empty() ? 0 : name.size(), &record});
  }
  const std::size_t count = std::min(most, entries.size());
  std::partial_sort(entries.begin(), entries.begin() + static_cast<std::ptrdiff_t>(count), entries.end());
  std::vector<const SymbolRecord*> records;
  for (std::size_t place = 0; place < count; ++place) records.push_back(entries[place].record);
  return records;
}

}  // namespace tessal
