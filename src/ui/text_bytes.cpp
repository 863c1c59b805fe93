#include "ui/text_bytes.h"

#include <optional>
#include <utility>

namespace tessal {

QString ToScreen(std::string_view bytes) {
  return QString::fromStdString(ToUtf8(bytes));
}

std::string FromScreen(const QString& text, std::string_view former, TextEncoding encoding) {
  if (text == ToScreen(former)) return std::string(former);
  QString clean = text;
  clean.remove(QChar(u'\0'));
  std::string edited = clean.toStdString();
  if (encoding == TextEncoding::Utf8) return edited;
  // A character that the encoding lacks, or bytes that would show as others.
  std::optional<std::string> bytes = Utf8ToWindows1252(edited);
  return bytes && ToUtf8(*bytes) == edited ? *std::move(bytes) : edited;
}

}  // namespace tessal
