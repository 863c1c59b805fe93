#include "ui/focus_watch.h"

#include <QEvent>
#include <QFocusEvent>
#include <QWidget>
#include <utility>

namespace tessal {

namespace {

class FocusWatch final : public QObject {
 public:
  FocusWatch(QWidget& widget, std::function<void()> callback) : QObject(&widget), lost(std::move(callback)) {
    widget.installEventFilter(this);
  }

  bool eventFilter(QObject* watched, QEvent* happened) override {
    if (happened->type() == QEvent::FocusOut) {
      // A menu that opens over the widget takes the focus for a moment only.
      const auto reason = static_cast<QFocusEvent*>(happened)->reason();
      if (reason != Qt::PopupFocusReason) lost();
    }
    return QObject::eventFilter(watched, happened);
  }

 private:
  std::function<void()> lost;
};

}  // namespace

void WatchFocusLoss(QWidget& widget, std::function<void()> lost) {
  new FocusWatch(widget, std::move(lost));
}

}  // namespace tessal
