// The commands that the view in front has for the menus of the host.
#pragma once

#include <QObject>
#include <functional>
#include <vector>

class QAction;
class QMenu;
class QMenuBar;

namespace tessal {

class CView;
struct ViewCommand;

class ViewCommands final : public QObject {
  Q_OBJECT

 public:
  /// A menu that is not in the bar yet is made before another; commands of the file menu go before an action.
  ViewCommands(QMenuBar& menuBar, QAction& lastMenu, QAction& lastFileCommand);

  /// Shows the commands of a view instead of the present ones; none for no view.
  void Show(CView* view);

 private:
  void Add(const ViewCommand& command);
  QMenu& MenuWithTitle(const QString& title);

  QMenuBar& bar;
  QAction& last;
  QAction& fileEnd;
  CView* shown = nullptr;
  std::vector<QAction*> actions;
  std::vector<QMenu*> madeMenus;
};

}  // namespace tessal
