#include "ui/node_commands.h"

#include <algorithm>
#include <array>

#include "core/template_core.h"
#include "ui/item_data.h"

namespace tessal {

namespace {

constexpr std::size_t kMostHorizontalVectors = 5;
constexpr int kOtherHelp = 107;

/// The owner of what a node's menu creates.
enum class OwnerRule { Folder, ListHead, Node };

struct CommandRow {
  ElementKind nodeKind;
  ElementKind kindToCreate;
  OwnerRule owner;
  Uid folder;
  bool offersDelete;
};

constexpr std::array<CommandRow, 29> kCommands = {{
    {ElementKind::StateVariable, ElementKind::StateVariable, OwnerRule::ListHead, Uid::None, true},
    {ElementKind::Constant, ElementKind::Constant, OwnerRule::Folder, folder_id::kConstants, true},
    {ElementKind::Forcing, ElementKind::Forcing, OwnerRule::Folder, folder_id::kForcings, true},
    {ElementKind::Auxiliary, ElementKind::Auxiliary, OwnerRule::Folder, folder_id::kAuxiliaries, true},
    {ElementKind::Process, ElementKind::Process, OwnerRule::ListHead, Uid::None, true},
    {ElementKind::DerivedOutput, ElementKind::DerivedOutput, OwnerRule::Folder, folder_id::kDerivedOutputs,
     true},
    {ElementKind::Specie, ElementKind::Specie, OwnerRule::Folder, folder_id::kParticleClasses, true},
    {ElementKind::SpecieStateVariable, ElementKind::SpecieStateVariable, OwnerRule::ListHead, Uid::None,
     true},
    {ElementKind::SpecieConstant, ElementKind::SpecieConstant, OwnerRule::ListHead, Uid::None, true},
    {ElementKind::SpecieForcing, ElementKind::SpecieForcing, OwnerRule::ListHead, Uid::None, true},
    {ElementKind::SpatialFunction, ElementKind::SpatialFunction, OwnerRule::ListHead, Uid::None, true},
    {ElementKind::ArithmeticExpression, ElementKind::ArithmeticExpression, OwnerRule::ListHead, Uid::None,
     true},
    {ElementKind::HorizontalVector, ElementKind::HorizontalVector, OwnerRule::ListHead, Uid::None, true},
    {ElementKind::ExternalFunction, ElementKind::ExternalFunction, OwnerRule::Folder,
     folder_id::kPluginFunctions, true},
    {ElementKind::VisibilityGroup, ElementKind::VisibilityGroup, OwnerRule::Folder,
     folder_id::kVisibilityGroup, true},
    {ElementKind::VisibilityGroups, ElementKind::VisibilityGroups, OwnerRule::Folder,
     folder_id::kVisibilityGroups, false},
    {ElementKind::StateVariableList, ElementKind::StateVariable, OwnerRule::Node, Uid::None, false},
    {ElementKind::ConstantList, ElementKind::Constant, OwnerRule::Folder, folder_id::kConstants, false},
    {ElementKind::ForcingList, ElementKind::Forcing, OwnerRule::Folder, folder_id::kForcings, false},
    {ElementKind::AuxiliaryList, ElementKind::Auxiliary, OwnerRule::Folder, folder_id::kAuxiliaries, false},
    {ElementKind::ProcessList, ElementKind::Process, OwnerRule::Node, Uid::None, false},
    {ElementKind::DerivedOutputList, ElementKind::DerivedOutput, OwnerRule::Folder,
     folder_id::kDerivedOutputs, false},
    {ElementKind::SpecieStateVariableList, ElementKind::SpecieStateVariable, OwnerRule::Node, Uid::None,
     false},
    {ElementKind::SpecieConstantList, ElementKind::SpecieConstant, OwnerRule::Node, Uid::None, false},
    {ElementKind::SpecieForcingList, ElementKind::SpecieForcing, OwnerRule::Node, Uid::None, false},
    {ElementKind::SpatialFunctionList, ElementKind::SpatialFunction, OwnerRule::Node, Uid::None, false},
    {ElementKind::ArithmeticExpressionList, ElementKind::ArithmeticExpression, OwnerRule::Node, Uid::None,
     false},
    {ElementKind::HorizontalVectorList, ElementKind::HorizontalVector, OwnerRule::Node, Uid::None, false},
    // The end of the table.
    {node_kind::kRoot, ElementKind::None, OwnerRule::Node, Uid::None, false},
}};

struct HelpRow {
  ElementKind elementKind;
  ElementKind listKind;
  int help;
};

constexpr std::array<HelpRow, 13> kHelp = {{
    {ElementKind::StateVariable, ElementKind::StateVariableList, 100},
    {ElementKind::Constant, ElementKind::ConstantList, 102},
    {ElementKind::Forcing, ElementKind::ForcingList, 106},
    {ElementKind::Auxiliary, ElementKind::AuxiliaryList, 101},
    {ElementKind::Process, ElementKind::ProcessList, 119},
    {ElementKind::DerivedOutput, ElementKind::DerivedOutputList, 120},
    {ElementKind::Specie, ElementKind::Specie, 114},
    {ElementKind::SpecieStateVariable, ElementKind::SpecieStateVariableList, 116},
    {ElementKind::SpecieConstant, ElementKind::SpecieConstantList, 113},
    {ElementKind::SpatialFunction, ElementKind::SpatialFunctionList, 115},
    {ElementKind::ArithmeticExpression, ElementKind::ArithmeticExpressionList, 112},
    {ElementKind::HorizontalVector, ElementKind::HorizontalVectorList, 117},
    {ElementKind::VerticalEquation, ElementKind::VerticalEquationList, 118},
}};
constexpr int kMiscellaneousHelp = 110;

Uid OwnerOf(const CItemData& node, const CommandRow& row, const TemplateCore& core) {
  switch (row.owner) {
    case OwnerRule::Folder:
      return row.folder;
    case OwnerRule::Node:
      return node.id;
    case OwnerRule::ListHead:
      break;
  }
  const CEL_Element* element = core.GetElement(node.id);
  return element == nullptr || element->Parent() == nullptr ? Uid::None : element->Parent()->GetUid();
}

/// Whether the class that owns a list may have one more horizontal movement.
bool HasRoomForVector(Uid ownerId, const TemplateCore& core) {
  const CEL_Lagrange_Specie* specie = core.GetParentSpecie(ownerId);
  return specie != nullptr && specie->horizontalVectors.size() < kMostHorizontalVectors;
}

}  // namespace

NodeCommands CommandsOfNode(const CItemData& node, const TemplateCore& core) {
  NodeCommands commands;
  const auto row = std::find_if(kCommands.begin(), kCommands.end(), [&node](const CommandRow& candidate) {
    return candidate.nodeKind == node.kind;
  });
  if (row == kCommands.end() || row->kindToCreate == ElementKind::None) return commands;
  commands.kindToCreate = row->kindToCreate;
  commands.ownerId = OwnerOf(node, *row, core);
  commands.canCreate =
      row->kindToCreate != ElementKind::ExternalFunction &&
      (row->kindToCreate != ElementKind::HorizontalVector || HasRoomForVector(commands.ownerId, core));
  const bool isFolder = node.kind == ElementKind::Specie && node.id == folder_id::kParticleClasses;
  commands.offersDelete = row->offersDelete && !isFolder;
  commands.canDelete =
      node.kind == ElementKind::VisibilityGroup || (IsElement(node.id) && core.CanDelete(node.id));
  return commands;
}

int HelpNumberOfKind(ElementKind nodeKind) {
  if (nodeKind == ElementKind::Miscellaneous) return kMiscellaneousHelp;
  const auto row = std::find_if(kHelp.begin(), kHelp.end(), [nodeKind](const HelpRow& candidate) {
    return candidate.elementKind == nodeKind || candidate.listKind == nodeKind;
  });
  return row == kHelp.end() ? kOtherHelp : row->help;
}

Uid FolderOfKind(ElementKind elementKind) {
  switch (elementKind) {
    case ElementKind::StateVariable:
      return folder_id::kStateVariables;
    case ElementKind::Constant:
      return folder_id::kConstants;
    case ElementKind::Forcing:
      return folder_id::kForcings;
    case ElementKind::Auxiliary:
      return folder_id::kAuxiliaries;
    case ElementKind::Process:
      return folder_id::kProcesses;
    case ElementKind::DerivedOutput:
      return folder_id::kDerivedOutputs;
    case ElementKind::Specie:
      return folder_id::kParticleClasses;
    default:
      return Uid::None;
  }
}

}  // namespace tessal
