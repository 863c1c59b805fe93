// What the paths of a call mean: a file, all templates of a folder, or standard input.
#pragma once

#include <optional>
#include <string>
#include <vector>

namespace tessal {
class TemplateCore;
}

namespace tessal::cli {

/// The path that is standard input.
inline constexpr const char* kStandardInput = "-";

/// The files of the paths, in their order: for a folder those in it and below it whose names end in
/// ".tessal", sorted. None, with the reason on standard error, when a folder can not be read or has no
/// template.
std::optional<std::vector<std::string>> FilesOf(const std::vector<std::string>& paths);

/// Loads a file as the editor does, or what standard input holds. False when it could not be loaded; the
/// registry then has the reasons.
bool LoadPath(TemplateCore& core, const std::string& path);

}  // namespace tessal::cli
