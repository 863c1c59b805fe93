// The tree of a template: a node for each collection and each element, with its data.
#pragma once

#include <QTreeWidget>
#include <cstddef>
#include <string>
#include <unordered_map>
#include <vector>

#include "ui/item_data.h"

namespace tessal {

class CEL_Element;
class CEL_Lagrange_Specie;
class TemplateCore;
struct ElementMessages;

class CElementTree final : public QTreeWidget {
  Q_OBJECT

 public:
  explicit CElementTree(QWidget* parent);

  /// Builds the whole tree from a template and opens its root.
  void Build(TemplateCore& core);

  static CItemData& DataOf(QTreeWidgetItem& item);
  /// What a node shows: its caption, and an element without one its symbol.
  static QString ShownText(const QTreeWidgetItem& item);

  /// The first node with this id in the order of the tree; none when there is none. Needs no walk.
  QTreeWidgetItem* FindById(Uid id) const;
  QTreeWidgetItem* RootItem() const { return root; }
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
  void RemoveNode(QTreeWidgetItem& item);
  void AddGroup(const std::string& name);
  /// Removes the node of the group at a position from 0; the groups after it move up by one number.
  void RemoveGroup(std::size_t position);
  /// Exchanges a node with a neighbour; nothing happens without one.
  void MoveNode(QTreeWidgetItem& item, int step);

  /// Brings the nodes in line with a template in which several elements or groups may have come, gone, moved
  /// or changed. Nodes that stay keep their data. Reports no change of the selection.
  void Follow(TemplateCore& core);
  /// Shows the caption of an element as it is now, where it has a node.
  void FollowCaption(const CEL_Element& element);

  /// Marks the nodes of the elements that have messages, and no others.
  void ShowMessages(const std::unordered_map<Uid, ElementMessages>& messages);

 private:
  /// A node that is in no tree yet, to be found by its id from now on.
  QTreeWidgetItem* Make(ElementKind kind, Uid id, const std::string& caption);
  QTreeWidgetItem* MakeElement(const CEL_Element& element);
  void ForgetBranch(QTreeWidgetItem& item);
  QTreeWidgetItem* Insert(QTreeWidgetItem& parent, int place, ElementKind kind, Uid id,
                          const std::string& caption);
  /// Inserts the node that is no element and has this id.
  QTreeWidgetItem* InsertFixed(QTreeWidgetItem& parent, int place, Uid id);
  template <class Elements>
  void InsertAll(QTreeWidgetItem& folder, const Elements& elements);
  /// Gives a folder the nodes of its elements, in their order.
  template <class Elements>
  void FollowFolder(Uid folderId, const Elements& elements);
  void FollowGroups(TemplateCore& core);
  QTreeWidgetItem* MakeBranch(const CEL_Element& element);

  /// Makes the branch of a particle class, outside of the tree.
  QTreeWidgetItem* MakeSpecie(const CEL_Lagrange_Specie& specie);

  std::vector<QTreeWidgetItem*> groupItems;
  /// The nodes by their ids. The visibility groups, which share one, are in the list above.
  std::unordered_map<Uid, QTreeWidgetItem*> nodes;
  std::vector<Uid> marked;  ///< the elements whose nodes are marked
  QTreeWidgetItem* root = nullptr;
};

}  // namespace tessal
