#include "tessal/template.h"

#include <utility>

#include "core/error_registry.h"
#include "core/rename.h"
#include "elements/property_io.h"
#include "elements/specie.h"
#include "expr/scanner.h"
#include "library/messages_of.h"
#include "library/template_data.h"

namespace tessal {
inline namespace v1 {

namespace {

Outcome RefusedHandle() {
  return {false, "the element is not of this template, or was removed"};
}

/// Loads by one of the core's ways, and keeps what it found.
template <class Way>
Outcome LoadBy(TemplateData& data, Way load) {
  data.ForgetIndex();
  // A comment that another text left open must not swallow the expressions of this one.
  ResetExpressionScanner();
  const bool isLoaded = load(data.Core());
  data.loadMessages = RegistryMessages();
  data.Core().History().Start();
  if (isLoaded) return {};
  return {false, JoinedTexts(data.loadMessages)};
}

Outcome SaveTo(TemplateData& data, const std::string& path) {
  // What the checks found is no part of why a save fails.
  Errors().ClearErrors();
  if (data.Core().SaveWrapper(path)) return {};
  return {false, JoinedTexts(RegistryMessages())};
}

/// Where an element of a kind is made: for a member of a particle class the list in it, nothing for a class
/// that there is not; no list for the others.
std::optional<Uid> ListFor(const TemplateCore& core, Kind kind, std::string_view classSymbol) {
  if (kind < Kind::ParticleStateVariable) return Uid::None;
  const auto place = static_cast<std::size_t>(kind) - static_cast<std::size_t>(Kind::ParticleStateVariable);
  if (place >= CEL_Lagrange_Specie::kListCount) return std::nullopt;
  for (const auto& specie : core.Species()) {
    if (specie->symbol.Text() == classSymbol) return specie->Heads()[place]->GetUid();
  }
  return std::nullopt;
}

}  // namespace

Template::Template() : data(std::make_unique<TemplateData>()) {}
Template::Template(Template&& other) noexcept = default;
Template& Template::operator=(Template&& other) noexcept = default;
Template::~Template() = default;

Outcome Template::Load(const std::string& path) {
  return LoadBy(*data, [&path](TemplateCore& core) { return core.LoadWrapper(path); });
}

Outcome Template::LoadText(std::string text) {
  return LoadBy(*data, [&text](TemplateCore& core) { return core.LoadText(std::move(text)); });
}

Outcome Template::Save() {
  if (data->Core().Account().Loses()) return {false, JoinedTexts(Losses())};
  return SaveInSpiteOfLosses();
}

Outcome Template::SaveInSpiteOfLosses() {
  const std::string path = data->Core().TemplateFileName();
  if (path.empty()) return {false, "the template has no file yet"};
  return SaveTo(*data, path);
}

Outcome Template::SaveAs(const std::string& path) {
  if (path.empty()) return {false, "the name of the file is empty"};
  return SaveTo(*data, path);
}

std::optional<std::string> Template::Text() {
  std::string reason;
  return data->Core().CopyText(reason);
}

bool Template::IsModified() const {
  return data->Core().Modified();
}

std::vector<Element> Template::Elements() const {
  std::vector<Element> elements;
  const CEL_Element* previous = nullptr;
  for (const SymbolRecord& record : data->Core().SymbolTable()) {
    // The two records of a movement are side by side.
    if (record.element != previous) elements.push_back(data->HandleOf(*record.element));
    previous = record.element;
  }
  return elements;
}

std::optional<Element> Template::Find(std::string_view symbol) const {
  const TemplateCore& core = data->Core();
  std::uint32_t sequence = 0;
  if (!core.FindSymbol(symbol, sequence)) return std::nullopt;
  return data->HandleOf(*core.FindRecordBySequence(sequence)->element);
}

const std::vector<TemplateMessage>& Template::LoadMessages() const {
  return data->loadMessages;
}

std::vector<TemplateMessage> Template::Losses() const {
  return LossesOf(data->Core().Account());
}

std::vector<TemplateMessage> Template::Check() {
  TemplateCore& core = data->Core();
  Errors().ClearErrors();
  core.ValidateTemplate();
  return RegistryMessages();
}

std::vector<UndefinedName> Template::UndefinedNames() const {
  std::vector<UndefinedName> names;
  for (const auto& undefined : data->Core().UndefinedSymbols()) {
    UndefinedName& name = names.emplace_back(UndefinedName{undefined->symbol, {}});
    for (const Uid user : undefined->usedBy) {
      if (const CEL_Element* element = data->Find(user)) name.usedBy.push_back(element->FullSymbol());
    }
  }
  return names;
}

std::optional<Element> Template::Create(Kind kind, std::string_view symbol, std::string_view classSymbol) {
  TemplateCore& core = data->Core();
  const std::string name(CleanText(symbol));
  const std::optional<Uid> list = ListFor(core, kind, classSymbol);
  if (kind == Kind::None || !list || !RenameRefusal(core, name).empty()) return std::nullopt;
  data->ForgetIndex();
  const CreatedElement created = core.CreateElement({name, static_cast<ElementKind>(kind), *list});
  const CEL_Element* element = created.uid == Uid::None ? nullptr : data->Find(created.uid);
  return element == nullptr ? std::nullopt : std::optional(data->HandleOf(*element));
}

Outcome Template::Remove(const Element& element) {
  const CEL_Element* removed = data->Find(element);
  if (removed == nullptr) return RefusedHandle();
  TemplateCore& core = data->Core();
  const Uid uid = removed->GetUid();
  if (!core.CanDelete(uid)) return {false, "'" + removed->FullSymbol() + "' is in use"};
  data->ForgetIndex();
  if (core.DeleteElement(uid)) return {};
  return {false, "'" + removed->FullSymbol() + "' can not be removed"};
}

Outcome Template::Move(const Element& element, Side side, const Element& sibling) {
  const CEL_Element* moved = data->Find(element);
  const CEL_Element* target = data->Find(sibling);
  if (moved == nullptr || target == nullptr) return RefusedHandle();
  if (data->Core().MoveElement(moved->GetUid(), target->GetUid(), side == Side::Before)) return {};
  return {false, "'" + moved->FullSymbol() + "' can not be moved beside '" + target->FullSymbol() +
                     "': they are of different lists, or a use would come before its definition"};
}

Outcome Template::Rename(std::string_view oldSymbol, std::string_view newSymbol, Uses uses) {
  TemplateCore& core = data->Core();
  const std::string name(CleanText(newSymbol));
  std::string refusal = RenameRefusal(core, name);
  if (!refusal.empty()) return {false, std::move(refusal)};
  const Rewriting rewriting = uses == Uses::Rewritten ? Rewriting::WholeNames : Rewriting::None;
  if (core.Rename(oldSymbol, name, rewriting)) return {};
  return {false, RenameFailure(name)};
}

bool Template::Undo() {
  TemplateCore& core = data->Core();
  data->ForgetIndex();
  return core.Undo().has_value();
}

bool Template::Redo() {
  TemplateCore& core = data->Core();
  data->ForgetIndex();
  return core.Redo().has_value();
}

}  // namespace v1
}  // namespace tessal
