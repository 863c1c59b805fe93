// The one view on a template: the tree of its elements, the form of the selected one, and the list of what is
// wrong. It is the hub of the editor: forms and dialogs speak to it through the document's hints.
#pragma once

#include <QWidget>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "core/creation.h"
#include "core/edit_history.h"
#include "platform/docview.h"
#include "ui/item_data.h"

class QAction;
class QMenu;
class QToolBar;
class QTreeWidgetItem;
class QVBoxLayout;

namespace tessal {

class CEL_Element;
class CEditCommands;
class CElementTree;
class CAccountStrip;
class CAnalysisTools;
class CErrorList;
class CFindTools;
class CLabel;
class CTextZoom;
class CRightPaneBase;
class CTessalDoc;
class TemplateCore;
class UserDialogs;

class CMainView final : public QWidget, public CView {
  Q_OBJECT

 public:
  CMainView(CTessalDoc& shownDocument, UserDialogs& userDialogs);
  ~CMainView() override;

  void OnInitialUpdate() override;
  void OnUpdate(const CView* sender, int hint, const UpdateHint* argument) override;
  /// Commits the open form.
  void OnCommit() override { CommitAll(); }
  bool HasUncommitted() const override;
  void WithUncommitted(const std::function<void()>& run) override;
  /// Makes the messages of the process those of this template again.
  void OnActivate() override;
  std::vector<ViewCommand> Commands() override;
  std::string StatusText() const override;
  std::string Place() const override;
  void GoTo(const std::string& place) override;
  QWidget* Widget() override { return this; }

  CTessalDoc& Document() const { return document; }
  CElementTree& Tree() const { return *tree; }
  CErrorList& ErrorList() const { return *errorList; }
  CFindTools& FindTools() const { return *findTools; }
  CAnalysisTools& Analyses() const { return *analyses; }
  CAccountStrip& AccountStrip() const { return *accountStrip; }
  /// The form of the selected node; none before the first selection.
  CRightPaneBase* Form() const { return form.get(); }
  /// The number of the help topic for the selected node.
  int HelpNumber() const { return helpNumber; }
  QMenu& HistoryMenu() const { return *historyMenu; }

  /// Selects the node with this id and makes it visible; nothing happens when there is none.
  void SelectById(Uid id);
  /// Makes an element and its node; its identity, none when nothing was made.
  Uid CreateElement(const CreateRequest& request);

  // Commands.
  /// Commits what is being entered, has an act change the template in any way, and shows what has become of
  /// it, with the node of its subject selected.
  void Act(const std::function<StepEffect()>& act);
  /// Makes an element of the kind that the selected node offers, and gives its symbol the focus.
  void CreateBeside();
  /// Gives the symbol in the form of the selected node the focus, with its text selected.
  void FocusSymbol();
  /// Moves the selected element past its neighbour in the template and in the tree, where that is allowed.
  void MoveSelected(int step);
  /// Deletes an element, or the group of a number from 1.
  void DeleteFromMenu(Uid id, std::int32_t groupIndex);
  /// Shows for a while what a command has done.
  void Say(const QString& text);
  /// Commits until nothing is left unwritten, for when the form goes or the document is saved.
  void CommitAll();

 protected:
  void focusInEvent(QFocusEvent* focus) override;
  bool eventFilter(QObject* watched, QEvent* happened) override;

 private:
  void BuildToolBar();
  void BuildLayout();
  /// Offers to create an undefined symbol that the user may have refused before.
  void CreateSymbol(const std::string& symbol);
  /// The title with the holder of the forms under it.
  QWidget* MakeTitleDetail();
  TemplateCore& Core() const;

  void OnSelectionChanged(QTreeWidgetItem* current, QTreeWidgetItem* previous);
  void ReplaceForm(QTreeWidgetItem* item);
  void CloseForm();
  void Commit();
  /// Takes over what the load passed over, and shows it.
  void ReadPassedOver();
  void ShowAccount();
  /// The list of messages with the strip and the bar over it.
  QWidget* MakeMessages();
  /// The tree with its filter over it.
  QWidget* MakeTree();
  void RefreshCaption(QTreeWidgetItem* item);
  void FocusForm();
  void ShowHelp();
  void UpdateNavigation();
  void FillHistoryMenu();
  void MarkDocument();
  void SelectGroup(std::int32_t position);

  void OpenContextMenu(const QPoint& point);
  void CreateFromMenu(const CItemData& clicked);
  void Follow(const StepEffect& effect);
  QTreeWidgetItem* NodeOfSubject(const StepEffect& effect) const;
  /// The name of the control of the form that has the focus; empty for none.
  QString FocusedControl() const;
  void DeleteNode(QTreeWidgetItem& item);
  void DeleteGroup(std::int32_t position);
  QTreeWidgetItem* FolderFor(const CreateRequest& request) const;
  void InsertCreated(const CreateRequest& request, Uid created);
  int PlaceOf(const CEL_Element& element, QTreeWidgetItem& folder) const;

  CTessalDoc& document;
  UserDialogs& dialogs;
  QToolBar* toolBar = nullptr;
  QToolBar* editBar = nullptr;
  QAction* helpContents = nullptr;
  QAction* back = nullptr;
  QAction* forward = nullptr;
  QAction* historyAction = nullptr;
  QMenu* historyMenu = nullptr;
  CLabel* title = nullptr;
  CEditCommands* edits = nullptr;
  CTextZoom* zoom = nullptr;
  CElementTree* tree = nullptr;
  CErrorList* errorList = nullptr;
  CFindTools* findTools = nullptr;
  CAnalysisTools* analyses = nullptr;
  CAccountStrip* accountStrip = nullptr;
  QWidget* holder = nullptr;
  QVBoxLayout* holderLayout = nullptr;
  std::unique_ptr<CRightPaneBase> form;
  QString caretText;                 ///< where the caret of an expression is, for the status
  QTreeWidgetItem* shown = nullptr;  ///< the node that the form shows
  CNavigationHistory history;
  int helpNumber = 109;
};

}  // namespace tessal
