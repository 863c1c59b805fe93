// Whole files: reading them, writing them, and putting a new one in the place of an old one so that nobody
// ever sees half of it. Every failure is reported in words.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "platform/text_source.h"

namespace tessal {

/// No file is read that has more bytes: places in it are counted in 32 bits.
inline constexpr std::uintmax_t kLargestFile = 1'000'000'000;

/// Reads a whole file. Nothing, with the reason in `failure`, when that fails; for one that is too large
/// `errno` is EFBIG.
std::optional<std::string> ReadWholeFile(const std::string& path, std::string& failure);

/// The size in bytes; 0 for a file that cannot be opened.
std::uintmax_t FileSize(const std::string& path);

/// Writes a new file that only its owner may read, for what others shall not see half-done. It takes the
/// place of a file or a link of that name in one step; what the link led to stays, and so does the file when
/// the writing fails. Returns the empty text, or the reason in words.
std::string WriteFreshFile(const std::string& path, std::string_view content);

/// Writes the content of a document into a new file beside the target and, when every byte is on disk, lets
/// it take the target's place in one step. The target's permissions stay, and a symbolic link stays a link to
/// the file that is replaced or made. A file with several names (hard links) is refused: its other names
/// would keep the old content. What killed replacements of the same target have left is removed. Returns the
/// empty text, or the reason in words. The old file is then whole, or, where only the folder could not be
/// flushed, the new one is.
std::string ReplaceFile(const std::string& target, std::string_view content);
std::string ReplaceFile(const std::string& target, const TextSource& content);

/// The same for what is made from a document. It is never written through a symbolic link, which is refused,
/// nor into the other names of a file, which keep the old content. A pipe, a terminal or a device of that
/// kind, by a link too, has no content that could be lost and is written as it is.
std::string WriteOutputFile(const std::string& path, std::string_view content);

/// The same for a content that is made while it is written.
std::string WriteOutputFile(const std::string& path, const TextSource& content);

/// Whether the path leads to a pipe, a terminal or a device of that kind.
bool IsStream(const std::string& path);

/// Removes a file. Returns the empty text, or the reason in words.
std::string RemoveFile(const std::string& path);

}  // namespace tessal
