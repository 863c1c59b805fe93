// What leads a user through a template: the filter over the tree, the pane that finds and replaces, the
// window that goes to a symbol, and the ways along matches and messages; with their commands.
#pragma once

#include <QObject>
#include <QString>
#include <functional>
#include <vector>

#include "core/find.h"
#include "platform/docview.h"
#include "platform/uid.h"

class QWidget;

namespace tessal {

class CElementTree;
class CErrorList;
class CFindPane;
class CRightPaneBase;
class CTessalDoc;
class CTreeFilter;
class UserDialogs;

/// What the tools lead through: the parts of a view, and two things that it does.
struct FindSurroundings {
  QWidget& view;
  CTessalDoc& document;
  UserDialogs& dialogs;
  CElementTree& tree;
  CErrorList& messages;
  std::function<void()> commit;           ///< puts what is being entered into the template
  std::function<CRightPaneBase*()> form;  ///< the form that is open; none before the first
};

class CFindTools final : public QObject {
  Q_OBJECT

 public:
  /// Their widgets are for the view to lay out.
  explicit CFindTools(FindSurroundings surroundings);

  CTreeFilter& TreeFilter() const { return *filter; }
  CFindPane& Pane() const { return *pane; }

  /// The commands for the menus.
  const std::vector<ViewCommand>& Commands() const { return commands; }

  /// Selects the owner of a text, and marks a part of it in its form.
  void GoTo(const FoundText& found, const TextMatch& match);
  /// Shows what the message with a code means.
  void Explain(const std::string& code);

 private:
  struct Command {
    const char* menu;
    QString text;
    QString key;
    std::function<void()> run;
  };

  std::vector<Command> CommandRows();
  void FilterTree();
  void FindInTemplate();
  void GoToMatch(int step);
  void GoToSymbol();
  void FindUsesOfSelected();
  void ShowReplaced();
  /// The name that the caret is on in an expression; else the symbol of the selected node.
  QString SelectedName() const;

  void SelectById(Uid uid);

  FindSurroundings around;
  CTreeFilter* filter;
  CFindPane* pane;
  std::vector<ViewCommand> commands;
  bool walksPane = false;  ///< whether the next match is one of the pane's
};

}  // namespace tessal
