// Turns the text of an expression into tokens. The parser pulls one token at a time; the colouring of the
// editor and the search for identifiers list all tokens of a text.
// There is one scanner in the process. Its start state outlives a scan: a text that ends inside an open
// comment leaves the next one in it.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace tessal {

/// The kinds of token. A character without a kind of its own has its own (signed) value as a code.
enum class TokenCode : std::int32_t {
  End = 0,
  Identifier = 258,
  IntNum = 259,
  FloatNum = 260,
  ScientificNum = 261,
  AddOpPlus = 262,
  AddOpMinus = 263,
  MulOpMultiply = 264,
  MulOpDivide = 265,
  Comma = 266,
  LeftBracket = 267,
  RightBracket = 268,
  LeftSquare = 269,
  RightSquare = 270,
  LeftCurly = 271,
  RightCurly = 272,
  Equal = 273,
  NotEqual = 274,
  Bigger = 275,
  Smaller = 276,
  BiggerOrEqual = 277,
  SmallerOrEqual = 278,
  If = 279,
  Then = 280,
  Else = 281,
  NotOp = 282,
  AndOp = 283,
  OrOp = 284,
  DirectAssign = 285,
  DirectPlus = 286,
  DirectMinus = 287,
  DirectMultiply = 288,
  DirectDivide = 289,
  RvalId = 290,
  ExceedanceFrequency = 291,
  UPlus = 292,
  UMinus = 293,
};

/// The name of a token code ("IDENTIFIER") in the grammar; "-" for a code that is no token's.
std::string_view TokenName(TokenCode code);

/// Whether a code is one of the vocabulary's, `Identifier` to `RvalId`; all others spoil a list of tokens.
constexpr bool IsPlainToken(TokenCode code) {
  return code >= TokenCode::Identifier && code <= TokenCode::RvalId;
}

struct ExpressionToken {
  std::string text;          ///< the lexeme as written
  TokenCode code;            ///< up to RvalId; ExceedanceFrequency for anything else
  std::int32_t line;         ///< line feeds before it, comments left out
  std::int32_t firstColumn;  ///< from 0, in its line
  std::int32_t lastColumn;
  std::int32_t firstOffset;  ///< from 0, in the text
  std::int32_t lastOffset;
};

/// Lists the tokens of a text. False, with a complete list, when it holds something that is no token, or the
/// word EXCEEDANCE_FREQUENCY. A zero byte ends the text.
bool ScanExpressionTokens(std::string_view text, std::vector<ExpressionToken>& tokens);

/// What is between the first and the last double quote of a stored expression; with a single one all that
/// follows it, without one the whole text.
std::string_view StripExpressionQuotes(std::string_view stored);

/// Where a scan begins: in plain text, or in the comment that an earlier text left open.
enum class ScannerStart : std::uint8_t { Text, Comment };

/// The start of the next scan, and its setting.
ScannerStart ExpressionScannerStart();
void SetExpressionScannerStart(ScannerStart start);

/// Back to plain text, for tests and for looks at a text that must leave no trace.
void ResetExpressionScanner();

/// A look at a text that nobody has committed: it starts in plain text, and what the text leaves open reaches
/// no later scan.
class ScannerRest final {
 public:
  ScannerRest() { ResetExpressionScanner(); }
  ScannerRest(const ScannerRest&) = delete;
  ScannerRest& operator=(const ScannerRest&) = delete;
  ~ScannerRest() { ResetExpressionScanner(); }
};

/// Bytes of an expression that is still parsed. A tree may take a hundred times the memory of its text.
inline constexpr std::size_t kLongestExpression = 1'000'000;

/// A lexeme by its place in the text that is scanned.
struct LexemeSpan {
  std::uint32_t start;
  std::uint32_t length;
};

/// The scanner as the parser and the lists pull from it. One scan at a time.
class ExpressionScan final {
 public:
  /// Begins a scan of a text, which must outlive it.
  explicit ExpressionScan(std::string_view scanned);
  ExpressionScan(const ExpressionScan&) = delete;
  ExpressionScan& operator=(const ExpressionScan&) = delete;

  /// The next token: `End` at the end, the (signed) character for one without a kind.
  TokenCode Next();
  /// The present token's text, a view into what is scanned, and its place there.
  std::string_view Lexeme() const { return {lexeme, static_cast<std::size_t>(here - lexeme)}; }
  LexemeSpan Span() const { return {Distance(text, lexeme), Distance(lexeme, here)}; }
  /// Characters taken so far, the present token's included.
  std::uint32_t Consumed() const { return Distance(text, here); }
  /// Line feeds met outside comments.
  std::uint32_t Lines() const { return lines; }
  /// Characters taken when the present line began.
  std::uint32_t LineStart() const { return Distance(text, line); }

 private:
  static std::uint32_t Distance(const char* from, const char* to) {
    return static_cast<std::uint32_t>(to - from);
  }
  void SkipComment();
  TokenCode Word();
  TokenCode Number();
  TokenCode Colon();
  const char* AfterDigits(const char* place) const;
  bool IsAt(const char* place, char character) const { return place < end && *place == character; }

  const char* text;
  const char* end;     ///< of the text, or its first zero byte
  const char* here;    ///< after the present token
  const char* lexeme;  ///< where the present token begins
  const char* line;    ///< where the present line begins
  std::uint32_t lines = 0;
};

}  // namespace tessal
