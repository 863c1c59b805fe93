// Any text is read to a tree or refused with a message; what a tree writes reads back. Adjacent blocks of
// comments become one on the way; after that a tree always writes the same text.
#include <cstdint>
#include <cstdlib>
#include <sstream>
#include <string>

#include "keyfile/item_tree.h"
#include "keyfile/reader.h"

namespace {

void Require(bool holds) {
  if (!holds) std::abort();
}

/// A root without a comment before its first section needs the blank line that every file has there.
std::string Written(const tessal::CKvfSectionItem& tree) {
  std::ostringstream text;
  tree.Write(text);
  return "\n" + text.str();
}

bool StartsWithComment(const tessal::CKvfSectionItem& tree) {
  return !tree.Children().empty() && tree.Children().front().ItemKind() == tessal::CKvfBaseItem::kComment;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string text(reinterpret_cast<const char*>(data), size);
  tessal::CKvfItemTree tree;
  if (tessal::ParseKeyFileTree(text, tree) == 0) {
    Require(!tessal::KeyFileFailureText().empty() && tree.Children().empty());
    return 0;
  }
  tessal::CKvfItemTree copy;
  copy.Assign(tree);
  Require(tree.Compare(tree, nullptr, nullptr, false) || !tree.Children().empty());
  const std::string once = Written(copy);
  if (StartsWithComment(tree)) return 0;
  tessal::CKvfItemTree again;
  Require(tessal::ParseKeyFileTree(once, again) == 1);
  const std::string twice = Written(again);
  tessal::CKvfItemTree last;
  Require(tessal::ParseKeyFileTree(twice, last) == 1);
  Require(Written(last) == twice);
  return 0;
}
