#include "ui/node_kinds.h"

#include <algorithm>
#include <iterator>

#include "core/template_core.h"
#include "ui/form_tables.h"
#include "ui/generic_list_view.h"
#include "ui/plugin_functions_page.h"
#include "ui/specie_forms.h"
#include "ui/tessal_view.h"
#include "ui/visibility_group_page.h"
#include "ui/visibility_groups_page.h"

namespace tessal {

namespace {

constexpr std::size_t kMostHorizontalVectors = 5;
constexpr int kOtherHelp = 107;
constexpr Uid kNone = Uid::None;

template <class FormClass>
std::unique_ptr<CRightPaneBase> Form(const FormContext& context, QWidget* parent) {
  return std::make_unique<FormClass>(context, parent);
}

std::string DescriptionOf(const CEL_Element& element) {
  return element.description.TextOf();
}

std::string PublicNameOf(const CEL_Element& element) {
  return "User function '" + static_cast<const CEL_ExternalFunction&>(element).publicName.TextOf() + "'";
}

using enum OwnerRule;
namespace fixed = folder_id;
using Kind = ElementKind;

// kind, id, folder, help, creates, owner, offers Delete, form, caption, caption of an element
constexpr NodeRow kNodeRows[] = {
    {node_kind::kRoot, fixed::kRoot, kNone, kOtherHelp, Kind::None, Node, false, Form<CTessalView>,
     "Tessal Setup"},

    {Kind::StateVariableList, fixed::kStateVariables, kNone, 100, Kind::StateVariable, Node, false,
     Form<CGenericListView>},
    {Kind::ConstantList, fixed::kConstants, kNone, 102, Kind::Constant, Node, false, Form<CGenericListView>},
    {Kind::ForcingList, fixed::kForcings, kNone, 106, Kind::Forcing, Node, false, Form<CGenericListView>},
    {Kind::AuxiliaryList, fixed::kAuxiliaries, kNone, 101, Kind::Auxiliary, Node, false,
     Form<CGenericListView>},
    {Kind::ProcessList, fixed::kProcesses, kNone, 119, Kind::Process, Node, false, Form<CGenericListView>},
    {Kind::DerivedOutputList, fixed::kDerivedOutputs, kNone, 120, Kind::DerivedOutput, Node, false,
     Form<CGenericListView>},
    {Kind::Specie, fixed::kParticleClasses, kNone, 114, Kind::Specie, Node, false, Form<CGenericListView>,
     "Particle Classes"},

    {Kind::StateVariable, kNone, fixed::kStateVariables, 100, Kind::StateVariable, ListHead, true,
     Form<CStateVariableView>},
    {Kind::Constant, kNone, fixed::kConstants, 102, Kind::Constant, Folder, true, Form<CConstantView>},
    {Kind::Forcing, kNone, fixed::kForcings, 106, Kind::Forcing, Folder, true, Form<CForcingView>},
    {Kind::Auxiliary, kNone, fixed::kAuxiliaries, 101, Kind::Auxiliary, Folder, true, Form<CAuxilarieView>},
    {Kind::Process, kNone, fixed::kProcesses, 119, Kind::Process, ListHead, true, Form<CProcessView>},
    {Kind::DerivedOutput, kNone, fixed::kDerivedOutputs, 120, Kind::DerivedOutput, Folder, true,
     Form<CDerviedView>, nullptr, DescriptionOf},
    {Kind::Specie, kNone, fixed::kParticleClasses, 114, Kind::Specie, Folder, true, Form<CSpecieGeneralView>},

    {Kind::SpecieStateVariableList, kNone, kNone, 116, Kind::SpecieStateVariable, Node, false,
     Form<CGenericListView>},
    {Kind::SpecieConstantList, kNone, kNone, 113, Kind::SpecieConstant, Node, false, Form<CGenericListView>},
    {Kind::SpecieForcingList, kNone, kNone, kOtherHelp, Kind::SpecieForcing, Node, false},
    {Kind::SpatialFunctionList, kNone, kNone, 115, Kind::SpatialFunction, Node, false,
     Form<CGenericListView>},
    {Kind::ArithmeticExpressionList, kNone, kNone, 112, Kind::ArithmeticExpression, Node, false,
     Form<CGenericListView>},
    {Kind::HorizontalVectorList, kNone, kNone, 117, Kind::HorizontalVector, Node, false,
     Form<CGenericListView>},
    {Kind::VerticalEquationList, kNone, kNone, 118, Kind::None, Node, false, Form<CGenericListView>},

    {Kind::SpecieStateVariable, kNone, kNone, 116, Kind::SpecieStateVariable, ListHead, true,
     Form<CSpecieStateVariableView>},
    {Kind::SpecieConstant, kNone, kNone, 113, Kind::SpecieConstant, ListHead, true,
     Form<CSpecieConstantView>},
    {Kind::SpecieForcing, kNone, kNone, kOtherHelp, Kind::SpecieForcing, ListHead, true},
    {Kind::SpatialFunction, kNone, kNone, 115, Kind::SpatialFunction, ListHead, true,
     Form<CSpecieSpatialFunctionView>},
    {Kind::ArithmeticExpression, kNone, kNone, 112, Kind::ArithmeticExpression, ListHead, true,
     Form<CSpecieArithmeticExprView>},
    {Kind::HorizontalVector, kNone, kNone, 117, Kind::HorizontalVector, ListHead, true,
     Form<CSpecieVectorHView>},
    {Kind::VerticalEquation, kNone, kNone, 118, Kind::None, Node, false, Form<CSpecieVectorVView>},

    {Kind::Miscellaneous, fixed::kMiscellaneous, kNone, 110, Kind::None, Node, false, Form<CMiscView>},
    {node_kind::kPluginFunctions, fixed::kPluginFunctions, kNone, kOtherHelp, Kind::None, Node, false,
     Form<CPluginFunctionsDlg>, "Plug-in Functions"},
    {Kind::ExternalFunction, kNone, fixed::kPluginFunctions, kOtherHelp, Kind::ExternalFunction, Folder, true,
     Form<CExternalFunctionView>, nullptr, PublicNameOf},
    {Kind::VisibilityGroups, fixed::kVisibilityGroups, kNone, kOtherHelp, Kind::VisibilityGroups, Node, false,
     Form<CVisibilityGroupsDlg>},
    {Kind::VisibilityGroup, fixed::kVisibilityGroup, kNone, kOtherHelp, Kind::VisibilityGroup, Node, true,
     Form<CVisibilityGroupDlg>},
};

constexpr NodeRow kUnknownNode{Kind::Unknown, kNone, kNone, kOtherHelp, Kind::None, Node, false};

template <class Test>
const NodeRow& FindRow(Test test) {
  const auto* const row = std::find_if(std::begin(kNodeRows), std::end(kNodeRows), test);
  return row == std::end(kNodeRows) ? kUnknownNode : *row;
}

Uid OwnerOf(const CItemData& node, const NodeRow& row, const TemplateCore& core) {
  switch (row.owner) {
    case Folder:
      return row.folder;
    case Node:
      return node.id;
    case ListHead:
      break;
  }
  const CEL_Element* element = core.GetElement(node.id);
  return element == nullptr || element->Parent() == nullptr ? kNone : element->Parent()->GetUid();
}

/// Whether the class that owns a list may have one more horizontal movement.
bool HasRoomForVector(Uid ownerId, const TemplateCore& core) {
  const CEL_Lagrange_Specie* specie = core.GetParentSpecie(ownerId);
  return specie != nullptr && specie->horizontalVectors.size() < kMostHorizontalVectors;
}

}  // namespace

const NodeRow& NodeRowOf(const CItemData& node) {
  return FindRow([&node](const NodeRow& row) {
    return row.kind == node.kind && (row.id == kNone || row.id == node.id);
  });
}

const NodeRow& NodeRowOfElements(ElementKind elementKind) {
  return FindRow([elementKind](const NodeRow& row) { return row.kind == elementKind && row.id == kNone; });
}

const NodeRow& NodeRowWithId(Uid id) {
  return FindRow([id](const NodeRow& row) { return row.id == id; });
}

std::string CaptionOfFixedNode(const NodeRow& row) {
  return row.caption != nullptr ? row.caption : std::string(KindText(row.kind));
}

std::string ElementCaption(const CEL_Element& element) {
  const NodeRow& row = NodeRowOfElements(element.Kind());
  return row.captionOf != nullptr ? row.captionOf(element) : element.symbol.TextOf();
}

std::string MarkedCaption(const CEL_Element& element) {
  const std::string caption = ElementCaption(element);
  return element.Loaded() ? caption : "*" + caption;
}

std::unique_ptr<CRightPaneBase> MakeForm(const FormContext& context, QWidget* parent) {
  const NodeRow& row = NodeRowOf(context.item);
  return row.makeForm != nullptr ? row.makeForm(context, parent) : Form<CNoView>(context, parent);
}

NodeCommands CommandsOfNode(const CItemData& node, const TemplateCore& core) {
  NodeCommands commands;
  const NodeRow& row = NodeRowOf(node);
  if (row.creates == ElementKind::None) return commands;
  commands.kindToCreate = row.creates;
  commands.ownerId = OwnerOf(node, row, core);
  commands.canCreate =
      row.creates != ElementKind::ExternalFunction &&
      (row.creates != ElementKind::HorizontalVector || HasRoomForVector(commands.ownerId, core));
  commands.offersDelete = row.offersDelete;
  commands.canDelete =
      node.kind == ElementKind::VisibilityGroup || (IsElement(node.id) && core.CanDelete(node.id));
  return commands;
}

}  // namespace tessal
