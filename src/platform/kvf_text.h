// What both readers of key-file text do with the bytes of a file before they read them.
#pragma once

#include <string>
#include <string_view>

namespace tessal {

/// The text up to its first zero byte, without a UTF-8 byte order mark, with each bare line feed as carriage
/// return and line feed: version control changes line ends, and the layout must survive it.
std::string KvfReadableText(std::string bytes);

/// Whether a text is a name of the format: a letter or underscore, then letters, digits and underscores.
bool IsKvfName(std::string_view text);

}  // namespace tessal
