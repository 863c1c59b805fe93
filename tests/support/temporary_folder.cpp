#include "support/temporary_folder.h"

#include <cstdlib>
#include <fstream>
#include <stdexcept>
#include <system_error>

namespace tessal::test {

TemporaryFolder::TemporaryFolder() {
  std::string pattern = (std::filesystem::temp_directory_path() / "tessal-test-XXXXXX").string();
  if (mkdtemp(pattern.data()) == nullptr) throw std::runtime_error("no temporary folder");
  path = pattern;
}

TemporaryFolder::~TemporaryFolder() {
  std::error_code ignored;
  std::filesystem::permissions(path, std::filesystem::perms::owner_all, ignored);
  std::filesystem::remove_all(path, ignored);
}

std::string TemporaryFolder::Write(std::string_view name, std::string_view content) const {
  std::ofstream(path / name, std::ios::binary) << content;
  return File(name);
}

std::string ReadFile(const std::string& path) {
  std::ifstream file(path, std::ios::binary | std::ios::ate);
  std::string content(file ? static_cast<std::size_t>(file.tellg()) : 0, '\0');
  file.seekg(0).read(content.data(), static_cast<std::streamsize>(content.size()));
  return content;
}

}  // namespace tessal::test
