// A folder that a test may fill, and that goes with it.
#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace tessal::test {

class TemporaryFolder final {
 public:
  TemporaryFolder();
  TemporaryFolder(const TemporaryFolder&) = delete;
  TemporaryFolder& operator=(const TemporaryFolder&) = delete;
  ~TemporaryFolder();

  const std::filesystem::path& Path() const { return path; }
  /// The path of a file in the folder, made with the content when one is given.
  std::string File(std::string_view name) const { return (path / name).string(); }
  std::string Write(std::string_view name, std::string_view content) const;

 private:
  std::filesystem::path path;
};

std::string ReadFile(const std::string& path);

}  // namespace tessal::test
