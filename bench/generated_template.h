// Files of generated templates for the benchmarks.
#pragma once

#include <cstdint>
#include <filesystem>
#include <string>

namespace tessal::bench {

/// A folder for the files of a run, removed with the object.
class ScratchFolder final {
 public:
  ScratchFolder();
  ScratchFolder(const ScratchFolder&) = delete;
  ScratchFolder& operator=(const ScratchFolder&) = delete;
  ~ScratchFolder();

  std::string File(const std::string& name) const { return (path / name).string(); }

 private:
  std::filesystem::path path;
};

/// Writes a template file of about that many elements and returns its path: of 100 elements 6 are state
/// variables, 30 constants, 14 forcings, 25 auxiliaries and 25 processes, whose expressions use four symbols
/// each.
std::string FileOfSize(const ScratchFolder& folder, std::int64_t elements);

/// The same of a template that has constants alone.
std::string FileOfConstants(const ScratchFolder& folder, int count);

}  // namespace tessal::bench
