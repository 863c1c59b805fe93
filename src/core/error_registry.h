// The process-wide list of messages about templates: what a load and a validation found.
// Checks add records and go on; the error list, the command line and the message boxes of a failed load
// or save read them. Two open templates share the list: the last to validate decides what it holds.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "core/messages.h"
#include "platform/uid.h"

namespace tessal {

/// What a message without an element has in the place of an identity.
inline constexpr Uid kNoElement{-1};

/// One message. `uid` is the identity of the element it speaks of, -1 for none. A message about the file
/// itself, which has no element yet, knows its line (from 1; 0 for none).
struct ErrorRecord {
  std::uint32_t level;
  std::string symbol;
  Uid uid;
  std::string text;
  int line;
  std::string_view code;  ///< of its row in the table of messages
  std::string name{};     ///< that it is about; empty for a message that is about none
};

/// The code of a record whose text was given from outside the table of messages.
inline constexpr std::string_view kOtherCode = "other";

class ErrorRegistry final {
 public:
  /// Appends a finding about an element, under a symbol.
  void Report(std::string_view symbol, Uid uid, const Finding& finding);

  /// Appends a finding about a line of the file that is being read or written; 0 for no line.
  void ReportInFile(std::string_view symbol, int line, const Finding& finding);

  /// The way of the element checks: one more in `ExpressionWarningCount`, too.
  void ReportCheck(std::string_view symbol, Uid uid, const Finding& finding);

  // The same for texts that do not come from the table of messages.

  /// Appends a record and raises the counter of its level (a level outside 1 to 4 has no counter).
  void AddError(std::uint32_t level, std::string_view symbol, Uid uid, std::string_view text);
  void AddError(ErrorLevel level, std::string_view symbol, Uid uid, std::string_view text);

  /// A warning of an element check, and one more in `ExpressionWarningCount`.
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

/// Work whose messages are not for the user's list: the registry is empty at its start, and at its end holds
/// again what it held before.
class MessagesAside final {
 public:
  MessagesAside() : kept(std::exchange(Errors(), ErrorRegistry())) {}
  MessagesAside(const MessagesAside&) = delete;
  MessagesAside& operator=(const MessagesAside&) = delete;
  ~MessagesAside() { Errors() = std::move(kept); }

 private:
  ErrorRegistry kept;
};

}  // namespace tessal
