#include "ui/text_places.h"

namespace tessal {

std::size_t BytesBefore(const QString& text, int position) {
  return static_cast<std::size_t>(QStringView(text).left(position).toUtf8().size());
}

int PositionAt(const std::string& bytes, std::size_t offset) {
  return static_cast<int>(QString::fromUtf8(bytes.data(), static_cast<qsizetype>(offset)).size());
}

}  // namespace tessal
