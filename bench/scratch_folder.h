// A folder for the files of a run.
#pragma once

#include <filesystem>
#include <string>

namespace tessal::bench {

/// Lies in the folder for temporary files and is removed with the object.
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

}  // namespace tessal::bench
