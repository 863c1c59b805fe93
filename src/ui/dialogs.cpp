#include "ui/dialogs.h"

#include <QApplication>
#include <QCheckBox>
#include <QCloseEvent>
#include <QDesktopServices>
#include <QDialog>
#include <QDialogButtonBox>
#include <QDir>
#include <QFileDialog>
#include <QFileInfo>
#include <QGridLayout>
#include <QKeyEvent>
#include <QMessageBox>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QUrl>
#include <QVBoxLayout>

#include "platform/busy_notice.h"
#include "ui/auto_create_dialog.h"
#include "ui/child.h"
#include "ui/help_window.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

void ShowBox(QWidget* parent, const QString& title, const QString& text) {
  const QuestionPointer pointer;
  QMessageBox box(QMessageBox::Warning, title, text, QMessageBox::Ok, parent);
  box.setTextFormat(Qt::PlainText);
  box.exec();
}

/// A question whose escape key and close button are no answer, where the toolkit takes them for a No.
/// The first of the texts, a line each, and how many more there are.
QString FirstOf(const std::vector<std::string>& texts) {
  constexpr std::size_t kMostShown = 10;
  QStringList lines;
  for (const std::string& text : texts) {
    if (static_cast<std::size_t>(lines.size()) == kMostShown) break;
    lines.append(ToScreen(text).simplified());
  }
  if (texts.size() > kMostShown) lines.append(strings::kMoreLosses.arg(texts.size() - kMostShown));
  return lines.join(u'\n');
}

class QuestionBox final : public QMessageBox {
 public:
  QuestionBox(QWidget* parent, const QString& question, StandardButtons buttons)
      : QMessageBox(Question, strings::kEditorName, question, buttons, parent) {
    setTextFormat(Qt::PlainText);
  }

  Answer Run() {
    const QuestionPointer pointer;
    switch (exec()) {
      case Yes:
        return Answer::Yes;
      case No:
        return Answer::No;
      case NoToAll:
        return Answer::NoToAll;
      default:
        return Answer::Cancelled;
    }
  }

 protected:
  void keyPressEvent(QKeyEvent* key) override {
    if (key->matches(QKeySequence::Cancel)) {
      done(Cancel);
    } else {
      QMessageBox::keyPressEvent(key);
    }
  }

  void closeEvent(QCloseEvent* closing) override {
    done(Cancel);
    closing->accept();
  }
};

/// Adds a ticked box below the fields of a file dialog; none for an empty text.
QCheckBox* AddOption(QFileDialog& dialog, const QString& text) {
  auto* layout = qobject_cast<QGridLayout*>(dialog.layout());
  if (text.isEmpty() || layout == nullptr) return nullptr;
  auto* box = MakeChild<QCheckBox>(text, &dialog);
  box->setChecked(true);
  layout->addWidget(box, layout->rowCount(), 0, 1, -1);
  return box;
}

class BoxDialogs final : public UserDialogs {
 public:
  void ShowMessage(const std::string& text) override { Warn(QApplication::activeWindow(), ToScreen(text)); }

  bool AskYesNo(const std::string& question) override {
    return Ask(QApplication::activeWindow(), ToScreen(question)) == Answer::Yes;
  }

  void Warn(QWidget* parent, const QString& text) override { ShowBox(parent, strings::kEditorName, text); }

  void ShowFailure(QWidget* parent, const QString& text) override { ShowBox(parent, strings::kError, text); }

  Answer Ask(QWidget* parent, const QString& question) override {
    return QuestionBox(parent, question, QMessageBox::Yes | QMessageBox::No).Run();
  }

  LossAnswer AskAboutLosses(const std::string& path, const std::vector<std::string>& losses) override {
    QMessageBox box(QMessageBox::Warning, strings::kEditorName,
                    strings::kAskAboutLosses.arg(ToScreen(path), FirstOf(losses)), QMessageBox::Cancel,
                    QApplication::activeWindow());
    box.setTextFormat(Qt::PlainText);
    const QPushButton* copy = box.addButton(strings::kSaveCopy, QMessageBox::ActionRole);
    const QPushButton* replace = box.addButton(strings::kReplace, QMessageBox::DestructiveRole);
    box.setDefaultButton(QMessageBox::Cancel);
    box.exec();
    if (box.clickedButton() == replace) return {LossAnswer::Wish::Replace, {}};
    if (box.clickedButton() != copy) return {};
    const QString chosen =
        QFileDialog::getSaveFileName(QApplication::activeWindow(), strings::kSaveCopy, ToScreen(path));
    if (chosen.isEmpty() || chosen == ToScreen(path)) return {};
    return {LossAnswer::Wish::SaveCopy, chosen.toStdString()};
  }

  void ShowDetails(QWidget* parent, const QString& title, const QString& text) override {
    QDialog dialog(parent);
    dialog.setWindowTitle(title);
    auto* shown = MakeChild<QPlainTextEdit>(text, &dialog);
    shown->setReadOnly(true);
    shown->setTabChangesFocus(true);
    shown->setAccessibleName(title);
    auto* buttons = MakeChild<QDialogButtonBox>(QDialogButtonBox::Close, &dialog);
    QObject::connect(buttons, &QDialogButtonBox::rejected, &dialog, &QDialog::reject);
    auto* layout = MakeChild<QVBoxLayout>(&dialog);
    layout->addWidget(shown);
    layout->addWidget(buttons);
    constexpr QSize kUsualSize(700, 400);
    dialog.resize(kUsualSize);
    dialog.exec();
  }

  Answer AskOneOfMany(QWidget* parent, const QString& question) override {
    return QuestionBox(parent, question, QMessageBox::Yes | QMessageBox::No | QMessageBox::NoToAll).Run();
  }

  Answer AskToReplace(QWidget* parent, const QString& question) override {
    QuestionBox box(parent, question, QMessageBox::Yes | QMessageBox::No);
    const QPushButton* wholeNames = box.addButton(strings::kLeaveLongerNames, QMessageBox::AcceptRole);
    box.setDefaultButton(QMessageBox::Yes);
    const Answer answer = box.Run();
    return box.clickedButton() == wholeNames ? Answer::WholeNames : answer;
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

  ExportAnswer ChooseExportFile(QWidget* parent, const ExportQuestion& question) override {
    const QString& proposal = question.proposal;
    QFileDialog dialog(parent, question.title, QFileInfo(proposal).path(), question.filter);
    dialog.setAcceptMode(QFileDialog::AcceptSave);
    dialog.setDefaultSuffix(QFileInfo(proposal).suffix());
    const QFileInfo folder(QFileInfo(proposal).path());
    // Not every dialog of a desktop takes a box, or a name in a folder that is not there yet.
    if (!folder.isDir() || !question.option.isEmpty()) dialog.setOption(QFileDialog::DontUseNativeDialog);
    if (folder.isDir()) {
      dialog.selectFile(proposal);
    } else {
      // The folder is made when the user agrees: until then it is a part of the name.
      dialog.setDirectory(folder.path());
      dialog.selectFile(folder.fileName() + u'/' + QFileInfo(proposal).fileName());
    }
    QCheckBox* option = AddOption(dialog, question.option);
    ExportAnswer answer;
    if (dialog.exec() == QDialog::Accepted) answer.path = dialog.selectedFiles().value(0);
    if (option != nullptr) answer.option = option->isChecked();
    return answer;
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
