// Texts of a template made fit for a page: nothing in them is taken for markup.
#pragma once

#include <string>
#include <string_view>

namespace tessal {

/// A text in UTF-8 with references in the place of the characters that markup is made of. It may be put
/// between tags and into quoted values.
std::string SafeText(std::string_view text);

/// A text in which Markdown finds no markup, not even in a table.
std::string MarkdownText(std::string_view text);

/// A symbol as a part of an anchor's name: letters, digits and underscores stay, every other byte is a hyphen
/// and two hexadecimal digits. Different symbols have different names.
std::string AnchorText(std::string_view symbol);

}  // namespace tessal
