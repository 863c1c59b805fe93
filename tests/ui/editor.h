// An open editor for tests: a document with its main view on a screen that nobody sees, a user who answers by
// script, and what such a user can do.
#pragma once

#include <QComboBox>
#include <QLineEdit>
#include <QStringList>
#include <QTreeWidgetItem>
#include <cstdint>
#include <memory>
#include <string>
#include <utility>

#include "core/document.h"
#include "support/qt_print.h"
#include "support/temporary_folder.h"
#include "ui/dialogs.h"
#include "ui/element_tree.h"
#include "ui/error_list.h"
#include "ui/expression_field.h"
#include "ui/main_view.h"
#include "ui/right_pane.h"

namespace tessal {
class CRowTable;
}

namespace tessal::test {

/// Answers every question, and notes what was asked and shown, in order.
class ScriptedUser final : public UserDialogs {
 public:
  void ShowMessage(const std::string& text) override { log.append(QString::fromStdString(text)); }
  bool AskYesNo(const std::string& question) override {
    return Ask(nullptr, QString::fromStdString(question)) == tessal::Answer::Yes;
  }
  LossAnswer AskAboutLosses(const std::string& path, const std::vector<std::string>& losses) override;
  void ShowDetails(QWidget* /*parent*/, const QString& /*title*/, const QString& text) override {
    log.append(text);
  }
  void Warn(QWidget* /*parent*/, const QString& text) override { log.append(text); }
  void ShowFailure(QWidget* /*parent*/, const QString& text) override { log.append(text); }
  tessal::Answer Ask(QWidget* parent, const QString& question) override;
  tessal::Answer AskOneOfMany(QWidget* parent, const QString& question) override;
  tessal::Answer AskToReplace(QWidget* parent, const QString& question) override;
  int ChooseKind(QWidget* parent, const QString& symbol, std::uint32_t mask) override;
  QString ChooseDocumentationFile(QWidget* /*parent*/, const QString& /*start*/) override {
    return documentationFile;
  }
  ExportAnswer ChooseExportFile(QWidget* /*parent*/, const ExportQuestion& question) override;
  bool OpenWithSystem(const QString& target) override;
  void ShowHelp(QWidget* /*parent*/, int topic) override { log.append("help " + QString::number(topic)); }

  /// What was asked and shown since the last call.
  QStringList TakeLog() { return std::exchange(log, {}); }

  QList<tessal::Answer> answers;  ///< to questions; Yes when used up
  LossAnswer lossAnswer{LossAnswer::Wish::Replace, {}};
  QList<int> choices;  ///< of kinds; skips when used up
  QString documentationFile;
  QString exportFile;        ///< where exports go; to the proposal when it is null
  bool exportOption = true;  ///< whether the box of an export stays ticked
  QStringList openable;      ///< what the system can open

 private:
  QStringList log;
};

/// Builds a template from its notation; "small" at the start is one element of each kind with a symbol: a
/// uses k and f, p uses a, and S is made of p.
std::string ModelText(std::string lines);

class Editor final {
 public:
  /// Opens a template; one that does not open throws.
  explicit Editor(const std::string& templateText);
  ~Editor();

  TemplateCore& Core() { return document->Core(); }
  CTessalDoc& Document() { return *document; }
  CMainView& View() { return *view; }
  CElementTree& Tree() { return view->Tree(); }
  ScriptedUser& User() { return user; }
  const std::string& Path() const { return path; }

  /// The first node with this caption, or with the captions of a path such as "Fish/Constants".
  QTreeWidgetItem* Node(const QString& caption);
  void Select(const QString& caption);
  QString Selected() { return Tree().currentItem()->text(0); }
  Uid IdOf(const QString& caption) { return CElementTree::DataOf(*Node(caption)).id; }
  /// The captions of a node's children.
  QStringList Children(const QString& caption);

  /// A control of the open form by its label.
  template <class Control = QWidget>
  Control& Field(const QString& label) {
    return dynamic_cast<Control&>(Labelled(label));
  }
  /// What a control shows.
  static QString TextOf(const QWidget& control);
  /// The rows of a list page, the selected one with a mark.
  static QStringList RowsOf(const CRowTable& table);
  /// Types over what a field holds; the focus stays there.
  void Type(const QString& label, const QString& text);
  void LeaveField() { Tree().setFocus(); }
  void Choose(const QString& label, const QString& caption);
  static QStringList Offered(const QComboBox& combo);

  /// Opens a node's menu, chooses the entry with a caption, if there is one, and gives the captions of all.
  QStringList UseMenu(const QString& caption, const QString& entry);

  /// The rows of the error list as "item: message".
  QStringList Rows();

 private:
  QWidget& Labelled(const QString& label);

  TemporaryFolder folder;
  std::string path;
  ScriptedUser user;
  std::unique_ptr<CTessalDoc> document;
  std::unique_ptr<CMainView> view;
};

}  // namespace tessal::test
