#include "app/work_timer.h"

#include <QCoreApplication>
#include <QEvent>

namespace tessal {

namespace {

using std::chrono::milliseconds;

constexpr milliseconds kPause(2000);
constexpr milliseconds kLongestWait(10000);

bool IsInput(QEvent::Type type) {
  switch (type) {
    case QEvent::KeyPress:
    case QEvent::InputMethod:
    case QEvent::MouseButtonRelease:
    case QEvent::Drop:
    case QEvent::Shortcut:
      return true;
    default:
      return false;
  }
}

}  // namespace

WorkTimer::WorkTimer() {
  for (QTimer* timer : {&pause, &wait}) {
    timer->setSingleShot(true);
    connect(timer, &QTimer::timeout, this, &WorkTimer::Elapse);
  }
  SetIntervals(kPause, kLongestWait);
  QCoreApplication::instance()->installEventFilter(this);
}

void WorkTimer::SetIntervals(milliseconds pauseLength, milliseconds longestWait) {
  pause.setInterval(pauseLength);
  wait.setInterval(longestWait);
}

void WorkTimer::NoteInput() {
  pause.start();
  if (!wait.isActive()) wait.start();
}

void WorkTimer::Elapse() {
  pause.stop();
  wait.stop();
  emit Due();
}

bool WorkTimer::eventFilter(QObject* watched, QEvent* event) {
  if (IsInput(event->type())) NoteInput();
  return QObject::eventFilter(watched, event);
}

}  // namespace tessal
