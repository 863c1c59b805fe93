#include "core/template_core.h"

#include "core/error_registry.h"
#include "elements/property_io.h"
#include "expr/function_catalogue.h"

namespace tessal {

namespace {

constexpr std::array<std::string_view, TemplateCore::kListHeadCount> kListSymbols = {
    "State Variables", "Constants", "Forcing", "Auxiliaries", "Processes", "Derived Outputs"};

}  // namespace

TemplateCore::TemplateCore() {
  InitCatalogues();
  for (std::size_t place = 0; place < listHeads.size(); ++place) {
    listHeads[place] =
        std::make_unique<CEL_ListHead>(KindAfter(ElementKind::StateVariableList, place), kListSymbols[place]);
    Adopt(*listHeads[place], root);
  }
  root.SetOwner(this);
  root.SetModifiedFlag(&flags.modified);
  Adopt(misc, root);
  flags.modified = false;
  Clear();
}

TemplateCore::~TemplateCore() {
  stateVariables.clear();
  constants.clear();
  forcings.clear();
  auxiliaries.clear();
  processes.clear();
  derivedOutputs.clear();
  species.clear();
  ReleaseCatalogues();
}

void TemplateCore::Clear() {
  templateFileName.clear();
  saveFileName.clear();
  root.ClearTexts();
  for (const auto& head : listHeads) head->ClearTexts();
  misc.Reset();
  hasMisc = true;
  stateVariables.clear();
  constants.clear();
  forcings.clear();
  auxiliaries.clear();
  processes.clear();
  derivedOutputs.clear();
  species.clear();
  groupCounter = 0;
  keptTree.Clear();
  symbolTable.clear();
  undefinedSymbols.clear();
  ClearLastKeyError();
  Errors().ClearErrors();
}

std::size_t TemplateCore::GetExternalFunctionCount() const {
  return hasMisc ? misc.ExternalFunctions().size() : 0;
}

std::int32_t TemplateCore::GetDocumentRevision() const {
  return hasMisc ? misc.documentRevision.IntValue() : 0;
}

CEL_ListHead& TemplateCore::ListHead(ElementKind listKind) const {
  const auto place = static_cast<std::size_t>(NumberOf(listKind) - NumberOf(ElementKind::StateVariableList));
  if (place >= listHeads.size()) throw SubscriptFailure();
  return *listHeads[place];
}

std::size_t TemplateCore::CountNamedElements() const {
  std::size_t count = 0;
  ForEachNamedElement([&count](const CEL_Element&) { ++count; });
  return count;
}

void TemplateCore::SetShowAllBuiltIns(bool value) {
  flags.showAllBuiltIns = value;
  for (const auto& constant : constants) constant->RebuildBuiltInChoices(value);
  for (const auto& forcing : forcings) forcing->RebuildBuiltInChoices(value);
}

void TemplateCore::Adopt(CEL_Element& element, CEL_Element& parent) {
  element.SetParent(&parent);
  element.SetOwner(this);
  element.SetModifiedFlag(&flags.modified);
}

}  // namespace tessal
