#include "docgen/safe_text.h"

#include "platform/ascii.h"
#include "platform/text_encoding.h"

namespace tessal {

std::string SafeText(std::string_view text) {
  std::string safe;
  for (const char character : ToUtf8(text)) {
    switch (character) {
      case '<':
        safe += "&lt;";
        break;
      case '>':
        safe += "&gt;";
        break;
      case '&':
        safe += "&amp;";
        break;
      case '"':
        safe += "&quot;";
        break;
      case '\'':
        safe += "&#39;";
        break;
      default:
        safe += character;
    }
  }
  return safe;
}

std::string MarkdownText(std::string_view text) {
  constexpr std::string_view kMarks = "\\`*<|";
  std::string escaped;
  for (const char character : text) {
    if (kMarks.find(character) != std::string_view::npos) escaped += '\\';
    escaped += character;
  }
  return escaped;
}

std::string AnchorText(std::string_view symbol) {
  constexpr std::string_view kDigits = "0123456789abcdef";
  constexpr unsigned kBase = 16;
  std::string text;
  for (const char character : symbol) {
    if (IsWordCharacter(character)) {
      text += character;
      continue;
    }
    const auto byte = static_cast<unsigned char>(character);
    text += '-';
    text += kDigits[byte / kBase];
    text += kDigits[byte % kBase];
  }
  return text;
}

}  // namespace tessal
