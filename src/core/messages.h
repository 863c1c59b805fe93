// A message of the table, and a message with its values filled in. Whatever finds a fault names the row by
// its code, and a code without a row does not compile:
//
//     Errors().Report(symbol, uid, {"order-violated", {used, user}});
#pragma once

#include <cstddef>
#include <initializer_list>
#include <span>
#include <string>
#include <string_view>

#include "core/message_table.h"
#include "core/message_table_of_analyses.h"

namespace tessal {

/// A row of one of the two tables of messages.
class Message final {
 public:
  /// Looks the code up while compiling.
  template <std::size_t kSize>
  consteval Message(const char (&code)[kSize]) : row(RowOf({code, kSize - 1})) {}

  const MessageRow* operator->() const { return row; }

 private:
  static consteval const MessageRow* RowOf(std::string_view code) {
    for (const MessageRow& candidate : kMessages) {
      if (candidate.code == code) return &candidate;
    }
    for (const MessageRow& candidate : kAnalysisMessages) {
      if (candidate.code == code) return &candidate;
    }
    throw "no message has this code";
  }

  const MessageRow* row;
};

/// What a check found: a message, and its text with the values in their places.
struct Finding {
  /// Takes a value for each place in the text of the row; further values are not used.
  Finding(Message message, std::initializer_list<std::string_view> values = {});

  Message message;
  std::string text;
  std::string name;  ///< that it is about; empty for a message that is about none
};

/// The rows of what loads, checks, changes and saves report, in the order of their table.
inline std::span<const MessageRow> AllMessages() {
  return kMessages;
}

/// The same of what analyses find.
inline std::span<const MessageRow> AnalysisMessages() {
  return kAnalysisMessages;
}

/// The row of a code in either table; none for any other.
const MessageRow* FindMessage(std::string_view code);

/// The word of a level ("Warning"); empty for a number outside 1 to 4.
std::string_view LevelWord(std::uint32_t level);

}  // namespace tessal
