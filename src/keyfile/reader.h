// The reader that turns key-file text into an item tree, with its comments and positions. One read at a time.
#pragma once

#include <cstdint>
#include <memory>
#include <string>

namespace tessal {

class CKvfSectionItem;

/// Reads a file into a tree. 1 on success; on failure 0, with the target as it was, and `KeyFileFailureText`
/// says why.
int LoadKeyFileTree(const std::string& path, CKvfSectionItem& target);

/// The same from a text in memory, up to its first zero byte and without a UTF-8 byte order mark. The tree
/// keeps the text.
int ParseKeyFileTree(std::shared_ptr<const std::string> text, CKvfSectionItem& target);
int ParseKeyFileTree(std::string text, CKvfSectionItem& target);

/// Whether a tree can be read from a text without a byte order mark: 1, or 0 with the same failure texts.
int CheckKeyFileText(const std::string& text);

/// The size of a file in bytes; 0 when it cannot be opened.
std::uintmax_t KeyFileSize(const std::string& path);

/// Why the last read failed; empty after a good one.
const std::string& KeyFileFailureText();

}  // namespace tessal
