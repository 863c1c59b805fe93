#include "keyfile/item_tree.h"

#include <algorithm>
#include <array>
#include <utility>
#include <vector>

namespace tessal {

namespace {

constexpr std::array<std::string_view, 4> kKindTexts = {"undefined", "Comment", "Section", "Keyword"};
constexpr std::size_t kBlanksPerLevel = 3;

std::uint32_t SizeOf(std::string_view text) {
  return static_cast<std::uint32_t>(text.size());
}

/// A copy of a value whose text lies in a memory.
KvfValue CopyOf(const KvfValue& value, ItemMemory& memory) {
  return value.IsText() ? value.WithText(memory.Copy(value.AsString())) : value;
}

CKvfCommentItem& MakeComment(std::span<const std::string_view> lines, ItemMemory& memory) {
  CKvfCommentItem& block = memory.Make<CKvfCommentItem>();
  for (std::size_t place = lines.size(); place-- > 0;) {
    block.Prepend(memory.Copy(lines[place]), memory);
  }
  return block;
}

CKvfKeyItem& CopyKey(std::span<const KvfValue> values, ItemMemory& memory) {
  std::vector<KvfValue> copies;
  copies.reserve(values.size());
  for (const KvfValue& value : values) copies.push_back(CopyOf(value, memory));
  return CKvfKeyItem::Make(memory, copies);
}

}  // namespace

void CKvfBaseItem::SetName(std::string_view text) {
  name = text.data();
  nameSize = SizeOf(text);
}

void CKvfBaseItem::SetComment(std::string_view text) {
  comment = text.data();
  commentSize = SizeOf(text);
}

void CKvfBaseItem::SetPosition(std::int32_t itemLine, std::int32_t itemColumn) {
  line = itemLine;
  column = itemColumn;
}

void CKvfBaseItem::CopyFields(const CKvfBaseItem& source, ItemMemory& memory) {
  SetName(memory.Copy(source.Name()));
  SetComment(memory.Copy(source.Comment()));
  SetPosition(source.line, source.column);
  kind = source.kind;
}

void CKvfBaseItem::Clear() {
  if (kind == kSection) {
    auto& section = static_cast<CKvfSectionItem&>(*this);
    section.first = section.last = nullptr;
  } else if (kind == kKeyword) {
    static_cast<CKvfKeyItem&>(*this).valueCount = 0;
  } else if (kind == kComment) {
    static_cast<CKvfCommentItem&>(*this).first = nullptr;
  }
  kind = kNone;
  SetName({});
  SetComment({});
  SetPosition(0, 0);
  parent = nullptr;
  depth = 0;
  mark = kUnmatched;
}

void CKvfBaseItem::SetDepth(std::size_t newDepth) {
  PutDepth(newDepth);
  if (kind != kSection) return;
  for (CKvfBaseItem& child : static_cast<CKvfSectionItem&>(*this).Children()) child.SetDepth(newDepth + 1);
}

CKvfBaseItem& CKvfBaseItem::CopyAt(std::size_t copyDepth, ItemMemory& memory) const {
  CKvfBaseItem* copy = nullptr;
  if (kind == kKeyword) {
    copy = &CopyKey(static_cast<const CKvfKeyItem&>(*this).Values(), memory);
  } else if (kind == kComment) {
    std::vector<std::string_view> lines;
    for (const CommentLine* each = static_cast<const CKvfCommentItem&>(*this).first; each; each = each->next)
      lines.push_back(each->text);
    copy = &MakeComment(lines, memory);
  } else {
    auto& section = memory.Make<CKvfSectionItem>(memory);
    section.PutDepth(copyDepth);
    if (kind == kSection) section.CopyContent(static_cast<const CKvfSectionItem&>(*this));
    copy = &section;
  }
  copy->PutDepth(copyDepth);
  copy->CopyFields(*this, memory);
  copy->parent = parent;
  return *copy;
}

std::string CKvfBaseItem::Path() const {
  std::vector<const CKvfBaseItem*> way;
  for (const CKvfBaseItem* item = this; item->parent != nullptr; item = item->parent) way.push_back(item);
  std::string path;
  // NOLINTNEXTLINE(modernize-loop-convert)
  for (auto item = way.rbegin(); item != way.rend(); ++item) path.append(".").append((*item)->Name());
  return path;
}

std::string CKvfBaseItem::Describe() const {
  if (parent == nullptr) return "(root)";
  return std::string(kKindTexts.at(kind)) + " " + Path();
}

std::size_t CKvfBaseItem::IndentSize() const {
  return parent == nullptr || depth < 1 ? 0 : kBlanksPerLevel * (depth - 1);
}

void CKvfSectionItem::SetStartComment(std::string_view text) {
  startComment = text.data();
  startCommentSize = SizeOf(text);
}

void CKvfSectionItem::Receive(CKvfBaseItem& child) {
  child.parent = this;
  // A part of a tree has the right depths once its uppermost item has.
  if (child.depth != depth + 1) child.SetDepth(depth + 1U);
}

void CKvfSectionItem::AppendChild(CKvfBaseItem& child) {
  Receive(child);
  child.next = nullptr;
  (first == nullptr ? first : last->next) = &child;
  last = &child;
}

void CKvfSectionItem::PrependChild(CKvfBaseItem& child) {
  Receive(child);
  child.next = first;
  if (first == nullptr) last = &child;
  first = &child;
}

CKvfSectionItem& CKvfSectionItem::AppendSection(std::string_view childName) {
  auto& child = memory->Make<CKvfSectionItem>(*memory);
  child.SetName(memory->Copy(childName));
  AppendChild(child);
  return child;
}

CKvfKeyItem& CKvfSectionItem::AppendKey(std::string_view childName, std::span<const KvfValue> values) {
  CKvfKeyItem& child = CopyKey(values, *memory);
  child.SetName(memory->Copy(childName));
  AppendChild(child);
  return child;
}

CKvfCommentItem& CKvfSectionItem::AppendComment(std::span<const std::string_view> lines) {
  CKvfCommentItem& child = MakeComment(lines, *memory);
  AppendChild(child);
  return child;
}

void CKvfSectionItem::CopyContent(const CKvfSectionItem& source) {
  SetStartComment(memory->Copy(source.StartComment()));
  for (const CKvfBaseItem& child : source.Children()) AppendChild(child.CopyAt(depth + 1, *memory));
}

void CKvfSectionItem::Assign(const CKvfSectionItem& source) {
  if (&source == this) return;
  CopyFields(source, *memory);
  mark = source.mark;
  depth = 0;
  CopyContent(source);
}

void CKvfSectionItem::TakeOver(std::unique_ptr<CKvfItemTree> source) {
  const CKvfItemTree& root = *source;
  memory->Hold(std::move(source));
  kind = root.kind;
  mark = root.mark;
  depth = 0;
  SetName(root.Name());
  SetComment(root.Comment());
  SetPosition(root.Line(), root.Column());
  SetStartComment(root.StartComment());
  for (CKvfBaseItem* child = root.first; child != nullptr;) {
    CKvfBaseItem* const following = child->next;
    AppendChild(*child);
    child = following;
  }
}

std::size_t CKvfSectionItem::CountChildren(Kind childKind) const {
  return static_cast<std::size_t>(std::ranges::count(Children(), childKind, &CKvfBaseItem::ItemKind));
}

CKvfBaseItem* CKvfSectionItem::ChildByKind(std::size_t index, Kind childKind) const {
  for (CKvfBaseItem& child : Children()) {
    if (child.ItemKind() == childKind && index-- == 0) return &child;
  }
  return nullptr;
}

void CKvfSectionItem::SetMarks(Mark newMark) {
  SetMark(newMark);
  for (CKvfBaseItem& child : Children()) {
    if (child.ItemKind() == kSection) {
      static_cast<CKvfSectionItem&>(child).SetMarks(newMark);
    } else {
      child.SetMark(newMark);
    }
  }
}

}  // namespace tessal
