// What can be done with a node of the tree, by its kind.
#pragma once

#include <cstdint>

namespace tessal {

struct CItemData;
class TemplateCore;

struct NodeCommands {
  std::int32_t kindToCreate = 0;  ///< 0: the node has no menu
  std::int32_t ownerId = 0;       ///< the second field of the request
  bool canCreate = false;
  bool offersDelete = false;
  bool canDelete = false;
};

NodeCommands CommandsOfNode(const CItemData& node, const TemplateCore& core);

/// The number of the help topic for nodes of a kind.
int HelpNumberOfKind(std::int32_t nodeKind);

/// The id of the folder that holds the elements of a kind from 1 to 7; 0 for any other kind.
std::int32_t FolderOfKind(std::int32_t elementKind);

}  // namespace tessal
