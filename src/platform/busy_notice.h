// What a user sees while something takes its time: a busy pointer, and a line in the status bar of the window
// around a widget. Needs Qt Widgets, which the targets that include it link.
#pragma once

#include <QCoreApplication>
#include <QGuiApplication>
#include <QPointer>
#include <QStatusTipEvent>
#include <QWidget>

namespace tessal {

class BusyNotice final {
 public:
  /// Shows the notice at once, and lets a dialog that was closed just now go from the screen. Keys and clicks
  /// wait until the work is done.
  BusyNotice(QWidget& widget, const QString& text) : shownIn(&widget) {
    Say(text);
    QGuiApplication::setOverrideCursor(Qt::WaitCursor);
    QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
  }
  BusyNotice(const BusyNotice&) = delete;
  BusyNotice& operator=(const BusyNotice&) = delete;
  ~BusyNotice() {
    QGuiApplication::restoreOverrideCursor();
    Say(QString());
  }

 private:
  /// A window with a status bar shows the tips of what is in it there.
  void Say(const QString& text) {
    if (!shownIn) return;
    QStatusTipEvent tip(text);
    QCoreApplication::sendEvent(shownIn, &tip);
  }

  QPointer<QWidget> shownIn;
};

/// The usual pointer for a question that comes up in the middle of such work.
class QuestionPointer final {
 public:
  QuestionPointer() : isBusy(QGuiApplication::overrideCursor() != nullptr) {
    if (isBusy) QGuiApplication::setOverrideCursor(Qt::ArrowCursor);
  }
  QuestionPointer(const QuestionPointer&) = delete;
  QuestionPointer& operator=(const QuestionPointer&) = delete;
  ~QuestionPointer() {
    if (isBusy) QGuiApplication::restoreOverrideCursor();
  }

 private:
  bool isBusy;
};

}  // namespace tessal
