// The identity of an element: a number that no other element of the process has or will have, the same
// through renames and moves, never stored in a file. Records, messages, views and requests keep identities,
// never pointers.
#pragma once

#include <cstdint>

namespace tessal {

/// Elements count from 1. Nodes of the editor's tree that are no elements have identities below 0.
enum class Uid : std::int32_t { None = 0 };

/// The number, for messages and for what a toolkit keeps as one.
constexpr std::int32_t NumberOf(Uid uid) {
  return static_cast<std::int32_t>(uid);
}

/// Whether it is an element's.
constexpr bool IsElement(Uid uid) {
  return NumberOf(uid) > 0;
}

}  // namespace tessal
