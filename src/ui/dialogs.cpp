#include "ui/dialogs.h"

#include <QApplication>
#include <QDesktopServices>
#include <QDir>
#include <QFileDialog>
#include <QFileInfo>
#include <QMessageBox>
#include <QUrl>

#include "platform/busy_notice.h"
#include "ui/auto_create_dialog.h"
#include "ui/help_window.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

QMessageBox::StandardButton ShowBox(QWidget* parent, QMessageBox::Icon icon, const QString& title,
                                    const QString& text, QMessageBox::StandardButtons buttons) {
  const QuestionPointer pointer;
  QMessageBox box(icon, title, text, buttons, parent);
  box.setTextFormat(Qt::PlainText);
  return static_cast<QMessageBox::StandardButton>(box.exec());
}

class BoxDialogs final : public UserDialogs {
 public:
  void ShowMessage(const std::string& text) override { Warn(QApplication::activeWindow(), ToScreen(text)); }

  bool AskYesNo(const std::string& question) override {
    return Ask(QApplication::activeWindow(), ToScreen(question));
  }

  void Warn(QWidget* parent, const QString& text) override {
    ShowBox(parent, QMessageBox::Warning, strings::kEditorName, text, QMessageBox::Ok);
  }

  void ShowFailure(QWidget* parent, const QString& text) override {
    ShowBox(parent, QMessageBox::Warning, strings::kError, text, QMessageBox::Ok);
  }

  bool Ask(QWidget* parent, const QString& question) override {
    return ShowBox(parent, QMessageBox::Question, strings::kEditorName, question,
                   QMessageBox::Yes | QMessageBox::No) == QMessageBox::Yes;
  }

  int ChooseKind(QWidget* parent, const QString& symbol, std::uint32_t mask) override {
    CAutoCreateDlg dialog(symbol, mask, parent);
    dialog.exec();
    return dialog.ChosenIndex();
  }

  QString ChooseDocumentationFile(QWidget* parent, const QString& start) override {
    return QFileDialog::getOpenFileName(parent, strings::kSelectDocumentation, start,
                                        strings::kDocumentationFilter);
  }

  QString ChooseExportFile(QWidget* parent, const QString& title, const QString& proposal,
                           const QString& filter) override {
    QFileDialog dialog(parent, title, QFileInfo(proposal).path(), filter);
    dialog.setAcceptMode(QFileDialog::AcceptSave);
    dialog.setDefaultSuffix(QFileInfo(proposal).suffix());
    const QFileInfo folder(QFileInfo(proposal).path());
    if (folder.isDir()) {
      dialog.selectFile(proposal);
    } else {
      // The folder is made when the user agrees: until then it is a part of the name. Not every dialog of a
      // desktop takes such a name.
      dialog.setOption(QFileDialog::DontUseNativeDialog);
      dialog.setDirectory(folder.path());
      dialog.selectFile(folder.fileName() + u'/' + QFileInfo(proposal).fileName());
    }
    return dialog.exec() == QDialog::Accepted ? dialog.selectedFiles().value(0) : QString();
  }

  bool OpenWithSystem(const QString& target) override {
    // Templates travel: a path may be written as on another system.
    QString path = target;
    if (!QFileInfo::exists(path)) path.replace(u'\\', u'/');
    const QUrl url = QFileInfo::exists(path) ? QUrl::fromLocalFile(QFileInfo(path).absoluteFilePath())
                                             : QUrl(target, QUrl::StrictMode);
    const bool canOpen = url.isLocalFile() ? QFileInfo::exists(url.toLocalFile()) : !url.scheme().isEmpty();
    return canOpen && QDesktopServices::openUrl(url);
  }

  void ShowHelp(QWidget* parent, int topic) override { OpenHelp(parent, topic); }
};

}  // namespace

UserDialogs& ScreenDialogs() {
  static BoxDialogs dialogs;
  return dialogs;
}

}  // namespace tessal
