#include "elements/visibility.h"

#include "elements/element_owner.h"
#include "elements/property_io.h"
#include "keyfile/keywords.h"

namespace tessal {

namespace {

std::set<std::int32_t> ReadItems(KvfNode keyword) {
  std::set<std::int32_t> records;
  const int count = keyword == nullptr ? 0 : kvfGetNoParams(keyword);
  for (int number = 1; number <= count; ++number) {
    std::int32_t item = 0;
    if (kvfGetInt(kvfParamByNum(keyword, number), item) == kKvfOk) records.insert(item);
  }
  return records;
}

/// The items lie after their count, and are read only with one above 0.
void ReadCountedItems(VisibilityLevel& level, KvfNode section, ReadStatus& status) {
  const KvfNode items = kvfKeywordByNameNum(section, key::kItems, 1);
  std::int32_t count = 0;
  if (ReadInteger(count, section, key::kItemCount, status)) {
    if (count <= 0) return;
    level.records = ReadItems(items);
    if (items != nullptr) return;
    status.ReportMissing(section, key::kItems);
    status.NoteUnread(section, key::kItems, nullptr);
  } else if (items != nullptr) {
    level.recordsPassedOver = ReadItems(items);
    status.Account().NoteOfVisibility(level.name, kvfGetLine(items),
                                      {"items-not-read", {level.name, status.Reason()}});
  }
}

VisibilityLevel ReadLevel(KvfNode section, ReadStatus& status) {
  VisibilityLevel level;
  ReadText(level.name, section, key::kLevel, status);
  ReadText(level.description, section, key::kDescription, status);
  ReadCountedItems(level, section, status);
  return level;
}

VisibilityGroup ReadGroup(KvfNode section, int number, ReadStatus& status) {
  VisibilityGroup group;
  group.name = "kvfGroup_" + std::to_string(number);
  ReadText(group.name, section, key::kGroup, status);
  ReadText(group.description, section, key::kDescription, status);
  std::int32_t count = 0;
  ReadInteger(count, section, key::kLevels, status);
  for (KvfNode level = kvfFirstSection(section); level != nullptr; level = kvfNextSection(level, section)) {
    group.levels.push_back(ReadLevel(level, status));
  }
  return group;
}

std::vector<VisibilityGroup> ReadGroups(KvfNode definitions, ReadStatus& status) {
  std::vector<VisibilityGroup> groups;
  int number = 0;
  for (KvfNode group = kvfFirstSection(definitions); group != nullptr;
       group = kvfNextSection(group, definitions)) {
    groups.push_back(ReadGroup(group, ++number, status));
  }
  return groups;
}

std::string Numbered(std::string_view prefix, std::size_t number) {
  return std::string(prefix) + std::to_string(number);
}

}  // namespace

CEL_Visibility::CEL_Visibility() : CEL_Element("Visibility Group Definitions") {
  SetKind(ElementKind::Visibility);
  SetFileFlags(false, false, true);
}

void CEL_Visibility::Reset() {
  ClearTexts();
  groups.clear();
  groupsPassedOver.clear();
}

void CEL_Visibility::Read(KvfNode settings, ReadStatus& status) {
  const KvfNode definitions = kvfSectionByNameNum(settings, section::kVisibilityGroups, 1);
  if (definitions == nullptr) return;
  ReadBase(definitions, status);
  std::int32_t count = 0;
  if (ReadInteger(count, definitions, key::kGroups, status)) {
    if (count > 0) groups = ReadGroups(definitions, status);
    return;
  }
  ReadStatus silent = ReadStatus::WithoutReports(status.Account());
  groupsPassedOver = ReadGroups(definitions, silent);
  if (groupsPassedOver.empty()) return;
  const std::string number = std::to_string(groupsPassedOver.size());
  status.Account().NoteOfVisibility(kvfGetNameGlb(definitions), kvfGetLine(definitions),
                                    {"groups-not-read", {number, status.Reason()}});
}

void CEL_Visibility::Write(KvfHandle file, int& status) {
  const std::map<Uid, std::int32_t> numbers = RecordNumbersOfItems();
  kvfAddSection(file, section::kVisibilityGroups);
  WriteBase(file, status);
  WriteInteger(static_cast<std::int32_t>(groups.size()), file, key::kGroups, *this, status);
  for (std::size_t group = 0; group < groups.size(); ++group) {
    kvfAddSection(file, Numbered(section::kGroupPrefix, group + 1));
    WriteText(groups[group].name, file, key::kGroup, *this, status);
    WriteText(groups[group].description, file, key::kDescription, *this, status);
    const auto& levels = groups[group].levels;
    WriteInteger(static_cast<std::int32_t>(levels.size()), file, key::kLevels, *this, status);
    for (std::size_t level = 0; level < levels.size(); ++level) {
      kvfAddSection(file, Numbered(section::kLevelPrefix, level + 1));
      WriteLevel(levels[level], numbers, file, status);
      kvfEndSection(file);
    }
    kvfEndSection(file);
  }
  kvfEndSection(file);
}

std::map<Uid, std::int32_t> CEL_Visibility::RecordNumbersOfItems() const {
  if (Owner() == nullptr) return {};
  std::set<Uid> uids;
  for (const VisibilityGroup& group : groups) {
    for (const VisibilityLevel& level : group.levels) uids.insert(level.items.begin(), level.items.end());
  }
  return Owner()->RecordNumbers(uids);
}

void CEL_Visibility::WriteLevel(const VisibilityLevel& level, const std::map<Uid, std::int32_t>& numbers,
                                KvfHandle file, int& status) {
  // The identities stay in memory: a second save starts from them again.
  std::set<std::int32_t> records;
  for (const Uid item : level.items) {
    const auto number = numbers.find(item);
    if (number != numbers.end()) records.insert(number->second);
  }
  WriteText(level.name, file, key::kLevel, *this, status);
  WriteText(level.description, file, key::kDescription, *this, status);
  WriteInteger(static_cast<std::int32_t>(records.size()), file, key::kItemCount, *this, status);
  if (records.empty()) return;
  int result = kvfAddKeyword(file, key::kItems);
  for (const std::int32_t record : records) {
    if (result == kKvfOk) result = kvfAddInt(file, record);
  }
  NoteWriteResult(result, key::kItems, *this, status);
}

}  // namespace tessal
