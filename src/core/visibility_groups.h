// Visibility groups: the definitions in the settings and the memberships that the elements keep are changed
// together. In memory both go by identity; the file holds record numbers. Groups and levels count from 1;
// everything does nothing, and gives 0 or an empty text, for a template without settings.
#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

#include "core/edits.h"
#include "core/template_state.h"

namespace tessal {

class VisibilityGroups final {
 public:
  explicit VisibilityGroups(TemplateState& templateState) : state(templateState) {}

  /// Makes memberships of the record numbers that a file holds.
  void TakeRecordNumbers();
  /// Adds the groups and items that the load passed over.
  void TakeOverPassedOver();
  std::int32_t AddGroup();
  void RemoveGroup(std::int32_t group);
  bool SetGroupName(std::int32_t group, std::string_view name);
  void SetGroupDescription(std::int32_t group, std::string_view text);
  std::int32_t CreateLevel(std::int32_t group);
  bool SetLevelName(std::int32_t group, std::int32_t level, std::string_view name);
  void SetLevelDescription(std::int32_t group, std::int32_t level, std::string_view text);
  void DeleteLevel(std::int32_t group, std::int32_t level);
  void AddItem(std::int32_t group, std::int32_t level, std::uint32_t sequence);
  void RemoveItem(std::int32_t group, std::int32_t level, std::uint32_t sequence);
  /// Gives the elements the memberships that the levels have, after those were put back as they were.
  void Reenter();
  /// Takes an element out of all groups; an edit when it was in one.
  void Leave(CEL_Element& element);

 private:
  /// Gives each element its memberships by the items of the levels.
  void EnterElements();
  template <class Named>
  bool Rename(const std::vector<Named>& siblings, Named& renamed, GroupTextEdit edit);
  void Describe(std::string& description, GroupTextEdit edit);
  std::vector<VisibilityGroup>& Groups() { return state.misc.Visibilities().groups; }

  TemplateState& state;
};

}  // namespace tessal
