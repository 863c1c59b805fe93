#include "keyfile/reader.h"

#include <limits>
#include <system_error>
#include <utility>

#include "keyfile/item_tree.h"
#include "keyfile/keyfile_grammar.h"
#include "keyfile/read_state.h"
#include "platform/file_replacement.h"
#include "platform/kvf_text.h"

namespace tessal {

namespace {

std::string& FailureText() {
  static std::string text;
  return text;
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
  const std::optional<std::string> text = ReadWholeFile(path, failure);
  if (!text) {
    FailureText() = "Error opening file '" + path + "'!";
    return 0;
  }
  return ParseKeyFileTree(*text, target);
}

int ParseKeyFileTree(const std::string& text, CKvfSectionItem& target) {
  FailureText().clear();
  std::string readable = KvfReadableText(text);
  if (readable.size() > static_cast<std::size_t>(std::numeric_limits<std::int32_t>::max() / 2)) {
    FailureText() = "Error memory exhaustedin line 0, column 0";
    return 0;
  }
  ReadState state(std::move(readable));
  if (tessal_keyfile_grammar_parse(state) != 0 || !state.Root()) {
    FailureText() = "Error " + state.Message() + "in line " + std::to_string(state.Line()) + ", column " +
                    std::to_string(state.Column());
    return 0;
  }
  target.TakeOver(*state.Root());
  return 1;
}

}  // namespace tessal
