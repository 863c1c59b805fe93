// The memory that a generated parser asks for while it runs: its stack, once it has grown, and long messages.
// The parse's owner holds it, so that an exception from an action or from the scanner loses none of it.
#pragma once

#include <cstddef>
#include <memory>
#include <vector>

namespace tessal {

class ParserMemory final {
 public:
  /// Raises `std::bad_alloc` when there is none: a parser that got no memory would take the input for too
  /// deeply nested.
  void* Take(std::size_t size) {
    blocks.push_back(std::make_unique_for_overwrite<std::max_align_t[]>(size / sizeof(std::max_align_t) + 1));
    return blocks.back().get();
  }

  void Release(const void* block) {
    std::erase_if(blocks, [block](const auto& taken) { return taken.get() == block; });
  }

 private:
  std::vector<std::unique_ptr<std::max_align_t[]>> blocks;
};

}  // namespace tessal
