// When unsaved work is due to be kept: after the user has paused, and in steady work after a while at most.
// Without any input nothing is ever due, but for what could not be done.
#pragma once

#include <QObject>
#include <QTimer>
#include <chrono>

namespace tessal {

class WorkTimer final : public QObject {
  Q_OBJECT

 public:
  /// Watches the input to the whole application.
  WorkTimer();

  void SetIntervals(std::chrono::milliseconds pauseLength, std::chrono::milliseconds longestWait);
  /// As input does: for changes that come from elsewhere.
  void NoteInput();

  /// What was due could not be done: it is due again after the longest wait, also without input.
  void TryAgain() { wait.start(); }

 signals:
  void Due();

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  void Elapse();

  QTimer pause;
  QTimer wait;
};

}  // namespace tessal
