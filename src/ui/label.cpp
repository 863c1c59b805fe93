#include "ui/label.h"

namespace tessal {

void CLabel::SetFontWeight(int weight) {
  QFont changed = font();
  changed.setWeight(static_cast<QFont::Weight>(weight));
  setFont(changed);
}

void CLabel::SetFontHeight(int pixels) {
  QFont changed = font();
  changed.setPixelSize(pixels);
  setFont(changed);
}

}  // namespace tessal
