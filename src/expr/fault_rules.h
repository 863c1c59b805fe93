// The sentences on syntax faults as a table: what lies around the token at which the parse stopped, and
// what to say about it.
#pragma once

#include <cstdint>
#include <span>
#include <string_view>

namespace tessal {

/// Sorts of tokens, as sets: the bits are joined by `|`.
namespace sort {
using Set = std::uint32_t;
inline constexpr Set kNone = 1U << 0;  ///< before the first token, or after the last
inline constexpr Set kName = 1U << 1;
inline constexpr Set kNumber = 1U << 2;
inline constexpr Set kSign = 1U << 3;    ///< + -
inline constexpr Set kFactor = 1U << 4;  ///< * /
inline constexpr Set kComma = 1U << 5;
inline constexpr Set kOpen = 1U << 6;  ///< (
inline constexpr Set kClose = 1U << 7;
inline constexpr Set kOpenSquare = 1U << 8;
inline constexpr Set kCloseSquare = 1U << 9;
inline constexpr Set kOpenCurly = 1U << 10;
inline constexpr Set kCloseCurly = 1U << 11;
inline constexpr Set kRelation = 1U << 12;
inline constexpr Set kIf = 1U << 13;
inline constexpr Set kThen = 1U << 14;
inline constexpr Set kElse = 1U << 15;
inline constexpr Set kNot = 1U << 16;
inline constexpr Set kJoin = 1U << 17;    ///< AND, OR
inline constexpr Set kModify = 1U << 18;  ///< ::= and its like
inline constexpr Set kRefer = 1U << 19;   ///< $
inline constexpr Set kExceedance = 1U << 20;
inline constexpr Set kStray = 1U << 21;  ///< a character that is no token

inline constexpr Set kAny = ~Set{0};
inline constexpr Set kValueEnd = kName | kNumber | kClose | kCloseSquare | kCloseCurly;
inline constexpr Set kValueBegin = kName | kNumber | kOpen | kOpenSquare | kIf | kRefer | kExceedance;
inline constexpr Set kNoValueEnd = kAny & ~kValueEnd;
}  // namespace sort

/// What is around the token: the innermost bracket, and the part of an IF that it is in.
namespace around {
using Set = std::uint16_t;
inline constexpr Set kTop = 1U << 0;  ///< no bracket
inline constexpr Set kParentheses = 1U << 1;
inline constexpr Set kCall = 1U << 2;
inline constexpr Set kIfCall = 1U << 3;  ///< IF(
inline constexpr Set kSquare = 1U << 4;
inline constexpr Set kCurly = 1U << 5;  ///< directly, or in one of its lists
// One of these at a time.
inline constexpr Set kNoIf = 1U << 6;
inline constexpr Set kCondition = 1U << 7;  ///< without a comparison before the token
inline constexpr Set kCompared = 1U << 8;   ///< with one
inline constexpr Set kThenPart = 1U << 9;
inline constexpr Set kElsePart = 1U << 10;

inline constexpr Set kBrackets = kTop | kParentheses | kCall | kIfCall | kSquare | kCurly;
inline constexpr Set kParts = kNoIf | kCondition | kCompared | kThenPart | kElsePart;
inline constexpr Set kAny = kBrackets | kParts;
}  // namespace around

/// Where no blank may be for a rule to fit.
enum class Touch : std::uint8_t { Any, Before, BothSides };

struct FaultRule {
  sort::Set before;
  sort::Set at;
  sort::Set after;
  around::Set brackets;
  around::Set parts;
  /// In the sentence %a, %b and %n are the token, the one before and the next one; %o and %c the innermost
  /// bracket and what closes it, %f what is called.
  std::string_view sentence;
  std::string_view atText{};      ///< exactly this, in any case
  std::string_view beforeText{};  ///< the same of the token before
  Touch touch = Touch::Any;
};

/// The first rule that fits applies; one fits always.
std::span<const FaultRule> FaultRules();

/// A character beyond ASCII that people write for something that the language has, and what to write.
struct ForeignSign {
  std::string_view sign;  ///< in UTF-8
  std::string_view sentence;
};

std::span<const ForeignSign> ForeignSigns();

}  // namespace tessal
