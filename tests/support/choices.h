// The fuzzer's bytes as choices: each takes one byte, and 0 when none is left.
#pragma once

#include <cstddef>
#include <cstdint>

namespace tessal::fuzz {

class Choices final {
 public:
  Choices(const std::uint8_t* bytes, std::size_t count) : data(bytes), left(count) {}

  bool Done() const { return left == 0; }
  /// A number below the count, which is at most 256.
  std::size_t Pick(std::size_t count) {
    if (left == 0 || count == 0) return 0;
    --left;
    return *data++ % count;
  }
  /// The same for counts up to 65536, from two bytes.
  std::size_t PickOfMany(std::size_t count) {
    constexpr std::size_t kByte = 256;
    const std::size_t high = Pick(kByte);
    return count == 0 ? 0 : (high * kByte + Pick(kByte)) % count;
  }
  template <class Values>
  const auto& AnyOf(const Values& values) {
    return values[Pick(values.size())];
  }

 private:
  const std::uint8_t* data;
  std::size_t left;
};

}  // namespace tessal::fuzz
