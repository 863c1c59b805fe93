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
  std::int32_t nodeKind;
  std::int32_t kindToCreate;
  OwnerRule owner;
  std::int32_t folder;
  bool offersDelete;
};

constexpr std::array<CommandRow, 29> kCommands = {{
    {kind::kStateVariable, kind::kStateVariable, OwnerRule::ListHead, 0, true},
    {kind::kConstant, kind::kConstant, OwnerRule::Folder, folder_id::kConstants, true},
    {kind::kForcing, kind::kForcing, OwnerRule::Folder, folder_id::kForcings, true},
    {kind::kAuxiliary, kind::kAuxiliary, OwnerRule::Folder, folder_id::kAuxiliaries, true},
    {kind::kProcess, kind::kProcess, OwnerRule::ListHead, 0, true},
    {kind::kDerivedOutput, kind::kDerivedOutput, OwnerRule::Folder, folder_id::kDerivedOutputs, true},
    {kind::kSpecie, kind::kSpecie, OwnerRule::Folder, folder_id::kParticleClasses, true},
    {kind::kSpecieStateVariable, kind::kSpecieStateVariable, OwnerRule::ListHead, 0, true},
    {kind::kSpecieConstant, kind::kSpecieConstant, OwnerRule::ListHead, 0, true},
    {kind::kSpecieForcing, kind::kSpecieForcing, OwnerRule::ListHead, 0, true},
    {kind::kSpatialFunction, kind::kSpatialFunction, OwnerRule::ListHead, 0, true},
    {kind::kArithmeticExpression, kind::kArithmeticExpression, OwnerRule::ListHead, 0, true},
    {kind::kHorizontalVector, kind::kHorizontalVector, OwnerRule::ListHead, 0, true},
    {kind::kExternalFunction, kind::kExternalFunction, OwnerRule::Folder, folder_id::kPluginFunctions, true},
    {kind::kVisibilityGroup, kind::kVisibilityGroup, OwnerRule::Folder, folder_id::kVisibilityGroup, true},
    {kind::kVisibilityGroups, kind::kVisibilityGroups, OwnerRule::Folder, folder_id::kVisibilityGroups,
     false},
    {kind::kStateVariableList, kind::kStateVariable, OwnerRule::Node, 0, false},
    {kind::kConstantList, kind::kConstant, OwnerRule::Folder, folder_id::kConstants, false},
    {kind::kForcingList, kind::kForcing, OwnerRule::Folder, folder_id::kForcings, false},
    {kind::kAuxiliaryList, kind::kAuxiliary, OwnerRule::Folder, folder_id::kAuxiliaries, false},
    {kind::kProcessList, kind::kProcess, OwnerRule::Node, 0, false},
    {kind::kDerivedOutputList, kind::kDerivedOutput, OwnerRule::Folder, folder_id::kDerivedOutputs, false},
    {kind::kSpecieStateVariableList, kind::kSpecieStateVariable, OwnerRule::Node, 0, false},
    {kind::kSpecieConstantList, kind::kSpecieConstant, OwnerRule::Node, 0, false},
    {kind::kSpecieForcingList, kind::kSpecieForcing, OwnerRule::Node, 0, false},
    {kind::kSpatialFunctionList, kind::kSpatialFunction, OwnerRule::Node, 0, false},
    {kind::kArithmeticExpressionList, kind::kArithmeticExpression, OwnerRule::Node, 0, false},
    {kind::kHorizontalVectorList, kind::kHorizontalVector, OwnerRule::Node, 0, false},
    // The end of the table.
    {node_kind::kRoot, 0, OwnerRule::Node, 0, false},
}};

struct HelpRow {
  std::int32_t elementKind;
  std::int32_t listKind;
  int help;
};

constexpr std::array<HelpRow, 13> kHelp = {{
    {kind::kStateVariable, kind::kStateVariableList, 100},
    {kind::kConstant, kind::kConstantList, 102},
    {kind::kForcing, kind::kForcingList, 106},
    {kind::kAuxiliary, kind::kAuxiliaryList, 101},
    {kind::kProcess, kind::kProcessList, 119},
    {kind::kDerivedOutput, kind::kDerivedOutputList, 120},
    {kind::kSpecie, kind::kSpecie, 114},
    {kind::kSpecieStateVariable, kind::kSpecieStateVariableList, 116},
    {kind::kSpecieConstant, kind::kSpecieConstantList, 113},
    {kind::kSpatialFunction, kind::kSpatialFunctionList, 115},
    {kind::kArithmeticExpression, kind::kArithmeticExpressionList, 112},
    {kind::kHorizontalVector, kind::kHorizontalVectorList, 117},
    {kind::kVerticalEquation, kind::kVerticalEquationList, 118},
}};
constexpr int kMiscellaneousHelp = 110;

std::int32_t OwnerOf(const CItemData& node, const CommandRow& row, const TemplateCore& core) {
  switch (row.owner) {
    case OwnerRule::Folder:
      return row.folder;
    case OwnerRule::Node:
      return node.id;
    case OwnerRule::ListHead:
      break;
  }
  const CEL_Element* element = core.GetElement(static_cast<std::uint32_t>(node.id));
  return element == nullptr || element->Parent() == nullptr ? 0 : element->Parent()->MessageUid();
}

/// Whether the class that owns a list may have one more horizontal movement.
bool HasRoomForVector(std::int32_t ownerId, const TemplateCore& core) {
  const CEL_Lagrange_Specie* specie = core.GetParentSpecie(static_cast<std::uint32_t>(ownerId));
  return specie != nullptr && specie->horizontalVectors.size() < kMostHorizontalVectors;
}

}  // namespace

NodeCommands CommandsOfNode(const CItemData& node, const TemplateCore& core) {
  NodeCommands commands;
  const auto row = std::find_if(kCommands.begin(), kCommands.end(), [&node](const CommandRow& candidate) {
    return candidate.nodeKind == node.kind;
  });
  if (row == kCommands.end() || row->kindToCreate == 0) return commands;
  commands.kindToCreate = row->kindToCreate;
  commands.ownerId = OwnerOf(node, *row, core);
  commands.canCreate =
      row->kindToCreate != kind::kExternalFunction &&
      (row->kindToCreate != kind::kHorizontalVector || HasRoomForVector(commands.ownerId, core));
  const bool isFolder = node.kind == kind::kSpecie && node.id == folder_id::kParticleClasses;
  commands.offersDelete = row->offersDelete && !isFolder;
  commands.canDelete = node.kind == kind::kVisibilityGroup ||
                       (node.id > 0 && core.CanDelete(static_cast<std::uint32_t>(node.id)));
  return commands;
}

int HelpNumberOfKind(std::int32_t nodeKind) {
  if (nodeKind == kind::kMiscellaneous) return kMiscellaneousHelp;
  const auto row = std::find_if(kHelp.begin(), kHelp.end(), [nodeKind](const HelpRow& candidate) {
    return candidate.elementKind == nodeKind || candidate.listKind == nodeKind;
  });
  return row == kHelp.end() ? kOtherHelp : row->help;
}

std::int32_t FolderOfKind(std::int32_t elementKind) {
  switch (elementKind) {
    case kind::kStateVariable:
      return folder_id::kStateVariables;
    case kind::kConstant:
      return folder_id::kConstants;
    case kind::kForcing:
      return folder_id::kForcings;
    case kind::kAuxiliary:
      return folder_id::kAuxiliaries;
    case kind::kProcess:
      return folder_id::kProcesses;
    case kind::kDerivedOutput:
      return folder_id::kDerivedOutputs;
    case kind::kSpecie:
      return folder_id::kParticleClasses;
    default:
      return 0;
  }
}

}  // namespace tessal
