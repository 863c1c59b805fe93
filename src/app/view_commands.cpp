#include "app/view_commands.h"

#include <QAction>
#include <QMenu>
#include <QMenuBar>
#include <algorithm>
#include <utility>

#include "platform/docview.h"

namespace tessal {

ViewCommands::ViewCommands(QMenuBar& menuBar, QAction& lastMenu, QList<QAction*> lastCommands)
    : QObject(&menuBar), bar(menuBar), last(lastMenu), ends(std::move(lastCommands)) {}

void ViewCommands::Show(CView* view) {
  // One of them may be the one that is running.
  for (const Shown& command : actions) {
    if (command.action == nullptr) continue;
    command.menu->removeAction(command.action);
    if (command.isOwn) command.action->deleteLater();
  }
  actions.clear();
  shown = view;
  if (view != nullptr) {
    for (const ViewCommand& command : view->Commands()) Add(command);
  }
  for (QMenu* menu : madeMenus) menu->menuAction()->setVisible(!menu->isEmpty());
}

void ViewCommands::Add(const ViewCommand& command) {
  QMenu& menu = MenuWithTitle(QString::fromStdString(command.menu));
  QAction* action = command.action;
  if (action == nullptr) {
    action = std::make_unique<QAction>(QString::fromStdString(command.text), &menu).release();
    action->setSeparator(command.text.empty());
    action->setCheckable(command.checkable);
    action->setChecked(command.checked);
    connect(action, &QAction::triggered, this, [this, run = command.run, view = shown] {
      run();
      // The commands may read otherwise now; another view may have come to the front meanwhile.
      if (shown == view) Show(view);
    });
  }
  const QList<QAction*> present = menu.actions();
  const auto end =
      std::find_if(present.begin(), present.end(), [this](QAction* each) { return ends.contains(each); });
  menu.insertAction(end == present.end() ? nullptr : *end, action);
  actions.push_back({&menu, action, command.action == nullptr});
}

QMenu& ViewCommands::MenuWithTitle(const QString& title) {
  for (QAction* entry : bar.actions()) {
    if (entry->menu() != nullptr && entry->text() == title) return *entry->menu();
  }
  QMenu* menu = std::make_unique<QMenu>(title, &bar).release();
  bar.insertMenu(&last, menu);
  madeMenus.push_back(menu);
  return *menu;
}

}  // namespace tessal
