// What a message means, in words: for the command that explains, for reports, for the page of all messages
// and for the editor.
#pragma once

#include <string>
#include <string_view>

#include "core/messages.h"

namespace tessal {

/// The word printed in place of a level for undefined symbols.
inline constexpr std::string_view kUndefinedWord = "Undefined";

/// The level of a message as reports show it.
std::string_view LevelWordOf(const MessageRow& row);

/// The text of a message as reports show it, its places as %1, %2 and so on.
std::string_view MessageText(const MessageRow& row);

/// The example and the remedy, a line each.
std::string HelpText(const MessageRow& row);

/// All that is known of a message, a line each: code, level and text; meaning; example; remedy.
std::string ExplanationText(const MessageRow& row);

}  // namespace tessal
