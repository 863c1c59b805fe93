// The memory of an item tree: blocks in which its items and copied texts lie side by side, and whatever else
// the tree looks into. It is released in one go.
#pragma once

#include <cstddef>
#include <memory>
#include <memory_resource>
#include <new>
#include <span>
#include <string_view>
#include <type_traits>
#include <utility>
#include <vector>

namespace tessal {

class ItemMemory final {
 public:
  /// `firstBlock` is the size of the first block in bytes; further ones grow.
  explicit ItemMemory(std::size_t firstBlock = 1024) : blocks(firstBlock) {}
  ItemMemory(const ItemMemory&) = delete;
  ItemMemory& operator=(const ItemMemory&) = delete;
  ~ItemMemory() = default;

  template <class Thing, class... Arguments>
  Thing& Make(Arguments&&... arguments) {
    static_assert(std::is_trivially_destructible_v<Thing>, "the memory is released without a look at it");
    return *::new (Take(sizeof(Thing), alignof(Thing))) Thing(std::forward<Arguments>(arguments)...);
  }

  /// A thing with a copy of a row of others right after it.
  template <class Thing, class Part, class... Arguments>
  Thing& MakeBefore(std::span<const Part> row, Arguments&&... arguments) {
    static_assert(std::is_trivially_destructible_v<Thing> && std::is_trivially_copyable_v<Part>);
    static_assert(sizeof(Thing) % alignof(Part) == 0 && alignof(Thing) >= alignof(Part));
    void* const place = Take(sizeof(Thing) + row.size_bytes(), alignof(Thing));
    Thing& thing = *::new (place) Thing(std::forward<Arguments>(arguments)...);
    std::uninitialized_copy(row.begin(), row.end(), reinterpret_cast<Part*>(&thing + 1));
    return thing;
  }

  /// A copy of a row of things.
  template <class Thing>
  std::span<Thing> Copy(std::span<const Thing> things) {
    static_assert(std::is_trivially_copyable_v<Thing>);
    auto* const copies = static_cast<Thing*>(Take(things.size_bytes(), alignof(Thing)));
    std::uninitialized_copy(things.begin(), things.end(), copies);
    return {copies, things.size()};
  }
  std::string_view Copy(std::string_view text) {
    const std::span<char> copy = Copy(std::span<const char>(text));
    return {copy.data(), copy.size()};
  }

  /// Keeps something for as long as the memory lives.
  void Hold(std::shared_ptr<const void> thing) { held.push_back(std::move(thing)); }

  /// The bytes given out so far.
  std::size_t Taken() const { return taken; }

 private:
  void* Take(std::size_t size, std::size_t alignment) {
    taken += size;
    return blocks.allocate(size, alignment);
  }

  std::size_t taken = 0;
  std::pmr::monotonic_buffer_resource blocks;
  std::vector<std::shared_ptr<const void>> held;
};

}  // namespace tessal
