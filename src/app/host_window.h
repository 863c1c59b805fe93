// The window of the host: it owns the documents, shows each in a tab, and drives them through the document
// template of the editor's module. What is in a document is none of its business.
#pragma once

#include <QMainWindow>
#include <QStringList>
#include <memory>
#include <vector>

#include "app/work_timer.h"

class QLabel;
class QMenu;
class QStackedWidget;
class QTabWidget;

namespace tessal {

class CMultiDocTemplate;
class NoticeBar;
class OpenDocument;
class StartPage;
class ViewCommands;

class HostWindow final : public QMainWindow {
  Q_OBJECT

 public:
  HostWindow(std::unique_ptr<CMultiDocTemplate> documents, const QString& editorName);
  ~HostWindow() override;

  void NewDocument();
  /// Opens a file in a tab of its own, or shows the tab that has it already. False when it did not load; the
  /// document has then shown why.
  bool OpenFile(const QString& path);
  void OpenFiles(const QStringList& paths);
  /// Offers unsaved work that the last run left, but for that of the files at the paths.
  void OfferLeftWork(const QStringList& except);
  /// The document in front; none when no document is open.
  OpenDocument* Current() const;
  int DocumentCount() const;
  /// Opens what was open when the application was closed last, at the places that were in front.
  void RestoreSession();
  bool SaveCurrent();
  bool SaveCurrentAs();
  /// Closes the document in front, and asks first when it holds unsaved work. False when the user
  /// declines.
  bool CloseCurrent();
  /// Decides when the unsaved work of all documents is kept for a recovery.
  WorkTimer& Timer() { return workTimer; }

 protected:
  void changeEvent(QEvent* change) override;
  void closeEvent(QCloseEvent* close) override;
  void dragEnterEvent(QDragEnterEvent* drag) override;
  void dropEvent(QDropEvent* drop) override;

 private:
  void MakeMenus();
  void FitToScreen();
  void FillRecentMenu();
  void ChooseFiles();
  void ShowAbout();
  QString FileFilter() const;

  void LayOut();
  void AddTab(std::unique_ptr<OpenDocument> opened);
  /// The document that gives way to the first file: new, alone, and nobody has touched it.
  OpenDocument* FindUntouched() const;
  OpenDocument* FindByWidget(const QWidget* widget) const;
  OpenDocument* FindByPath(const QString& path) const;
  bool Save(OpenDocument& saved, const QString& path);
  bool SaveUnderNewName(OpenDocument& saved);
  /// Whether a document may go: it is unmodified, or the user has saved it or given it up.
  bool MayClose(OpenDocument& closing);
  void Drop(OpenDocument& closed);
  void KeepWork();
  void KeepOpenFiles() const;
  void UpdateTitles();
  /// What the view in front has to say, with a message for a while.
  void ShowStatus(const std::string& message);
  // What can be done about a file that others have changed.
  void ShowNotice();
  void ReloadCurrent();
  void KeepCurrent();
  void CompareCurrent();
  QString TabText(const QString& title) const;
  /// The view of the document in front takes over the messages and the menus; without one, the start page is
  /// shown.
  void Activate();
  void ShowFront();

  std::unique_ptr<CMultiDocTemplate> docTemplate;
  QString name;
  QStackedWidget* pages;
  QTabWidget* tabs;
  StartPage* startPage;
  NoticeBar* notice;
  QLabel* status;
  ViewCommands* viewCommands = nullptr;
  QMenu* recentMenu = nullptr;
  QList<QAction*> documentActions;  ///< those that need a document in front
  WorkTimer workTimer;
  std::vector<std::unique_ptr<OpenDocument>> documents;
  QString notKept;  ///< why work could not be kept when it was last due, as the status bar says it
  int newDocuments = 0;
};

}  // namespace tessal
