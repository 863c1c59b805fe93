// A template file in a folder of the process, for fuzz targets.
#pragma once

#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>

#include "platform/file_replacement.h"

namespace tessal::fuzz {

/// Memory-backed where the system has it, and one for each process.
inline std::string ScratchFile(std::string_view name) {
  static const std::string kFolder = [] {
    std::string pattern = "/dev/shm/tessal-fuzz-XXXXXX";
    if (mkdtemp(pattern.data()) == nullptr) pattern = "/tmp";
    return pattern;
  }();
  return kFolder + "/" + std::string(name);
}

/// Takes the first line off a text.
inline std::string TakeLine(std::string_view& rest) {
  const std::size_t end = rest.find('\n');
  std::string line(rest.substr(0, end));
  rest = end == std::string_view::npos ? std::string_view() : rest.substr(end + 1);
  return line;
}

inline void Require(bool holds, const char* what) {
  if (holds) return;
  std::fprintf(stderr, "does not hold: %s\n", what);
  std::abort();
}

}  // namespace tessal::fuzz
