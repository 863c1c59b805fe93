// Taking steps back and doing them again: what the history exchanges, and what follows from it for the whole
// template.
#include <unordered_set>

#include "core/search_functions.h"
#include "core/template_core.h"
#include "core/visibility_groups.h"

namespace tessal {

void TemplateCore::OnChanging(CEL_Element& element, CEL_Property& property) {
  history.NoteValue(element, property);
}

void TemplateCore::OnAppended(CEL_Element& element) {
  if (!history.IsRecording()) return;
  if (element.Kind() == ElementKind::ExternalFunction) {
    history.NoteInserted({element.Kind(), nullptr}, state.misc.ExternalFunctions().size() - 1, element);
    return;
  }
  const ListPlace list{element.Kind(), GetParentSpecie(element.ListHeader()->GetUid())};
  WithList(state.collections, list, [this, &list, &element](const auto& members) {
    history.NoteInserted(list, members.size() - 1, element);
  });
}

void TemplateCore::OnRemoved(std::unique_ptr<CEL_Element> element, std::size_t place) {
  const ListPlace list{element->Kind(), nullptr};
  history.NoteRemoved(list, place, std::move(element));
}

std::optional<StepEffect> TemplateCore::Undo() {
  if (history.UndoCount() == 0) return std::nullopt;
  return Take(&EditHistory::Undo);
}

std::optional<StepEffect> TemplateCore::Redo() {
  if (history.RedoCount() == 0) return std::nullopt;
  return Take(&EditHistory::Redo);
}

StepEffect TemplateCore::Take(StepEffect (EditHistory::*step)()) {
  const NotificationsOff silent;
  std::unordered_set<const UndefinedSymbol*> formerlyUndefined;
  for (const auto& undefined : UndefinedSymbols()) formerlyUndefined.insert(undefined.get());
  StepEffect effect = (history.*step)();
  FollowStep(effect);
  // Who takes back the definition of a symbol knows that it is undefined then.
  for (const auto& undefined : UndefinedSymbols()) {
    if (!formerlyUndefined.contains(undefined.get())) undefined->asked = true;
  }
  return effect;
}

void TemplateCore::FollowStep(const StepEffect& effect) {
  const RecordingOff unrecorded(history);
  std::int32_t number = 0;
  for (const auto& specie : Species()) {
    specie->SetIndex(++number);
    specie->StampMembers();
  }
  state.table.RebuildUnderLinks(state.collections, state.misc);
  if (effect.builtIns) SetShowAllBuiltIns(state.flags.showAllBuiltIns);
  if (state.hasMisc && (effect.groups || effect.structure)) VisibilityGroups(state).Reenter();
  if (HasSearchFunction(Elements())) FillSearchChoices(Elements());
  state.flags.modified = !history.IsSaved();
}

}  // namespace tessal
