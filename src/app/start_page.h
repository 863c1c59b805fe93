// What the window shows while no document is open: where to begin.
#pragma once

#include <QWidget>

class QVBoxLayout;

namespace tessal {

class StartPage final : public QWidget {
  Q_OBJECT

 public:
  explicit StartPage(QWidget* parent);

  /// Lists the recent files and the examples as they are now.
  void Fill();

 signals:
  void NewRequested();
  void OpenRequested();
  void FileChosen(const QString& path);

 private:
  void AddFiles(const QString& heading, const QStringList& paths, QString (*captionOf)(const QString& path));

  QVBoxLayout* lists;
};

}  // namespace tessal
