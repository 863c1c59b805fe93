// The commands of the edit menu: taking back, cutting, copying and pasting, new elements and gone ones. Where
// a field with text has the focus, those that it knows too are about its text.
#pragma once

#include <QObject>
#include <array>
#include <functional>
#include <optional>
#include <vector>

#include "platform/docview.h"
#include "platform/uid.h"

class QAction;
class QToolBar;

namespace tessal {

class CMainView;
class CTessalDoc;
class TemplateCore;
struct PastedElements;
struct StepEffect;
class UserDialogs;

class CEditCommands final : public QObject {
  Q_OBJECT

 public:
  CEditCommands(CMainView& mainView, UserDialogs& userDialogs);

  /// Adds the usual ones to a tool bar.
  void AddTo(QToolBar& bar) const;
  std::vector<ViewCommand> Commands() const;
  /// Names and enables the commands by what can be done now.
  void Update();

 protected:
  /// Lets the keys for undo and redo pass by a field that has nothing of the kind to do.
  bool eventFilter(QObject* watched, QEvent* happened) override;

 private:
  enum Command { Undo, Redo, Cut, Copy, Paste, Duplicate, New, Delete, Rename, MoveUp, MoveDown };
  static constexpr std::size_t kCommandCount = 11;

  TemplateCore& Core() const;
  void Run(Command command);
  /// Has the field with the focus do it with its text; false when there is none, or it cannot.
  bool RunInField(Command command) const;
  /// Takes a step back, or does one again.
  void TakeStep(std::optional<StepEffect> (CTessalDoc::*take)(), const QString& said);
  void CutOrCopy(bool removes);
  void PasteFromClipboard();
  void DuplicateSelected();
  /// Has elements made, and shows them, or why not all were.
  PastedElements Make(const std::function<PastedElements()>& make);
  void DeleteSelected();
  /// The elements that the commands are about: the rows that are selected in a list, or that of the node.
  std::vector<Uid> Selected() const;
  void WatchField(QWidget* field);

  CMainView& view;
  UserDialogs& dialogs;
  std::array<QAction*, kCommandCount> actions{};
};

}  // namespace tessal
