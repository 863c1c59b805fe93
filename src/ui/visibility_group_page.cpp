#include "ui/visibility_group_page.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QStyledItemDelegate>
#include <QVBoxLayout>
#include <algorithm>

#include "core/document.h"
#include "elements/property_io.h"
#include "ui/alt_keys.h"
#include "ui/child.h"
#include "ui/control_ids.h"
#include "ui/create_hint.h"
#include "ui/row_table.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

// The columns of the levels that are edited in place.
constexpr int kNameColumn = 1;
constexpr int kDescriptionColumn = 2;
/// How far beyond the row the list of included items shows after one was taken out.
constexpr int kRowsBeyond = 5;

/// What a line holds as bytes, when it was edited; the former bytes otherwise.
std::string Entered(const QLineEdit& line, const std::string& former, TextEncoding encoding) {
  const std::string entered = FromScreen(line.text(), former, encoding);
  return line.text() == ToScreen(former) ? former : std::string(CleanText(entered));
}

void ShowLine(QLineEdit& line, const std::string& text) {
  line.setText(ToScreen(text));
  line.setCursorPosition(0);
}

/// Gives the line in which a cell is edited its number and a name for screen readers.
class CellDelegate final : public QStyledItemDelegate {
 public:
  using QStyledItemDelegate::QStyledItemDelegate;

  QWidget* createEditor(QWidget* parent, const QStyleOptionViewItem& option,
                        const QModelIndex& cell) const override {
    QWidget* editor = QStyledItemDelegate::createEditor(parent, option, cell);
    editor->setObjectName(QStringLiteral("1143"));
    editor->setAccessibleName(cell.model()->headerData(cell.column(), Qt::Horizontal).toString());
    return editor;
  }
};

}  // namespace

CVisibilityGroupDlg::CVisibilityGroupDlg(const FormContext& context, QWidget* parent)
    : CRightPaneBase(context, parent), layout(MakeChild<QVBoxLayout>(this)) {
  BuildGroupFields();
  BuildLevels();
  BuildItems();
  QStringList texts;
  for (const QLabel* label : labels) texts.append(label->text());
  texts = WithAltKeys(texts);
  for (QLabel* label : labels) label->setText(texts.takeFirst());
}

QLabel* CVisibilityGroupDlg::AddLabel(const QString& text, QWidget* labelled) {
  auto* label = MakeChild<QLabel>(text, this);
  label->setBuddy(labelled);
  labels.append(label);
  return label;
}

QLineEdit* CVisibilityGroupDlg::AddLine(int control, const QString& label,
                                        void (CVisibilityGroupDlg::*store)()) {
  auto* line = MakeChild<QLineEdit>(this);
  line->setObjectName(QString::number(control));
  line->setAccessibleName(label);
  connect(line, &QLineEdit::textEdited, this, [this] { NoteEdited(); });
  connect(line, &QLineEdit::editingFinished, this, [this, store] {
    (this->*store)();
    NoteFocusLost();
  });
  return line;
}

QPushButton* CVisibilityGroupDlg::AddButton(int control, const QString& text, const QString& accessibleName,
                                            void (CVisibilityGroupDlg::*run)()) {
  auto* button = MakeChild<QPushButton>(text, this);
  button->setObjectName(QString::number(control));
  button->setAccessibleName(accessibleName);
  button->setToolTip(accessibleName);
  connect(button, &QPushButton::clicked, this, run);
  return button;
}

void CVisibilityGroupDlg::BuildGroupFields() {
  auto* grid = MakeChild<QGridLayout>();
  const auto addRow = [this, grid](const QString& label, QLineEdit* line) {
    const int row = grid->rowCount();
    grid->addWidget(AddLabel(label, line), row, 0);
    grid->addWidget(line, row, 1);
  };
  name = AddLine(1133, strings::kGroupName, &CVisibilityGroupDlg::StoreGroup);
  description = AddLine(1134, strings::kGroupDescription, &CVisibilityGroupDlg::StoreGroup);
  addRow(strings::kGroupName, name);
  addRow(strings::kGroupDescription, description);
  layout->addLayout(grid);
}

void CVisibilityGroupDlg::BuildLevels() {
  levels = MakeChild<CRowTable>(control_id::kList, strings::kDefinedLevels, this);
  levels->Model().AllowEditing(
      {kNameColumn, kDescriptionColumn},
      [this](int row, int column, const QString& text) { StoreLevelCell(row, column, text); });
  levels->setItemDelegate(MakeChild<CellDelegate>(levels));
  connect(levels, &CRowTable::RowSelected, this, &CVisibilityGroupDlg::SelectLevel);
  deleteLevel =
      AddButton(1135, QStringLiteral("-"), strings::kDeleteLevel, &CVisibilityGroupDlg::DeleteLevel);
  QPushButton* add = AddButton(1136, QStringLiteral("+"), strings::kAddLevel, &CVisibilityGroupDlg::AddLevel);
  levelName = AddLine(1150, strings::kLevelName, &CVisibilityGroupDlg::StoreLevel);
  levelDescription = AddLine(1151, strings::kLevelDescription, &CVisibilityGroupDlg::StoreLevel);

  auto* grid = MakeChild<QGridLayout>();
  constexpr int kRowsOfLevels = 3;
  grid->addWidget(AddLabel(strings::kDefinedLevels, levels), 0, 0);
  grid->addWidget(levels, 1, 0, kRowsOfLevels, 1);
  grid->addWidget(deleteLevel, 1, 1);
  grid->addWidget(add, 2, 1);
  grid->setRowStretch(kRowsOfLevels, 1);
  auto* fields = MakeChild<QHBoxLayout>();
  for (QLineEdit* line : {levelName, levelDescription}) {
    fields->addWidget(AddLabel(line == levelName ? strings::kLevelName : strings::kDescriptionColumn, line));
    fields->addWidget(line, 1);
  }
  layout->addLayout(grid, 1);
  layout->addLayout(fields);
}

void CVisibilityGroupDlg::BuildItems() {
  available = MakeChild<CRowTable>(1137, strings::kAvailableItems, this);
  included = MakeChild<CRowTable>(1139, strings::kIncludedItems, this);
  include = AddButton(1141, strings::kInclude, strings::kIncludeItem, &CVisibilityGroupDlg::IncludePicked);
  exclude = AddButton(1142, strings::kExclude, strings::kExcludeItem, &CVisibilityGroupDlg::ExcludePicked);
  for (CRowTable* table : {available, included}) {
    connect(table, &CRowTable::RowSelected, this, &CVisibilityGroupDlg::UpdateButtons);
  }
  connect(available, &CRowTable::RowEntered, this, &CVisibilityGroupDlg::IncludePicked);
  connect(included, &CRowTable::RowEntered, this, &CVisibilityGroupDlg::ExcludePicked);

  auto* grid = MakeChild<QGridLayout>();
  const auto addTable = [this, grid](int column, int labelControl, CRowTable* table) {
    QLabel* label = AddLabel(table->accessibleName(), table);
    label->setObjectName(QString::number(labelControl));
    grid->addWidget(label, 0, column);
    grid->addWidget(table, 1, column);
    grid->setColumnStretch(column, 1);
  };
  addTable(0, 1138, available);
  auto* arrows = MakeChild<QVBoxLayout>();
  arrows->addStretch(1);
  arrows->addWidget(include);
  arrows->addWidget(exclude);
  arrows->addStretch(1);
  grid->addLayout(arrows, 1, 1);
  addTable(2, 1140, included);
  layout->addLayout(grid, 2);
}

const VisibilityGroup* CVisibilityGroupDlg::Group() const {
  const CEL_Miscanellous* settings = Core().GetMisc();
  const auto place = static_cast<std::size_t>(Number() - 1);
  const bool isThere = settings != nullptr && Number() >= 1 && place < settings->Visibilities().groups.size();
  return isThere ? &settings->Visibilities().groups[place] : nullptr;
}

const VisibilityLevel* CVisibilityGroupDlg::Level() const {
  const VisibilityGroup* group = Group();
  const auto place = static_cast<std::size_t>(current - 1);
  return group != nullptr && current >= 1 && place < group->levels.size() ? &group->levels[place] : nullptr;
}

void CVisibilityGroupDlg::ItemToForm() {
  const VisibilityGroup* group = Group();
  if (group == nullptr) return;
  ShowLine(*name, group->name);
  ShowLine(*description, group->description);
  // The level that is left stores its lines, which may still show what the template held before.
  ShowLevelFields();
  ShowLevels(0);
}

void CVisibilityGroupDlg::ShowLevels(int selected) {
  std::vector<CRowModel::Row> rows(Group()->levels.size());
  for (std::size_t place = 0; place < rows.size(); ++place) {
    rows[place].key = rows[place].number = static_cast<std::int32_t>(place + 1);
  }
  levels->Fill({QStringLiteral("level"), QStringLiteral("Name"), strings::kDescriptionColumn},
               std::move(rows), [this](const CRowModel::Row& row, int column) {
                 const auto place = static_cast<std::size_t>(row.key - 1);
                 if (column == 0 || Group() == nullptr || place >= Group()->levels.size())
                   return std::to_string(row.number);
                 const VisibilityLevel& level = Group()->levels[place];
                 return column == kNameColumn ? level.name : level.description;
               });
  levels->SelectRow(selected);
}

void CVisibilityGroupDlg::SelectLevel(int row) {
  StoreLevel();
  current = row + 1;
  ShowLevelFields();
  FillItems();
}

void CVisibilityGroupDlg::ShowLevelFields() {
  const VisibilityLevel* level = Level();
  ShowLine(*levelName, level == nullptr ? std::string() : level->name);
  ShowLine(*levelDescription, level == nullptr ? std::string() : level->description);
  levelName->setEnabled(level != nullptr);
  levelDescription->setEnabled(level != nullptr);
}

void CVisibilityGroupDlg::FillItems() {
  FillItemTable(*available, Core().AvailableItems(Number(), current));
  FillItemTable(*included, Core().IncludedItems(Number(), current));
  UpdateButtons();
}

void CVisibilityGroupDlg::FillItemTable(CRowTable& table, const std::vector<std::int32_t>& numbers) {
  std::vector<CRowModel::Row> rows;
  for (const std::int32_t number : numbers) {
    const CEL_Element* element = Core().GetElementBySequence(static_cast<std::uint32_t>(number));
    if (element != nullptr) rows.push_back({element->GetUid(), number, number});
  }
  table.Fill({QStringLiteral("ID"), QStringLiteral("Symbol"), strings::kDescriptionColumn}, std::move(rows),
             [&core = Core()](const CRowModel::Row& row, int column) {
               if (column == 0) return std::to_string(row.number);
               const SymbolRecord* record = core.FindRecordBySequence(static_cast<std::uint32_t>(row.key));
               if (record == nullptr) return std::string();
               return column == 1 ? core.RecordSymbol(*record) : record->element->description.TextOf();
             });
}

void CVisibilityGroupDlg::UpdateButtons() {
  deleteLevel->setEnabled(Level() != nullptr);
  include->setEnabled(available->CurrentRow() >= 0);
  exclude->setEnabled(included->CurrentRow() >= 0);
}

void CVisibilityGroupDlg::FormToItem() {
  const VisibilityGroup* group = Group();
  if (group == nullptr) return;
  StoreGroup();
  StoreLevel();
  const RenameGroupHint argument(Number() - 1, group->name);
  Document().UpdateAllViews(nullptr, hint::kRenameGroup, &argument);
}

std::vector<TypedValue> CVisibilityGroupDlg::TypedValues() const {
  std::vector<TypedValue> typed;
  TemplateCore& core = Core();
  const TextEncoding encoding = Document().Encoding();
  const auto add = [&typed, encoding](const QLineEdit& line, const std::string& former, const auto& set) {
    const std::string entered = Entered(line, former, encoding);
    if (entered != former)
      typed.push_back({[set, entered] { set(entered); }, [set, former] { set(former); }});
  };
  const std::int32_t group = Number();
  if (Group() == nullptr) return typed;
  add(*name, Group()->name, [&core, group](const std::string& text) { core.SetGroupName(group, text); });
  add(*description, Group()->description,
      [&core, group](const std::string& text) { core.SetGroupDescription(group, text); });
  const std::int32_t level = current;
  if (Level() == nullptr) return typed;
  add(*levelName, Level()->name,
      [&core, group, level](const std::string& text) { core.SetLevelName(group, level, text); });
  add(*levelDescription, Level()->description,
      [&core, group, level](const std::string& text) { core.SetLevelDescription(group, level, text); });
  return typed;
}

QWidget* CVisibilityGroupDlg::ShowText(const TextToShow& text) {
  const bool isName = text.place.field == kNameField;
  if (text.place.level > 0) levels->SelectRow(text.place.level - 1);
  QLineEdit* ofLevel = isName ? levelName : levelDescription;
  QLineEdit* line = text.place.level > 0 ? ofLevel : (isName ? name : description);
  line->setFocus(Qt::OtherFocusReason);
  line->setSelection(text.start, text.length);
  return line;
}

void CVisibilityGroupDlg::StoreGroup() {
  const VisibilityGroup* group = Group();
  if (group == nullptr) return;
  // A name that another group has is refused without a word: the line goes back to the true one.
  const std::string entered = Entered(*name, group->name, Document().Encoding());
  if (entered != group->name) Core().SetGroupName(Number(), entered);
  Core().SetGroupDescription(Number(), Entered(*description, group->description, Document().Encoding()));
  ShowLine(*name, group->name);
}

void CVisibilityGroupDlg::StoreLevel() {
  const VisibilityLevel* level = Level();
  if (level == nullptr) return;
  const std::string entered = Entered(*levelName, level->name, Document().Encoding());
  if (entered != level->name) Core().SetLevelName(Number(), current, entered);
  Core().SetLevelDescription(Number(), current,
                             Entered(*levelDescription, level->description, Document().Encoding()));
  ShowLine(*levelName, level->name);
  levels->Model().RefreshRow(current - 1);
}

void CVisibilityGroupDlg::StoreLevelCell(int row, int column, const QString& text) {
  const VisibilityGroup* group = Group();
  const auto place = static_cast<std::size_t>(row);
  if (group == nullptr || place >= group->levels.size()) return;
  const VisibilityLevel& level = group->levels[place];
  const std::string entered =
      FromScreen(text, column == kNameColumn ? level.name : level.description, Document().Encoding());
  if (column == kNameColumn) {
    Core().SetLevelName(Number(), row + 1, CleanText(entered));
  } else {
    Core().SetLevelDescription(Number(), row + 1, CleanText(entered));
  }
  if (row + 1 == current) ShowLevelFields();
  RequestCommit();
}

void CVisibilityGroupDlg::AddLevel() {
  const std::int32_t number = Core().CreateLevel(Number());
  if (number < 1) return;
  ShowLevels(number - 1);
  RequestCommit();
}

void CVisibilityGroupDlg::DeleteLevel() {
  const int row = levels->CurrentRow();
  if (row < 0) return;
  current = 0;
  Core().DeleteLevel(Number(), row + 1);
  Load();
  RequestCommit();
}

void CVisibilityGroupDlg::IncludePicked() {
  const int row = available->CurrentRow();
  if (row < 0 || Level() == nullptr) return;
  const CRowModel::Row picked = available->Model().Rows()[static_cast<std::size_t>(row)];
  Core().AddItemToLevel(Number(), current, static_cast<std::uint32_t>(picked.key));
  FillItems();
  available->SelectRow(row, QAbstractItemView::PositionAtCenter);
  RequestCommit();
}

void CVisibilityGroupDlg::ExcludePicked() {
  const int row = included->CurrentRow();
  if (row < 0 || Level() == nullptr) return;
  const CRowModel::Row picked = included->Model().Rows()[static_cast<std::size_t>(row)];
  Core().RemoveItemFromLevel(Number(), current, static_cast<std::uint32_t>(picked.key));
  FillItems();
  included->SelectRow(row);
  const int beyond = std::min(row + kRowsBeyond, included->Model().rowCount() - 1);
  included->scrollTo(included->Model().index(beyond, 0));
  RequestCommit();
}

}  // namespace tessal
