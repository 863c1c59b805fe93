// Texts as XML may hold them.
#pragma once

#include <string>
#include <string_view>

namespace tessal {

/// Bytes of any encoding as XML 1.0 in UTF-8, fit for content and for values in double quotes: markup and
/// line ends become references, and the characters that XML has no way to write become U+FFFD.
std::string XmlText(std::string_view bytes);

}  // namespace tessal
