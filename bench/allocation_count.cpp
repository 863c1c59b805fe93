// Counts what a process asks the allocator of the C library for. Preloaded into the process, it adds to the
// counts in a file that it maps into memory, so that they are there however the process ends. What a program
// takes from the system by itself (mmap) is not counted.
#include "allocation_count.h"

#include <fcntl.h>
#include <sys/mman.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <cstddef>
#include <cstdlib>

// The allocator's own names for what is replaced here; no header declares them.
extern "C" {
void* __libc_malloc(std::size_t size);
void* __libc_calloc(std::size_t count, std::size_t size);
void* __libc_realloc(void* block, std::size_t size);
void* __libc_memalign(std::size_t alignment, std::size_t size);
}

namespace {

using tessal::bench::AllocationCounts;

// Allocations come before any constructor has run, so the counts begin here.
constinit AllocationCounts early;
constinit std::atomic<AllocationCounts*> counts{&early};

void Count(std::size_t bytes) {
  AllocationCounts& present = *counts.load(std::memory_order_relaxed);
  std::atomic_ref(present.calls).fetch_add(1, std::memory_order_relaxed);
  std::atomic_ref(present.bytes).fetch_add(bytes, std::memory_order_relaxed);
}

/// Moves the counts into the file. Without one they go nowhere.
[[gnu::constructor]] void MapCounts() {
  const char* path = std::getenv(tessal::bench::kAllocationFile);
  const int file = path == nullptr ? -1 : open(path, O_RDWR | O_CLOEXEC);
  if (file < 0) return;
  void* mapped = mmap(nullptr, sizeof(AllocationCounts), PROT_READ | PROT_WRITE, MAP_SHARED, file, 0);
  close(file);
  if (mapped == MAP_FAILED) return;
  auto* kept = static_cast<AllocationCounts*>(mapped);
  *kept = early;
  counts = kept;
}

}  // namespace

extern "C" {

void* malloc(std::size_t size) {
  Count(size);
  return __libc_malloc(size);
}

void* calloc(std::size_t count, std::size_t size) {
  Count(count * size);
  return __libc_calloc(count, size);
}

void* realloc(void* block, std::size_t size) {
  Count(size);
  return __libc_realloc(block, size);
}

void* memalign(std::size_t alignment, std::size_t size) {
  Count(size);
  return __libc_memalign(alignment, size);
}

void* aligned_alloc(std::size_t alignment, std::size_t size) {
  return memalign(alignment, size);
}

int posix_memalign(void** block, std::size_t alignment, std::size_t size) {
  *block = memalign(alignment, size);
  return *block == nullptr ? ENOMEM : 0;
}

}  // extern "C"
