// What stands behind each node of the element tree, and the history of the nodes that were visited.
#pragma once

#include <cstddef>
#include <cstdint>
#include <list>
#include <map>
#include <string>

namespace tessal {

/// Identities of the nodes that are no elements.
namespace folder_id {
inline constexpr std::int32_t kRoot = -1;
inline constexpr std::int32_t kStateVariables = -2;
inline constexpr std::int32_t kConstants = -3;
inline constexpr std::int32_t kForcings = -4;
inline constexpr std::int32_t kAuxiliaries = -5;
inline constexpr std::int32_t kProcesses = -6;
inline constexpr std::int32_t kDerivedOutputs = -7;
inline constexpr std::int32_t kMiscellaneous = -8;
inline constexpr std::int32_t kParticleClasses = -9;
inline constexpr std::int32_t kPluginFunctions = -10;
inline constexpr std::int32_t kVisibilityGroups = -11;
inline constexpr std::int32_t kVisibilityGroup = -12;
}  // namespace folder_id

/// Kinds of nodes that no element has.
namespace node_kind {
inline constexpr std::int32_t kRoot = 0;
inline constexpr std::int32_t kPluginFunctions = 35;
}  // namespace node_kind

struct CItemData {
  std::int32_t id = 0;          ///< the element's identity, or a folder's
  std::int32_t groupIndex = 0;  ///< the number from 1 of a visibility group's node, else 0
  std::int32_t kind = 0;
  std::map<std::string, std::string>
      viewState;  ///< what a form keeps for the node while the document is open
};

struct CHistoryData {
  std::int32_t id;
  std::string caption;
};

/// The nodes visited, newest first, each once, and the one that is shown now.
class CNavigationHistory final {
 public:
  static constexpr std::size_t kMostEntries = 30;

  /// Enters a visited node before the present one and makes it the present one. Newer entries stay.
  void Add(std::int32_t id, const std::string& caption);
  /// Moves towards older or newer entries, at most to the end; the identity there, 0 for none.
  std::int32_t Back();
  std::int32_t Forward();
  bool CanGoBack() const { return position + 1 < static_cast<std::ptrdiff_t>(entries.size()); }
  bool CanGoForward() const { return !entries.empty() && position > 0; }

  const std::list<CHistoryData>& Entries() const { return entries; }
  /// The place of the present entry from the newest, -1 for none.
  std::ptrdiff_t Position() const { return position; }

 private:
  std::int32_t IdAtPosition() const;

  std::list<CHistoryData> entries;
  std::ptrdiff_t position = -1;
};

}  // namespace tessal
