#include "ui/dialogs.h"

#include <QApplication>
#include <QDesktopServices>
#include <QFileDialog>
#include <QFileInfo>
#include <QMessageBox>
#include <QUrl>

#include "ui/auto_create_dialog.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

class BoxDialogs final : public UserDialogs {
 public:
  void ShowMessage(const std::string& text) override { Warn(QApplication::activeWindow(), ToScreen(text)); }

  bool AskYesNo(const std::string& question) override {
    return Ask(QApplication::activeWindow(), ToScreen(question));
  }

  void Warn(QWidget* parent, const QString& text) override {
    QMessageBox box(QMessageBox::Warning, strings::kEditorName, text, QMessageBox::Ok, parent);
    box.setTextFormat(Qt::PlainText);
    box.exec();
  }

  bool Ask(QWidget* parent, const QString& question) override {
    QMessageBox box(QMessageBox::Question, strings::kEditorName, question, QMessageBox::Yes | QMessageBox::No,
                    parent);
    box.setTextFormat(Qt::PlainText);
    return box.exec() == QMessageBox::Yes;
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
    const QUrl url = QFileInfo::exists(target) ? QUrl::fromLocalFile(QFileInfo(target).absoluteFilePath())
                                               : QUrl(target, QUrl::StrictMode);
    const bool canOpen = url.isLocalFile() || !url.scheme().isEmpty();
    return canOpen && QDesktopServices::openUrl(url);
  }
};

}  // namespace

UserDialogs& ScreenDialogs() {
  static BoxDialogs dialogs;
  return dialogs;
}

}  // namespace tessal
