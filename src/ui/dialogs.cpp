#include "ui/dialogs.h"

#include <QApplication>
#include <QDesktopServices>
#include <QFileDialog>
#include <QFileInfo>
#include <QMessageBox>
#include <QUrl>

#include "ui/auto_create_dialog.h"
#include "ui/help_window.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

QMessageBox::StandardButton ShowBox(QWidget* parent, QMessageBox::Icon icon, const QString& title,
                                    const QString& text, QMessageBox::StandardButtons buttons) {
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
