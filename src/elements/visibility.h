// Visibility groups: named groups with levels, by which an application shows a modeller only part of a large
// template. The definitions list, for each level, the elements that belong to it.
#pragma once

#include <map>
#include <set>
#include <string>
#include <vector>

#include "elements/element.h"

namespace tessal {

struct VisibilityLevel {
  std::string name{};
  std::string description{};
  std::set<Uid> items{};  ///< the identities of its elements
  /// The numbers of symbol records that a file holds in their place; none after the template has its table.
  std::set<std::int32_t> records{};
  /// The same, as the load passed it over: to be taken over on demand.
  std::set<Uid> passedOver{};
  std::set<std::int32_t> recordsPassedOver{};
};

struct VisibilityGroup {
  std::string name;
  std::string description;
  std::vector<VisibilityLevel> levels;
};

class CEL_Visibility final : public CEL_Element {
 public:
  CEL_Visibility();

  /// Reads the sub-section of the settings; without one nothing changes.
  void Read(KvfNode settings, ReadStatus& status) override;
  /// Writes the sub-section, with the numbers of symbol records in the place of identities.
  void Write(KvfHandle file, int& status) override;
  void Reset() override;
  void GetFields(std::vector<ElementField>& /*fields*/) const override {}
  int SetFields(const std::vector<ElementField>& /*fields*/) override { return 0; }

  std::vector<VisibilityGroup> groups;
  /// Groups that the load passed over, to be taken over on demand.
  std::vector<VisibilityGroup> groupsPassedOver;

 private:
  /// The record number of every element that belongs to any level.
  std::map<Uid, std::int32_t> RecordNumbersOfItems() const;
  void WriteLevel(const VisibilityLevel& level, const std::map<Uid, std::int32_t>& numbers, KvfHandle file,
                  int& status);
};

}  // namespace tessal
