#include "elements/visibility.h"

#include "elements/element_owner.h"
#include "elements/property_io.h"
#include "keyfile/keywords.h"

namespace tessal {

namespace {

void ReadItems(KvfNode section, std::set<std::int32_t>& records) {
  const KvfNode keyword = kvfKeywordByNameNum(section, key::kItems, 1);
  const int count = keyword == nullptr ? 0 : kvfGetNoParams(keyword);
  for (int number = 1; number <= count; ++number) {
    std::int32_t item = 0;
    if (kvfGetInt(kvfParamByNum(keyword, number), item) == kKvfOk) records.insert(item);
  }
}

VisibilityLevel ReadLevel(KvfNode section, int& status) {
  VisibilityLevel level;
  ReadText(level.name, section, key::kLevel, status);
  ReadText(level.description, section, key::kDescription, status);
  std::int32_t count = 0;
  if (ReadInteger(count, section, key::kItemCount, status) && count > 0) ReadItems(section, level.records);
  return level;
}

VisibilityGroup ReadGroup(KvfNode section, int number, int& status) {
  VisibilityGroup group;
  group.name = "kvfGroup_" + std::to_string(number);
  ReadText(group.name, section, key::kGroup, status);
  ReadText(group.description, section, key::kDescription, status);
  std::int32_t count = 0;
  ReadInteger(count, section, key::kLevels, status);
  const int sections = kvfGetNoSections(section);
  group.levels.reserve(static_cast<std::size_t>(sections));
  for (int level = 1; level <= sections; ++level) {
    group.levels.push_back(ReadLevel(kvfSectionByNum(section, level), status));
  }
  return group;
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
}

void CEL_Visibility::Read(KvfNode settings, int& status) {
  const KvfNode definitions = kvfSectionByNameNum(settings, section::kVisibilityGroups, 1);
  if (definitions == nullptr) return;
  ReadBase(definitions, status);
  std::int32_t count = 0;
  if (!ReadInteger(count, definitions, key::kGroups, status) || count <= 0) return;
  groups.clear();
  const int sections = kvfGetNoSections(definitions);
  groups.reserve(static_cast<std::size_t>(sections));
  for (int group = 1; group <= sections; ++group) {
    groups.push_back(ReadGroup(kvfSectionByNum(definitions, group), group, status));
  }
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
