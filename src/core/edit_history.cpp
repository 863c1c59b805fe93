#include "core/edit_history.h"

#include <algorithm>
#include <new>
#include <utility>

namespace tessal {

namespace {

/// For a step whose name there was no memory for.
constexpr const char* kNameless = "Edit";

/// The group that an edit is about, in the state after it; 0 for none.
std::int32_t GroupOf(const TemplateEdit& edit) {
  return std::visit(
      [](const auto& each) -> std::int32_t {
        if constexpr (requires { each.group; }) {
          return each.group;
        } else {
          return 0;
        }
      },
      edit);
}

}  // namespace

void EditHistory::Start() {
  Clear();
  started = true;
  saved = 0;
}

void EditHistory::Stop() {
  Clear();
  started = false;
}

void EditHistory::Clear() {
  steps.clear();
  open.clear();
  noted.clear();
  fresh.clear();
  done = 0;
  bytes = 0;
  saved = kNever;
}

void EditHistory::MarkSaved() {
  CloseUnbegun();
  saved = done;
}

bool EditHistory::IsSaved() {
  CloseUnbegun();
  return saved == done;
}

std::size_t EditHistory::UndoCount() {
  CloseUnbegun();
  return done;
}

std::size_t EditHistory::RedoCount() {
  CloseUnbegun();
  return steps.size() - done;
}

std::string_view EditHistory::UndoName() {
  return UndoCount() > 0 ? steps[done - 1].name : std::string_view();
}

std::string_view EditHistory::RedoName() {
  return RedoCount() > 0 ? steps[done].name : std::string_view();
}

StepEffect EditHistory::Undo() {
  const RecordingOff quiet(*this);
  Step& step = steps[done - 1];
  for (auto edit = step.edits.rbegin(); edit != step.edits.rend(); ++edit) Exchange(state, *edit);
  --done;
  Measure(step);
  return Settle(step);
}

StepEffect EditHistory::Redo() {
  const RecordingOff quiet(*this);
  Step& step = steps[done];
  for (TemplateEdit& edit : step.edits) Exchange(state, edit);
  ++done;
  Measure(step);
  return Settle(step);
}

StepEffect EditHistory::Settle(const Step& step) {
  StepEffect effect;
  effect.name = step.name;
  effect.subject = SubjectOfStep(step.edits);
  const CEL_Element* previous = nullptr;
  for (const TemplateEdit& edit : step.edits) {
    if (const auto* value = std::get_if<ValueEdit>(&edit)) {
      if (value->element == std::exchange(previous, value->element)) continue;
      value->element->FollowValues();
      effect.changed.push_back(value->element->GetUid());
    } else if (std::holds_alternative<PlaceEdit>(edit)) {
      effect.structure = true;
    } else if (std::holds_alternative<BuiltInsEdit>(edit)) {
      effect.builtIns = true;
    } else if (!std::holds_alternative<PresenceEdit>(edit)) {
      effect.groups = true;
      if (effect.group == 0) effect.group = GroupOf(edit);
    }
  }
  for (const TemplateEdit& edit : step.edits) {
    const auto* presence = std::get_if<PresenceEdit>(&edit);
    if (presence == nullptr) continue;
    effect.structure = true;
    presence->away ? presence->element->Withdraw() : presence->element->FollowValues();
  }
  return effect;
}

void EditHistory::Begin() {
  if (depth == 0) CloseUnbegun();
  if (++depth > 1 || !IsRecording()) return;
  MakeRoom();
}

void EditHistory::End(std::string_view name) noexcept {
  if (--depth == 0) Close(name);
}

void EditHistory::Close(std::string_view name) noexcept {
  noted.clear();
  fresh.clear();
  DropUnchanged();
  if (!open.empty()) Append(name);
}

/// A value that is as it was before the act, because it was refused or went back, was not changed by it.
void EditHistory::DropUnchanged() {
  std::erase_if(open, [](const TemplateEdit& edit) {
    const auto* value = std::get_if<ValueEdit>(&edit);
    try {
      return value != nullptr && ValueOf(*value->property) == value->other;
    } catch (const std::bad_alloc&) {
      return false;
    }
  });
}

void EditHistory::Append(std::string_view name) {
  for (auto forgotten = steps.begin() + static_cast<std::ptrdiff_t>(done); forgotten != steps.end();
       ++forgotten) {
    bytes -= forgotten->bytes;
  }
  steps.erase(steps.begin() + static_cast<std::ptrdiff_t>(done), steps.end());
  if (saved != kNever && saved > done) saved = kNever;
  Step& step = steps.emplace_back();
  step.edits = std::exchange(open, {});
  ++done;
  try {
    step.name = name.empty() ? NameOfStep(state, step.edits) : std::string(name);
    step.edits.shrink_to_fit();
    Measure(step);
    ForgetOldest();
  } catch (const std::bad_alloc&) {
    if (step.name.empty()) step.name = kNameless;  // short enough to need no memory
  }
}

void EditHistory::Measure(Step& step) {
  bytes -= step.bytes;
  step.bytes = sizeof(Step) + step.name.size();
  for (const TemplateEdit& edit : step.edits) step.bytes += SizeOf(edit);
  bytes += step.bytes;
}

void EditHistory::ForgetOldest() {
  std::size_t count = 0;
  while (bytes > kMostBytes && count + 1 < done) bytes -= steps[count++].bytes;
  if (count == 0) return;
  steps.erase(steps.begin(), steps.begin() + static_cast<std::ptrdiff_t>(count));
  done -= count;
  saved = saved == kNever || saved < count ? kNever : saved - count;
}

void EditHistory::NoteValue(CEL_Element& element, CEL_Property& property) {
  if (!IsRecording()) return;
  const bool isFresh = fresh.contains(&element);
  if (isFresh || !noted.insert(&property).second) return;
  Note(ValueEdit{&element, &property, ValueOf(property)});
}

void EditHistory::NoteInserted(const ListPlace& list, std::size_t place, CEL_Element& element) {
  if (!IsRecording()) return;
  fresh.insert(&element);
  Note(PresenceEdit{list, place, &element, nullptr});
}

void EditHistory::NoteRemoved(const ListPlace& list, std::size_t place,
                              std::unique_ptr<CEL_Element> element) {
  if (!IsRecording()) return;
  CEL_Element* removed = element.get();
  Note(PresenceEdit{list, place, removed, std::move(element)});
}

void EditHistory::NoteMoved(const ListPlace& list, std::size_t from, std::size_t to, CEL_Element& element) {
  if (from != to) Note(PlaceEdit{list, from, to, &element});
}

void EditHistory::Note(TemplateEdit edit) {
  if (!IsRecording()) return;
  if (depth == 0) MakeRoom();
  open.push_back(std::move(edit));
}

/// The end of an act takes no memory for its step: it may be on the way out of a failure.
void EditHistory::MakeRoom() {
  if (steps.size() == steps.capacity()) steps.reserve(2 * steps.size() + 1);
}

}  // namespace tessal
