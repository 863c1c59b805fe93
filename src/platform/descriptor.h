// An open file descriptor.
#pragma once

#include <unistd.h>

#include <string_view>
#include <utility>

namespace tessal {

/// Owns a descriptor; a negative number is none. Closing a written file is a step that can fail, so a writer
/// closes it and asks.
class Descriptor final {
 public:
  Descriptor() = default;
  explicit Descriptor(int number) : descriptor(number) {}
  Descriptor(const Descriptor&) = delete;
  Descriptor& operator=(const Descriptor&) = delete;
  Descriptor(Descriptor&& other) noexcept : descriptor(std::exchange(other.descriptor, -1)) {}
  Descriptor& operator=(Descriptor&& other) noexcept {
    std::swap(descriptor, other.descriptor);
    return *this;
  }
  ~Descriptor() {
    if (descriptor >= 0) close(descriptor);
  }

  bool IsOpen() const { return descriptor >= 0; }
  int Number() const { return descriptor; }
  bool Close() { return close(std::exchange(descriptor, -1)) == 0; }

 private:
  int descriptor = -1;
};

/// Writes everything. False, with the cause in `errno`, when not every byte was taken.
bool WriteAll(int descriptor, std::string_view content);

}  // namespace tessal
