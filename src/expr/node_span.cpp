#include "expr/node_span.h"

#include <algorithm>
#include <cstddef>
#include <functional>
#include <optional>
#include <vector>

#include "expr/expression_shape.h"
#include "expr/token_spans.h"

namespace tessal {

namespace {

/// The tokens, and the places of the first and the last that belong to a node.
struct TokenRange {
  const std::vector<TokenSpan>& tokens;
  std::size_t first;
  std::size_t last;

  TokenCode Code(std::size_t place) const { return tokens[place].code; }

  /// Takes in what closes the brackets that the range opens, and what opens those that it closes.
  void Balance() {
    std::size_t open = 0;
    std::size_t unopened = 0;
    for (std::size_t place = first; place <= last; ++place) {
      if (IsOpening(Code(place))) ++open;
      if (!IsClosing(Code(place))) continue;
      if (open > 0) {
        --open;
      } else {
        ++unopened;
      }
    }
    // Whatever else lies between is of the node too: the list of a call, the end of an interaction.
    for (std::size_t inner = 0; open > 0 && last + 1 < tokens.size();) {
      ++last;
      if (IsOpening(Code(last))) ++inner;
      if (IsClosing(Code(last)) && inner-- == 0) {
        --open;
        inner = 0;
      }
    }
    while (unopened > 0 && first > 0) {
      --first;
      if (IsOpening(Code(first))) --unopened;
    }
  }

  /// Takes in the token before the first one and the brackets that open before it, where it is of this kind.
  void TakeInBefore(TokenCode code) {
    std::size_t place = first;
    while (place > 0 && Code(place - 1) == TokenCode::LeftBracket) --place;
    if (place > 0 && Code(place - 1) == code) first = place - 1;
  }

  /// Takes in what comes after the text of the last leaf.
  void TakeInAfter() {
    const auto hasNext = [this](TokenCode code) {
      return last + 1 < tokens.size() && Code(last + 1) == code;
    };
    if (hasNext(TokenCode::RightSquare)) ++last;
    // A call without arguments.
    if (Code(last) == TokenCode::Identifier && hasNext(TokenCode::LeftBracket)) ++last;
  }
};

/// Whether the text of a node is a part of the scanned text: "negate" and its like are not.
bool IsPartOf(std::string_view part, std::string_view text) {
  const std::less_equal<const char*> isNotAfter;
  return !part.empty() && isNotAfter(text.data(), part.data()) &&
         isNotAfter(part.data() + part.size(), text.data() + text.size());
}

/// The token with which a node begins, where that is no part of its text.
TokenCode OwnStart(const ExpressionNode& node, std::string_view text) {
  switch (node.Kind()) {
    case NodeKind::Negate:
      return TokenCode::AddOpMinus;
    case NodeKind::Conditional:
      return TokenCode::If;
    case NodeKind::Property:
      return TokenCode::LeftSquare;
    case NodeKind::Exceedance:
      return TokenCode::ExceedanceFrequency;
    case NodeKind::Call:
      return IsPartOf(node.Text(), text) ? TokenCode::End : TokenCode::RvalId;
    default:
      return TokenCode::End;
  }
}

/// Whether the text of a node comes before its children.
bool BeginsWithItsText(const ExpressionNode& node, std::string_view text) {
  switch (node.Kind()) {
    case NodeKind::Arithmetic:
    case NodeKind::Comparison:
      return false;
    default:
      return IsPartOf(node.Text(), text);
  }
}

/// The starts of a node and of those in it that begin at the same place, from the innermost out.
std::vector<TokenCode> StartsOf(const ExpressionNode& node, std::string_view text) {
  std::vector<TokenCode> starts;
  for (const ExpressionNode* part = &node; part != nullptr;) {
    // What the grammar has made of AND, OR and NOT has no words of its own.
    const std::optional<Logic> logic =
        part->Kind() == NodeKind::Comparison ? LogicOf(*part) : std::optional<Logic>();
    if (logic) {
      if (logic->which == Logic::Operator::Not) starts.push_back(TokenCode::NotOp);
      part = &logic->left;
      continue;
    }
    if (const TokenCode start = OwnStart(*part, text); start != TokenCode::End) starts.push_back(start);
    if (BeginsWithItsText(*part, text)) break;
    part = part->Child(1);
  }
  std::reverse(starts.begin(), starts.end());
  return starts;
}

}  // namespace

LexemeSpan SpanOf(const ExpressionNode& node, std::string_view text) {
  auto begin = static_cast<std::uint32_t>(text.size());
  std::uint32_t end = 0;
  node.WalkPostOrder(
      nullptr,
      [&](NodeKind, std::string_view part, std::int32_t) {
        if (!IsPartOf(part, text)) return;
        const auto start = static_cast<std::uint32_t>(part.data() - text.data());
        begin = std::min(begin, start);
        end = std::max(end, start + static_cast<std::uint32_t>(part.size()));
      },
      nullptr);
  if (begin >= end) return {0, 0};
  const std::vector<TokenSpan> tokens = TokenSpans(text);
  const auto first = std::find_if(tokens.begin(), tokens.end(),
                                  [begin](const TokenSpan& token) { return token.End() > begin; });
  if (first == tokens.end()) return {begin, end - begin};
  const auto after =
      std::find_if(first, tokens.end(), [end](const TokenSpan& token) { return token.span.start >= end; });
  TokenRange range{tokens, static_cast<std::size_t>(first - tokens.begin()),
                   static_cast<std::size_t>(after - tokens.begin()) - 1};
  for (const TokenCode start : StartsOf(node, text)) range.TakeInBefore(start);
  range.TakeInAfter();
  range.Balance();
  const std::uint32_t start = tokens[range.first].span.start;
  return {start, tokens[range.last].End() - start};
}

std::string_view TextOf(const ExpressionNode& node, std::string_view text) {
  const LexemeSpan span = SpanOf(node, text);
  return text.substr(span.start, span.length);
}

}  // namespace tessal
