// The data of each node of the element tree, and the history of the nodes that were visited.
#pragma once

#include <cstddef>
#include <cstdint>
#include <list>
#include <map>
#include <string>

#include "elements/element_kind.h"
#include "platform/uid.h"

namespace tessal {

/// Identities of the nodes that are no elements.
namespace folder_id {
inline constexpr Uid kRoot{-1};
inline constexpr Uid kStateVariables{-2};
inline constexpr Uid kConstants{-3};
inline constexpr Uid kForcings{-4};
inline constexpr Uid kAuxiliaries{-5};
inline constexpr Uid kProcesses{-6};
inline constexpr Uid kDerivedOutputs{-7};
inline constexpr Uid kMiscellaneous{-8};
inline constexpr Uid kParticleClasses{-9};
inline constexpr Uid kPluginFunctions{-10};
inline constexpr Uid kVisibilityGroups{-11};
inline constexpr Uid kVisibilityGroup{-12};
}  // namespace folder_id

/// Kinds of nodes that no element has.
namespace node_kind {
inline constexpr ElementKind kRoot = ElementKind::None;
inline constexpr ElementKind kPluginFunctions{35};
}  // namespace node_kind

struct CItemData {
  Uid id = Uid::None;           ///< the element's identity, or a folder's
  std::int32_t groupIndex = 0;  ///< the number from 1 of a visibility group's node, else 0
  ElementKind kind = ElementKind::None;
  /// What a form keeps for its next visit, such as the page that was open; gone with the document.
  std::map<std::string, std::string> viewState{};
};

struct CHistoryData {
  Uid id;
  std::string caption;
};

/// The nodes visited, newest first, each once, and the one that is shown now.
class CNavigationHistory final {
 public:
  static constexpr std::size_t kMostEntries = 30;

  /// Enters a visited node before the present one and makes it the present one. Newer entries stay.
  void Add(Uid id, const std::string& caption);
  /// Moves towards older or newer entries, at most to the end; the identity there, or none.
  Uid Back();
  Uid Forward();
  bool CanGoBack() const { return position + 1 < static_cast<std::ptrdiff_t>(entries.size()); }
  bool CanGoForward() const { return !entries.empty() && position > 0; }

  const std::list<CHistoryData>& Entries() const { return entries; }
  /// The place of the present entry from the newest, -1 for none.
  std::ptrdiff_t Position() const { return position; }

 private:
  Uid IdAtPosition() const;

  std::list<CHistoryData> entries;
  std::ptrdiff_t position = -1;
};

}  // namespace tessal
