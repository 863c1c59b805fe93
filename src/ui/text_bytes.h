// Between the bytes of a template and the text on the screen. Bytes show as UTF-8 when they are valid UTF-8,
// otherwise as Windows-1252; what nobody edited goes back as the same bytes.
#pragma once

#include <QString>
#include <string>
#include <string_view>

#include "platform/text_encoding.h"

namespace tessal {

QString ToScreen(std::string_view bytes);

/// The bytes of an edited text. A text that shows as the former bytes do gives them back; another is written
/// in the document's encoding, or in UTF-8 where its bytes in that encoding would not show as the same text.
/// Zero bytes are dropped.
std::string FromScreen(const QString& text, std::string_view former, TextEncoding encoding);

}  // namespace tessal
