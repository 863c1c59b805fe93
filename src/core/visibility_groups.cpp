// Visibility groups: the definitions in the settings and the memberships that the elements keep are changed
// together. In memory both go by identity; the file holds record numbers.
#include <algorithm>

#include "core/template_core.h"

namespace tessal {

void TemplateCore::ApplyVisibilityGroups() {
  auto& groups = misc.Visibilities().groups;
  for (std::size_t group = 0; group < groups.size(); ++group) {
    auto& levels = groups[group].levels;
    for (std::size_t level = 0; level < levels.size(); ++level) {
      std::set<Uid>& uids = levels[level].items;
      for (const std::int32_t number : levels[level].records) {
        const SymbolRecord* record =
            number < 1 ? nullptr : FindRecordBySequence(static_cast<std::uint32_t>(number));
        if (record == nullptr) continue;
        // Both records of a movement stand for one member.
        if (!uids.insert(record->element->GetUid()).second) continue;
        record->element->SetVisibility(static_cast<std::int32_t>(group + 1),
                                       static_cast<std::int32_t>(level + 1));
      }
      levels[level].records.clear();
    }
  }
}

template <class Visitor>
void TemplateCore::ForEachRecordElement(Visitor visit) const {
  const CEL_Element* previous = nullptr;
  for (const SymbolRecord& record : symbolTable) {
    if (record.element != previous) visit(*record.element);
    previous = record.element;
  }
}

void TemplateCore::LeaveVisibilityGroups(CEL_Element& element) {
  for (VisibilityGroup& group : misc.Visibilities().groups) {
    for (VisibilityLevel& level : group.levels) level.items.erase(element.GetUid());
  }
  const auto memberships = element.Visibility();
  for (const auto& [group, level] : memberships) element.RemoveVisibility(group, level);
}

bool TemplateCore::HasGroup(std::int32_t group) const {
  return hasMisc && group >= 1 && static_cast<std::size_t>(group) <= misc.Visibilities().groups.size();
}

bool TemplateCore::HasLevel(std::int32_t group, std::int32_t level) const {
  return HasGroup(group) && level >= 1 && static_cast<std::size_t>(level) <= Group(group).levels.size();
}

const VisibilityGroup& TemplateCore::Group(std::int32_t group) const {
  return misc.Visibilities().groups[static_cast<std::size_t>(group - 1)];
}

VisibilityGroup& TemplateCore::Group(std::int32_t group) {
  return misc.Visibilities().groups[static_cast<std::size_t>(group - 1)];
}

VisibilityLevel& TemplateCore::Level(std::int32_t group, std::int32_t level) {
  return Group(group).levels[static_cast<std::size_t>(level - 1)];
}

std::int32_t TemplateCore::AddVisibilityGroup() {
  if (!hasMisc) return 0;
  auto& groups = misc.Visibilities().groups;
  const auto taken = [&groups](const std::string& name) {
    return std::any_of(groups.begin(), groups.end(),
                       [&name](const auto& group) { return group.name == name; });
  };
  const auto nameOf = [](std::uint32_t number) { return "Group_" + std::to_string(number); };
  if (groupCounter > 0 || groups.empty()) {
    ++groupCounter;
  } else {
    groupCounter = static_cast<std::uint32_t>(groups.size());
    while (taken(nameOf(groupCounter))) ++groupCounter;
  }
  groups.push_back({nameOf(groupCounter), "", {}});
  flags.modified = true;
  return static_cast<std::int32_t>(groups.size());
}

void TemplateCore::RemoveVisibilityGroup(std::int32_t group) {
  if (!HasGroup(group)) return;
  auto& groups = misc.Visibilities().groups;
  groups.erase(groups.begin() + (group - 1));
  ForEachRecordElement([group](CEL_Element& element) {
    element.RemoveVisibilityGroup(group);
    element.CloseVisibilityGroupGap(group);
  });
  flags.modified = true;
}

std::int32_t TemplateCore::CreateLevel(std::int32_t group) {
  if (!HasGroup(group)) return 0;
  auto& levels = Group(group).levels;
  const std::size_t number = levels.size() + 1;
  levels.push_back({"Level_" + std::to_string(number), "", {}, {}});
  flags.modified = true;
  return static_cast<std::int32_t>(number);
}

void TemplateCore::DeleteLevel(std::int32_t group, std::int32_t level) {
  if (!HasLevel(group, level)) return;
  auto& levels = Group(group).levels;
  levels.erase(levels.begin() + (level - 1));
  ForEachRecordElement([group, level](CEL_Element& element) {
    element.RemoveVisibility(group, level);
    element.CloseVisibilityLevelGap(group, level);
  });
  flags.modified = true;
}

void TemplateCore::AddItemToLevel(std::int32_t group, std::int32_t level, std::uint32_t sequence) {
  CEL_Element* element = GetElementBySequence(sequence);
  if (element == nullptr || !HasLevel(group, level)) return;
  if (!Level(group, level).items.insert(element->GetUid()).second) return;
  element->SetVisibility(group, level);
  flags.modified = true;
}

void TemplateCore::RemoveItemFromLevel(std::int32_t group, std::int32_t level, std::uint32_t sequence) {
  CEL_Element* element = GetElementBySequence(sequence);
  if (element == nullptr || !HasLevel(group, level)) return;
  if (Level(group, level).items.erase(element->GetUid()) == 0) return;
  element->RemoveVisibility(group, level);
  flags.modified = true;
}

void TemplateCore::CollectItems(std::int32_t group, std::int32_t level, std::vector<std::int32_t>& items,
                                bool recursive) const {
  items.clear();
  if (!hasMisc) return;
  if (group < 1) {
    for (const SymbolRecord& record : symbolTable)
      items.push_back(static_cast<std::int32_t>(record.sequence));
    return;
  }
  if (!HasGroup(group)) return;
  const auto& levels = Group(group).levels;
  std::set<Uid> uids;
  const auto collect = [&uids](const VisibilityLevel& from) {
    uids.insert(from.items.begin(), from.items.end());
  };
  if (level < 1) {
    for (const VisibilityLevel& each : levels) collect(each);
  } else {
    // A level above the last is taken as the last.
    std::size_t count = std::min(static_cast<std::size_t>(level), levels.size());
    for (; count > 0; --count) {
      collect(levels[count - 1]);
      if (!recursive) break;
    }
  }
  const std::set<std::int32_t> numbers = ItemsToRecordNumbers(uids);
  items.assign(numbers.begin(), numbers.end());
}

std::string TemplateCore::NamedGroup(std::int32_t group, std::string_view all) const {
  if (!hasMisc) return {};
  if (group < 1) return std::string(all);
  return HasGroup(group) ? Group(group).name : std::string();
}

std::string TemplateCore::NamedLevel(std::int32_t group, std::int32_t level, std::string_view all) const {
  if (!hasMisc) return {};
  if (group < 1 || level < 1) return std::string(all);
  if (!HasLevel(group, level)) return {};
  return Group(group).levels[static_cast<std::size_t>(level - 1)].name;
}

std::string TemplateCore::GroupText(std::int32_t group) const {
  return NamedGroup(group, "any");
}

std::string TemplateCore::GroupListText(std::int32_t group) const {
  return NamedGroup(group, "all variables");
}

std::string TemplateCore::LevelText(std::int32_t group, std::int32_t level) const {
  return NamedLevel(group, level, "all");
}

std::string TemplateCore::LevelListText(std::int32_t group, std::int32_t level) const {
  return NamedLevel(group, level, "all variables in this group");
}

}  // namespace tessal
