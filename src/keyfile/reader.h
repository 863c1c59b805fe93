// The reader that turns key-file text into an item tree, with its comments and positions. One read at a time.
#pragma once

#include <cstdint>
#include <string>

namespace tessal {

class CKvfSectionItem;

/// Reads a file into a tree. 1 on success; on failure 0, with the target as it was, and `KeyFileFailureText`
/// says why.
int LoadKeyFileTree(const std::string& path, CKvfSectionItem& target);

/// The same from a text in memory.
int ParseKeyFileTree(std::string text, CKvfSectionItem& target);

/// Whether a tree can be read from a text that `KvfReadableText` has prepared: 1, or 0 with the same failure
/// texts. The text is as it was afterwards.
int CheckKeyFileText(std::string& readable);

/// The size of a file in bytes; 0 when it cannot be opened.
std::uintmax_t KeyFileSize(const std::string& path);

/// Why the last read failed; empty after a good one.
const std::string& KeyFileFailureText();

}  // namespace tessal
