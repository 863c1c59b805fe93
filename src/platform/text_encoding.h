// The encodings that bytes may be in. Nothing in the core looks at one; what shows text to people takes
// bytes as UTF-8 when they are valid UTF-8, and as Windows-1252 otherwise.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace tessal {

enum class TextEncoding : std::uint8_t { Utf8, Windows1252 };

bool IsUtf8(std::string_view bytes);

/// The encoding that bytes are in as a whole.
TextEncoding EncodingOf(std::string_view bytes);

/// The text in UTF-8, whichever of the two encodings it is in.
std::string ToUtf8(std::string_view bytes);

/// A UTF-8 text in Windows-1252; nothing when it holds a character that the encoding lacks.
std::optional<std::string> Utf8ToWindows1252(std::string_view text);

/// The bytes of a UTF-8 text in an encoding; in UTF-8 where its bytes in that encoding would not show as the
/// same text.
std::string EncodedText(std::string text, TextEncoding encoding);

}  // namespace tessal
