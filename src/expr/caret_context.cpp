#include "expr/caret_context.h"

#include <algorithm>
#include <vector>

#include "expr/token_spans.h"

namespace tessal {

namespace {

/// A bracket that is open at the caret.
struct OpenBracket {
  TokenCode code;
  LexemeSpan name{0, 0};  ///< of what is called, if it is a call
  bool isTarget = false;  ///< the first parentheses of an interaction
  std::size_t commas = 0;
};

/// Whether the gap before the caret has it in a comment.
bool IsInComment(std::string_view text, std::size_t gapStart, std::size_t caret) {
  std::size_t place = gapStart;
  for (;;) {
    const std::size_t start = text.find("/*", place);
    if (start == std::string_view::npos || start + 2 > caret) return false;
    const std::size_t end = text.find("*/", start + 2);
    if (end == std::string_view::npos || end + 2 > caret) return true;
    place = end + 2;
  }
}

bool IsWord(TokenCode code) {
  return code == TokenCode::Identifier || code == TokenCode::ExceedanceFrequency ||
         (code >= TokenCode::If && code <= TokenCode::OrOp);
}

OpenBracket Opened(std::string_view text, const std::vector<TokenSpan>& tokens, std::size_t place) {
  OpenBracket open{tokens[place].code};
  if (place == 0 || open.code != TokenCode::LeftBracket) return open;
  const TokenSpan& before = tokens[place - 1];
  open.isTarget = before.code == TokenCode::LeftCurly;
  const bool isCall = IsWord(before.code) && before.code != TokenCode::NotOp &&
                      before.code != TokenCode::AndOp && before.code != TokenCode::OrOp &&
                      before.code != TokenCode::Then && before.code != TokenCode::Else;
  if (isCall && !TextOf(text, before).empty()) open.name = before.span;
  return open;
}

/// Takes a closing bracket off the ones that are open; one that closes nothing changes nothing.
void Close(std::vector<OpenBracket>& open, TokenCode closing) {
  const auto last = std::find_if(open.rbegin(), open.rend(), [closing](const OpenBracket& bracket) {
    return ClosingOf(bracket.code) == closing;
  });
  if (last != open.rend()) open.erase(std::prev(last.base()), open.end());
}

CaretPlace PlaceAfter(const TokenSpan* before, const std::vector<OpenBracket>& open) {
  if (!open.empty() && open.back().isTarget && open.back().commas == 0) return CaretPlace::Target;
  if (before == nullptr) return CaretPlace::Value;
  if (before->code == TokenCode::LeftSquare) return CaretPlace::Property;
  return EndsValue(before->code) ? CaretPlace::Operator : CaretPlace::Value;
}

}  // namespace

CaretContext ContextAt(std::string_view text, std::size_t caret) {
  const std::vector<TokenSpan> tokens = TokenSpans(text);
  CaretContext context;
  context.word = {static_cast<std::uint32_t>(caret), 0};
  std::vector<OpenBracket> open;
  const TokenSpan* before = nullptr;
  bool isInNumber = false;
  for (std::size_t place = 0; place < tokens.size() && tokens[place].span.start < caret; ++place) {
    const TokenSpan& token = tokens[place];
    const bool touches = caret <= token.End();
    if (touches && IsWord(token.code)) {
      context.word = token.span;
      // The E of a number whose exponent is still to come.
      isInNumber = before != nullptr && IsNumber(before->code) && before->End() == token.span.start;
      break;
    }
    isInNumber = touches && IsNumber(token.code);
    if (isInNumber) break;
    if (caret < token.End()) break;
    if (IsOpening(token.code)) open.push_back(Opened(text, tokens, place));
    if (IsClosing(token.code)) Close(open, token.code);
    if (token.code == TokenCode::Comma && !open.empty()) ++open.back().commas;
    before = &token;
  }
  const auto call = std::find_if(open.rbegin(), open.rend(),
                                 [](const OpenBracket& bracket) { return bracket.name.length > 0; });
  const bool isComment = IsInComment(text, before == nullptr ? 0 : before->End(), context.word.start);
  if (call != open.rend() && !isComment) context.call = CallAtCaret{call->name, call->commas};
  if (!isInNumber && !isComment) context.place = PlaceAfter(before, open);
  return context;
}

std::optional<BracketPair> BracketAt(std::string_view text, std::size_t caret) {
  const std::vector<TokenSpan> tokens = TokenSpans(text);
  const auto isBracket = [](const TokenSpan& token) {
    return IsOpening(token.code) || IsClosing(token.code);
  };
  const auto endsAt = std::find_if(tokens.begin(), tokens.end(), [&](const TokenSpan& token) {
    return isBracket(token) && token.End() == caret;
  });
  const auto chosen = endsAt != tokens.end()
                          ? endsAt
                          : std::find_if(tokens.begin(), tokens.end(), [&](const TokenSpan& token) {
                              return isBracket(token) && token.span.start == caret;
                            });
  if (chosen == tokens.end()) return std::nullopt;
  std::vector<const TokenSpan*> open;
  for (const TokenSpan& token : tokens) {
    if (IsOpening(token.code)) open.push_back(&token);
    if (!IsClosing(token.code)) continue;
    const bool fits = !open.empty() && ClosingOf(open.back()->code) == token.code;
    if (&token == &*chosen)
      return BracketPair{token.span, fits ? std::optional(open.back()->span) : std::nullopt};
    if (fits && open.back() == &*chosen) return BracketPair{chosen->span, token.span};
    // One of another kind closes nothing.
    if (fits) open.pop_back();
  }
  return BracketPair{chosen->span, std::nullopt};
}

}  // namespace tessal
