// A key file as a tree of items: sections hold keywords, comments and further sections, in file order. The
// tree writes itself back as text and compares itself with another tree.
#pragma once

#include <cstddef>
#include <cstdint>
#include <iosfwd>
#include <memory>
#include <set>
#include <string>
#include <vector>

#include "keyfile/kvf_value.h"

namespace tessal {

class CKvfSectionItem;

/// Regular expressions for the names that a comparison leaves out.
using IgnoredNames = std::set<std::string>;

/// A longer expression is refused as a faulty one: reading it recurses along it.
inline constexpr std::size_t kLongestIgnoredName = 1000;

class CKvfBaseItem {
 public:
  enum Kind : std::int32_t { kNone = 0, kComment = 1, kSection = 2, kKeyword = 3 };
  enum Mark : std::int32_t { kUnmatched = 0, kDifferent = 1, kSame = 2, kIgnored = 3 };

  CKvfBaseItem() = default;
  CKvfBaseItem& operator=(const CKvfBaseItem&) = delete;
  virtual ~CKvfBaseItem() = default;

  virtual void SetDepth(std::size_t newDepth) { depth = newDepth; }
  /// Whether the items are equal; differences go to the report, where there is one. A faulty regular
  /// expression among the ignored names raises `std::regex_error`.
  virtual bool Compare(CKvfBaseItem& other, std::ostream* report, const IgnoredNames* ignoreNames,
                       bool onlyKeywords);
  virtual void Write(std::ostream& stream) const;
  /// Empties the item, which is of no kind from then on; taking another's fields gives a section its kind
  /// back.
  virtual void Clear();
  /// A copy with the parent of its source and depth 0.
  virtual std::unique_ptr<CKvfBaseItem> Copy() const = 0;

  Kind ItemKind() const { return kind; }
  /// The names from the top, a point before each; the root gives the empty text.
  std::string Path() const;
  /// The kind's word and the path; "(root)" for the root.
  std::string Describe() const;
  /// Three blanks for each level below the top-level sections.
  std::string Indent() const;

  std::string name;                   ///< empty for a comment
  std::string comment;                ///< after a keyword, or after a section's end
  CKvfSectionItem* parent = nullptr;  ///< none for the root
  std::size_t depth = 0;              ///< root 0; a child is its parent's plus one
  Mark mark = kUnmatched;
  std::int32_t line = 0;  ///< from 0, as the reader counted when the item was complete
  std::int32_t column = 0;

 protected:
  explicit CKvfBaseItem(Kind itemKind) : kind(itemKind) {}
  CKvfBaseItem(const CKvfBaseItem& source);

  Kind kind = kNone;
};

/// A block of adjacent comment lines.
class CKvfCommentItem final : public CKvfBaseItem {
 public:
  CKvfCommentItem() : CKvfBaseItem(kComment) {}
  CKvfCommentItem(const CKvfCommentItem& source) = default;

  /// All comments compare as equal.
  bool Compare(CKvfBaseItem& other, std::ostream* report, const IgnoredNames* ignoreNames,
               bool onlyKeywords) override;
  void Write(std::ostream& stream) const override;
  void Clear() override;
  std::unique_ptr<CKvfBaseItem> Copy() const override { return std::make_unique<CKvfCommentItem>(*this); }

  std::vector<std::string> lines;  ///< without the leading "//"
};

class CKvfKeyItem final : public CKvfBaseItem {
 public:
  CKvfKeyItem() : CKvfBaseItem(kKeyword) {}
  CKvfKeyItem(const CKvfKeyItem& source) = default;

  bool Compare(CKvfBaseItem& other, std::ostream* report, const IgnoredNames* ignoreNames,
               bool onlyKeywords) override;
  void Write(std::ostream& stream) const override;
  void Clear() override;
  std::unique_ptr<CKvfBaseItem> Copy() const override { return std::make_unique<CKvfKeyItem>(*this); }

  std::vector<KvfValue> values;
};

class CKvfSectionItem final : public CKvfBaseItem {
 public:
  CKvfSectionItem() : CKvfBaseItem(kSection) {}
  CKvfSectionItem(const CKvfSectionItem& source);

  void SetDepth(std::size_t newDepth) override;
  bool Compare(CKvfBaseItem& other, std::ostream* report, const IgnoredNames* ignoreNames,
               bool onlyKeywords) override;
  void Write(std::ostream& stream) const override;
  /// Leaves the start comment.
  void Clear() override;
  std::unique_ptr<CKvfBaseItem> Copy() const override { return std::make_unique<CKvfSectionItem>(*this); }

  const std::vector<std::unique_ptr<CKvfBaseItem>>& Children() const { return children; }
  /// Takes an item in, and gives it its parent and depth.
  void AppendChild(std::unique_ptr<CKvfBaseItem> child);
  /// Takes an item in under construction: its depth is set later, with that of the whole tree.
  void AdoptChild(std::unique_ptr<CKvfBaseItem> child);
  /// Takes the fields of another section and, after the present children, its children themselves.
  void TakeOver(CKvfSectionItem& source);
  std::size_t CountChildren(Kind childKind) const;
  /// The child with that place from 0 among those of its kind, or none.
  CKvfBaseItem* ChildByKind(std::size_t index, Kind childKind) const;
  /// Marks the section and everything below it.
  void SetMarks(Mark newMark);
  /// Takes the fields of another section and, after the present children, copies of its children.
  void Assign(const CKvfSectionItem& source);

  std::string startComment;  ///< on the head line

 private:
  class Comparison;

  void CopyFields(const CKvfSectionItem& source);
  void CopyChildren(const CKvfSectionItem& source);
  void ReportDifferences(std::ostream& report, int side, bool onlyKeywords) const;

  std::vector<std::unique_ptr<CKvfBaseItem>> children;
};

}  // namespace tessal
