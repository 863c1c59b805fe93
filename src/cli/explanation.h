// What a message means, in words: for the command that explains, for reports to code hosts, and for the page
// of all messages.
#pragma once

#include <string>
#include <string_view>

#include "core/messages.h"

namespace tessal::cli {

/// The word printed in place of a level for undefined symbols.
inline constexpr std::string_view kUndefinedWord = "Undefined";

/// The level of a message as `check` prints it.
std::string_view LevelWordOf(const MessageRow& row);

/// The text of a message as `check` prints it, its places as %1, %2 and so on.
std::string_view TextOf(const MessageRow& row);

/// The example and the remedy, a line each; as Markdown a paragraph each.
std::string HelpText(const MessageRow& row);
std::string HelpMarkdown(const MessageRow& row);

/// The page of all messages, as Markdown.
std::string MessagesPage();

}  // namespace tessal::cli
