#include "keyfile/reader.h"

#include <limits>
#include <utility>

#include "keyfile/item_tree.h"
#include "keyfile/keyfile_grammar.h"
#include "keyfile/tree_builder.h"
#include "platform/file_replacement.h"
#include "platform/kvf_text.h"

namespace tessal {

namespace {

std::string& FailureText() {
  static std::string text;
  return text;
}

/// The scanner counts in 32 bits.
bool HasScannableSize(const std::string& readable) {
  FailureText().clear();
  if (readable.size() <= static_cast<std::size_t>(std::numeric_limits<std::int32_t>::max() / 2)) return true;
  FailureText() = "Error memory exhaustedin line 0, column 0";
  return false;
}

bool Runs(ReadState& state) {
  if (tessal_keyfile_grammar_parse(state) == 0) return true;
  FailureText() = "Error " + state.Message() + "in line " + std::to_string(state.Line()) + ", column " +
                  std::to_string(state.Column());
  return false;
}

}  // namespace

const std::string& KeyFileFailureText() {
  return FailureText();
}

std::uintmax_t KeyFileSize(const std::string& path) {
  return FileSize(path);
}

int LoadKeyFileTree(const std::string& path, CKvfSectionItem& target) {
  FailureText().clear();
  if (KeyFileSize(path) == 0) {
    FailureText() = "File '" + path + "'not found!";
    return 0;
  }
  std::string failure;
  std::optional<std::string> text = ReadWholeFile(path, failure);
  if (!text) {
    FailureText() = "Error opening file '" + path + "'!";
    return 0;
  }
  return ParseKeyFileTree(*std::move(text), target);
}

int ParseKeyFileTree(std::string text, CKvfSectionItem& target) {
  std::string readable = KvfReadableText(std::move(text));
  if (!HasScannableSize(readable)) return 0;
  TreeBuilder builder(readable);
  if (!Runs(builder)) {
    if (builder.IsFull()) {
      FailureText() = "Error tree takes more than " + std::to_string(TreeBuilder::kMostTimes) +
                      " times the memory of its text";
    }
    return 0;
  }
  target.TakeOver(*builder.Root());
  return 1;
}

int CheckKeyFileText(std::string& readable) {
  if (!HasScannableSize(readable)) return 0;
  ReadState check(readable);
  return Runs(check) ? 1 : 0;
}

}  // namespace tessal
