// Taking over what a load passed over, on demand: an edit like any other.
#include <unordered_map>

#include "core/template_core.h"
#include "core/visibility_groups.h"

namespace tessal {

namespace {

/// Everything that a file has a section for.
std::unordered_map<Uid, CEL_Element*> ElementsOfFile(TemplateState& state) {
  std::unordered_map<Uid, CEL_Element*> elements;
  const auto add = [&elements](CEL_Element& element) { elements.emplace(element.GetUid(), &element); };
  state.table.ForEachElement([&add](const SymbolRecord& record) { add(*record.element); });
  add(state.root);
  for (const auto& head : state.listHeads) add(*head);
  for (const auto& specie : state.collections.species) {
    for (const auto& head : specie->Heads()) add(*head);
  }
  add(state.misc);
  add(state.misc.ExternalFunctionHead());
  add(state.misc.Visibilities());
  for (const auto& function : state.misc.ExternalFunctions()) add(*function);
  return elements;
}

}  // namespace

bool TemplateCore::TakeOverPassedOver() {
  const CEL_Visibility& visibilities = state.misc.Visibilities();
  TakenOver before{visibilities.groups, visibilities.groupsPassedOver, state.account};
  const std::vector<AccountEntry> entries = state.account.TakePassedOver();
  if (!entries.empty()) {
    const EditStep step(history);
    history.Note(TakeOverEdit{std::make_unique<TakenOver>(std::move(before))});
    // As in a load, a value changes nothing but itself.
    const NotificationsOff silent;
    const auto elements = ElementsOfFile(state);
    for (const AccountEntry& entry : entries) {
      const auto hit = entry.value ? elements.find(entry.value->element) : elements.end();
      if (hit == elements.end()) continue;
      hit->second->SetFields({entry.value->field});
      hit->second->SelectPresentValues();
      hit->second->UpdateLocks();
    }
    if (state.hasMisc) VisibilityGroups(state).TakeOverPassedOver();
    state.flags.modified = true;
  }
  RebuildSymbolTable();
  return state.account.Count(AccountKind::Unread) == 0;
}

}  // namespace tessal
