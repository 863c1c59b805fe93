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

/// Token codes. A character without a token of its own has its own value as a code.
namespace token {
inline constexpr std::int32_t kEnd = 0;
inline constexpr std::int32_t kIdentifier = 258;
inline constexpr std::int32_t kIntNum = 259;
inline constexpr std::int32_t kFloatNum = 260;
inline constexpr std::int32_t kScientificNum = 261;
inline constexpr std::int32_t kAddOpPlus = 262;
inline constexpr std::int32_t kAddOpMinus = 263;
inline constexpr std::int32_t kMulOpMultiply = 264;
inline constexpr std::int32_t kMulOpDivide = 265;
inline constexpr std::int32_t kComma = 266;
inline constexpr std::int32_t kLeftBracket = 267;
inline constexpr std::int32_t kRightBracket = 268;
inline constexpr std::int32_t kLeftSquare = 269;
inline constexpr std::int32_t kRightSquare = 270;
inline constexpr std::int32_t kLeftCurly = 271;
inline constexpr std::int32_t kRightCurly = 272;
inline constexpr std::int32_t kEqual = 273;
inline constexpr std::int32_t kNotEqual = 274;
inline constexpr std::int32_t kBigger = 275;
inline constexpr std::int32_t kSmaller = 276;
inline constexpr std::int32_t kBiggerOrEqual = 277;
inline constexpr std::int32_t kSmallerOrEqual = 278;
inline constexpr std::int32_t kIf = 279;
inline constexpr std::int32_t kThen = 280;
inline constexpr std::int32_t kElse = 281;
inline constexpr std::int32_t kNotOp = 282;
inline constexpr std::int32_t kAndOp = 283;
inline constexpr std::int32_t kOrOp = 284;
inline constexpr std::int32_t kDirectAssign = 285;
inline constexpr std::int32_t kDirectPlus = 286;
inline constexpr std::int32_t kDirectMinus = 287;
inline constexpr std::int32_t kDirectMultiply = 288;
inline constexpr std::int32_t kDirectDivide = 289;
inline constexpr std::int32_t kRvalId = 290;
inline constexpr std::int32_t kExceedanceFrequency = 291;
inline constexpr std::int32_t kUPlus = 292;
inline constexpr std::int32_t kUMinus = 293;
}  // namespace token

/// The name of a token code ("IDENTIFIER"); "-" for a code outside the table.
std::string_view TokenName(std::int32_t code);

struct ExpressionToken {
  std::string text;          ///< the lexeme as it stands
  std::int32_t code;         ///< 258 to 290, or 291 for anything else
  std::int32_t line;         ///< line feeds before it, comments left out
  std::int32_t firstColumn;  ///< from 0, in its line
  std::int32_t lastColumn;
  std::int32_t firstOffset;  ///< from 0, in the text
  std::int32_t lastOffset;
};

/// Lists the tokens of a text. False, with a complete list, when it holds something that is no token, or the
/// word EXCEEDANCE_FREQUENCY. A zero byte ends the text.
bool ScanExpressionTokens(std::string_view text, std::vector<ExpressionToken>& tokens);

/// What stands between the first and the last double quote of a stored expression; with a single one all that
/// follows it, without one the whole text.
std::string_view StripExpressionQuotes(std::string_view stored);

/// Back to the normal start state, for tests and for looks at a text that must leave no trace.
void ResetExpressionScanner();

/// The scanner as the parser and the lists pull from it. One scan at a time.
class ExpressionScan final {
 public:
  /// Begins a scan of a copy of the text.
  explicit ExpressionScan(std::string_view text);
  ExpressionScan(const ExpressionScan&) = delete;
  ExpressionScan& operator=(const ExpressionScan&) = delete;
  ~ExpressionScan();

  /// The code of the next token: 0 at the end, the (signed) character for one without a token.
  std::int32_t Next();
  /// The present token's text; good until the next one is pulled.
  std::string_view Lexeme() const;
  /// Characters taken so far, the present token's included.
  std::uint32_t Consumed() const;
  /// Line feeds met outside comments.
  std::uint32_t Lines() const;
  /// Characters taken when the present line began.
  std::uint32_t LineStart() const;
};

}  // namespace tessal
