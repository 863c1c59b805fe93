#include "ui/label.h"

#include <QHelpEvent>
#include <QPainter>
#include <QStyle>
#include <QToolTip>

#include "ui/plain_tip.h"

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

bool CLabel::IsTooLong() const {
  return !wordWrap() && fontMetrics().horizontalAdvance(text()) > contentsRect().width();
}

bool CLabel::event(QEvent* happened) {
  if (happened->type() != QEvent::ToolTip || !IsTooLong()) return QLabel::event(happened);
  QToolTip::showText(static_cast<QHelpEvent*>(happened)->globalPos(), PlainTip(text()), this);
  return true;
}

void CLabel::paintEvent(QPaintEvent* paint) {
  if (!IsTooLong()) return QLabel::paintEvent(paint);
  QPainter painter(this);
  const QRect place = contentsRect();
  style()->drawItemText(&painter, place, static_cast<int>(alignment()), palette(), isEnabled(),
                        fontMetrics().elidedText(text(), Qt::ElideRight, place.width()), foregroundRole());
}

}  // namespace tessal
