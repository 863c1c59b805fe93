#include "ui/plugin_functions_page.h"

#include "core/template_core.h"
#include "ui/node_kinds.h"
#include "ui/row_table.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

std::string CellText(const CEL_ExternalFunction& function, int column) {
  switch (column) {
    case 1:
      return function.publicName.TextOf();
    case 2:
      return function.description.TextOf();
    default:
      return function.dll.TextOf();
  }
}

}  // namespace

CPluginFunctionsDlg::CPluginFunctionsDlg(const FormContext& context, QWidget* parent)
    : CListPage(context, ToScreen(CaptionOfFixedNode(NodeRowOf(context.item))), parent) {}

void CPluginFunctionsDlg::ItemToForm() {
  const CEL_Miscanellous* settings = Core().GetMisc();
  std::vector<CRowModel::Row> rows;
  if (settings != nullptr) {
    for (const auto& function : settings->ExternalFunctions()) {
      const auto number = static_cast<std::int32_t>(rows.size() + 1);
      rows.push_back({function->GetUid(), number, number});
    }
  }
  Table().Fill({strings::kNumberColumn, QStringLiteral("Publicname"), strings::kDescriptionColumn,
                QStringLiteral("DLL")},
               std::move(rows), [&core = Core()](const CRowModel::Row& row, int column) {
                 if (column == 0) return std::to_string(row.number);
                 const CEL_Element* element = core.GetElement(row.uid);
                 return element == nullptr
                            ? std::string()
                            : CellText(static_cast<const CEL_ExternalFunction&>(*element), column);
               });
  Table().SelectRow(0);
  UpdateCommands();
}

void CPluginFunctionsDlg::EnterRow(int row) {
  JumpTo(Table().Model().Rows()[static_cast<std::size_t>(row)].uid);
}

}  // namespace tessal
