// A key file as a tree of items: sections hold keywords, comments and further sections, in file order. The
// tree writes itself back as text and compares itself with another tree.
// Items lie in the memory of their tree, small and side by side. They are made through their section, never
// move, and go with the tree; all their texts are views.
#pragma once

#include <cstddef>
#include <cstdint>
#include <iosfwd>
#include <iterator>
#include <memory>
#include <set>
#include <span>
#include <string>
#include <string_view>

#include "keyfile/item_memory.h"
#include "keyfile/kvf_value.h"

namespace tessal {

class CKvfItemTree;
class CKvfKeyItem;
class CKvfCommentItem;
class CKvfSectionItem;

/// Regular expressions for the names that a comparison leaves out.
using IgnoredNames = std::set<std::string>;

/// A longer expression is refused as a faulty one: reading it recurses along it.
inline constexpr std::size_t kLongestIgnoredName = 1000;

/// What an item does depends on its kind; an item of no kind does nothing and equals nothing.
class CKvfBaseItem {
 public:
  enum Kind : std::uint8_t { kNone = 0, kComment = 1, kSection = 2, kKeyword = 3 };
  enum Mark : std::uint8_t { kUnmatched = 0, kDifferent = 1, kSame = 2, kIgnored = 3 };

  CKvfBaseItem(const CKvfBaseItem&) = delete;
  CKvfBaseItem& operator=(const CKvfBaseItem&) = delete;

  /// Gives the item a depth, and all below it theirs.
  void SetDepth(std::size_t newDepth);
  /// Whether the items are equal; differences go to the report, where there is one. All comments are equal. A
  /// faulty regular expression among the ignored names raises `std::regex_error`.
  bool Compare(CKvfBaseItem& other, std::ostream* report, const IgnoredNames* ignoreNames, bool onlyKeywords);
  void Write(std::ostream& stream) const;
  /// Appends what is written.
  void AppendTo(std::string& text) const;
  /// Empties the item, which is of no kind from then on; taking another's fields gives a section its kind
  /// back. The start comment of a section stays.
  void Clear();
  /// A copy in a memory, with the parent of its source and depth 0. Its texts are copies too.
  CKvfBaseItem& Copy(ItemMemory& memory) const { return CopyAt(0, memory); }

  Kind ItemKind() const { return kind; }
  /// The names from the top, a point before each; the root gives the empty text.
  std::string Path() const;
  /// The kind's word and the path; "(root)" for the root.
  std::string Describe() const;
  /// Three blanks for each level below the top-level sections.
  std::string Indent() const { return std::string(IndentSize(), ' '); }
  std::size_t IndentSize() const;

  /// Empty for a comment.
  std::string_view Name() const { return {name, nameSize}; }
  /// After a keyword, or after a section's end.
  std::string_view Comment() const { return {comment, commentSize}; }
  /// None for the root.
  CKvfSectionItem* Parent() const { return parent; }
  /// Root 0; a child is its parent's plus one.
  std::size_t Depth() const { return depth; }
  Mark ComparisonMark() const { return mark; }
  /// From 0, as the reader counted when the item was complete.
  std::int32_t Line() const { return line; }
  std::int32_t Column() const { return column; }

  // The texts must live as long as the tree (`ItemMemory::Copy`).
  void SetName(std::string_view text);
  void SetComment(std::string_view text);
  void SetPosition(std::int32_t itemLine, std::int32_t itemColumn);
  void SetMark(Mark newMark) { mark = newMark; }

 protected:
  explicit CKvfBaseItem(Kind itemKind) : kind(itemKind) {}
  ~CKvfBaseItem() = default;

  /// A copy with a depth.
  CKvfBaseItem& CopyAt(std::size_t copyDepth, ItemMemory& memory) const;
  /// Takes kind, name, comment and position of another item, with copies of the texts.
  void CopyFields(const CKvfBaseItem& source, ItemMemory& memory);

 private:
  friend class CKvfSectionItem;
  friend class ItemIterator;

  static constexpr unsigned kDepthBits = 28;

  /// Gives the item alone a depth.
  void PutDepth(std::size_t value) { depth = static_cast<std::uint32_t>(value) & ((1U << kDepthBits) - 1); }

  CKvfBaseItem* next = nullptr;  ///< of the same section
  CKvfSectionItem* parent = nullptr;
  const char* name = nullptr;
  const char* comment = nullptr;
  std::uint32_t nameSize = 0;
  std::uint32_t commentSize = 0;
  std::int32_t line = 0;
  std::int32_t column = 0;
  std::uint32_t depth : kDepthBits = 0;
  Kind kind : 2;
  Mark mark : 2 = kUnmatched;
};

class ItemIterator final {
 public:
  using value_type = CKvfBaseItem;
  using difference_type = std::ptrdiff_t;

  ItemIterator() = default;
  explicit ItemIterator(CKvfBaseItem* first) : item(first) {}
  CKvfBaseItem& operator*() const { return *item; }
  CKvfBaseItem* operator->() const { return item; }
  ItemIterator& operator++() {
    item = item->next;
    return *this;
  }
  ItemIterator operator++(int) {
    const ItemIterator former = *this;
    ++*this;
    return former;
  }
  friend bool operator==(const ItemIterator&, const ItemIterator&) = default;

 private:
  CKvfBaseItem* item = nullptr;
};

/// The children of a section, in file order.
class ItemRange final {
 public:
  explicit ItemRange(CKvfBaseItem* firstChild) : first(firstChild) {}
  ItemIterator begin() const { return first; }
  static ItemIterator end() { return {}; }
  bool empty() const { return first == end(); }
  CKvfBaseItem& front() const { return *first; }

 private:
  ItemIterator first;
};

/// A line of a comment, without the leading "//".
struct CommentLine {
  std::string_view text;
  const CommentLine* next;
};

/// A block of adjacent comment lines.
class CKvfCommentItem final : public CKvfBaseItem {
 public:
  CKvfCommentItem() : CKvfBaseItem(kComment) {}

  /// The first of the lines; none for an empty block.
  const CommentLine* FirstLine() const { return first; }
  /// Puts a line before the others. Its text must live as long as the tree.
  void Prepend(std::string_view text, ItemMemory& memory) {
    first = &memory.Make<CommentLine>(CommentLine{text, first});
  }

 private:
  friend class CKvfBaseItem;

  const CommentLine* first = nullptr;
};

class CKvfKeyItem final : public CKvfBaseItem {
 public:
  /// A keyword with its values after it in a memory.
  static CKvfKeyItem& Make(ItemMemory& memory, std::span<const KvfValue> values) {
    return memory.MakeBefore<CKvfKeyItem>(values, values.size());
  }

  std::span<const KvfValue> Values() const {
    return {reinterpret_cast<const KvfValue*>(this + 1), valueCount};
  }

 private:
  friend class CKvfBaseItem;
  friend class ItemMemory;

  explicit CKvfKeyItem(std::size_t count)
      : CKvfBaseItem(kKeyword), valueCount(static_cast<std::uint32_t>(count)) {}

  std::uint32_t valueCount;
};

class CKvfSectionItem : public CKvfBaseItem {
 public:
  /// An empty section, what is below which lies in a memory.
  explicit CKvfSectionItem(ItemMemory& treeMemory) : CKvfBaseItem(kSection), memory(&treeMemory) {}

  ItemRange Children() const { return ItemRange(first); }
  std::size_t CountChildren(Kind childKind) const;
  /// The child with that place from 0 among those of its kind, or none.
  CKvfBaseItem* ChildByKind(std::size_t index, Kind childKind) const;

  /// Takes an item of the section's memory in, and gives it its parent and depth.
  void AppendChild(CKvfBaseItem& child);
  void PrependChild(CKvfBaseItem& child);
  // A new child with copies of the texts.
  CKvfSectionItem& AppendSection(std::string_view childName);
  CKvfKeyItem& AppendKey(std::string_view childName, std::span<const KvfValue> values);
  CKvfCommentItem& AppendComment(std::span<const std::string_view> lines);
  /// Takes the fields of a tree's root and, after the present children, its children themselves. Their memory
  /// goes with this section's.
  void TakeOver(std::unique_ptr<CKvfItemTree> source);
  /// Takes the fields of another section and, after the present children, copies of its children.
  void Assign(const CKvfSectionItem& source);

  /// Marks the section and everything below it.
  void SetMarks(Mark newMark);

  /// On the head line.
  std::string_view StartComment() const { return {startComment, startCommentSize}; }
  /// The text must live as long as the tree.
  void SetStartComment(std::string_view text);

 private:
  friend class CKvfBaseItem;

  /// Takes copies of the start comment and the children of another section.
  void CopyContent(const CKvfSectionItem& source);
  /// Puts a child in its place as far as its depth.
  void Receive(CKvfBaseItem& child);

  std::uint32_t startCommentSize = 0;
  const char* startComment = nullptr;
  CKvfBaseItem* first = nullptr;
  CKvfBaseItem* last = nullptr;
  ItemMemory* memory;
};

static_assert(sizeof(CKvfKeyItem) == 56 && sizeof(KvfValue) == 16, "most of a tree");

/// A root that owns the memory of everything below it.
class CKvfItemTree final : public CKvfSectionItem {
 public:
  explicit CKvfItemTree(std::size_t firstBlock = 1024) : CKvfSectionItem(own), own(firstBlock) {}

  ItemMemory& Memory() { return own; }

 private:
  ItemMemory own;
};

}  // namespace tessal
