// What a search looks for: plain text, or a regular expression in the syntax of RE2, which takes no more time
// than the text is long. Patterns, texts and places are in UTF-8.
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace tessal {

/// A pattern as the user enters it.
struct PatternText {
  std::string text;
  bool isRegex = false;
  bool wholeSymbols = false;  ///< a match does not begin or end within a symbol
  bool ignoreCase = false;
};

/// A match by its place, in bytes. It is never empty.
struct TextMatch {
  std::size_t start = 0;
  std::size_t length = 0;
  bool operator==(const TextMatch&) const = default;
};

class TextPattern final {
 public:
  explicit TextPattern(const PatternText& pattern);
  TextPattern(const TextPattern&) = delete;
  TextPattern& operator=(const TextPattern&) = delete;
  ~TextPattern();

  /// Why the pattern finds nothing at all, in words for the user; empty when it is a good one. An empty
  /// pattern is a good one, and finds nothing.
  const std::string& Failure() const { return failure; }

  /// The matches in a text, from its start on; none overlaps another.
  std::vector<TextMatch> MatchesIn(std::string_view text) const;

  /// Why a replacement cannot be used, in words for the user; empty when it can. That for a regular
  /// expression has \1 to \9 for its groups, \0 for the match, and \\ for a backslash; a plain one is taken
  /// as it is.
  std::string ReplacementFailure(const std::string& replacement) const;

  /// The text with each match replaced.
  std::string Replaced(std::string_view text, const std::string& replacement) const;

 private:
  class Engine;

  template <class Visitor>
  void ForEachMatch(std::string_view text, int groups, Visitor visit) const;

  std::unique_ptr<const Engine> engine;  ///< none for a pattern that finds nothing
  bool isRegex;
  std::string failure;
};

}  // namespace tessal
