#include "expr/plain_language.h"

#include <algorithm>
#include <array>
#include <optional>

#include "expr/fault_rules.h"
#include "expr/function_catalogue.h"
#include "expr/function_reference.h"
#include "expr/parser.h"
#include "expr/semantic_checks.h"
#include "expr/token_spans.h"
#include "expr/user_function_names.h"
#include "platform/ascii.h"
#include "platform/utf8_bytes.h"

namespace tessal {

namespace {

struct SortRow {
  TokenCode first;
  TokenCode last;
  sort::Set sort;
};

constexpr std::array<SortRow, 20> kSorts = {{
    {TokenCode::Identifier, TokenCode::Identifier, sort::kName},
    {TokenCode::IntNum, TokenCode::ScientificNum, sort::kNumber},
    {TokenCode::AddOpPlus, TokenCode::AddOpMinus, sort::kSign},
    {TokenCode::MulOpMultiply, TokenCode::MulOpDivide, sort::kFactor},
    {TokenCode::Comma, TokenCode::Comma, sort::kComma},
    {TokenCode::LeftBracket, TokenCode::LeftBracket, sort::kOpen},
    {TokenCode::RightBracket, TokenCode::RightBracket, sort::kClose},
    {TokenCode::LeftSquare, TokenCode::LeftSquare, sort::kOpenSquare},
    {TokenCode::RightSquare, TokenCode::RightSquare, sort::kCloseSquare},
    {TokenCode::LeftCurly, TokenCode::LeftCurly, sort::kOpenCurly},
    {TokenCode::RightCurly, TokenCode::RightCurly, sort::kCloseCurly},
    {TokenCode::Equal, TokenCode::SmallerOrEqual, sort::kRelation},
    {TokenCode::If, TokenCode::If, sort::kIf},
    {TokenCode::Then, TokenCode::Then, sort::kThen},
    {TokenCode::Else, TokenCode::Else, sort::kElse},
    {TokenCode::NotOp, TokenCode::NotOp, sort::kNot},
    {TokenCode::AndOp, TokenCode::OrOp, sort::kJoin},
    {TokenCode::DirectAssign, TokenCode::DirectDivide, sort::kModify},
    {TokenCode::RvalId, TokenCode::RvalId, sort::kRefer},
    {TokenCode::ExceedanceFrequency, TokenCode::ExceedanceFrequency, sort::kExceedance},
}};

sort::Set SortOf(TokenCode code) {
  const auto row = std::find_if(kSorts.begin(), kSorts.end(), [code](const SortRow& each) {
    return each.first <= code && code <= each.last;
  });
  return row == kSorts.end() ? sort::kStray : row->sort;
}

/// A bracket that is open, or the text as a whole, with how far an IF in it has come.
struct Level {
  std::optional<TokenSpan> bracket;
  around::Set kind = around::kTop;
  LexemeSpan called{0, 0};
  /// The IFs at this level that have no value for either case yet; the innermost last.
  std::vector<around::Set> conditionals = {};
};

/// The bits of an interaction's lists and of conditions reach into the brackets within.
around::Set KindOf(const Level& outer, const TokenSpan* before, const TokenSpan& bracket) {
  switch (bracket.code) {
    case TokenCode::LeftSquare:
      return around::kSquare;
    case TokenCode::LeftCurly:
      return around::kCurly;
    default:
      break;
  }
  const bool isOfInteraction = outer.kind == around::kCurly;
  if (isOfInteraction) return around::kCurly;
  if (before == nullptr) return around::kParentheses;
  if (before->code == TokenCode::Identifier) return around::kCall;
  return before->code == TokenCode::If ? around::kIfCall : around::kParentheses;
}

/// What is open where the parse stopped.
class Surroundings final {
 public:
  Surroundings(const std::vector<TokenSpan>& tokens, std::size_t end) : levels(1) {
    for (std::size_t place = 0; place < end; ++place) {
      Pass(place == 0 ? nullptr : &tokens[place - 1], tokens[place]);
    }
  }

  const Level& Innermost() const { return levels.back(); }

  /// The part of an IF around the place.
  around::Set Part() const {
    const auto level = std::find_if(levels.rbegin(), levels.rend(), IsEdge);
    return level == levels.rend() || level->conditionals.empty() ? around::kNoIf : level->conditionals.back();
  }

 private:
  void Pass(const TokenSpan* before, const TokenSpan& token) {
    Level& level = levels.back();
    if (IsOpening(token.code)) {
      Open(before, token);
    } else if (IsClosing(token.code)) {
      const auto open = std::find_if(levels.rbegin(), levels.rend(), [&token](const Level& each) {
        return each.bracket && ClosingOf(each.bracket->code) == token.code;
      });
      if (open != levels.rend()) levels.erase(std::prev(open.base()), levels.end());
      if (levels.back().kind == around::kIfCall) return;
    } else if (token.code == TokenCode::If) {
      level.conditionals.push_back(around::kCondition);
    } else if (token.code == TokenCode::Then) {
      SetPart(around::kThenPart);
    } else if (token.code == TokenCode::Else) {
      EndThen();
    } else if (SortOf(token.code) == sort::kRelation) {
      if (Part() == around::kCondition) SetPart(around::kCompared);
    } else if (SortOf(token.code) == sort::kJoin) {
      if (Part() == around::kCompared) SetPart(around::kCondition);
    } else if (token.code == TokenCode::Comma && level.kind == around::kIfCall) {
      level.conditionals.assign(1, around::kElsePart);
    }
  }

  void Open(const TokenSpan* before, const TokenSpan& token) {
    Level inner{.bracket = token, .kind = KindOf(levels.back(), before, token)};
    if (inner.kind == around::kCall) inner.called = before->span;
    const bool isExceedance = before != nullptr && before->code == TokenCode::ExceedanceFrequency;
    if (inner.kind == around::kIfCall || isExceedance) inner.conditionals.push_back(around::kCondition);
    levels.push_back(inner);
  }

  /// Whether a level has an IF of its own, or hides the ones around it, as plain parentheses do not.
  static bool IsEdge(const Level& level) {
    return !level.conditionals.empty() || level.kind != around::kParentheses;
  }

  void SetPart(around::Set part) {
    const auto level = std::find_if(levels.rbegin(), levels.rend(), IsEdge);
    if (level == levels.rend() || level->conditionals.empty()) return;
    level->conditionals.back() = part;
    // What looks like IF( may be a condition in parentheses, of an IF with THEN.
    const auto outer = std::next(level);
    if (level->kind == around::kIfCall && part != around::kThenPart && outer != levels.rend() &&
        !outer->conditionals.empty())
      outer->conditionals.back() = part;
  }

  void EndThen() {
    std::vector<around::Set>& open = levels.back().conditionals;
    while (!open.empty() && open.back() != around::kThenPart) open.pop_back();
    if (!open.empty()) open.back() = around::kElsePart;
  }

  std::vector<Level> levels;
};

/// What to write in the place of a character beyond ASCII.
std::string SentenceOnCharacter(std::string_view text, LexemeSpan character) {
  const std::string_view sign = text.substr(character.start, character.length);
  for (const ForeignSign& foreign : ForeignSigns()) {
    if (foreign.sign == sign) return std::string(foreign.sentence);
  }
  return "Nothing is read from here on: " + std::string(sign) + " may only be in a comment.";
}

/// One search for the sentence on a syntax fault.
class SyntaxFault final {
 public:
  SyntaxFault(std::string_view faultyText, const std::vector<TokenSpan>& textTokens, LexemeSpan stopped)
      : text(faultyText), tokens(textTokens), place(PlaceOf(stopped.start)), around(textTokens, place) {}

  ExpressionFault Find() const {
    if (const auto comment = OpenComment(text, tokens); comment && place == tokens.size()) return *comment;
    ExpressionFault fault;
    if (At() != nullptr) {
      fault.at = CharacterAt(text, At()->span);
    } else if (Before() != nullptr) {
      const std::optional<TokenSpan>& open = around.Innermost().bracket;
      fault.at = open && EndsValue(Before()->code) ? open->span : Before()->span;
    }
    fault.plain =
        At() != nullptr && At()->code < TokenCode::End ? SentenceOnCharacter(text, fault.at) : Sentence();
    return fault;
  }

  /// The comment that is open at the end of a text.
  static std::optional<ExpressionFault> OpenComment(std::string_view text,
                                                    const std::vector<TokenSpan>& tokens) {
    std::size_t start = text.find("/*", tokens.empty() ? 0 : tokens.back().End());
    while (start != std::string_view::npos) {
      const std::size_t end = text.find("*/", start + 2);
      if (end == std::string_view::npos) {
        ExpressionFault fault;
        fault.at = {static_cast<std::uint32_t>(start), 2};
        fault.plain = "The comment that begins here is not closed by */.";
        return fault;
      }
      start = text.find("/*", end + 2);
    }
    return std::nullopt;
  }

  /// The whole of a character in UTF-8 of which a token is the first byte.
  static LexemeSpan CharacterAt(std::string_view text, LexemeSpan token) {
    const auto isContinued = [text](std::size_t at) {
      return at < text.size() && ContinuesCharacter(text[at]);
    };
    if (token.length == 1 && (static_cast<unsigned char>(text[token.start]) & 0x80U) != 0) {
      while (isContinued(token.start + token.length)) ++token.length;
    }
    return token;
  }

 private:
  /// The index of the token at which the parse stopped; the count of tokens at the end of the text.
  std::size_t PlaceOf(std::uint32_t start) const {
    const auto token = std::find_if(tokens.begin(), tokens.end(),
                                    [start](const TokenSpan& each) { return each.span.start >= start; });
    return static_cast<std::size_t>(token - tokens.begin());
  }

  const TokenSpan* Before() const { return place == 0 ? nullptr : &tokens[place - 1]; }
  const TokenSpan* At() const { return place < tokens.size() ? &tokens[place] : nullptr; }
  const TokenSpan* After() const { return place + 1 < tokens.size() ? &tokens[place + 1] : nullptr; }

  std::string_view TextAt(const TokenSpan* token) const {
    return token == nullptr ? std::string_view() : TextOf(text, *token);
  }

  bool Fits(const FaultRule& rule) const {
    const auto isOf = [](sort::Set set, const TokenSpan* token) {
      return (set & (token == nullptr ? sort::kNone : SortOf(token->code))) != 0;
    };
    if (!isOf(rule.before, Before()) || !isOf(rule.at, At()) || !isOf(rule.after, After())) return false;
    if ((rule.brackets & around.Innermost().kind) == 0 || (rule.parts & around.Part()) == 0) return false;
    const auto isText = [](std::string_view wanted, std::string_view given) {
      return wanted.empty() || EqualIgnoringCase(wanted, given);
    };
    if (!isText(rule.atText, TextAt(At())) || !isText(rule.beforeText, TextAt(Before()))) return false;
    const bool touchesBefore = rule.touch == Touch::Any || Touches(Before(), At());
    return touchesBefore && (rule.touch != Touch::BothSides || Touches(At(), After()));
  }

  static bool Touches(const TokenSpan* left, const TokenSpan* right) {
    return left != nullptr && right != nullptr && left->End() == right->span.start;
  }

  std::string Sentence() const {
    const std::span<const FaultRule> rules = FaultRules();
    const auto rule =
        std::find_if(rules.begin(), rules.end(), [this](const FaultRule& each) { return Fits(each); });
    return Filled(rule->sentence);
  }

  std::string_view ValueOf(char letter) const {
    const std::optional<TokenSpan>& open = around.Innermost().bracket;
    switch (letter) {
      case 'a':
        return TextAt(At());
      case 'b':
        return TextAt(Before());
      case 'n':
        return TextAt(After());
      case 'o':
        return open ? TextOf(text, *open) : std::string_view();
      case 'c':
        return !open                                  ? std::string_view()
               : open->code == TokenCode::LeftBracket ? ")"
               : open->code == TokenCode::LeftSquare  ? "]"
                                                      : "}";
      default:
        return text.substr(around.Innermost().called.start, around.Innermost().called.length);
    }
  }

  std::string Filled(std::string_view sentence) const {
    constexpr std::size_t kLongestName = 40;
    std::string filled;
    for (std::size_t letter = 0; letter < sentence.size(); ++letter) {
      if (sentence[letter] != '%') {
        filled += sentence[letter];
        continue;
      }
      const std::string_view value = ValueOf(sentence[++letter]);
      filled += value.substr(0, kLongestName);
      if (value.size() > kLongestName) filled += "...";
    }
    return filled;
  }

  std::string_view text;
  const std::vector<TokenSpan>& tokens;
  std::size_t place;
  Surroundings around;
};

/// Sentences on failures that have no place in the grammar.
struct LimitSentence {
  std::string_view code;
  std::string_view sentence;
};

constexpr std::array<LimitSentence, 3> kLimits = {{
    {"token-too-long", "A name or a number has at most 999 characters."},
    {"nesting-too-deep", "The brackets and conditions are nested too deeply."},
    {"expression-too-long", "The expression is too long to be read."},
}};

ExpressionFault FaultOf(const ParseFailure& failure, std::string_view text,
                        const std::vector<TokenSpan>& tokens) {
  const auto limit = std::find_if(kLimits.begin(), kLimits.end(), [&failure](const LimitSentence& row) {
    return row.code == failure.finding.message->code;
  });
  ExpressionFault fault;
  if (limit != kLimits.end()) {
    fault.at = failure.at;
    fault.plain = limit->sentence;
  } else {
    fault = SyntaxFault(text, tokens, failure.at).Find();
  }
  fault.isSyntax = true;
  fault.words = failure.finding.text;
  while (!fault.words.empty() && fault.words.back() == '\n') fault.words.pop_back();
  return fault;
}

std::string CountText(std::int32_t count) {
  if (count == 0) return "no arguments";
  return std::to_string(count) + (count == 1 ? " argument" : " arguments");
}

std::string SentenceOnCall(std::string_view code, std::string_view name, std::int32_t given) {
  if (code == "unknown-property")
    return "No property is called " + std::string(name) + "." + NearNamesText(name, PropertyNames());
  const CatalogueFunction* function = FindFunction(name);
  if (code == "argument-count" && function != nullptr) {
    return std::string(name) + " takes " + CountText(function->argumentCount) + ": " + std::string(name) +
           "(" + JoinedArguments(*function) + "). Here it is given " + CountText(given) + ".";
  }
  if (name == "RID_VAL") return "$ calls a user function of the name RID_VAL, and there is none.";
  if (code == "deprecated-function")
    return std::string(name) + " is kept for old templates: use another function.";
  std::vector<std::string_view> names;
  for (const CatalogueFunction& row : Functions()) names.push_back(row.name);
  for (const std::string& row : UserFunctionNames()) names.push_back(row);
  return "No function is called " + std::string(name) + "." + NearNamesText(name, names);
}

/// Where a name of the tree is in the text; that of a call by `$` is in none.
LexemeSpan SpanOf(std::string_view text, std::string_view name, const std::vector<TokenSpan>& tokens) {
  if (name.data() >= text.data() && name.data() + name.size() <= text.data() + text.size()) {
    return {static_cast<std::uint32_t>(name.data() - text.data()), static_cast<std::uint32_t>(name.size())};
  }
  const auto sign = std::find_if(tokens.begin(), tokens.end(),
                                 [](const TokenSpan& each) { return each.code == TokenCode::RvalId; });
  return sign == tokens.end() ? LexemeSpan{0, 0} : sign->span;
}

}  // namespace

std::string NearNamesText(std::string_view typed, std::span<const std::string_view> names) {
  std::string text;
  for (const std::string_view name : NearestNames(typed, names)) {
    text += (text.empty() ? " Near it: " : ", ") + std::string(name);
    // One that differs in its case alone is the one that was meant.
    if (EqualIgnoringCase(name, typed)) break;
  }
  return text.empty() ? text : text + ".";
}

std::vector<ExpressionFault> FindLanguageFaults(std::string_view text) {
  const ScannerRest rest;
  const auto parsed = ParseExpression(text);
  const std::vector<TokenSpan> tokens = TokenSpans(text);
  if (const ParseFailure* failure = parsed->Failure()) return {FaultOf(*failure, text, tokens)};
  std::vector<ExpressionFault> faults;
  for (const CallFinding& found : FindCallFaults(*parsed->Tree())) {
    ExpressionFault fault;
    fault.at = SpanOf(text, found.name, tokens);
    fault.words = found.finding.text;
    fault.plain = SentenceOnCall(found.finding.message->code, found.name, found.arguments);
    faults.push_back(fault);
  }
  const auto cut = std::find_if(tokens.begin(), tokens.end(),
                                [](const TokenSpan& token) { return token.code < TokenCode::End; });
  if (cut != tokens.end()) {
    ExpressionFault fault;
    fault.at = SyntaxFault::CharacterAt(text, cut->span);
    fault.plain = SentenceOnCharacter(text, fault.at);
    faults.push_back(fault);
  } else if (auto comment = SyntaxFault::OpenComment(text, tokens)) {
    faults.push_back(*comment);
  }
  std::stable_sort(faults.begin(), faults.end(),
                   [](const ExpressionFault& left, const ExpressionFault& right) {
                     return left.at.start < right.at.start;
                   });
  return faults;
}

}  // namespace tessal
