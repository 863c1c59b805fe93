// Widgets, layouts, actions and tree items that belong to a parent: whoever makes one here hands it over at
// once.
#pragma once

#include <memory>
#include <utility>

namespace tessal {

/// Makes an object that its Qt parent owns: the last argument, or what it is put into next.
template <class Object, class... Arguments>
Object* MakeChild(Arguments&&... arguments) {
  return std::make_unique<Object>(std::forward<Arguments>(arguments)...).release();
}

}  // namespace tessal
