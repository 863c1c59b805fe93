// The tree that the handles and nodes of the key-file library refer to.
#pragma once

#include <deque>
#include <string>
#include <string_view>
#include <vector>

#include "platform/kvf2004.h"

namespace tessal {

/// A target, section, keyword or parameter. A file owns all its items in one store, so that releasing deeply
/// nested ones does not recurse.
struct KvfItem {
  enum class Type { Root, Section, Keyword, Parameter };
  enum class Value { Integer, Real, Boolean, Quoted, Path };

  Type type = Type::Root;
  Value value = Value::Quoted;  ///< of a parameter
  /// Whether somebody has read the parameter, or asked for the section. Reading changes nothing else.
  mutable bool wasRead = false;
  int line = 0;                       ///< from 1; 0 for an item that was not read
  std::string text;                   ///< the name, or a parameter's text as written
  std::vector<KvfItem*> sections;     ///< sub-sections
  std::vector<KvfItem*> keywords;     ///< keywords, or a keyword's parameters
  std::vector<const KvfItem*> order;  ///< sections and keywords as they were added
};

/// A comment of a file that was read. It has no place among the items.
struct KvfComment {
  int line;           ///< from 1
  std::size_t start;  ///< in the text, after the slashes
  std::size_t size;
};

/// The part of the text that a top-level section takes, from the start of its first line to that of the line
/// after its last.
struct KvfSpan {
  const KvfItem* section;
  std::size_t start;
  std::size_t end;
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

  // What an image that was read comes from.
  std::string source;
  std::size_t bytesCut = 0;  ///< after a zero byte, which ends the text
  std::vector<KvfSpan> targets;
  std::vector<KvfComment> comments;

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

/// Reads the image's source, which `KvfReadableText` has prepared. False, with the error filled in, when it
/// is no key-file text.
bool ReadKvfImage(KvfImage& image, KvfSyntaxError& error);

/// What is in the source beside one of its top-level sections, from the first section on, without blank lines
/// at the ends.
std::string KvfTextBeside(const KvfImage& image, const KvfItem* section);

/// The comments in the head of the source and inside a top-level section, without those that the library
/// writes itself.
std::vector<KvfRemark> KvfRemarksOf(const KvfImage& image, const KvfItem* section);

/// Appends a keyword with its values, as `kvfWrite` writes them but for the line end.
void AppendKvfKeyword(const KvfItem& keyword, std::string& text);

/// The text of an image: the library's header comment and all targets, with CRLF line ends.
std::string WriteKvfImage(KvfImage& image);

}  // namespace tessal
