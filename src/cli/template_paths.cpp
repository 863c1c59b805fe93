#include "cli/template_paths.h"

#include <algorithm>
#include <filesystem>
#include <system_error>

#include "cli/output.h"
#include "core/template_core.h"

namespace tessal::cli {

namespace {

constexpr const char* kExtension = ".tessal";

/// Appends the templates of a folder; the reason when it could not be read.
std::error_code AppendTemplates(const std::string& folder, std::vector<std::string>& files) {
  std::error_code failure;
  const auto first = static_cast<std::ptrdiff_t>(files.size());
  std::filesystem::recursive_directory_iterator entry(folder, failure);
  for (; !failure && entry != std::filesystem::recursive_directory_iterator(); entry.increment(failure)) {
    // What is no file at all, such as a link to nothing, is a fault of the load, and not passed over.
    std::error_code noFolder;
    if (entry->path().extension() == kExtension && !entry->is_directory(noFolder)) {
      files.push_back(entry->path().string());
    }
  }
  std::sort(files.begin() + first, files.end());
  return failure;
}

}  // namespace

std::optional<std::vector<std::string>> FilesOf(const std::vector<std::string>& paths) {
  std::vector<std::string> files;
  for (const std::string& path : paths) {
    std::error_code noFolder;
    if (path == kStandardInput || !std::filesystem::is_directory(path, noFolder)) {
      files.push_back(path);
      continue;
    }
    const std::size_t before = files.size();
    const std::error_code failure = AppendTemplates(path, files);
    if (!failure && files.size() > before) continue;
    Complain("'" + path + "': " +
             (failure ? failure.message() : std::string("no file *") + kExtension + " in the folder"));
    return std::nullopt;
  }
  return files;
}

bool LoadPath(TemplateCore& core, const std::string& path) {
  return path == kStandardInput ? core.LoadText(ReadStandardInput()) : core.LoadWrapper(path);
}

}  // namespace tessal::cli
