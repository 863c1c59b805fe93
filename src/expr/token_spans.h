// The tokens of an expression by their places: what looks at a text while it is edited works on them, whether
// the text scans cleanly or not.
#pragma once

#include <string_view>
#include <vector>

#include "expr/scanner.h"

namespace tessal {

struct TokenSpan {
  TokenCode code;  ///< the (signed) character for one without a kind
  LexemeSpan span;

  std::uint32_t End() const { return span.start + span.length; }
};

/// All tokens up to the end or a zero byte, comments left out. Leaves no trace in the scanner.
std::vector<TokenSpan> TokenSpans(std::string_view text);

/// The text of a token of it.
inline std::string_view TextOf(std::string_view text, const TokenSpan& token) {
  return text.substr(token.span.start, token.span.length);
}

constexpr bool IsNumber(TokenCode code) {
  return code >= TokenCode::IntNum && code <= TokenCode::ScientificNum;
}

/// The closing bracket of an opening one; `End` for what opens nothing.
constexpr TokenCode ClosingOf(TokenCode code) {
  switch (code) {
    case TokenCode::LeftBracket:
      return TokenCode::RightBracket;
    case TokenCode::LeftSquare:
      return TokenCode::RightSquare;
    case TokenCode::LeftCurly:
      return TokenCode::RightCurly;
    default:
      return TokenCode::End;
  }
}

constexpr bool IsOpening(TokenCode code) {
  return ClosingOf(code) != TokenCode::End;
}

constexpr bool IsClosing(TokenCode code) {
  return code == TokenCode::RightBracket || code == TokenCode::RightSquare || code == TokenCode::RightCurly;
}

/// Whether a value may end with the token, so that an operator comes next.
constexpr bool EndsValue(TokenCode code) {
  return code == TokenCode::Identifier || IsNumber(code) || IsClosing(code);
}

}  // namespace tessal
