// The strip above the list of messages: what of the file the load did not take over, with its details and a
// button that takes over what was passed over. Hidden while there is nothing to say.
#pragma once

#include <QFrame>

class QLabel;
class QPushButton;

namespace tessal {

class LoadAccount;

class CAccountStrip final : public QFrame {
  Q_OBJECT

 public:
  explicit CAccountStrip(QWidget* parent);

  /// Shows what the account says; hides itself when a save of the template loses nothing of its file.
  void Show(const LoadAccount& account);

 signals:
  void DetailsRequested();
  /// The user wants what was passed over.
  void ReadRequested();

 private:
  QLabel* text;
  QPushButton* details;
  QPushButton* read;
};

/// What an account holds, one entry a line, for a box or a list.
QString AccountDetails(const LoadAccount& account);

}  // namespace tessal
