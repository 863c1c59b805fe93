// Comparing two item trees, with a report of what differs. Comments never count, and an item without a
// partner makes no difference by itself: it is reported only together with a real one.
#include <array>
#include <ostream>
#include <regex>
#include <string_view>
#include <unordered_map>
#include <utility>

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

bool IsIgnored(const std::string& name, const std::vector<std::regex>& expressions) {
  if (name.size() > kLongestMatched) return false;
  for (const std::regex& expression : expressions) {
    if (std::regex_search(name, expression)) return true;
  }
  return false;
}

void Report(std::ostream* report, std::string_view first, std::string_view second) {
  if (report != nullptr) *report << first << second << '\n';
}

}  // namespace

bool CKvfKeyItem::Compare(CKvfBaseItem& other, std::ostream* report, const IgnoredNames* ignoreNames,
                          bool /*onlyKeywords*/) {
  if (other.ItemKind() != kKeyword) return false;
  if (ignoreNames != nullptr && IsIgnored(name, Compile(ignoreNames))) {
    Report(report, "ignored key name ", name);
    return true;
  }
  const auto& otherKey = static_cast<const CKvfKeyItem&>(other);
  if (name != otherKey.name) {
    Report(report, "Different key names " + name + "<>", otherKey.name);
    return false;
  }
  if (values.size() != otherKey.values.size()) {
    Report(report, name, " different value count");
    return false;
  }
  if (values.empty()) return false;
  for (std::size_t place = 0; place < values.size(); ++place) {
    if (values[place] == otherKey.values[place]) continue;
    Report(report, name + " Value #" + std::to_string(place + 1), " is different");
    return false;
  }
  Report(report, name, " matches");
  return true;
}

/// The recursive step of a comparison. Partners are found by name; the marks of both trees are the result.
class CKvfSectionItem::Comparison final {
 public:
  explicit Comparison(const IgnoredNames* ignoreNames) : ignored(Compile(ignoreNames)) {}

  bool Run(CKvfSectionItem& left, CKvfSectionItem& right) {
    if (left.name != right.name) return false;
    if (IsIgnored(left.name, ignored)) {
      left.SetMarks(kIgnored);
      right.SetMarks(kIgnored);
      return true;
    }
    Partners partners(right);
    bool ignoredMarked = false;
    std::size_t differences = 0;
    for (const auto& child : left.children) {
      switch (child->ItemKind()) {
        case kSection:
          differences +=
              CompareSections(static_cast<CKvfSectionItem&>(*child), partners.sections[child->name]);
          break;
        case kKeyword:
          if (IsIgnored(child->name, ignored)) {
            child->mark = kIgnored;
            break;
          }
          if (!ignoredMarked) MarkIgnoredKeywords(right);
          ignoredMarked = true;
          differences += CompareKeywords(static_cast<CKvfKeyItem&>(*child), partners.keywords[child->name]);
          break;
        default:
          child->mark = kIgnored;
          break;
      }
    }
    left.mark = differences == 0 ? kSame : kDifferent;
    return differences == 0;
  }

 private:
  /// The children of a section by name, each list in file order.
  struct Partners {
    explicit Partners(const CKvfSectionItem& section) {
      for (const auto& child : section.children) {
        if (child->ItemKind() == kSection) {
          sections[child->name].push_back(static_cast<CKvfSectionItem*>(child.get()));
        } else if (child->ItemKind() == kKeyword) {
          keywords[child->name].push_back(static_cast<CKvfKeyItem*>(child.get()));
        }
      }
    }
    std::unordered_map<std::string_view, std::vector<CKvfSectionItem*>> sections;
    std::unordered_map<std::string_view, std::vector<CKvfKeyItem*>> keywords;
  };

  /// Does not stop at the first partner: every unmatched one of the name is compared, and none is left for
  /// the next child of the name.
  std::size_t CompareSections(CKvfSectionItem& child, std::vector<CKvfSectionItem*>& candidates) {
    std::size_t differences = 0;
    for (CKvfSectionItem* candidate : std::exchange(candidates, {})) {
      const bool same = Run(child, *candidate);
      if (!same) ++differences;
      child.mark = candidate->mark = same ? kSame : kDifferent;
    }
    return differences;
  }

  static std::size_t CompareKeywords(CKvfKeyItem& child, std::vector<CKvfKeyItem*>& candidates) {
    std::size_t differences = 0;
    for (CKvfKeyItem* candidate : std::exchange(candidates, {})) {
      const bool same = child.Compare(*candidate, nullptr, nullptr, false);
      if (!same) ++differences;
      child.mark = candidate->mark = same ? kSame : kDifferent;
    }
    return differences;
  }

  void MarkIgnoredKeywords(const CKvfSectionItem& section) const {
    for (const auto& child : section.children) {
      const bool open = child->ItemKind() == kKeyword && child->mark == kUnmatched;
      if (open && IsIgnored(child->name, ignored)) child->mark = kIgnored;
    }
  }

  std::vector<std::regex> ignored;
};

bool CKvfSectionItem::Compare(CKvfBaseItem& other, std::ostream* report, const IgnoredNames* ignoreNames,
                              bool onlyKeywords) {
  if (other.ItemKind() != kSection) return false;
  auto& otherSection = static_cast<CKvfSectionItem&>(other);
  SetMarks(kUnmatched);
  otherSection.SetMarks(kUnmatched);
  const bool same = Comparison(ignoreNames).Run(*this, otherSection);
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
  ReportDifferences(*report, kThisSide, onlyKeywords);
  otherSection.ReportDifferences(*report, kOtherSide, onlyKeywords);
  return false;
}

void CKvfSectionItem::ReportDifferences(std::ostream& report, int side, bool onlyKeywords) const {
  constexpr std::array<std::string_view, 2> kUnmatchedTexts = {" is missing", " is extra"};
  for (const auto& child : children) {
    const Kind childKind = child->ItemKind();
    const bool isReported = childKind != kComment && (childKind == kKeyword || !onlyKeywords);
    if (isReported && child->mark == kUnmatched) {
      report << child->Describe() << kUnmatchedTexts.at(static_cast<std::size_t>(side)) << '\n';
    } else if (isReported && child->mark == kDifferent && side == 0) {
      report << child->Describe() << " is different (line " << child->line << ")\n";
    }
    if (childKind == kSection) {
      static_cast<const CKvfSectionItem&>(*child).ReportDifferences(report, side, onlyKeywords);
    }
  }
}

}  // namespace tessal
