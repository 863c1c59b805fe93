// The tree that the handles and nodes of the key-file library refer to.
#pragma once

#include <deque>
#include <string>
#include <string_view>
#include <vector>

namespace tessal {

/// A target, section, keyword or parameter. A file owns all its items in one store, so that releasing deeply
/// nested ones does not recurse.
struct KvfItem {
  enum class Type { Root, Section, Keyword, Parameter };
  enum class Value { Integer, Real, Boolean, Quoted, Path };

  Type type = Type::Root;
  Value value = Value::Quoted;        ///< of a parameter
  int line = 0;                       ///< from 1; 0 for an item that was not read
  std::string text;                   ///< the name, or a parameter's text as written
  std::vector<KvfItem*> sections;     ///< sub-sections
  std::vector<KvfItem*> keywords;     ///< keywords, or a keyword's parameters
  std::vector<const KvfItem*> order;  ///< sections and keywords as they were added
};

/// One file image.
class KvfImage final {
 public:
  KvfImage() { items.emplace_back(); }
  KvfImage(const KvfImage&) = delete;
  KvfImage& operator=(const KvfImage&) = delete;

  KvfItem& Root() { return items.front(); }
  KvfItem& AddSection(KvfItem& parent, std::string_view name, int line);
  KvfItem& AddKeyword(KvfItem& section, std::string_view name, int line);
  void AddParameter(KvfItem& keyword, KvfItem::Value value, std::string text);

  // What an image under construction has open.
  std::vector<KvfItem*> openSections;
  KvfItem* openKeyword = nullptr;

 private:
  std::deque<KvfItem> items;
};

/// Where and near what a text stopped being key-file text.
struct KvfSyntaxError {
  int line = 0;      ///< from 1
  int position = 0;  ///< from 1, in its line
  std::string text;  ///< at most 40 bytes, one line
};

/// Reads a text that `KvfReadableText` has prepared. False, with the error filled in, when it is none.
bool ReadKvfImage(std::string_view text, KvfImage& image, KvfSyntaxError& error);

/// The text of an image: the library's header comment and all targets, with CRLF line ends.
std::string WriteKvfImage(KvfImage& image);

}  // namespace tessal
