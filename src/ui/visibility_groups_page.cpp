#include "ui/visibility_groups_page.h"

#include "core/document.h"
#include "ui/node_kinds.h"
#include "ui/row_table.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

std::string CellText(const VisibilityGroup& group, int column) {
  switch (column) {
    case 1:
      return group.name;
    case 2:
      return group.description;
    default:
      return std::to_string(group.levels.size());
  }
}

}  // namespace

CVisibilityGroupsDlg::CVisibilityGroupsDlg(const FormContext& context, QWidget* parent)
    : CListPage(context, ToScreen(CaptionOfFixedNode(NodeRowOf(context.item))), parent) {}

void CVisibilityGroupsDlg::ItemToForm() {
  const CEL_Miscanellous* settings = Core().GetMisc();
  std::vector<CRowModel::Row> rows(settings == nullptr ? 0 : settings->Visibilities().groups.size());
  for (std::size_t place = 0; place < rows.size(); ++place) {
    rows[place].key = static_cast<std::int32_t>(place);
    rows[place].number = static_cast<std::int32_t>(place + 1);
  }
  // The last title is spelt as it has always been.
  Table().Fill({strings::kNumberColumn, QStringLiteral("Group"), strings::kDescriptionColumn,
                QStringLiteral("Levles")},
               std::move(rows), [&core = Core()](const CRowModel::Row& row, int column) {
                 if (column == 0) return std::to_string(row.number);
                 const auto& groups = core.GetMisc()->Visibilities().groups;
                 const auto place = static_cast<std::size_t>(row.key);
                 return place < groups.size() ? CellText(groups[place], column) : std::string();
               });
  Table().SelectRow(0);
  UpdateCommands();
}

bool CVisibilityGroupsDlg::CanRun(Command command, int row) const {
  return command == New || (row >= 0 && (command == Edit || command == Delete));
}

void CVisibilityGroupsDlg::Run(Command command, int row) {
  if (command == Edit) return EnterRow(row);
  if (command == New) {
    Document().UpdateAllViews(nullptr, hint::kAddGroup);
    Reload(RowCount());
  } else {
    const NumberHint argument(row);
    Document().UpdateAllViews(nullptr, hint::kDeleteGroup, &argument);
    Reload(row);
  }
  RequestCommit();
}

void CVisibilityGroupsDlg::EnterRow(int row) {
  const NumberHint argument(row);
  Document().UpdateAllViews(nullptr, hint::kSelectGroup, &argument);
}

}  // namespace tessal
