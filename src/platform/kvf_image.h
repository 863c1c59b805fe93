// A key file that was read, as the handles and nodes of the key-file library refer to it. Names and texts are
// views into the text of the file, and all items lie in one arena, so that a file of a million elements costs
// few bytes an item and is released in one go.
#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <memory_resource>
#include <span>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/kvf2004.h"

namespace tessal {

/// What every node is: a section, a keyword or a parameter, with its name or its text as written.
struct KvfItem {
  enum class Type : std::uint8_t { Section, Keyword, Parameter };
  enum class Value : std::uint8_t { Integer, Real, Boolean, Quoted, Path };

  KvfItem(Type itemType, std::string_view itemText)
      : start(itemText.data()), size(static_cast<std::uint32_t>(itemText.size())), type(itemType) {}

  std::string_view Text() const { return {start, size}; }

  const char* start;
  std::uint32_t size;
  Type type;
  Value value = Value::Quoted;  ///< of a parameter
  /// Whether somebody has read the parameter, or asked for the section. Reading changes nothing else.
  mutable bool wasRead = false;
};

/// A section or a keyword: what has a line of its own and a place among others.
struct KvfEntry : KvfItem {
  KvfEntry(Type entryType, std::string_view name, int entryLine)
      : KvfItem(entryType, name), line(entryLine) {}

  int line;                 ///< from 1; 0 for the root
  std::uint32_t count = 0;  ///< of a section its sub-sections, of a keyword its parameters
  const KvfEntry* next = nullptr;
};

struct KvfKeyword final : KvfEntry {
  KvfKeyword(std::string_view name, int keywordLine) : KvfEntry(Type::Keyword, name, keywordLine) {}

  std::span<const KvfItem> Parameters() const { return {parameters, count}; }

  const KvfItem* parameters = nullptr;
};

struct KvfSection final : KvfEntry {
  KvfSection(std::string_view name, int sectionLine) : KvfEntry(Type::Section, name, sectionLine) {}

  const KvfEntry* first = nullptr;  ///< of its keywords and sub-sections, in the order of the file
};

/// A comment of a file. It has no place among the items.
struct KvfComment {
  int line;             ///< from 1
  std::uint32_t start;  ///< in the text, after the slashes
  std::uint32_t size;
};

/// The part of the text that a top-level section takes, from the start of its first line to that of the line
/// after its last.
struct KvfSpan {
  const KvfSection* section;
  std::size_t start;
  std::size_t end;
};

class KvfImage final {
 public:
  /// Of a text that `KvfReadableText` has prepared.
  explicit KvfImage(std::string readableText) : source(std::move(readableText)) {}
  KvfImage(const KvfImage&) = delete;
  KvfImage& operator=(const KvfImage&) = delete;

  std::string source;
  std::size_t bytesCut = 0;  ///< after a zero byte, which ends the text
  std::pmr::monotonic_buffer_resource arena;
  KvfSection root{"", 0};
  std::vector<KvfSpan> targets;
  std::deque<KvfComment> comments;
};

/// Where and near what a text stopped being key-file text.
struct KvfSyntaxError {
  int line = 0;      ///< from 1
  int position = 0;  ///< from 1, in its line
  std::string text;  ///< at most 40 bytes, one line
};

/// Fills an image from its source. False, with the error filled in, when that is no key-file text.
bool ReadKvfImage(KvfImage& image, KvfSyntaxError& error);

/// What is in the source beside one of its top-level sections, from the first section on, without blank lines
/// at the ends.
std::string KvfTextBeside(const KvfImage& image, const KvfItem* section);

/// Visits the comments in the head of the source and inside a top-level section, without those that the
/// library writes itself.
void ForEachKvfRemark(const KvfImage& image, const KvfItem* section,
                      const std::function<void(const KvfRemark&)>& visit);

}  // namespace tessal
