#include "ui/text_bytes.h"

#include "platform/text_encoding.h"

namespace tessal {

QString ToScreen(std::string_view bytes) {
  return QString::fromStdString(ToUtf8(bytes));
}

std::string FromScreen(const QString& text, std::string_view former) {
  if (text == ToScreen(former)) return std::string(former);
  QString clean = text;
  clean.remove(QChar(u'\0'));
  std::string edited = clean.toStdString();
  if (IsUtf8(former)) return edited;
  return Utf8ToWindows1252(edited).value_or(edited);
}

}  // namespace tessal
