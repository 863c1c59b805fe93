// The commands that the view in front has for the menus of the host.
#pragma once

#include <QAction>
#include <QList>
#include <QObject>
#include <QPointer>
#include <functional>
#include <vector>

class QMenu;
class QMenuBar;

namespace tessal {

class CView;
struct ViewCommand;

class ViewCommands final : public QObject {
  Q_OBJECT

 public:
  /// A menu that is not in the bar yet is made before another. In a menu with one of the given actions the
  /// commands go before it.
  ViewCommands(QMenuBar& menuBar, QAction& lastMenu, QList<QAction*> lastCommands);

  /// Shows the commands of a view instead of the present ones; none for no view.
  void Show(CView* view);

 private:
  void Add(const ViewCommand& command);
  QMenu& MenuWithTitle(const QString& title);

  QMenuBar& bar;
  QAction& last;
  QList<QAction*> ends;
  CView* shown = nullptr;
  struct Shown {
    QMenu* menu;
    QPointer<QAction> action;  ///< the view's goes with it
    bool isOwn;                ///< made here, not the view's
  };

  std::vector<Shown> actions;
  std::vector<QMenu*> madeMenus;
};

}  // namespace tessal
