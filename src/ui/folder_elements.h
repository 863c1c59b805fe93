// The elements that a folder of the tree holds.
#pragma once

#include <QString>
#include <vector>

#include "ui/item_data.h"

namespace tessal {

class CEL_Element;
class TemplateCore;

/// The kind of the elements that a folder holds; None for a node that is no folder.
ElementKind KindInFolder(const CItemData& folder);

/// In the order of the template; none for a node that is no folder.
std::vector<const CEL_Element*> ElementsOfFolder(const TemplateCore& core, const CItemData& folder);

/// The symbols of elements in a line, for people; those that are gone are left out.
QString SymbolsOf(const TemplateCore& core, const std::vector<Uid>& uids);

}  // namespace tessal
