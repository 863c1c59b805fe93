// What readers of key-file text see of the bytes of a file.
#pragma once

#include <string>
#include <string_view>

namespace tessal {

/// What a file may begin with to say that it is UTF-8.
inline constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";

/// A text with each bare line feed as carriage return and line feed: version control changes line ends, and
/// the layout must survive it.
std::string KvfLineEnds(std::string text);

/// What of a text decides how it is written.
struct KvfTextMarks {
  bool hasZero = false;  ///< no file can hold it
  bool hasApostrophe = false;
  bool hasBar = false;
  bool hasLineEnd = false;  ///< a line feed or a carriage return
};
KvfTextMarks KvfMarksIn(std::string_view text);

/// Whether a text is a name of the format: a letter or underscore, then letters, digits and underscores.
bool IsKvfName(std::string_view text);

}  // namespace tessal
