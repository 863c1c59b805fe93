#include "ui/generic_list_view.h"

#include <QCheckBox>
#include <QComboBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QVBoxLayout>
#include <algorithm>
#include <cstdlib>

#include "core/document.h"
#include "ui/alt_keys.h"
#include "ui/child.h"
#include "ui/create_hint.h"
#include "ui/dialogs.h"
#include "ui/folder_elements.h"
#include "ui/icons.h"
#include "ui/node_kinds.h"
#include "ui/property_of.h"
#include "ui/row_table.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr int kGroupControl = 1147;
constexpr int kLevelControl = 1148;
constexpr int kExpandControl = 1149;

struct ListColumn {
  const char* title = nullptr;
  CEL_Property& (*property)(CEL_Element& element) = nullptr;
};

struct FolderColumns {
  ElementKind folder;
  std::array<ListColumn, 3> columns;
  bool isFiltered = true;
};

using Kind = ElementKind;
constexpr ListColumn kSymbol{"Symbol", Of<&CEL_Element::symbol>};
constexpr ListColumn kVector{"Vector", Of<&CEL_Element::symbol>};
constexpr ListColumn kDescription{"Description", Of<&CEL_Element::description>};
constexpr ListColumn kValue{"Default Value", Of<&CEL_Constant::defaultValue>};
constexpr ListColumn kMemberValue{"Default Value", Of<&CEL_Lagrange_Constant::defaultValue>};
constexpr ListColumn kExpression{"Expression", Of<&CEL_ExpressionElement::expression>};
constexpr ListColumn kEquation{"Expression", Of<&CEL_StateVariable::equation>};
constexpr ListColumn kMemberEquation{"Expression", Of<&CEL_Lagrange_StateVariable::equation>};
constexpr ListColumn kMemberExpression{"Expression", Of<&CEL_Lagrange_Arithmetical_Expression::expression>};

// What each folder shows after the running number. Classes and movements belong to no visibility level.
constexpr FolderColumns kFolders[] = {
    {Kind::StateVariableList, {kSymbol, kEquation, kDescription}},
    {Kind::ConstantList, {kSymbol, kValue, kDescription}},
    {Kind::ForcingList, {kSymbol, kDescription}},
    {Kind::AuxiliaryList, {kSymbol, kExpression, kDescription}},
    {Kind::ProcessList, {kSymbol, kExpression, kDescription}},
    {Kind::DerivedOutputList, {kSymbol, kExpression}},
    {Kind::Specie, {kSymbol, kDescription}, false},
    {Kind::SpecieStateVariableList, {kSymbol, kMemberEquation, kDescription}},
    {Kind::SpecieConstantList, {kSymbol, kMemberValue, kDescription}},
    {Kind::SpatialFunctionList, {kSymbol, kDescription}},
    {Kind::ArithmeticExpressionList, {kSymbol, kMemberExpression, kDescription}},
    {Kind::HorizontalVectorList, {kVector}, false},
    {Kind::VerticalEquationList, {kVector}, false},
};

const FolderColumns& ColumnsOf(ElementKind folder) {
  const auto* const row = std::find_if(std::begin(kFolders), std::end(kFolders),
                                       [folder](const FolderColumns& each) { return each.folder == folder; });
  return row == std::end(kFolders) ? kFolders[0] : *row;
}

/// The element of a row: by its number in the symbol table, unless that has changed since.
CEL_Element* ElementOf(const TemplateCore& core, const CRowModel::Row& row) {
  CEL_Element* element = core.GetElementBySequence(static_cast<std::uint32_t>(row.key));
  return element != nullptr && element->GetUid() == row.uid ? element : core.GetElement(row.uid);
}

std::ptrdiff_t DistanceInFolder(const std::vector<const CEL_Element*>& elements, Uid first, Uid second) {
  const auto find = [&elements](Uid uid) {
    return std::find_if(elements.begin(), elements.end(),
                        [uid](const CEL_Element* element) { return element->GetUid() == uid; });
  };
  return std::abs(find(first) - find(second));
}

}  // namespace

CGenericListView::CGenericListView(const FormContext& context, QWidget* parent)
    : CListPage(context, ToScreen(CaptionOfFixedNode(NodeRowOf(context.item))), parent) {
  BuildFilter();
  constexpr int kNameColumn = 1;
  const ElementKind kind = KindInFolder(context.item);
  Table().Model().ShowIcons(kNameColumn, [kind](const CRowModel::Row&) { return IconOfKind(kind); });
  Table().AllowSeveral([this](int row) { MoveRowsTo(row); });
}

void CGenericListView::BuildFilter() {
  auto* row = MakeChild<QHBoxLayout>();
  const QStringList labels = WithAltKeys({strings::kVisibilityGroup, strings::kLevel, strings::kExpand});
  const auto addCombo = [this, row](int control, const QString& caption, const QString& keyedCaption) {
    auto* combo = MakeChild<QComboBox>(this);
    combo->setObjectName(QString::number(control));
    combo->setAccessibleName(caption);
    combo->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    auto* label = MakeChild<QLabel>(keyedCaption, this);
    label->setBuddy(combo);
    row->addWidget(label);
    row->addWidget(combo, 1);
    return combo;
  };
  groups = addCombo(kGroupControl, strings::kVisibilityGroup, labels[0]);
  levels = addCombo(kLevelControl, strings::kLevel, labels[1]);
  expand = MakeChild<QCheckBox>(labels[2], this);
  expand->setObjectName(QString::number(kExpandControl));
  expand->setAccessibleName(strings::kExpand);
  row->addWidget(expand);
  Rows().insertLayout(1, row);
  connect(groups, &QComboBox::activated, this, &CGenericListView::ChooseGroup);
  connect(levels, &QComboBox::activated, this, &CGenericListView::ChooseLevel);
  connect(expand, &QCheckBox::clicked, this, &CGenericListView::Expand);
}

void CGenericListView::ShowFilter() {
  const CTessalDoc& document = Document();
  const CEL_Miscanellous* settings = Core().GetMisc();
  const std::size_t groupCount = settings == nullptr ? 0 : settings->Visibilities().groups.size();
  groups->clear();
  levels->clear();
  for (std::size_t group = 0; group <= groupCount; ++group) {
    groups->addItem(ToScreen(Core().GroupText(static_cast<std::int32_t>(group))));
  }
  const auto chosen = static_cast<std::size_t>(document.visibilityGroup);
  const bool isKnown = chosen >= 1 && chosen <= groupCount;
  const std::size_t levelCount = isKnown ? settings->Visibilities().groups[chosen - 1].levels.size() : 0;
  for (std::size_t level = 0; level <= levelCount; ++level) {
    levels->addItem(ToScreen(Core().LevelText(document.visibilityGroup, static_cast<std::int32_t>(level))));
  }
  groups->setCurrentIndex(document.visibilityGroup);
  levels->setCurrentIndex(document.visibilityLevel);
  expand->setChecked(document.visibilityRecursive);
  for (QWidget* control :
       {static_cast<QWidget*>(groups), static_cast<QWidget*>(levels), static_cast<QWidget*>(expand)}) {
    control->setEnabled(groupCount > 0);
  }
}

void CGenericListView::ChooseGroup(int group) {
  Document().visibilityGroup = group;
  ChooseLevel(0);
}

void CGenericListView::ChooseLevel(int level) {
  Document().visibilityLevel = level;
  Expand(false);
}

void CGenericListView::Expand(bool on) {
  Document().visibilityRecursive = on;
  Load();
}

void CGenericListView::ItemToForm() {
  ShowFilter();
  FillTable();
  Table().SelectRow(0);
  UpdateCommands();
}

void CGenericListView::FillTable() {
  const FolderColumns& folder = ColumnsOf(Item().kind);
  const CTessalDoc& document = Document();
  std::vector<std::int32_t> numbers;
  // All levels of a group, or one, with those below it where they count in.
  const bool takesAll = document.visibilityLevel < 1;
  Core().CollectItems(document.visibilityGroup, document.visibilityLevel, numbers,
                      takesAll || document.visibilityRecursive);
  std::sort(numbers.begin(), numbers.end());
  // A template without settings has no groups to filter by.
  const bool isFiltered = folder.isFiltered && Core().GetMisc() != nullptr && document.visibilityGroup > 0;
  std::vector<CRowModel::Row> rows;
  for (const CEL_Element* element : ElementsOfFolder(Core(), Item())) {
    const std::int32_t number = element->id.IntValue();
    if (isFiltered && !std::binary_search(numbers.begin(), numbers.end(), number)) continue;
    rows.push_back({element->GetUid(), number, static_cast<std::int32_t>(rows.size() + 1)});
  }
  QStringList titles{strings::kNumberColumn};
  for (const ListColumn& column : folder.columns) {
    if (column.title != nullptr) titles.append(QString::fromLatin1(column.title));
  }
  Table().Fill(titles, std::move(rows), [&core = Core(), &folder](const CRowModel::Row& row, int column) {
    if (column == 0) return std::to_string(row.number);
    CEL_Element* element = ElementOf(core, row);
    return element == nullptr
               ? std::string()
               : folder.columns[static_cast<std::size_t>(column - 1)].property(*element).TextOf();
  });
}

Uid CGenericListView::UidOf(int row) const {
  return row < 0 ? Uid::None : Table().Model().Rows()[static_cast<std::size_t>(row)].uid;
}

bool CGenericListView::CanCreate(int row) const {
  const CEL_Element* selected = Core().GetElement(UidOf(row));
  if (selected == nullptr) return true;
  return selected->Kind() != ElementKind::VerticalEquation &&
         (selected->Kind() != ElementKind::HorizontalVector || CommandsOfNode(Item(), Core()).canCreate);
}

bool CGenericListView::CanMoveRow(int row, int step) const {
  const int target = row + step;
  if (row < 0 || target < 0 || target >= RowCount()) return false;
  return Item().kind != ElementKind::VerticalEquationList && Core().CanMove(UidOf(row), UidOf(target));
}

bool CGenericListView::CanRun(Command command, int row) const {
  switch (command) {
    case New:
      return CanCreate(row);
    case Edit:
      return row >= 0;
    case Delete:
      return row >= 0 && (Table().SelectedRows().size() > 1 || Core().CanDelete(UidOf(row)));
    case MoveDown:
      return CanMoveRow(row, 1);
    case MoveUp:
      return CanMoveRow(row, -1);
  }
  return false;
}

void CGenericListView::Run(Command command, int row) {
  switch (command) {
    case New:
      return CreateNew();
    case Edit:
      return EnterRow(row);
    case Delete:
      return Table().SelectedRows().size() > 1 ? DeleteRows() : DeleteRow(row);
    case MoveDown:
      return MoveRow(row, 1);
    case MoveUp:
      return MoveRow(row, -1);
  }
}

void CGenericListView::EnterRow(int row) {
  JumpTo(UidOf(row));
}

void CGenericListView::CreateNew() {
  const NodeCommands commands = CommandsOfNode(Item(), Core());
  CreateRequest request;
  request.kind = commands.kindToCreate;
  request.ownerId = commands.ownerId;
  const CreateHint argument(request);
  Document().UpdateAllViews(nullptr, hint::kCreateElement, &argument);
  Reload(RowCount());
  RequestCommit();
}

void CGenericListView::DeleteRow(int row) {
  const Uid uid = UidOf(row);
  if (!Core().DeleteElement(uid)) return;
  Table().Model().RemoveRowAt(row);
  const NumberHint argument(NumberOf(uid));
  Document().UpdateAllViews(nullptr, hint::kDeleteItem, &argument);
  UpdateCommands();
  RequestCommit();
}

std::vector<Uid> CGenericListView::SelectedElements() const {
  std::vector<Uid> uids;
  for (const int row : Table().SelectedRows()) uids.push_back(UidOf(row));
  return uids;
}

void CGenericListView::DeleteRows() {
  const int first = Table().SelectedRows().front();
  const std::vector<Uid> kept = Core().DeleteElements(SelectedElements());
  Document().UpdateAllViews(nullptr, hint::kStructure);
  Reload(first);
  RequestCommit();
  if (!kept.empty()) Dialogs().Warn(this, strings::kStillUsed.arg(SymbolsOf(Core(), kept)));
}

void CGenericListView::MoveRowsTo(int row) {
  const std::vector<Uid> moved = SelectedElements();
  const bool isEnd = row >= RowCount();
  Uid target = UidOf(isEnd ? RowCount() - 1 : row);
  std::vector<Uid> refused;
  {
    const EditStep step(Core().History());
    for (const Uid uid : moved) {
      if (uid == target) continue;
      const bool isMoved = Core().MoveElement(uid, target, !isEnd);
      if (!isMoved) refused.push_back(uid);
      // To the end each goes after the one before it.
      if (isMoved && isEnd) target = uid;
    }
  }
  Document().UpdateAllViews(nullptr, hint::kStructure);
  Reload(row);
  RequestCommit();
  if (!refused.empty()) Dialogs().Warn(this, strings::kNotMoved.arg(SymbolsOf(Core(), refused)));
}

void CGenericListView::MoveRow(int row, int step) {
  const Uid uid = UidOf(row);
  const Uid target = UidOf(row + step);
  const std::ptrdiff_t places = DistanceInFolder(ElementsOfFolder(Core(), Item()), uid, target);
  if (!Core().MoveElement(uid, target, step < 0)) return;
  Table().Model().ExchangeRows(row, row + step);
  Table().SelectRow(row + step);
  const NumberHint argument(NumberOf(uid));
  // The filter may leave out what lies between the two rows: the node passes each of them.
  for (std::ptrdiff_t place = 0; place < places; ++place) {
    Document().UpdateAllViews(nullptr, step < 0 ? hint::kMoveUp : hint::kMoveDown, &argument);
  }
  UpdateCommands();
  RequestCommit();
}

}  // namespace tessal
