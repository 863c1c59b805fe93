// Comparing two item trees, with a report of what differs. Comments never count, and an item without a
// partner makes no difference by itself: it is reported only together with a real one.
#include <algorithm>
#include <array>
#include <bit>
#include <functional>
#include <ostream>
#include <regex>
#include <string_view>
#include <utility>
#include <vector>

#include "keyfile/item_tree.h"

namespace tessal {

namespace {

/// Longer names match no expression: a search may cost the square of the name's length.
constexpr std::size_t kLongestMatched = 1000;

std::regex CompileOne(const std::string& expression) {
  if (expression.size() > kLongestIgnoredName) {
    throw std::regex_error(std::regex_constants::error_complexity);
  }
#ifdef __GLIBCXX__
  // Without the flag a search may try every way through the expression, for longer than anyone waits and in
  // as many nested calls as the name has bytes. Back references cannot be searched so, and are refused.
  constexpr auto kGrammar = std::regex::ECMAScript | std::regex_constants::__polynomial;
#else
  constexpr auto kGrammar = std::regex::ECMAScript;
#endif
  return std::regex(expression, kGrammar);
}

std::vector<std::regex> Compile(const IgnoredNames* names) {
  std::vector<std::regex> expressions;
  if (names == nullptr) return expressions;
  expressions.reserve(names->size());
  for (const std::string& name : *names) expressions.push_back(CompileOne(name));
  return expressions;
}

bool IsIgnored(std::string_view name, const std::vector<std::regex>& expressions) {
  if (name.size() > kLongestMatched) return false;
  for (const std::regex& expression : expressions) {
    if (std::regex_search(name.begin(), name.end(), expression)) return true;
  }
  return false;
}

void Report(std::ostream* report, std::string_view first, std::string_view second) {
  if (report != nullptr) *report << first << second << '\n';
}

bool CompareKeys(const CKvfKeyItem& key, const CKvfKeyItem& other, std::ostream* report) {
  if (key.Name() != other.Name()) {
    if (report != nullptr) {
      *report << "Different key names " << key.Name() << "<>" << other.Name() << '\n';
    }
    return false;
  }
  const std::span<const KvfValue> values = key.Values();
  const std::span<const KvfValue> otherValues = other.Values();
  if (values.size() != otherValues.size()) {
    Report(report, key.Name(), " different value count");
    return false;
  }
  if (values.empty()) return false;
  const auto difference = std::ranges::mismatch(values, otherValues).in1;
  if (difference != values.end()) {
    if (report != nullptr) {
      *report << key.Name() << " Value #" << difference - values.begin() + 1 << " is different\n";
    }
    return false;
  }
  Report(report, key.Name(), " matches");
  return true;
}

/// The sections and keywords of a section by kind and name.
class Partners final {
 public:
  static constexpr std::uint32_t kNone = 0xFFFFFFFFU;

  explicit Partners(const CKvfSectionItem& section) {
    for (CKvfBaseItem& child : section.Children()) {
      if (child.ItemKind() != CKvfBaseItem::kComment) items.push_back({&child, kNone});
    }
    names.resize(std::bit_ceil(2 * items.size() + 1));
    // From the end, so that the items of a name are in file order.
    for (auto place = static_cast<std::uint32_t>(items.size()); place-- > 0;) {
      Name& name = Find(*items[place].item);
      items[place].next = std::exchange(name.first, place);
      name.any = place;
    }
  }

  /// Calls back for each item with the kind and name of another one, and leaves none for a later call.
  template <class Item, class Call>
  void TakeEach(const Item& like, Call call) {
    Name& name = Find(like);
    for (std::uint32_t place = std::exchange(name.first, kNone); place != kNone; place = items[place].next) {
      call(static_cast<Item&>(*items[place].item));
    }
  }

 private:
  struct Entry {
    CKvfBaseItem* item;
    std::uint32_t next;  ///< of the same kind and name
  };
  struct Name {
    std::uint32_t any = kNone;    ///< an item with the name; none for a free place
    std::uint32_t first = kNone;  ///< of those that are left
  };

  Name& Find(const CKvfBaseItem& item) {
    const std::size_t mask = names.size() - 1;
    std::size_t place = std::hash<std::string_view>()(item.Name()) & mask;
    while (names[place].any != kNone) {
      const CKvfBaseItem& other = *items[names[place].any].item;
      if (other.ItemKind() == item.ItemKind() && other.Name() == item.Name()) break;
      place = (place + 1) & mask;
    }
    return names[place];
  }

  std::vector<Entry> items;
  std::vector<Name> names;  ///< hashed, with at least as many free places as names
};

/// The recursive step of a comparison. Partners are found by name; the marks of both trees are the result.
class Comparison final {
 public:
  explicit Comparison(const IgnoredNames* ignoreNames) : ignored(Compile(ignoreNames)) {}

  bool Run(CKvfSectionItem& left, CKvfSectionItem& right) {
    if (left.Name() != right.Name()) return false;
    if (IsIgnored(left.Name(), ignored)) {
      left.SetMarks(CKvfBaseItem::kIgnored);
      right.SetMarks(CKvfBaseItem::kIgnored);
      return true;
    }
    Partners partners(right);
    bool ignoredMarked = false;
    bool same = true;
    for (CKvfBaseItem& child : left.Children()) {
      if (child.ItemKind() == CKvfBaseItem::kSection) {
        same = CompareAll(static_cast<CKvfSectionItem&>(child), partners) && same;
      } else if (child.ItemKind() == CKvfBaseItem::kKeyword && !IsIgnored(child.Name(), ignored)) {
        if (!std::exchange(ignoredMarked, true)) MarkIgnoredKeywords(right);
        same = CompareAll(static_cast<CKvfKeyItem&>(child), partners) && same;
      } else {
        child.SetMark(CKvfBaseItem::kIgnored);
      }
    }
    left.SetMark(same ? CKvfBaseItem::kSame : CKvfBaseItem::kDifferent);
    return same;
  }

 private:
  static bool Run(CKvfKeyItem& left, CKvfKeyItem& right) { return CompareKeys(left, right, nullptr); }

  /// Does not stop at the first partner: every unmatched one of the name is compared, and none is left for
  /// the next child of the name.
  template <class Item>
  bool CompareAll(Item& child, Partners& partners) {
    bool allSame = true;
    partners.TakeEach(child, [&](Item& candidate) {
      const bool same = Run(child, candidate);
      allSame = allSame && same;
      const auto mark = same ? CKvfBaseItem::kSame : CKvfBaseItem::kDifferent;
      child.SetMark(mark);
      candidate.SetMark(mark);
    });
    return allSame;
  }

  void MarkIgnoredKeywords(const CKvfSectionItem& section) const {
    if (ignored.empty()) return;
    for (CKvfBaseItem& child : section.Children()) {
      const bool isOpen =
          child.ItemKind() == CKvfBaseItem::kKeyword && child.ComparisonMark() == CKvfBaseItem::kUnmatched;
      if (isOpen && IsIgnored(child.Name(), ignored)) child.SetMark(CKvfBaseItem::kIgnored);
    }
  }

  std::vector<std::regex> ignored;
};

void ReportDifferences(const CKvfSectionItem& section, std::ostream& report, int side, bool onlyKeywords) {
  constexpr std::array<std::string_view, 2> kUnmatchedTexts = {" is missing", " is extra"};
  for (const CKvfBaseItem& child : section.Children()) {
    const CKvfBaseItem::Kind kind = child.ItemKind();
    const CKvfBaseItem::Mark mark = child.ComparisonMark();
    const bool isReported =
        kind == CKvfBaseItem::kKeyword || (kind != CKvfBaseItem::kComment && !onlyKeywords);
    if (isReported && mark == CKvfBaseItem::kUnmatched) {
      report << child.Describe() << kUnmatchedTexts.at(static_cast<std::size_t>(side)) << '\n';
    } else if (isReported && mark == CKvfBaseItem::kDifferent && side == 0) {
      report << child.Describe() << " is different (line " << child.Line() << ")\n";
    }
    if (kind == CKvfBaseItem::kSection) {
      ReportDifferences(static_cast<const CKvfSectionItem&>(child), report, side, onlyKeywords);
    }
  }
}

bool CompareSections(CKvfSectionItem& section, CKvfSectionItem& other, std::ostream* report,
                     const IgnoredNames* ignoreNames, bool onlyKeywords) {
  section.SetMarks(CKvfBaseItem::kUnmatched);
  other.SetMarks(CKvfBaseItem::kUnmatched);
  const bool same = Comparison(ignoreNames).Run(section, other);
  if (report == nullptr) return same;
  if (ignoreNames != nullptr) {
    *report << "Ignored names : ";
    std::string_view separator;
    for (const std::string& ignoredName : *ignoreNames) {
      *report << separator << ignoredName;
      separator = ", ";
    }
    *report << '\n';
  }
  if (onlyKeywords) *report << "List ony keyword differences\n";
  if (same) {
    *report << "No differences detected!\n";
    return true;
  }
  constexpr int kThisSide = 0;
  constexpr int kOtherSide = 1;
  ReportDifferences(section, *report, kThisSide, onlyKeywords);
  ReportDifferences(other, *report, kOtherSide, onlyKeywords);
  return false;
}

}  // namespace

bool CKvfBaseItem::Compare(CKvfBaseItem& other, std::ostream* report, const IgnoredNames* ignoreNames,
                           bool onlyKeywords) {
  if (kind == kNone || other.kind != kind) return false;
  if (kind == kSection) {
    return CompareSections(static_cast<CKvfSectionItem&>(*this), static_cast<CKvfSectionItem&>(other), report,
                           ignoreNames, onlyKeywords);
  }
  if (kind == kComment) return true;
  if (ignoreNames != nullptr && IsIgnored(Name(), Compile(ignoreNames))) {
    Report(report, "ignored key name ", Name());
    return true;
  }
  return CompareKeys(static_cast<CKvfKeyItem&>(*this), static_cast<CKvfKeyItem&>(other), report);
}

}  // namespace tessal
