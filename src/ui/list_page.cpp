#include "ui/list_page.h"

#include <QAction>
#include <QToolBar>
#include <QVBoxLayout>

#include "ui/child.h"
#include "ui/control_ids.h"
#include "ui/icons.h"
#include "ui/row_table.h"
#include "ui/strings.h"

namespace tessal {

namespace {

struct CommandRow {
  int control;
  const QString& text;
  QKeySequence key;
  IconCommand icon;
};

// In the order of the tool bar.
const std::array<CommandRow, 5>& CommandRows() {
  static const std::array<CommandRow, 5> kRows = {{
      {32796, strings::kNew, QKeySequence(Qt::Key_Insert), IconCommand::New},
      {32790, strings::kEditRow, QKeySequence(), IconCommand::Edit},
      {32789, strings::kDelete, QKeySequence(Qt::Key_Delete), IconCommand::Delete},
      {32791, strings::kMoveDown, QKeySequence(Qt::ALT | Qt::Key_Down), IconCommand::MoveDown},
      {32792, strings::kMoveUp, QKeySequence(Qt::ALT | Qt::Key_Up), IconCommand::MoveUp},
  }};
  return kRows;
}

}  // namespace

CListPage::CListPage(const FormContext& context, const QString& name, QWidget* parent)
    : CRightPaneBase(context, parent),
      layout(MakeChild<QVBoxLayout>(this)),
      table(MakeChild<CRowTable>(control_id::kList, name, this)) {
  BuildToolBar();
  layout->addWidget(table, 1);
  connect(table, &CRowTable::RowSelected, this, &CListPage::UpdateCommands);
  connect(table->selectionModel(), &QItemSelectionModel::selectionChanged, this, &CListPage::UpdateCommands);
  connect(table, &CRowTable::RowEntered, this, [this](int row) { EnterRow(row); });
}

void CListPage::BuildToolBar() {
  auto* bar = MakeChild<QToolBar>(this);
  bar->setObjectName(QString::number(control_id::kListCommands));
  bar->setAccessibleName(strings::kListCommands);
  bar->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
  for (std::size_t place = 0; place < kCommandCount; ++place) {
    const CommandRow& row = CommandRows()[place];
    QAction* action = bar->addAction(IconOfCommand(row.icon), row.text);
    actions[place] = action;
    action->setObjectName(QString::number(row.control));
    action->setShortcut(row.key);
    action->setShortcutContext(Qt::WidgetWithChildrenShortcut);
    addAction(action);
    QWidget* button = bar->widgetForAction(action);
    button->setFocusPolicy(Qt::TabFocus);
    button->setAccessibleName(row.text);
    connect(action, &QAction::triggered, this,
            [this, place] { Run(static_cast<Command>(place), table->CurrentRow()); });
  }
  layout->addWidget(bar);
}

void CListPage::OnStructureChanged() {
  Reload(table->CurrentRow());
}

void CListPage::Reload(int row) {
  table->setUpdatesEnabled(false);
  Load();
  table->SelectRow(row);
  table->setUpdatesEnabled(true);
}

void CListPage::UpdateCommands() {
  const int row = table->CurrentRow();
  for (std::size_t place = 0; place < kCommandCount; ++place) {
    actions[place]->setEnabled(CanRun(static_cast<Command>(place), row));
  }
}

int CListPage::RowCount() const {
  return table->Model().rowCount();
}

}  // namespace tessal
