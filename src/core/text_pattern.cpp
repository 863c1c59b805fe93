#include "core/text_pattern.h"

#include <re2/re2.h>

#include <array>

#include "platform/ascii.h"
#include "platform/utf8_bytes.h"

namespace tessal {

namespace {

/// The match and the groups that a replacement may name.
constexpr int kMostGroups = 10;

/// A pattern that matches where the given one does, but not within a symbol. A plain pattern that begins or
/// ends with a sign has no symbol to bound there.
std::string BoundBySymbols(const PatternText& pattern, const std::string& expression) {
  const std::string bound = "\\b";
  const bool atStart = pattern.isRegex || IsWordCharacter(pattern.text.front());
  const bool atEnd = pattern.isRegex || IsWordCharacter(pattern.text.back());
  return (atStart ? bound : std::string()) + "(?:" + expression + ")" + (atEnd ? bound : std::string());
}

/// The place of the character after the one at a place.
std::size_t AfterCharacter(std::string_view text, std::size_t place) {
  ++place;
  while (place < text.size() && ContinuesCharacter(text[place])) ++place;
  return place;
}

}  // namespace

class TextPattern::Engine final {
 public:
  Engine(const std::string& expression, const re2::RE2::Options& options) : regex(expression, options) {}

  const re2::RE2 regex;
};

TextPattern::TextPattern(const PatternText& pattern) : isRegex(pattern.isRegex) {
  if (pattern.text.empty()) return;
  re2::RE2::Options options;
  options.set_log_errors(false);
  options.set_case_sensitive(!pattern.ignoreCase);
  const std::string expression = isRegex ? pattern.text : re2::RE2::QuoteMeta(pattern.text);
  auto made = std::make_unique<const Engine>(expression, options);
  // Bounds come only around what is good by itself: they must not close a bracket of its own.
  if (made->regex.ok() && pattern.wholeSymbols)
    made = std::make_unique<const Engine>(BoundBySymbols(pattern, expression), options);
  if (!made->regex.ok()) {
    failure = "The pattern cannot be used: " + made->regex.error();
    return;
  }
  engine = std::move(made);
}

TextPattern::~TextPattern() = default;

/// Calls the visitor with each match and its groups, an array with the match first.
template <class Visitor>
void TextPattern::ForEachMatch(std::string_view text, int groups, Visitor visit) const {
  if (engine == nullptr) return;
  std::array<re2::StringPiece, kMostGroups> found;
  const re2::StringPiece whole(text.data(), text.size());
  std::size_t place = 0;
  while (place <= text.size() &&
         engine->regex.Match(whole, place, text.size(), re2::RE2::UNANCHORED, found.data(), groups)) {
    const auto start = static_cast<std::size_t>(found[0].data() - text.data());
    if (found[0].empty()) {
      place = AfterCharacter(text, start);
      continue;
    }
    place = start + found[0].size();
    visit(TextMatch{start, found[0].size()}, found);
  }
}

std::vector<TextMatch> TextPattern::MatchesIn(std::string_view text) const {
  std::vector<TextMatch> matches;
  ForEachMatch(text, 1, [&matches](const TextMatch& match, const auto&) { matches.push_back(match); });
  return matches;
}

std::string TextPattern::ReplacementFailure(const std::string& replacement) const {
  std::string reason;
  if (!isRegex || engine == nullptr || engine->regex.CheckRewriteString(replacement, &reason)) return {};
  return "The replacement cannot be used: " + reason;
}

std::string TextPattern::Replaced(std::string_view text, const std::string& replacement) const {
  std::string result;
  std::size_t copied = 0;
  const int groups = isRegex ? re2::RE2::MaxSubmatch(replacement) + 1 : 1;
  ForEachMatch(text, groups, [&](const TextMatch& match, const auto& found) {
    result += text.substr(copied, match.start - copied);
    if (isRegex) {
      engine->regex.Rewrite(&result, replacement, found.data(), groups);
    } else {
      result += replacement;
    }
    copied = match.start + match.length;
  });
  return result.append(text.substr(copied));
}

}  // namespace tessal
