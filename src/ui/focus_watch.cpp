#include "ui/focus_watch.h"

#include <QEvent>
#include <QFocusEvent>
#include <QWidget>
#include <utility>

#include "ui/child.h"

namespace tessal {

namespace {

class FocusWatch final : public QObject {
 public:
  FocusWatch(std::function<void()> callback, QWidget* widget) : QObject(widget), lost(std::move(callback)) {}

  bool eventFilter(QObject* /*watched*/, QEvent* happened) override {
    if (happened->type() == QEvent::FocusOut &&
        static_cast<QFocusEvent*>(happened)->reason() != Qt::PopupFocusReason) {
      lost();
    }
    return false;
  }

 private:
  std::function<void()> lost;
};

class WheelGuard final : public QObject {
 public:
  explicit WheelGuard(QWidget* widget) : QObject(widget), guarded(*widget) {}

  bool eventFilter(QObject* /*watched*/, QEvent* happened) override {
    if (happened->type() != QEvent::Wheel || guarded.hasFocus()) return false;
    happened->ignore();
    return true;
  }

 private:
  QWidget& guarded;
};

}  // namespace

void WatchFocusLoss(QWidget& widget, std::function<void()> lost) {
  widget.installEventFilter(MakeChild<FocusWatch>(std::move(lost), &widget));
}

void IgnoreWheelWithoutFocus(QWidget& widget) {
  widget.installEventFilter(MakeChild<WheelGuard>(&widget));
}

}  // namespace tessal
