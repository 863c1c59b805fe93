#include "core/template_core.h"

#include "core/error_registry.h"
#include "core/search_functions.h"
#include "elements/property_io.h"
#include "expr/function_catalogue.h"
#include "keyfile/reader.h"

namespace tessal {

CEL_ListHead& TemplateState::ListHead(ElementKind listKind) const {
  const auto place = static_cast<std::size_t>(NumberOf(listKind) - NumberOf(ElementKind::StateVariableList));
  if (place >= listHeads.size()) throw SubscriptFailure();
  return *listHeads[place];
}

void TemplateState::AssignIds() {
  ResolveReferencesToNames(collections);
  for (const SymbolRecord& record : table.Records()) {
    record.element->id.SetInt(static_cast<std::int32_t>(record.sequence));
  }
  NumberSpecies(collections);
  ResolveNamesToReferences(collections);
  flags.modified = true;
}

void TemplateState::SetSpatialTree(bool needed) {
  misc.buildSpatialTree.SetBool(needed);
  // A form opens on the selection.
  misc.SelectPresentValues();
}

void TemplateState::SettleSpatialTree() {
  if (!collections.species.empty()) SetSpatialTree(NeedSpatialTree(collections));
}

TemplateCore::TemplateCore() {
  InitCatalogues();
  state.history = &history;
  for (std::size_t place = 0; place < state.listHeads.size(); ++place) {
    const ElementKind listKind = KindAfter(ElementKind::StateVariableList, place);
    state.listHeads[place] = std::make_unique<CEL_ListHead>(listKind, KindText(listKind));
    Adopt(*state.listHeads[place], state.root);
  }
  state.root.SetOwner(this);
  state.root.SetModifiedFlag(&state.flags.modified);
  Adopt(state.misc, state.root);
  state.flags.modified = false;
  Clear();
}

TemplateCore::~TemplateCore() {
  history.Stop();
  ForEachCollection([this](const auto& row) { (state.collections.*row.elements).clear(); });
  ReleaseCatalogues();
}

void TemplateCore::Clear() {
  history.Stop();
  state.templateFileName.clear();
  state.saveFileName.clear();
  state.root.ClearTexts();
  for (const auto& head : state.listHeads) head->ClearTexts();
  state.misc.Reset();
  state.hasMisc = true;
  ForEachCollection([this](const auto& row) { (state.collections.*row.elements).clear(); });
  state.groupCounter = 0;
  state.source = {};
  state.keptText = {};
  state.keptTree.reset();
  state.account.Clear();
  state.table.Clear();
  ClearLastKeyError();
  Errors().ClearErrors();
}

const CKvfSectionItem& TemplateCore::KeptTree() const {
  if (!state.keptTree) {
    state.keptTree = std::make_unique<CKvfItemTree>();
    if (state.source) ParseKeyFileTree(state.source, *state.keptTree);
  }
  return *state.keptTree;
}

void TemplateCore::SetKeptText(std::string text) {
  if (text == state.keptText) return;
  history.Note(KeptTextEdit{std::exchange(state.keptText, std::move(text))});
  state.flags.modified = true;
}

std::size_t TemplateCore::GetExternalFunctionCount() const {
  return state.hasMisc ? state.misc.ExternalFunctions().size() : 0;
}

std::int32_t TemplateCore::GetDocumentRevision() const {
  return state.hasMisc ? state.misc.documentRevision.IntValue() : 0;
}

std::size_t TemplateCore::CountNamedElements() const {
  std::size_t count = 0;
  ForEachNamedElement(Elements(), [&count](const CEL_Element&) { ++count; });
  return count;
}

void TemplateCore::SetShowAllBuiltIns(bool value) {
  if (state.flags.showAllBuiltIns != value) history.Note(BuiltInsEdit{state.flags.showAllBuiltIns});
  state.flags.showAllBuiltIns = value;
  for (const auto& constant : Constants()) constant->RebuildBuiltInChoices(value);
  for (const auto& forcing : Forcings()) forcing->RebuildBuiltInChoices(value);
}

void TemplateCore::Adopt(CEL_Element& element, CEL_Element& parent) {
  element.SetParent(&parent);
  element.SetOwner(this);
  element.SetModifiedFlag(&state.flags.modified);
}

void TemplateCore::RebuildSymbolTable() {
  if (!state.flags.rebuildEnabled) return;
  const NotificationsOff silent;
  state.table.Rebuild(state.collections, state.misc);
}

void TemplateCore::RefreshSearchFunctionChoices() {
  OfferSearchChoices(Elements());
  state.SettleSpatialTree();
}

}  // namespace tessal
