// Patterns in texts: the first byte says how the pattern is meant, the lines after it are the pattern, the
// replacement and, with all the rest, the text. Matches are in order and within the text, and a replacement
// changes them and nothing else.
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "core/symbol_ranking.h"
#include "core/text_pattern.h"
#include "platform/text_encoding.h"
#include "template_file.h"

using namespace tessal;
using fuzz::Require;
using fuzz::TakeLine;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  constexpr std::size_t kLongest = 4096;
  if (size == 0 || size > kLongest) return 0;
  std::string_view rest(reinterpret_cast<const char*>(data) + 1, size - 1);
  PatternText given;
  given.isRegex = (data[0] & 1U) != 0;
  given.wholeSymbols = (data[0] & 2U) != 0;
  given.ignoreCase = (data[0] & 4U) != 0;
  given.text = ToUtf8(TakeLine(rest));
  const std::string replacement = ToUtf8(TakeLine(rest));
  const std::string text = ToUtf8(rest);

  const TextPattern pattern(given);
  const std::vector<TextMatch> matches = pattern.MatchesIn(text);
  Require(pattern.Failure().empty() || matches.empty(), "a bad pattern finds nothing");
  Require(given.isRegex || pattern.Failure().empty(), "every plain text is a good pattern");
  std::string replaced;
  std::size_t copied = 0;
  for (const TextMatch& match : matches) {
    Require(match.start >= copied && match.length > 0, "matches are in order, and none is empty");
    Require(match.start + match.length <= text.size(), "a match is in the text");
    Require(IsUtf8(text.substr(match.start, match.length)), "a match is made of characters");
    if (!given.isRegex && !given.ignoreCase)
      Require(text.compare(match.start, match.length, given.text) == 0, "plain text matches itself");
    replaced.append(text, copied, match.start - copied).append(replacement);
    copied = match.start + match.length;
  }
  replaced.append(text, copied);
  if (pattern.ReplacementFailure(replacement).empty()) {
    const std::string made = pattern.Replaced(text, replacement);
    const bool isLiteral = !given.isRegex || replacement.find('\\') == std::string::npos;
    if (isLiteral) Require(made == replaced, "a replacement changes the matches alone");
    Require(!matches.empty() || made == text, "without a match nothing changes");
  }
  // The letters of a symbol always lead to it.
  Require(RankSymbol(text, given.text).has_value() || text.find(given.text) != 0 || text.size() > 256,
          "a symbol fits its own beginning");
  return 0;
}
