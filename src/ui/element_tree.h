// The tree of a template: a node for each collection and each element, with its data.
#pragma once

#include <QTreeWidget>
#include <cstddef>
#include <string>
#include <vector>

#include "ui/item_data.h"

namespace tessal {

class CEL_Element;
class CEL_Lagrange_Specie;
class TemplateCore;

class CElementTree final : public QTreeWidget {
  Q_OBJECT

 public:
  explicit CElementTree(QWidget* parent);

  /// Builds the whole tree from a template and opens its root.
  void Build(TemplateCore& core);

  static CItemData& DataOf(QTreeWidgetItem& item);

  /// The first node with this id, depth first; none when there is none.
  QTreeWidgetItem* FindById(Uid id) const;
  QTreeWidgetItem* RootItem() const { return topLevelItem(0); }
  /// The nodes of the visibility groups, in group order.
  const std::vector<QTreeWidgetItem*>& GroupItems() const { return groupItems; }

  /// Inserts the node of an element into its folder; a place beyond the end is the last.
  QTreeWidgetItem* InsertElement(QTreeWidgetItem& folder, const CEL_Element& element, int place);
  /// Inserts the node of a particle class with its whole branch.
  QTreeWidgetItem* InsertSpecie(QTreeWidgetItem& folder, const CEL_Lagrange_Specie& specie);
  void ShowMisc(TemplateCore& core);
  void ShowParticles(TemplateCore& core);
  void RemoveBranch(Uid folderId);
  /// Removes a node with its branch; the root stays.
  static void RemoveNode(QTreeWidgetItem& item);
  void AddGroup(const std::string& name);
  /// Removes the node of the group at a position from 0; the groups after it move up by one number.
  void RemoveGroup(std::size_t position);
  /// Exchanges a node with a neighbour; nothing happens without one.
  void MoveNode(QTreeWidgetItem& item, int step);

 private:
  QTreeWidgetItem* Insert(QTreeWidgetItem& parent, int place, ElementKind kind, Uid id,
                          const std::string& caption);
  /// Inserts the node that is no element and has this id.
  QTreeWidgetItem* InsertFixed(QTreeWidgetItem& parent, int place, Uid id);
  template <class Elements>
  void InsertAll(QTreeWidgetItem& folder, const Elements& elements);

  std::vector<QTreeWidgetItem*> groupItems;
};

}  // namespace tessal
