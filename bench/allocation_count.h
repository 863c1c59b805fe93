// How the library that counts allocations reports to who has it preloaded into a process.
#pragma once

#include <cstdint>

namespace tessal::bench {

/// The environment variable with the path of the file that holds the counts; the file has their size already.
inline constexpr const char* kAllocationFile = "TESSAL_ALLOCATION_FILE";

struct AllocationCounts {
  std::uint64_t calls = 0;  ///< of malloc, calloc, realloc and what aligns; operator new calls malloc
  std::uint64_t bytes = 0;  ///< asked for
};

}  // namespace tessal::bench
