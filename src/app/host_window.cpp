#include "app/host_window.h"

#include <malloc.h>

#include <QAction>
#include <QApplication>
#include <QCloseEvent>
#include <QDir>
#include <QDragEnterEvent>
#include <QDropEvent>
#include <QFileDialog>
#include <QFileInfo>
#include <QFontMetrics>
#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>
#include <QMimeData>
#include <QScreen>
#include <QSettings>
#include <QStackedWidget>
#include <QStatusBar>
#include <QStyle>
#include <QTabBar>
#include <QTabWidget>
#include <QVBoxLayout>
#include <algorithm>
#include <utility>

#include "app/comparison_dialog.h"
#include "app/document_lock.h"
#include "app/document_opening.h"
#include "app/notice_bar.h"
#include "app/open_document.h"
#include "app/recent_files.h"
#include "app/session.h"
#include "app/start_page.h"
#include "app/view_commands.h"
#include "platform/busy_notice.h"
#include "platform/docview.h"

namespace tessal {

namespace {

const QString kGeometryKey = QStringLiteral("geometry");
constexpr QSize kUsualSize(1100, 760);
constexpr int kMostTitleCharacters = 100;
constexpr int kMostTabCharacters = 40;

QStringList LocalFiles(const QMimeData& mime) {
  QStringList files;
  for (const QUrl& url : mime.urls()) {
    if (url.isLocalFile()) files.append(url.toLocalFile());
  }
  return files;
}

/// One file in one spelling, whatever links and dots lead to it.
QString FullPath(const QString& path) {
  const QFileInfo file(path);
  QString canonical = file.canonicalFilePath();
  if (!canonical.isEmpty()) return canonical;
  const QString folder = QFileInfo(file.absolutePath()).canonicalFilePath();
  return folder.isEmpty() ? file.absoluteFilePath() : QDir(folder).filePath(file.fileName());
}

QString Shortened(const QString& text, int mostCharacters) {
  return text.size() <= mostCharacters ? text : text.left(mostCharacters - 3) + QStringLiteral("...");
}

}  // namespace

HostWindow::HostWindow(std::unique_ptr<CMultiDocTemplate> documentTemplate, const QString& editorName)
    : docTemplate(std::move(documentTemplate)),
      name(editorName),
      pages(std::make_unique<QStackedWidget>(this).release()),
      tabs(std::make_unique<QTabWidget>(this).release()),
      startPage(std::make_unique<StartPage>(this).release()),
      notice(std::make_unique<NoticeBar>(this).release()),
      status(std::make_unique<QLabel>(this).release()) {
  tabs->setDocumentMode(true);
  tabs->setTabsClosable(true);
  tabs->setMovable(true);
  tabs->setAccessibleName(tr("Open documents"));
  LayOut();
  setAcceptDrops(true);
  // Made now, it shows what the widgets of the window have to say.
  statusBar()->addPermanentWidget(status);
  FitToScreen();
  MakeMenus();
  connect(startPage, &StartPage::NewRequested, this, &HostWindow::NewDocument);
  connect(startPage, &StartPage::OpenRequested, this, &HostWindow::ChooseFiles);
  connect(startPage, &StartPage::FileChosen, this, &HostWindow::OpenFile);
  connect(tabs, &QTabWidget::currentChanged, this, &HostWindow::Activate);
  connect(tabs, &QTabWidget::tabCloseRequested, this, [this](int index) {
    tabs->setCurrentIndex(index);
    CloseCurrent();
  });
  connect(notice, &NoticeBar::ReloadRequested, this, &HostWindow::ReloadCurrent);
  connect(notice, &NoticeBar::KeepRequested, this, &HostWindow::KeepCurrent);
  connect(notice, &NoticeBar::CompareRequested, this, &HostWindow::CompareCurrent);
  connect(&workTimer, &WorkTimer::Due, this, &HostWindow::KeepWork);
  ShowFront();
}

void HostWindow::LayOut() {
  pages->addWidget(startPage);
  pages->addWidget(tabs);
  auto* middle = std::make_unique<QWidget>(this).release();
  auto* rows = std::make_unique<QVBoxLayout>(middle).release();
  rows->setContentsMargins(0, 0, 0, 0);
  rows->setSpacing(0);
  rows->addWidget(notice);
  rows->addWidget(pages, 1);
  setCentralWidget(middle);
}

void HostWindow::FitToScreen() {
  resize(kUsualSize);
  restoreGeometry(QSettings().value(kGeometryKey).toByteArray());
  // The frame takes its part of the screen too; its size is known only when the window has been shown.
  constexpr int kFrame = 40;
  const QSize available = screen()->availableGeometry().size();
  resize(size().boundedTo(available - QSize(kFrame, kFrame)));
}

HostWindow::~HostWindow() {
  // The views are widgets of the tabs, and owned here: they leave the tabs before those go.
  const QSignalBlocker quiet(tabs);
  viewCommands->Show(nullptr);
  tabs->clear();
  documents.clear();
}

void HostWindow::MakeMenus() {
  QMenu* file = menuBar()->addMenu(tr("&File"));
  file->addAction(tr("&New"), QKeySequence::New, this, &HostWindow::NewDocument);
  file->addAction(tr("&Open..."), QKeySequence::Open, this, &HostWindow::ChooseFiles);
  recentMenu = file->addMenu(tr("Open &Recent"));
  connect(recentMenu, &QMenu::aboutToShow, this, &HostWindow::FillRecentMenu);
  file->addAction(tr("Reopen &Last Session"), this, &HostWindow::RestoreSession);
  QAction* restores = file->addAction(tr("Reopen It at Star&t"));
  restores->setCheckable(true);
  restores->setChecked(RestoresSession());
  connect(restores, &QAction::toggled, this, &SetRestoresSession);
  file->addSeparator();
  documentActions.append(file->addAction(tr("&Save"), QKeySequence::Save, this, &HostWindow::SaveCurrent));
  documentActions.append(
      file->addAction(tr("Save &As..."), QKeySequence(tr("Ctrl+Shift+S")), this, &HostWindow::SaveCurrentAs));
  file->addSeparator();
  QAction* close = file->addAction(tr("&Close"), this, &HostWindow::CloseCurrent);
  // The same on every desktop, as the guide says.
  close->setShortcuts({QKeySequence(tr("Ctrl+W")), QKeySequence(tr("Ctrl+F4"))});
  documentActions.append(close);
  file->addAction(tr("&Quit"), QKeySequence(tr("Ctrl+Q")), this, &QWidget::close);
  QMenu* help = menuBar()->addMenu(tr("&Help"));
  QAction* about = help->addAction(tr("&About"), this, &HostWindow::ShowAbout);
  viewCommands =
      std::make_unique<ViewCommands>(*menuBar(), *help->menuAction(), QList<QAction*>{close, about})
          .release();
}

void HostWindow::FillRecentMenu() {
  recentMenu->clear();
  const QStringList files = RecentFiles();
  for (const QString& path : files) {
    recentMenu->addAction(RecentFileCaption(path), this, [this, path] { OpenFile(path); });
  }
  if (files.isEmpty()) {
    recentMenu->addAction(tr("No files yet"))->setEnabled(false);
    return;
  }
  recentMenu->addSeparator();
  recentMenu->addAction(tr("&Clear List"), &ClearRecentFiles);
}

void HostWindow::ShowAbout() {
  QMessageBox::about(
      this, tr("About %1").arg(name),
      tr("%1 %2\n\nTemplates of aquatic process models.").arg(name, qApp->applicationVersion()));
}

QString HostWindow::FileFilter() const {
  return QString::fromStdString(docTemplate->GetDocString(CMultiDocTemplate::kFilterName)) +
         tr(";;All files (*)");
}

void HostWindow::NewDocument() {
  auto made = std::make_unique<OpenDocument>(docTemplate->CreateNewDocument());
  if (!made->Document().OnNewDocument()) return;
  const std::string plain = docTemplate->GetDocString(CMultiDocTemplate::kNewFileName);
  made->Document().SetTitle(plain + std::to_string(++newDocuments));
  AddTab(std::move(made));
}

void HostWindow::ChooseFiles() {
  const QString folder = Current() == nullptr ? QString() : QFileInfo(Current()->Path()).path();
  const QStringList chosen = QFileDialog::getOpenFileNames(this, tr("Open"), folder, FileFilter());
  OpenFiles(chosen);
}

void HostWindow::OpenFiles(const QStringList& paths) {
  for (const QString& path : paths) OpenFile(path);
}

void HostWindow::RestoreSession() {
  const Session session = KeptSession();
  OpenDocument* front = nullptr;
  int number = 0;
  for (const SessionFile& file : session.files) {
    const bool isFront = number++ == session.front;
    if (!OpenFile(file.path)) continue;
    Current()->View().GoTo(file.place);
    if (isFront) front = Current();
  }
  if (front != nullptr) tabs->setCurrentWidget(front->Widget());
}

void HostWindow::KeepOpenFiles() const {
  Session session;
  for (int tab = 0; tab < tabs->count(); ++tab) {
    const OpenDocument* open = FindByWidget(tabs->widget(tab));
    if (open == nullptr || open->Path().isEmpty()) continue;
    if (open == Current()) session.front = static_cast<int>(session.files.size());
    session.files.push_back({open->Path(), open->View().Place()});
  }
  KeepSession(session);
}

bool HostWindow::OpenFile(const QString& path) {
  const QString full = FullPath(path);
  if (OpenDocument* open = FindByPath(full)) {
    tabs->setCurrentWidget(open->Widget());
    return true;
  }
  OpenDocument* untouched = FindUntouched();
  auto opened = DocumentOpening(*docTemplate, *this, name).Open(full);
  if (!opened) {
    // The messages of the file that failed give way to those of the document in front.
    Activate();
    return false;
  }
  AddRecentFile(full);
  AddTab(std::move(opened));
  if (untouched != nullptr) Drop(*untouched);
  return true;
}

void HostWindow::OfferLeftWork(const QStringList& except) {
  QStringList asked;
  for (const QString& path : except) asked.append(FullPath(path));
  for (const FoundWork& work : FindAllWork()) {
    if (asked.contains(work.path)) continue;
    auto recovered = DocumentOpening(*docTemplate, *this, name).OfferWork(work);
    if (!recovered) continue;
    if (!work.path.isEmpty()) AddRecentFile(work.path);
    AddTab(std::move(recovered));
  }
  Activate();
}

OpenDocument* HostWindow::FindUntouched() const {
  if (documents.size() != 1 || !documents.front()->IsFresh()) return nullptr;
  // What is being entered is work too.
  documents.front()->View().OnCommit();
  return documents.front()->Document().IsModified() ? nullptr : documents.front().get();
}

void HostWindow::AddTab(std::unique_ptr<OpenDocument> opened) {
  opened->Show(*docTemplate);
  opened->View().SetFrameTitleUpdate([this] { UpdateTitles(); });
  opened->View().SetStatusUpdate([this](const std::string& message) { ShowStatus(message); });
  connect(&opened->File(), &WatchedFile::StateChanged, this, &HostWindow::ShowNotice);
  documents.push_back(std::move(opened));
  OpenDocument& shown = *documents.back();
  {
    // The view is still empty, and its messages are the newest.
    const QSignalBlocker quiet(tabs);
    tabs->setCurrentIndex(tabs->addTab(shown.Widget(), shown.Title()));
  }
  pages->setCurrentWidget(tabs);
  shown.View().OnInitialUpdate();
  ShowFront();
  shown.Widget()->setFocus();
}

OpenDocument* HostWindow::FindByWidget(const QWidget* widget) const {
  const auto hit = std::find_if(documents.begin(), documents.end(),
                                [widget](const auto& open) { return open->Widget() == widget; });
  return hit == documents.end() ? nullptr : hit->get();
}

OpenDocument* HostWindow::FindByPath(const QString& path) const {
  const auto hit = std::find_if(documents.begin(), documents.end(), [&path](const auto& open) {
    return !open->Path().isEmpty() && FullPath(open->Path()) == path;
  });
  return hit == documents.end() ? nullptr : hit->get();
}

OpenDocument* HostWindow::Current() const {
  return FindByWidget(tabs->currentWidget());
}

int HostWindow::DocumentCount() const {
  return static_cast<int>(documents.size());
}

bool HostWindow::SaveCurrent() {
  OpenDocument* saved = Current();
  if (saved == nullptr) return false;
  if (saved->Path().isEmpty() || saved->IsReadOnly()) return SaveUnderNewName(*saved);
  if (saved->File().Look() == FileState::Changed &&
      QMessageBox::warning(this, name,
                           tr("The file '%1' was changed by somebody else since it was read.\n\nReplace it?")
                               .arg(saved->Path()),
                           QMessageBox::Yes | QMessageBox::No, QMessageBox::No) != QMessageBox::Yes) {
    return false;
  }
  return Save(*saved, saved->Path());
}

bool HostWindow::SaveCurrentAs() {
  OpenDocument* saved = Current();
  return saved != nullptr && SaveUnderNewName(*saved);
}

bool HostWindow::SaveUnderNewName(OpenDocument& saved) {
  const QString extension =
      QString::fromStdString(docTemplate->GetDocString(CMultiDocTemplate::kFilterExtension));
  QFileDialog dialog(this, tr("Save As"), saved.Path(), FileFilter());
  dialog.setAcceptMode(QFileDialog::AcceptSave);
  dialog.setDefaultSuffix(extension.mid(1));
  if (dialog.exec() != QDialog::Accepted) return false;
  const QString path = dialog.selectedFiles().value(0);
  dialog.hide();
  const OpenDocument* other = FindByPath(FullPath(path));
  if (other != nullptr && other != &saved) {
    QMessageBox::warning(this, name, tr("The file '%1' is open in another tab.").arg(path));
    return false;
  }
  TakenLock taken;
  const bool isOwnFile = FullPath(path) == FullPath(saved.Path()) && !saved.IsReadOnly();
  if (!isOwnFile) taken = LockDocument(FullPath(path));
  if (!taken.holder.isEmpty()) {
    QMessageBox::warning(this, name,
                         tr("The file '%1' is open in another editor (%2).").arg(path, taken.holder));
    return false;
  }
  if (!Save(saved, path)) return false;
  if (!isOwnFile) saved.SetLock(std::move(taken.lock));
  AddRecentFile(path);
  return true;
}

bool HostWindow::Save(OpenDocument& saved, const QString& path) {
  // What is being entered belongs in the file, and its messages to the question before it is written.
  saved.View().OnCommit();
  const BusyNotice busy(*this, tr("Saving %1...").arg(path));
  const bool done = saved.Save(path);
  UpdateTitles();
  return done;
}

bool HostWindow::MayClose(OpenDocument& closing) {
  tabs->setCurrentWidget(closing.Widget());
  closing.View().OnCommit();
  // Of a file that is gone, the document is all that is left.
  if (!closing.Document().IsModified() && closing.File().State() != FileState::Gone) return true;
  const auto answer = QMessageBox::warning(
      this, name,
      tr("Save the changes to '%1'?").arg(closing.Path().isEmpty() ? closing.Title() : closing.Path()),
      QMessageBox::Save | QMessageBox::Discard | QMessageBox::Cancel, QMessageBox::Save);
  return answer == QMessageBox::Save ? SaveCurrent() : answer == QMessageBox::Discard;
}

bool HostWindow::CloseCurrent() {
  OpenDocument* closing = Current();
  if (closing == nullptr || !MayClose(*closing)) return false;
  Drop(*closing);
  return true;
}

void HostWindow::Drop(OpenDocument& closed) {
  closed.Document().OnCloseDocument();
  closed.DropWork();
  const auto hit = std::find_if(documents.begin(), documents.end(),
                                [&closed](const auto& open) { return open.get() == &closed; });
  std::unique_ptr<OpenDocument> gone = std::move(*hit);
  documents.erase(hit);
  tabs->removeTab(tabs->indexOf(gone->Widget()));
  gone->Widget()->setParent(nullptr);
  gone.reset();
  // The allocator would hold on to the memory of a large document.
  malloc_trim(0);
  ShowFront();
}

void HostWindow::KeepWork() {
  QString failure;
  for (const auto& open : documents) {
    const QString reason = open->KeepWork();
    if (failure.isEmpty()) failure = reason;
  }
  const QString former = std::exchange(
      notKept,
      failure.isEmpty() ? QString() : tr("Unsaved work can not be kept for a recovery: %1").arg(failure));
  if (!notKept.isEmpty()) {
    statusBar()->showMessage(notKept);
    workTimer.TryAgain();
  } else if (statusBar()->currentMessage() == former) {
    statusBar()->clearMessage();
  }
}

void HostWindow::ShowNotice() {
  const QIcon warning = style()->standardIcon(QStyle::SP_MessageBoxWarning);
  for (const auto& open : documents) {
    const bool isAsKnown = open->File().State() == FileState::AsKnown;
    tabs->setTabIcon(tabs->indexOf(open->Widget()), isAsKnown ? QIcon() : warning);
  }
  OpenDocument* front = Current();
  notice->ShowState(front == nullptr ? FileState::AsKnown : front->File().State(),
                    front == nullptr ? QString() : front->Path());
}

void HostWindow::ReloadCurrent() {
  OpenDocument* former = Current();
  if (former == nullptr) return;
  const QString path = former->Path();
  const bool hasWork = former->Document().IsModified() || former->View().HasUncommitted();
  if (hasWork && QMessageBox::warning(this, name, tr("Discard the changes to '%1'?").arg(path),
                                      QMessageBox::Discard | QMessageBox::Cancel,
                                      QMessageBox::Cancel) != QMessageBox::Discard) {
    return;
  }
  const BusyNotice busy(*this, tr("Opening %1...").arg(path));
  auto opened = std::make_unique<OpenDocument>(docTemplate->CreateNewDocument());
  if (!opened->Open(path)) {
    opened.reset();
    Activate();
    return;
  }
  opened->SetLock(former->TakeLock());
  if (former->IsReadOnly()) opened->SetReadOnly();
  const int place = tabs->indexOf(former->Widget());
  AddTab(std::move(opened));
  Drop(*former);
  tabs->tabBar()->moveTab(tabs->count() - 1, place);
}

void HostWindow::KeepCurrent() {
  OpenDocument* kept = Current();
  if (kept == nullptr) return;
  kept->File().TakeAsKnown();
  kept->Document().NoteOtherFile();
  workTimer.NoteInput();
  UpdateTitles();
}

void HostWindow::CompareCurrent() {
  OpenDocument* compared = Current();
  if (compared == nullptr) return;
  DocumentComparison comparison;
  compared->View().WithUncommitted([compared, &comparison] {
    comparison = compared->Document().CompareWithFile(compared->Document().PathName());
  });
  ComparisonDialog(comparison, tr("In the file"), tr("In the editor"), this).exec();
}

void HostWindow::changeEvent(QEvent* change) {
  QMainWindow::changeEvent(change);
  // Where a file cannot be watched, coming back from another program is the moment to look.
  if (change->type() != QEvent::ActivationChange || !isActiveWindow()) return;
  for (const auto& open : documents) open->File().Look();
}

void HostWindow::Activate() {
  // It was about the document that was in front.
  if (notKept.isEmpty()) statusBar()->clearMessage();
  if (OpenDocument* front = Current()) front->View().OnActivate();
  ShowFront();
}

void HostWindow::ShowFront() {
  OpenDocument* front = Current();
  if (front == nullptr) startPage->Fill();
  pages->setCurrentWidget(front == nullptr ? static_cast<QWidget*>(startPage) : tabs);
  viewCommands->Show(front == nullptr ? nullptr : &front->View());
  UpdateTitles();
}

QString HostWindow::TabText(const QString& title) const {
  const QFontMetrics metrics = tabs->fontMetrics();
  QString text = metrics.elidedText(title, Qt::ElideMiddle, kMostTabCharacters * metrics.averageCharWidth());
  // An ampersand in a file's name marks no shortcut key.
  return text.replace(u'&', QStringLiteral("&&"));
}

void HostWindow::UpdateTitles() {
  for (const auto& open : documents) {
    const int tab = tabs->indexOf(open->Widget());
    if (tab < 0) continue;
    tabs->setTabText(tab, TabText(open->Title()));
    tabs->setTabToolTip(tab, open->Path());
  }
  const OpenDocument* front = Current();
  setWindowTitle(front == nullptr
                     ? name
                     : Shortened(front->Title(), kMostTitleCharacters) + QStringLiteral(" \u2013 ") + name);
  for (QAction* action : documentActions) action->setEnabled(front != nullptr);
  ShowNotice();
  ShowStatus({});
}

void HostWindow::ShowStatus(const std::string& message) {
  constexpr int kShownFor = 10000;  // milliseconds
  const OpenDocument* front = Current();
  status->setText(front == nullptr ? QString() : QString::fromStdString(front->View().StatusText()));
  if (!message.empty()) statusBar()->showMessage(QString::fromStdString(message), kShownFor);
}

void HostWindow::closeEvent(QCloseEvent* close) {
  // Each document is asked about before any goes, so that a Cancel leaves everything open.
  for (const auto& open : documents) {
    if (MayClose(*open)) continue;
    close->ignore();
    return;
  }
  KeepOpenFiles();
  for (const auto& open : documents) open->DropWork();
  QSettings().setValue(kGeometryKey, saveGeometry());
  close->accept();
}

void HostWindow::dragEnterEvent(QDragEnterEvent* drag) {
  if (!LocalFiles(*drag->mimeData()).isEmpty()) drag->acceptProposedAction();
}

void HostWindow::dropEvent(QDropEvent* drop) {
  drop->acceptProposedAction();
  OpenFiles(LocalFiles(*drop->mimeData()));
}

}  // namespace tessal
