// Where the main view is: selecting nodes, the history of those visited, and places that another run finds
// again.
#include "ui/main_view.h"

#include <QAction>
#include <QMenu>
#include <string_view>

#include "core/document.h"
#include "ui/element_tree.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

// How a place is written: what sort of node it is, and what names it.
constexpr std::string_view kSymbolPlace = "symbol ";
constexpr std::string_view kNodePlace = "node ";
constexpr std::string_view kGroupPlace = "group ";
constexpr std::string_view kListPlace = "list ";

}  // namespace

void CMainView::SelectById(Uid id) {
  QTreeWidgetItem* item = tree->FindById(id);
  if (item == nullptr) return;
  tree->setCurrentItem(item);
  tree->scrollToItem(item);
}

void CMainView::SelectGroup(std::int32_t position) {
  const auto& groups = tree->GroupItems();
  const auto place = static_cast<std::size_t>(position);
  if (position < 0 || place >= groups.size()) return;
  tree->setCurrentItem(groups[place]);
  tree->scrollToItem(groups[place]);
}

void CMainView::UpdateNavigation() {
  back->setEnabled(history.CanGoBack());
  forward->setEnabled(history.CanGoForward());
  historyAction->setEnabled(history.CanGoBack() || history.CanGoForward());
}

void CMainView::FillHistoryMenu() {
  historyMenu->clear();
  std::ptrdiff_t place = 0;
  for (const CHistoryData& entry : history.Entries()) {
    QAction* action =
        historyMenu->addAction(ToScreen(entry.caption), this, [this, id = entry.id] { SelectById(id); });
    action->setCheckable(true);
    action->setChecked(place++ == history.Position());
  }
}

std::string CMainView::Place() const {
  QTreeWidgetItem* item = tree->currentItem();
  if (item == nullptr) return {};
  const CItemData& node = CElementTree::DataOf(*item);
  if (node.groupIndex > 0) return std::string(kGroupPlace) + std::to_string(node.groupIndex);
  if (!IsElement(node.id)) return std::string(kNodePlace) + std::to_string(NumberOf(node.id));
  if (const CEL_Lagrange_Specie* specie = Core().GetParentSpecie(node.id)) {
    return std::string(kListPlace) + std::to_string(NumberOf(node.kind)) + ' ' + specie->symbol.TextOf();
  }
  const CEL_Element* element = Core().GetElement(node.id);
  return element == nullptr ? std::string() : std::string(kSymbolPlace) + element->FullSymbol();
}

void CMainView::GoTo(const std::string& place) {
  const std::string_view text = place;
  const auto rest = [text](std::string_view sort) { return std::string(text.substr(sort.size())); };
  if (text.starts_with(kGroupPlace))
    return SelectGroup(QString::fromStdString(rest(kGroupPlace)).toInt() - 1);
  if (text.starts_with(kNodePlace)) return SelectById(Uid{QString::fromStdString(rest(kNodePlace)).toInt()});
  std::uint32_t sequence = 0;
  if (text.starts_with(kSymbolPlace) && Core().FindSymbol(rest(kSymbolPlace), sequence)) {
    return SelectById(Core().FindRecordBySequence(sequence)->uid);
  }
  if (!text.starts_with(kListPlace)) return;
  const QString list = ToScreen(rest(kListPlace));
  const std::string name = list.section(u' ', 1).toStdString();
  for (const auto& specie : Core().Species()) {
    for (const auto& head : specie->Heads()) {
      if (specie->symbol.Text() == name && NumberOf(head->Kind()) == list.section(u' ', 0, 0).toInt()) {
        return SelectById(head->GetUid());
      }
    }
  }
}

}  // namespace tessal
