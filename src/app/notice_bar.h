// A bar above the documents that says what others did to the file of the one in front, and offers what can be
// done about it. It waits: who types on is not interrupted.
#pragma once

#include <QFrame>

class QLabel;
class QPushButton;

namespace tessal {

enum class FileState : std::uint8_t;

class NoticeBar final : public QFrame {
  Q_OBJECT

 public:
  explicit NoticeBar(QWidget* parent);

  /// Shows what became of the file, or nothing when it is as known.
  void ShowState(FileState state, const QString& path);

 signals:
  void ReloadRequested();
  void KeepRequested();
  void CompareRequested();

 private:
  QLabel* text;
  QPushButton* reload;
  QPushButton* compare;
};

}  // namespace tessal
