// The process-wide list of messages about templates: what a load and a validation found.
// Checks add records and go on; the error list, the command line and the message boxes of a failed load
// or save read them. Two open templates share the list: the last to validate decides what it holds.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "platform/uid.h"

namespace tessal {

/// What a message without an element has in the place of an identity.
inline constexpr Uid kNoElement{-1};

/// How grave a message is. Only a fatal one changes the flow of control: it makes a load fail.
enum class ErrorLevel : std::uint32_t { Notice = 1, Warning = 2, Critical = 3, Fatal = 4 };

/// One message. `uid` is the identity of the element it speaks of, -1 for none. A message about the file
/// itself, which has no element yet, knows its line (from 1; 0 for none).
struct ErrorRecord {
  std::uint32_t level;
  std::string symbol;
  Uid uid;
  std::string text;
  int line;
};

/// The word of a level ("Warning"); empty for a number outside 1 to 4.
std::string_view LevelWord(std::uint32_t level);

/// Texts that several checks and change handlers share.
namespace message {
inline constexpr std::string_view kNoError = "No Error";
inline constexpr std::string_view kBelowMinimum = "The (default) value is lower than the minimum!";
inline constexpr std::string_view kAboveMaximum = "The (default) value is higher than the maximum!";
inline constexpr std::string_view kOutsideRange = "The default value is not within minimum to maximum!";
inline constexpr std::string_view kRangeReversed = "The minimum must be less equal maximum!";
inline constexpr std::string_view kIllegalSymbol =
    ", illegal symbol name (keyword or illegal characters used)";
inline constexpr std::string_view kAlreadyDefined = ", already defined!";
inline constexpr std::string_view kUnknownSymbol = "unknown symbol name used in expression";
inline constexpr std::string_view kIllegalText =
    "Decription, online help or documentation contain illegal characters ('!')";
inline constexpr std::string_view kNoVariable = "No valid variable/property selected";
inline constexpr std::string_view kNoSpecie = "No valid specie selected";
inline constexpr std::string_view kNoMath = "Invalid math function";
inline constexpr std::string_view kNoRadius = "Search radius must be larger than zero";
inline constexpr std::string_view kDeprecatedBuiltin =
    "The selected built-in ID is deprecated and should not be used for new templates";
}  // namespace message

class ErrorRegistry final {
 public:
  /// Appends a record and raises the counter of its level (a level outside 1 to 4 has no counter).
  void AddError(std::uint32_t level, std::string_view symbol, Uid uid, std::string_view text);
  void AddError(ErrorLevel level, std::string_view symbol, Uid uid, std::string_view text);

  /// Appends a record about a place in the file that is being read.
  void AddFileError(ErrorLevel level, std::string_view symbol, std::string_view text, int line);

  /// The way of the element checks: a warning, and one more in `ExpressionWarningCount`.
  void ReportElementError(std::string_view symbol, Uid uid, std::string_view text);

  /// Empties the list and the level counters; `ExpressionWarningCount` stays.
  void ClearErrors();

  /// The number of records of a level; for any number outside 1 to 4, of all levels.
  std::size_t GetErrorCount(std::uint32_t level) const;

  /// Copies a record's fields; false, with the outputs untouched, when there is no such index.
  bool GetError(std::size_t index, std::uint32_t& level, std::string& symbol, Uid& uid,
                std::string& text) const;

  /// The long form, for message boxes. False, with "invalid error number!", when there is no such index.
  bool FormatError(std::size_t index, std::string& text) const;

  /// The long forms of all records, each followed by a line end.
  std::string JoinErrors() const;

  /// The short form, for lists: symbol, identity (-1 for none) and "word: text".
  void GetErrorForList(std::size_t index, std::string& symbol, Uid& uid, std::string& text) const;

  const std::vector<ErrorRecord>& Records() const { return records; }

  /// Counts the warnings of element checks since the start of the last validation. Nothing acts on it.
  std::int32_t ExpressionWarningCount() const { return expressionWarningCount; }
  void ResetExpressionWarningCount() { expressionWarningCount = 0; }

  /// Back to the state of a fresh process, for tests.
  void Reset();

 private:
  static constexpr std::size_t kLevels = 4;

  void Append(ErrorRecord record);

  std::vector<ErrorRecord> records;
  std::array<std::size_t, kLevels> counts{};
  std::int32_t expressionWarningCount = 0;
};

/// The registry of the process.
ErrorRegistry& Errors();

}  // namespace tessal
