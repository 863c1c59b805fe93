#include "app/view_commands.h"

#include <QAction>
#include <QMenu>
#include <QMenuBar>
#include <algorithm>

#include "platform/docview.h"

namespace tessal {

ViewCommands::ViewCommands(QMenuBar& menuBar, QAction& lastMenu, QAction& lastFileCommand)
    : QObject(&menuBar), bar(menuBar), last(lastMenu), fileEnd(lastFileCommand) {}

void ViewCommands::Show(CView* view) {
  // One of them may be the one that is running.
  for (QAction* action : actions) {
    static_cast<QWidget*>(action->parent())->removeAction(action);
    action->deleteLater();
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
  auto* action = std::make_unique<QAction>(QString::fromStdString(command.text), &menu).release();
  action->setCheckable(command.checkable);
  action->setChecked(command.checked);
  connect(action, &QAction::triggered, this, [this, run = command.run, view = shown] {
    run();
    // The commands may read otherwise now; another view may have come to the front meanwhile.
    if (shown == view) Show(view);
  });
  const QList<QAction*> present = menu.actions();
  menu.insertAction(present.contains(&fileEnd) ? &fileEnd : nullptr, action);
  actions.push_back(action);
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
