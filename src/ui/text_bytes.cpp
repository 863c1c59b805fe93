#include "ui/text_bytes.h"

namespace tessal {

QString ToScreen(std::string_view bytes) {
  return QString::fromStdString(ToUtf8(bytes));
}

std::string FromScreen(const QString& text, std::string_view former, TextEncoding encoding) {
  if (text == ToScreen(former)) return std::string(former);
  QString clean = text;
  clean.remove(QChar(u'\0'));
  return EncodedText(clean.toStdString(), encoding);
}

}  // namespace tessal
