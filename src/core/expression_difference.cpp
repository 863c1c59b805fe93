#include "core/expression_difference.h"

#include <algorithm>
#include <cstdint>

#include "expr/token_walk.h"

namespace tessal {

namespace {

/// The most comparisons of a token with a token. More are no help to a reader, and take their time.
constexpr std::size_t kMostCells = 250'000;

using Tokens = std::vector<std::string_view>;

Tokens TokensOf(std::string_view text) {
  Tokens tokens;
  ForEachToken(text, [&tokens](TokenCode /*code*/, std::string_view lexeme) { tokens.push_back(lexeme); });
  return tokens;
}

/// Adds a token to the parts of its text; one next to the last part makes it longer.
void Add(std::vector<TextPart>& parts, std::string_view text, const Tokens& tokens, std::size_t place) {
  const auto start = static_cast<std::size_t>(tokens[place].data() - text.data());
  const std::size_t end = start + tokens[place].size();
  const bool follows = !parts.empty() && place > 0 &&
                       parts.back().end == static_cast<std::size_t>(tokens[place - 1].data() - text.data()) +
                                               tokens[place - 1].size();
  if (follows) {
    parts.back().end = end;
  } else {
    parts.push_back({start, end});
  }
}

/// The rows of a longest common sequence: for each pair of rests of the middles, its length.
class CommonLengths final {
 public:
  CommonLengths(const Tokens& beforeTokens, const Tokens& afterTokens, std::size_t prefix, std::size_t suffix)
      : rows(beforeTokens.size() - prefix - suffix), columns(afterTokens.size() - prefix - suffix) {
    if (rows * columns > kMostCells) return;
    lengths.assign((rows + 1) * (columns + 1), 0);
    for (std::size_t row = rows; row-- > 0;) {
      for (std::size_t column = columns; column-- > 0;) {
        const bool isSame = beforeTokens[prefix + row] == afterTokens[prefix + column];
        At(row, column) =
            isSame ? At(row + 1, column + 1) + 1 : std::max(At(row + 1, column), At(row, column + 1));
      }
    }
  }

  bool IsEmpty() const { return lengths.empty(); }
  std::uint32_t& At(std::size_t row, std::size_t column) { return lengths[row * (columns + 1) + column]; }

 private:
  std::size_t rows;
  std::size_t columns;
  std::vector<std::uint32_t> lengths;
};

}  // namespace

ExpressionDifference DifferenceOf(std::string_view before, std::string_view after) {
  const Tokens former = TokensOf(before);
  const Tokens later = TokensOf(after);
  const std::size_t shorter = std::min(former.size(), later.size());
  std::size_t prefix = 0;
  while (prefix < shorter && former[prefix] == later[prefix]) ++prefix;
  std::size_t suffix = 0;
  while (suffix < shorter - prefix && former[former.size() - 1 - suffix] == later[later.size() - 1 - suffix])
    ++suffix;
  CommonLengths common(former, later, prefix, suffix);
  ExpressionDifference difference;
  std::size_t row = 0;
  std::size_t column = 0;
  const std::size_t rows = former.size() - prefix - suffix;
  const std::size_t columns = later.size() - prefix - suffix;
  while (row < rows || column < columns) {
    const bool isInBoth = row < rows && column < columns;
    if (isInBoth && !common.IsEmpty() && former[prefix + row] == later[prefix + column]) {
      ++row;
      ++column;
    } else if (row < rows && (column == columns || common.IsEmpty() ||
                              common.At(row + 1, column) >= common.At(row, column + 1))) {
      Add(difference.before, before, former, prefix + row++);
    } else {
      Add(difference.after, after, later, prefix + column++);
    }
  }
  return difference;
}

}  // namespace tessal
