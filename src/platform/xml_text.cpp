#include "platform/xml_text.h"

#include <array>
#include <cstddef>

#include "platform/text_encoding.h"

namespace tessal {

namespace {

constexpr std::string_view kReplacement = "\xEF\xBF\xBD";

struct Reference {
  char character;
  std::string_view text;
};

/// A parser turns line ends and tabs in values into blanks unless they are references.
constexpr std::array<Reference, 7> kReferences = {{
    {'&', "&amp;"},
    {'<', "&lt;"},
    {'>', "&gt;"},
    {'"', "&quot;"},
    {'\t', "&#9;"},
    {'\n', "&#10;"},
    {'\r', "&#13;"},
}};

std::string_view ReferenceOf(char character) {
  for (const Reference& reference : kReferences) {
    if (reference.character == character) return reference.text;
  }
  constexpr unsigned char kFirstAllowed = 0x20;
  return static_cast<unsigned char>(character) < kFirstAllowed ? kReplacement : std::string_view();
}

}  // namespace

std::string XmlText(std::string_view bytes) {
  const std::string text = ToUtf8(bytes);
  std::string xml;
  xml.reserve(text.size());
  for (std::size_t place = 0; place < text.size(); ++place) {
    const std::string_view rest = std::string_view(text).substr(place);
    if (rest.starts_with("\xEF\xBF\xBE") || rest.starts_with("\xEF\xBF\xBF")) {
      xml += kReplacement;
      place += 2;
      continue;
    }
    const std::string_view reference = ReferenceOf(text[place]);
    if (reference.empty()) {
      xml += text[place];
    } else {
      xml += reference;
    }
  }
  return xml;
}

}  // namespace tessal
