// What can be done with a node of the tree, by its kind.
#pragma once

#include "elements/element_kind.h"
#include "platform/uid.h"

namespace tessal {

struct CItemData;
class TemplateCore;

struct NodeCommands {
  ElementKind kindToCreate = ElementKind::None;  ///< None: the node has no menu
  Uid ownerId = Uid::None;                       ///< the second field of the request
  bool canCreate = false;
  bool offersDelete = false;
  bool canDelete = false;
};

NodeCommands CommandsOfNode(const CItemData& node, const TemplateCore& core);

/// The number of the help topic for nodes of a kind.
int HelpNumberOfKind(ElementKind nodeKind);

/// The id of the folder that holds the elements of a kind from 1 to 7; none for any other kind.
Uid FolderOfKind(ElementKind elementKind);

}  // namespace tessal
