// What a message means, as Markdown: for reports to code hosts, and for the page of all messages.
#pragma once

#include <string>

#include "core/explanation.h"

namespace tessal::cli {

/// The example and the remedy, a paragraph each.
std::string HelpMarkdown(const MessageRow& row);

/// The page of all messages, as Markdown.
std::string MessagesPage();

}  // namespace tessal::cli
