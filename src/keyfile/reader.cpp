#include "keyfile/reader.h"

#include <limits>
#include <optional>
#include <string_view>
#include <utility>

#include "keyfile/item_tree.h"
#include "keyfile/keyfile_grammar.h"
#include "keyfile/scanner.h"
#include "keyfile/tree_builder.h"
#include "platform/file_replacement.h"
#include "platform/kvf_text.h"
#include "platform/lalr_parser.h"

namespace tessal {

namespace {

std::string& FailureText() {
  static std::string text;
  return text;
}

constexpr std::size_t kUndefinedToken = KeyFileGrammar::kTokenCount - 1;

constexpr std::string_view NameOf(KeyFileToken token) {
  return LalrSymbolName<KeyFileGrammar>(static_cast<std::size_t>(token));
}

// The scanner's tokens are the grammar's, in the same order.
static_assert(NameOf(KeyFileToken::End) == "$end" && NameOf(KeyFileToken::Identifier) == "IDENTIFIER" &&
              NameOf(KeyFileToken::Path) == "PATH_STRING" && NameOf(KeyFileToken::NewLine) == "NEWLINE" &&
              NameOf(KeyFileToken::Other) == "$undefined" &&
              static_cast<std::size_t>(KeyFileToken::Other) == kUndefinedToken);

/// Reads the text of a scan. The actions of the grammar's rules are those of `state`.
template <class State>
bool Runs(KeyFileScan& scan, State& state) {
  const auto pull = [&scan, &state](KeyFileGrammar::Value& value) {
    if (state.IsFull()) return kLalrStop;
    const KeyFileToken token = scan.Next();
    value.piece = scan.Piece();
    return static_cast<std::size_t>(token);
  };
  LalrOutcome outcome = RunLalr<KeyFileGrammar>(state, pull);
  if (outcome.end == LalrEnd::Accepted) return true;
  if (outcome.end == LalrEnd::Stopped) {
    FailureText() = "Error tree takes more than " + std::to_string(TreeBuilder::kMostTimes) +
                    " times the memory of its text";
    return false;
  }
  if (outcome.end == LalrEnd::TooDeep) outcome.words = "memory exhausted";
  FailureText() = "Error " + outcome.words + "in line " + std::to_string(scan.Line()) + ", column " +
                  std::to_string(scan.Column());
  return false;
}

/// The scanner counts in 32 bits, a bare line feed as two characters.
bool HasScannableSize(const std::string& text) {
  FailureText().clear();
  if (text.size() <= static_cast<std::size_t>(std::numeric_limits<std::int32_t>::max() / 2)) return true;
  FailureText() = "Error memory exhaustedin line 0, column 0";
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
  return ParseKeyFileTree(std::make_shared<const std::string>(std::move(text)), target);
}

int ParseKeyFileTree(std::shared_ptr<const std::string> text, CKvfSectionItem& target) {
  if (!HasScannableSize(*text)) return 0;
  KeyFileScan scan(text->c_str() + (text->starts_with(kByteOrderMark) ? kByteOrderMark.size() : 0));
  TreeBuilder builder(scan, text->size());
  if (!Runs(scan, builder)) return 0;
  std::unique_ptr<CKvfItemTree> tree = builder.Take();
  tree->Memory().Hold(std::move(text));
  target.TakeOver(std::move(tree));
  return 1;
}

int CheckKeyFileText(const std::string& text) {
  if (!HasScannableSize(text)) return 0;
  KeyFileScan scan(text.c_str());
  TreelessRead check;
  return Runs(scan, check) ? 1 : 0;
}

}  // namespace tessal
