#include "expr/scanner.h"

#include <algorithm>
#include <array>
#include <limits>

#include "platform/ascii.h"

namespace tessal {

namespace {

ScannerStart nextStart = ScannerStart::Text;

/// What a token may begin with.
enum class ByteClass : std::uint8_t {
  Token,  ///< it is one, whatever follows
  Pair,   ///< a token of two characters, or one alone
  Slash,
  Colon,
  Blank,
  LineFeed,
  Letter,
  Digit
};

/// What a byte begins.
struct Beginning {
  ByteClass byteClass = ByteClass::Token;
  char follower = '\0';  ///< what makes a pair
  TokenCode token{0};    ///< of the byte alone
  TokenCode pair{0};
};

struct LoneSign {
  char sign;
  TokenCode token;
};

constexpr LoneSign kLoneSigns[] = {
    {'+', TokenCode::AddOpPlus},   {'-', TokenCode::AddOpMinus},   {'*', TokenCode::MulOpMultiply},
    {'/', TokenCode::MulOpDivide}, {',', TokenCode::Comma},        {';', TokenCode::Comma},
    {'(', TokenCode::LeftBracket}, {')', TokenCode::RightBracket}, {'[', TokenCode::LeftSquare},
    {']', TokenCode::RightSquare}, {'{', TokenCode::LeftCurly},    {'}', TokenCode::RightCurly},
    {'!', TokenCode::NotOp},       {'>', TokenCode::Bigger},       {'<', TokenCode::Smaller},
    {'$', TokenCode::RvalId},
};

struct SignPair {
  char sign;
  char follower;
  TokenCode token;
};

constexpr SignPair kSignPairs[] = {
    {'=', '=', TokenCode::Equal},         {'!', '=', TokenCode::NotEqual},
    {'>', '=', TokenCode::BiggerOrEqual}, {'<', '=', TokenCode::SmallerOrEqual},
    {'&', '&', TokenCode::AndOp},         {'|', '|', TokenCode::OrOp},
};

/// What makes a direct modification after two colons.
constexpr LoneSign kDirectSigns[] = {
    {'=', TokenCode::DirectAssign},   {'+', TokenCode::DirectPlus},   {'-', TokenCode::DirectMinus},
    {'*', TokenCode::DirectMultiply}, {'/', TokenCode::DirectDivide},
};

constexpr ByteClass ClassOf(char character) {
  if (IsAsciiDigit(character)) return ByteClass::Digit;
  if (IsWordCharacter(character)) return ByteClass::Letter;
  switch (character) {
    case ' ':
    case '\t':
    case '\r':
      return ByteClass::Blank;
    case '\n':
      return ByteClass::LineFeed;
    case '/':
      return ByteClass::Slash;
    case ':':
      return ByteClass::Colon;
    default:
      return ByteClass::Token;
  }
}

constexpr std::size_t PlaceOf(char character) {
  return static_cast<unsigned char>(character);
}

/// A character without a token of its own is its signed value.
constexpr std::array<Beginning, 256> kBeginnings = [] {
  std::array<Beginning, 256> rows;
  for (std::size_t byte = 0; byte < rows.size(); ++byte) {
    rows[byte].byteClass = ClassOf(static_cast<char>(byte));
    rows[byte].token = TokenCode{static_cast<signed char>(byte)};
  }
  for (const LoneSign& lone : kLoneSigns) rows[PlaceOf(lone.sign)].token = lone.token;
  for (const SignPair& pair : kSignPairs) {
    Beginning& row = rows[PlaceOf(pair.sign)];
    row.byteClass = ByteClass::Pair;
    row.follower = pair.follower;
    row.pair = pair.token;
  }
  return rows;
}();

/// Whether a character continues a name or keyword.
constexpr bool ContinuesWord(char character) {
  const ByteClass byteClass = kBeginnings[PlaceOf(character)].byteClass;
  return byteClass == ByteClass::Letter || byteClass == ByteClass::Digit;
}

/// The keyword or name that a word is. NOT, AND, OR and EXCEEDANCE_FREQUENCY are keywords in capitals only.
TokenCode CodeOfWord(std::string_view word) {
  const auto isWord = [word](std::string_view upper) { return EqualIgnoringCase(word, upper); };
  switch (word.size()) {
    case 2:
      return isWord("IF") ? TokenCode::If : word == "OR" ? TokenCode::OrOp : TokenCode::Identifier;
    case 3:
      return word == "NOT" ? TokenCode::NotOp : word == "AND" ? TokenCode::AndOp : TokenCode::Identifier;
    case 4:
      return isWord("THEN") ? TokenCode::Then : isWord("ELSE") ? TokenCode::Else : TokenCode::Identifier;
    case 20:
      return word == "EXCEEDANCE_FREQUENCY" ? TokenCode::ExceedanceFrequency : TokenCode::Identifier;
    default:
      return TokenCode::Identifier;
  }
}

ExpressionToken MakeToken(const ExpressionScan& scan, TokenCode code) {
  const std::string_view lexeme = scan.Lexeme();
  const auto length = static_cast<std::int32_t>(lexeme.size());
  ExpressionToken listed;
  listed.text = lexeme;
  listed.code = IsPlainToken(code) ? code : TokenCode::ExceedanceFrequency;
  listed.line = static_cast<std::int32_t>(scan.Lines());
  listed.lastOffset = static_cast<std::int32_t>(scan.Consumed()) - 1;
  listed.firstOffset = listed.lastOffset - length + 1;
  listed.lastColumn = static_cast<std::int32_t>(scan.Consumed() - scan.LineStart()) - 1;
  listed.firstColumn = listed.lastColumn - length + 1;
  return listed;
}

}  // namespace

ExpressionScan::ExpressionScan(std::string_view scanned) {
  constexpr auto kLongest = static_cast<std::size_t>(std::numeric_limits<std::int32_t>::max() - 2);
  text = scanned.substr(0, std::min(scanned.find('\0'), kLongest));
}

TokenCode ExpressionScan::Next() {
  for (;;) {
    if (nextStart == ScannerStart::Comment) SkipComment();
    lexemeStart = consumed;
    if (consumed == text.size()) return TokenCode::End;
    const Beginning& first = kBeginnings[PlaceOf(text[consumed++])];
    switch (first.byteClass) {
      case ByteClass::Token:
        return first.token;
      case ByteClass::Letter:
        return Word();
      case ByteClass::Blank:
        break;
      case ByteClass::Digit:
        return Number();
      case ByteClass::Pair:
        if (At(consumed) != first.follower) return first.token;
        ++consumed;
        return first.pair;
      case ByteClass::Slash:
        if (At(consumed) != '*') return first.token;
        ++consumed;
        nextStart = ScannerStart::Comment;
        break;
      case ByteClass::Colon:
        return Colon();
      case ByteClass::LineFeed:
        ++lines;
        lineStart = consumed;
        break;
    }
  }
}

void ExpressionScan::SkipComment() {
  // Its line feeds do not count.
  const std::size_t end = text.find("*/", consumed);
  consumed = static_cast<std::uint32_t>(end == std::string_view::npos ? text.size() : end + 2);
  if (end != std::string_view::npos) nextStart = ScannerStart::Text;
}

TokenCode ExpressionScan::Word() {
  while (ContinuesWord(At(consumed))) ++consumed;
  return CodeOfWord(Lexeme());
}

std::uint32_t ExpressionScan::AfterDigits(std::uint32_t place) const {
  while (IsAsciiDigit(At(place))) ++place;
  return place;
}

TokenCode ExpressionScan::Number() {
  TokenCode code = TokenCode::IntNum;
  consumed = AfterDigits(consumed);
  if (At(consumed) == '.') {
    code = TokenCode::FloatNum;
    consumed = AfterDigits(consumed + 1);
  }
  if (UpperCase(At(consumed)) != 'E') return code;
  const char sign = At(consumed + 1);
  const std::uint32_t digits = consumed + (sign == '+' || sign == '-' ? 2 : 1);
  const std::uint32_t end = AfterDigits(digits);
  // An E without digits is a name after the number.
  if (end == digits) return code;
  consumed = end;
  return TokenCode::ScientificNum;
}

TokenCode ExpressionScan::Colon() {
  if (At(consumed) == ':') {
    for (const LoneSign& direct : kDirectSigns) {
      if (At(consumed + 1) != direct.sign) continue;
      consumed += 2;
      return direct.token;
    }
  }
  return TokenCode{':'};
}

bool ScanExpressionTokens(std::string_view text, std::vector<ExpressionToken>& tokens) {
  tokens.clear();
  bool clean = true;
  ExpressionScan scan(text);
  for (TokenCode code = scan.Next(); code != TokenCode::End; code = scan.Next()) {
    clean = clean && IsPlainToken(code);
    tokens.push_back(MakeToken(scan, code));
  }
  return clean;
}

std::string_view StripExpressionQuotes(std::string_view stored) {
  const std::size_t first = stored.find('"');
  if (first == std::string_view::npos) return stored;
  const std::size_t last = stored.rfind('"');
  return last == first ? stored.substr(first + 1) : stored.substr(first + 1, last - first - 1);
}

ScannerStart ExpressionScannerStart() {
  return nextStart;
}

void SetExpressionScannerStart(ScannerStart start) {
  nextStart = start;
}

void ResetExpressionScanner() {
  SetExpressionScannerStart(ScannerStart::Text);
}

}  // namespace tessal
