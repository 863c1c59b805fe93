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

/// The bytes that continue a name or keyword.
constexpr std::array<bool, 256> kContinuesWord = [] {
  std::array<bool, 256> continues{};
  for (std::size_t byte = 0; byte < continues.size(); ++byte) {
    continues[byte] = IsWordCharacter(static_cast<char>(byte));
  }
  return continues;
}();

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

ExpressionScan::ExpressionScan(std::string_view scanned)
    : text(scanned.data()), here(text), lexeme(text), line(text) {
  constexpr auto kLongest = static_cast<std::size_t>(std::numeric_limits<std::int32_t>::max() - 2);
  end = text + std::min({scanned.find('\0'), scanned.size(), kLongest});
}

TokenCode ExpressionScan::Next() {
  if (nextStart == ScannerStart::Comment) SkipComment();
  for (;;) {
    lexeme = here;
    if (here == end) return TokenCode::End;
    const Beginning& first = kBeginnings[PlaceOf(*here++)];
    // The most frequent ones first.
    if (first.byteClass == ByteClass::Letter) return Word();
    if (first.byteClass == ByteClass::Token) return first.token;
    if (first.byteClass == ByteClass::Blank) continue;
    if (first.byteClass == ByteClass::LineFeed) {
      ++lines;
      line = here;
    } else if (first.byteClass == ByteClass::Slash && IsAt(here, '*')) {
      ++here;
      nextStart = ScannerStart::Comment;
      SkipComment();
    } else {
      switch (first.byteClass) {
        case ByteClass::Digit:
          return Number();
        case ByteClass::Colon:
          return Colon();
        default:
          if (first.byteClass != ByteClass::Pair || !IsAt(here, first.follower)) return first.token;
          ++here;
          return first.pair;
      }
    }
  }
}
void ExpressionScan::SkipComment() {
  // Its line feeds do not count.
  constexpr std::string_view kEnd = "*/";
  here = std::search(here, end, kEnd.begin(), kEnd.end());
  if (here == end) return;
  here += kEnd.size();
  nextStart = ScannerStart::Text;
}

TokenCode ExpressionScan::Word() {
  const char* place = here;
  while (place != end && kContinuesWord[PlaceOf(*place)]) ++place;
  here = place;
  return CodeOfWord(Lexeme());
}

const char* ExpressionScan::AfterDigits(const char* place) const {
  return std::find_if_not(place, end, IsAsciiDigit);
}

TokenCode ExpressionScan::Number() {
  TokenCode code = TokenCode::IntNum;
  here = AfterDigits(here);
  if (IsAt(here, '.')) {
    code = TokenCode::FloatNum;
    here = AfterDigits(here + 1);
  }
  if (!IsAt(here, 'e') && !IsAt(here, 'E')) return code;
  const bool hasSign = IsAt(here + 1, '+') || IsAt(here + 1, '-');
  const char* const digits = here + (hasSign ? 2 : 1);
  const char* const afterDigits = AfterDigits(digits);
  // An E without digits is a name after the number.
  if (afterDigits == digits) return code;
  here = afterDigits;
  return TokenCode::ScientificNum;
}

TokenCode ExpressionScan::Colon() {
  if (IsAt(here, ':')) {
    for (const LoneSign& direct : kDirectSigns) {
      if (!IsAt(here + 1, direct.sign)) continue;
      here += 2;
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
