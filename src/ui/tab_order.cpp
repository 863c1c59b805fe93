#include "ui/tab_order.h"

#include <QWidget>

namespace tessal {

QList<QWidget*> TabStopsIn(const QWidget& part, QWidget& from) {
  QList<QWidget*> stops;
  for (QWidget* next = from.nextInFocusChain(); next != &from; next = next->nextInFocusChain()) {
    if (part.isAncestorOf(next) && (next->focusPolicy() & Qt::TabFocus) != 0) stops.append(next);
  }
  return stops;
}

QWidget& ChainAfter(QWidget& stop, const QWidget& part) {
  QWidget* last = &stop;
  for (QWidget* next : TabStopsIn(part, stop)) {
    QWidget::setTabOrder(last, next);
    last = next;
  }
  return *last;
}

}  // namespace tessal
