#include "core/visibility_groups.h"

#include <algorithm>
#include <iterator>
#include <unordered_map>
#include <utility>

#include "core/edit_history.h"
#include "core/template_core.h"
#include "elements/free_name.h"

namespace tessal {

namespace {

template <class Values>
auto Numbered(Values& values, std::int32_t number) {
  const auto place = static_cast<std::size_t>(number - 1);
  return number >= 1 && place < values.size() ? &values[place] : nullptr;
}

/// The group of a number; none when there is no such group, or no settings.
template <class State>
auto GroupOf(State& state, std::int32_t group) {
  auto* found = Numbered(state.misc.Visibilities().groups, group);
  return state.hasMisc ? found : nullptr;
}

template <class State>
auto LevelOf(State& state, std::int32_t group, std::int32_t level) {
  auto* found = GroupOf(state, group);
  return found == nullptr ? nullptr : Numbered(found->levels, level);
}

/// Whether a group or a level of this name is among the siblings, the excepted one aside.
template <class Named>
bool HasName(const std::vector<Named>& siblings, std::string_view name, const Named* except = nullptr) {
  return std::any_of(siblings.begin(), siblings.end(),
                     [name, except](const Named& each) { return &each != except && each.name == name; });
}

std::string NamedGroup(const TemplateState& state, std::int32_t group, std::string_view all) {
  if (!state.hasMisc) return {};
  if (group < 1) return std::string(all);
  const VisibilityGroup* found = GroupOf(state, group);
  return found == nullptr ? std::string() : found->name;
}

std::string NamedLevel(const TemplateState& state, std::int32_t group, std::int32_t level,
                       std::string_view all) {
  if (!state.hasMisc) return {};
  if (group < 1 || level < 1) return std::string(all);
  const VisibilityLevel* found = LevelOf(state, group, level);
  return found == nullptr ? std::string() : found->name;
}

/// The record numbers of the elements that belong to a level, or of those that do not.
std::vector<std::int32_t> ItemsOfLevel(const TemplateState& state, std::int32_t group, std::int32_t level,
                                       bool belongs) {
  std::vector<std::int32_t> numbers;
  const VisibilityLevel* found = LevelOf(state, group, level);
  if (found == nullptr) return numbers;
  state.table.ForEachElement([found, belongs, &numbers](const SymbolRecord& record) {
    if (found->items.contains(record.uid) == belongs) {
      numbers.push_back(static_cast<std::int32_t>(record.sequence));
    }
  });
  return numbers;
}

}  // namespace

void VisibilityGroups::TakeRecordNumbers() {
  const auto take = [this](const VisibilityLevel& level, std::set<std::int32_t>& records,
                           std::set<Uid>& items) {
    for (const std::int32_t sequence : records) {
      const SymbolRecord* record =
          sequence < 1 ? nullptr : state.table.BySequence(static_cast<std::uint32_t>(sequence));
      // Both records of a movement are one member.
      if (record != nullptr) {
        items.insert(record->uid);
      } else {
        state.account.Note(AccountKind::Dropped, level.name, 0,
                           {"item-dropped", {std::to_string(sequence), level.name}});
      }
    }
    records.clear();
  };
  const auto takeAll = [&take](std::vector<VisibilityGroup>& groups) {
    for (VisibilityGroup& group : groups) {
      for (VisibilityLevel& level : group.levels) {
        take(level, level.records, level.items);
        take(level, level.recordsPassedOver, level.passedOver);
      }
    }
  };
  takeAll(Groups());
  takeAll(state.misc.Visibilities().groupsPassedOver);
  EnterElements();
}

void VisibilityGroups::EnterElements() {
  std::unordered_map<Uid, CEL_Element*> elements;
  state.table.ForEachElement(
      [&elements](const SymbolRecord& record) { elements.emplace(record.uid, record.element); });
  std::int32_t group = 0;
  for (const VisibilityGroup& each : Groups()) {
    ++group;
    std::int32_t number = 0;
    for (const VisibilityLevel& level : each.levels) {
      ++number;
      for (const Uid uid : level.items) {
        const auto hit = elements.find(uid);
        if (hit == elements.end()) continue;
        const auto& pairs = hit->second->Visibility();
        const bool isIn = std::find(pairs.begin(), pairs.end(), std::pair(group, number)) != pairs.end();
        if (!isIn) hit->second->SetVisibility(group, number);
      }
    }
  }
}

void VisibilityGroups::TakeOverPassedOver() {
  CEL_Visibility& visibilities = state.misc.Visibilities();
  std::move(visibilities.groupsPassedOver.begin(), visibilities.groupsPassedOver.end(),
            std::back_inserter(visibilities.groups));
  visibilities.groupsPassedOver.clear();
  for (VisibilityGroup& group : visibilities.groups) {
    for (VisibilityLevel& level : group.levels) level.items.merge(std::exchange(level.passedOver, {}));
  }
  EnterElements();
}

void VisibilityGroups::Reenter() {
  state.table.ForEachElement([](const SymbolRecord& record) { record.element->ClearVisibility(); });
  EnterElements();
}

void VisibilityGroups::Leave(CEL_Element& element) {
  std::int32_t group = 0;
  for (VisibilityGroup& each : Groups()) {
    ++group;
    std::int32_t number = 0;
    for (VisibilityLevel& level : each.levels) {
      ++number;
      if (level.items.erase(element.GetUid()) == 0) continue;
      state.history->Note(MembershipEdit{group, number, element.GetUid()});
    }
  }
  const auto memberships = element.Visibility();
  if (memberships.empty()) return;
  for (const auto& [itsGroup, level] : memberships) element.RemoveVisibility(itsGroup, level);
  state.flags.modified = true;
}

std::int32_t VisibilityGroups::AddGroup() {
  if (!state.hasMisc) return 0;
  auto& groups = Groups();
  const std::uint32_t formerCounter = state.groupCounter;
  const auto nameOf = [](std::uint32_t number) { return "Group_" + std::to_string(number); };
  if (state.groupCounter > 0 || groups.empty()) {
    ++state.groupCounter;
  } else {
    state.groupCounter = static_cast<std::uint32_t>(groups.size());
    while (HasName(groups, nameOf(state.groupCounter))) ++state.groupCounter;
  }
  groups.push_back({nameOf(state.groupCounter), "", {}});
  state.flags.modified = true;
  const auto number = static_cast<std::int32_t>(groups.size());
  state.history->Note(GroupEdit{number, nullptr, formerCounter});
  return number;
}

void VisibilityGroups::RemoveGroup(std::int32_t group) {
  if (GroupOf(state, group) == nullptr) return;
  const auto place = Groups().begin() + (group - 1);
  auto gone = std::make_unique<VisibilityGroup>(std::move(*place));
  Groups().erase(place);
  state.history->Note(GroupEdit{group, std::move(gone), state.groupCounter});
  state.table.ForEachElement([group](const SymbolRecord& record) {
    record.element->RemoveVisibilityGroup(group);
    record.element->CloseVisibilityGroupGap(group);
  });
  state.flags.modified = true;
}

std::int32_t VisibilityGroups::CreateLevel(std::int32_t group) {
  VisibilityGroup* found = GroupOf(state, group);
  if (found == nullptr) return 0;
  auto& levels = found->levels;
  levels.push_back({FirstFreeName("Level_", levels.size() + 1,
                                  [&levels](const std::string& name) { return HasName(levels, name); }),
                    ""});
  state.flags.modified = true;
  const auto number = static_cast<std::int32_t>(levels.size());
  state.history->Note(LevelEdit{group, number, nullptr});
  return number;
}

template <class Named>
bool VisibilityGroups::Rename(const std::vector<Named>& siblings, Named& renamed, GroupTextEdit edit) {
  if (renamed.name == edit.other) return true;
  if (edit.other.empty() || HasName(siblings, edit.other, &renamed)) return false;
  std::swap(renamed.name, edit.other);
  state.history->Note(std::move(edit));
  state.flags.modified = true;
  return true;
}

void VisibilityGroups::Describe(std::string& description, GroupTextEdit edit) {
  if (description == edit.other) return;
  std::swap(description, edit.other);
  state.history->Note(std::move(edit));
  state.flags.modified = true;
}

bool VisibilityGroups::SetGroupName(std::int32_t group, std::string_view name) {
  VisibilityGroup* found = GroupOf(state, group);
  return found != nullptr && Rename(Groups(), *found, GroupTextEdit{group, 0, true, std::string(name)});
}

void VisibilityGroups::SetGroupDescription(std::int32_t group, std::string_view text) {
  VisibilityGroup* found = GroupOf(state, group);
  if (found != nullptr) Describe(found->description, GroupTextEdit{group, 0, false, std::string(text)});
}

bool VisibilityGroups::SetLevelName(std::int32_t group, std::int32_t level, std::string_view name) {
  VisibilityLevel* found = LevelOf(state, group, level);
  if (found == nullptr) return false;
  return Rename(GroupOf(state, group)->levels, *found, GroupTextEdit{group, level, true, std::string(name)});
}

void VisibilityGroups::SetLevelDescription(std::int32_t group, std::int32_t level, std::string_view text) {
  VisibilityLevel* found = LevelOf(state, group, level);
  if (found != nullptr) Describe(found->description, GroupTextEdit{group, level, false, std::string(text)});
}

void VisibilityGroups::DeleteLevel(std::int32_t group, std::int32_t level) {
  if (LevelOf(state, group, level) == nullptr) return;
  auto& levels = GroupOf(state, group)->levels;
  const auto place = levels.begin() + (level - 1);
  auto gone = std::make_unique<VisibilityLevel>(std::move(*place));
  levels.erase(place);
  state.history->Note(LevelEdit{group, level, std::move(gone)});
  state.table.ForEachElement([group, level](const SymbolRecord& record) {
    record.element->RemoveVisibility(group, level);
    record.element->CloseVisibilityLevelGap(group, level);
  });
  state.flags.modified = true;
}

void VisibilityGroups::AddItem(std::int32_t group, std::int32_t level, std::uint32_t sequence) {
  const SymbolRecord* record = state.table.BySequence(sequence);
  VisibilityLevel* found = LevelOf(state, group, level);
  if (record == nullptr || found == nullptr || !found->items.insert(record->uid).second) return;
  record->element->SetVisibility(group, level);
  state.history->Note(MembershipEdit{group, level, record->uid});
  state.flags.modified = true;
}

void VisibilityGroups::RemoveItem(std::int32_t group, std::int32_t level, std::uint32_t sequence) {
  const SymbolRecord* record = state.table.BySequence(sequence);
  VisibilityLevel* found = LevelOf(state, group, level);
  if (record == nullptr || found == nullptr || found->items.erase(record->uid) == 0) return;
  record->element->RemoveVisibility(group, level);
  state.history->Note(MembershipEdit{group, level, record->uid});
  state.flags.modified = true;
}

std::int32_t TemplateCore::AddVisibilityGroup() {
  return VisibilityGroups(state).AddGroup();
}

void TemplateCore::RemoveVisibilityGroup(std::int32_t group) {
  VisibilityGroups(state).RemoveGroup(group);
}

bool TemplateCore::SetGroupName(std::int32_t group, std::string_view name) {
  return VisibilityGroups(state).SetGroupName(group, name);
}

void TemplateCore::SetGroupDescription(std::int32_t group, std::string_view text) {
  VisibilityGroups(state).SetGroupDescription(group, text);
}

std::int32_t TemplateCore::CreateLevel(std::int32_t group) {
  return VisibilityGroups(state).CreateLevel(group);
}

bool TemplateCore::SetLevelName(std::int32_t group, std::int32_t level, std::string_view name) {
  return VisibilityGroups(state).SetLevelName(group, level, name);
}

void TemplateCore::SetLevelDescription(std::int32_t group, std::int32_t level, std::string_view text) {
  VisibilityGroups(state).SetLevelDescription(group, level, text);
}

void TemplateCore::DeleteLevel(std::int32_t group, std::int32_t level) {
  VisibilityGroups(state).DeleteLevel(group, level);
}

void TemplateCore::AddItemToLevel(std::int32_t group, std::int32_t level, std::uint32_t sequence) {
  VisibilityGroups(state).AddItem(group, level, sequence);
}

void TemplateCore::RemoveItemFromLevel(std::int32_t group, std::int32_t level, std::uint32_t sequence) {
  VisibilityGroups(state).RemoveItem(group, level, sequence);
}

void TemplateCore::CollectItems(std::int32_t group, std::int32_t level, std::vector<std::int32_t>& items,
                                bool recursive) const {
  items.clear();
  if (!state.hasMisc) return;
  if (group < 1) {
    for (const SymbolRecord& record : SymbolTable())
      items.push_back(static_cast<std::int32_t>(record.sequence));
    return;
  }
  const VisibilityGroup* found = GroupOf(state, group);
  if (found == nullptr) return;
  const auto& levels = found->levels;
  // All levels for a level below 1; a level above the last is taken as the last.
  const std::size_t last =
      level < 1 ? levels.size() : std::min(static_cast<std::size_t>(level), levels.size());
  const std::size_t first = level < 1 || recursive || last == 0 ? 0 : last - 1;
  std::set<Uid> uids;
  for (std::size_t place = first; place < last; ++place) {
    uids.insert(levels[place].items.begin(), levels[place].items.end());
  }
  for (const auto& [uid, number] : RecordNumbers(uids)) items.push_back(number);
  std::sort(items.begin(), items.end());
}

std::vector<std::int32_t> TemplateCore::IncludedItems(std::int32_t group, std::int32_t level) const {
  return ItemsOfLevel(state, group, level, true);
}

std::vector<std::int32_t> TemplateCore::AvailableItems(std::int32_t group, std::int32_t level) const {
  return ItemsOfLevel(state, group, level, false);
}

std::string TemplateCore::GroupText(std::int32_t group) const {
  return NamedGroup(state, group, "any");
}

std::string TemplateCore::GroupListText(std::int32_t group) const {
  return NamedGroup(state, group, "all variables");
}

std::string TemplateCore::LevelText(std::int32_t group, std::int32_t level) const {
  return NamedLevel(state, group, level, "all");
}

std::string TemplateCore::LevelListText(std::int32_t group, std::int32_t level) const {
  return NamedLevel(state, group, level, "all variables in this group");
}

}  // namespace tessal
