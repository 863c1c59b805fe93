// What the editor knows of each kind of node in the tree: a row for each kind, and what is read from the
// rows. A new kind of node is a row here, with a form of its own where it has one.
#pragma once

#include <memory>
#include <string>

#include "ui/item_data.h"

class QWidget;

namespace tessal {

class CEL_Element;
class CRightPaneBase;
class TemplateCore;
struct FormContext;

/// The owner that a request from a node's menu names.
enum class OwnerRule {
  Folder,    ///< the folder of the row
  ListHead,  ///< the list head that owns the element
  Node       ///< the node itself
};

struct NodeRow {
  ElementKind kind;
  Uid id;               ///< of a node that is no element and there once; None for the nodes of elements
  Uid folder;           ///< the folder that holds all elements of the kind; None when there are several
  int help;             ///< the number of the help topic
  ElementKind creates;  ///< the kind that the node's menu creates; None for a node without a menu
  OwnerRule owner;
  bool offersDelete;
  /// Makes the form of the right pane; none for a node without one.
  std::unique_ptr<CRightPaneBase> (*makeForm)(const FormContext& context, QWidget* parent) = nullptr;
  /// The caption of a node that is no element, where it is not the text of the kind.
  const char* caption = nullptr;
  /// The caption of an element's node; its symbol where there is no rule.
  std::string (*captionOf)(const CEL_Element& element) = nullptr;
};

/// The row of a node; for one of no known kind a row without menu and form.
const NodeRow& NodeRowOf(const CItemData& node);
/// The row of the elements of a kind.
const NodeRow& NodeRowOfElements(ElementKind elementKind);
/// The row of the node that is no element and has this id.
const NodeRow& NodeRowWithId(Uid id);

/// The caption of a node that is no element.
std::string CaptionOfFixedNode(const NodeRow& row);
/// The caption of an element's node: its symbol, a derived output's description, or a user function's public
/// name. With the mark, when nobody has looked at the element yet.
std::string ElementCaption(const CEL_Element& element);
std::string MarkedCaption(const CEL_Element& element);

/// The form for the node of a context; never none.
std::unique_ptr<CRightPaneBase> MakeForm(const FormContext& context, QWidget* parent);

/// What a node's menu offers now.
struct NodeCommands {
  ElementKind kindToCreate = ElementKind::None;  ///< None: the node has no menu
  Uid ownerId = Uid::None;                       ///< the second field of the request
  bool canCreate = false;
  bool offersDelete = false;
  bool canDelete = false;
};

NodeCommands CommandsOfNode(const CItemData& node, const TemplateCore& core);

}  // namespace tessal
