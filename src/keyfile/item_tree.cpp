#include "keyfile/item_tree.h"

#include <algorithm>
#include <array>
#include <ostream>
#include <utility>

namespace tessal {

namespace {

constexpr std::array<std::string_view, 4> kKindTexts = {"undefined", "Comment", "Section", "Keyword"};
constexpr std::size_t kBlanksPerLevel = 3;

}  // namespace

CKvfBaseItem::CKvfBaseItem(const CKvfBaseItem& source)
    : name(source.name),
      comment(source.comment),
      parent(source.parent),
      line(source.line),
      column(source.column),
      kind(source.kind) {}

bool CKvfBaseItem::Compare(CKvfBaseItem& /*other*/, std::ostream* /*report*/,
                           const IgnoredNames* /*ignoreNames*/, bool /*onlyKeywords*/) {
  return false;
}

void CKvfBaseItem::Write(std::ostream& /*stream*/) const {}

void CKvfBaseItem::Clear() {
  kind = kNone;
  name.clear();
  comment.clear();
  parent = nullptr;
  depth = 0;
  mark = kUnmatched;
  line = 0;
  column = 0;
}

std::string CKvfBaseItem::Path() const {
  std::vector<const CKvfBaseItem*> way;
  for (const CKvfBaseItem* item = this; item->parent != nullptr; item = item->parent) way.push_back(item);
  std::string path;
  // NOLINTNEXTLINE(modernize-loop-convert)
  for (auto item = way.rbegin(); item != way.rend(); ++item) path += "." + (*item)->name;
  return path;
}

std::string CKvfBaseItem::Describe() const {
  if (parent == nullptr) return "(root)";
  return std::string(kKindTexts.at(static_cast<std::size_t>(kind))) + " " + Path();
}

std::string CKvfBaseItem::Indent() const {
  if (parent == nullptr || depth < 1) return {};
  return std::string(kBlanksPerLevel * (depth - 1), ' ');
}

bool CKvfCommentItem::Compare(CKvfBaseItem& other, std::ostream* /*report*/,
                              const IgnoredNames* /*ignoreNames*/, bool /*onlyKeywords*/) {
  return other.ItemKind() == kind;
}

void CKvfCommentItem::Write(std::ostream& stream) const {
  const std::string indent = Indent();
  for (const std::string& text : lines) stream << indent << "//" << text << '\n';
  if (lines.size() > 1) stream << indent << '\n';
}

void CKvfCommentItem::Clear() {
  CKvfBaseItem::Clear();
  lines.clear();
}

void CKvfKeyItem::Write(std::ostream& stream) const {
  stream << Indent() << name << " = ";
  bool first = true;
  for (const KvfValue& value : values) {
    if (!std::exchange(first, false)) stream << ',';
    value.Write(stream);
  }
  if (!comment.empty()) stream << " //" << comment;
  stream << '\n';
}

void CKvfKeyItem::Clear() {
  CKvfBaseItem::Clear();
  values.clear();
}

CKvfSectionItem::CKvfSectionItem(const CKvfSectionItem& source)
    : CKvfBaseItem(source), startComment(source.startComment) {
  CopyChildren(source);
}

void CKvfSectionItem::CopyChildren(const CKvfSectionItem& source) {
  // A copy of a child sits one level below wherever this section will be put.
  for (const auto& child : source.children) AppendChild(child->Copy());
}

void CKvfSectionItem::CopyFields(const CKvfSectionItem& source) {
  kind = source.kind;
  name = source.name;
  comment = source.comment;
  line = source.line;
  column = source.column;
  mark = source.mark;
  depth = 0;
  startComment = source.startComment;
}

void CKvfSectionItem::Assign(const CKvfSectionItem& source) {
  if (&source == this) return;
  CopyFields(source);
  CopyChildren(source);
}

void CKvfSectionItem::SetDepth(std::size_t newDepth) {
  depth = newDepth;
  for (const auto& child : children) child->SetDepth(depth + 1);
}

void CKvfSectionItem::AppendChild(std::unique_ptr<CKvfBaseItem> child) {
  child->parent = this;
  child->SetDepth(depth + 1);
  children.push_back(std::move(child));
}

void CKvfSectionItem::AdoptChild(std::unique_ptr<CKvfBaseItem> child) {
  child->parent = this;
  children.push_back(std::move(child));
}

void CKvfSectionItem::TakeOver(CKvfSectionItem& source) {
  CopyFields(source);
  std::vector<std::unique_ptr<CKvfBaseItem>> taken = std::exchange(source.children, {});
  children.reserve(children.size() + taken.size());
  for (auto& child : taken) AppendChild(std::move(child));
}

void CKvfSectionItem::Write(std::ostream& stream) const {
  const std::string indent = Indent();
  if (parent != nullptr) {
    stream << indent << '[' << name << ']';
    if (!startComment.empty()) stream << " //" << startComment;
    stream << '\n';
  }
  for (const auto& child : children) child->Write(stream);
  if (parent != nullptr) {
    stream << indent << "EndSect";
    if (!comment.empty()) stream << " //" << comment;
  }
  stream << "\n\n";
}

void CKvfSectionItem::Clear() {
  CKvfBaseItem::Clear();
  children.clear();
}

std::size_t CKvfSectionItem::CountChildren(Kind childKind) const {
  return static_cast<std::size_t>(
      std::count_if(children.begin(), children.end(),
                    [childKind](const auto& child) { return child->ItemKind() == childKind; }));
}

CKvfBaseItem* CKvfSectionItem::ChildByKind(std::size_t index, Kind childKind) const {
  for (const auto& child : children) {
    if (child->ItemKind() == childKind && index-- == 0) return child.get();
  }
  return nullptr;
}

void CKvfSectionItem::SetMarks(Mark newMark) {
  mark = newMark;
  for (const auto& child : children) {
    if (child->ItemKind() == kSection) {
      static_cast<CKvfSectionItem&>(*child).SetMarks(newMark);
    } else {
      child->mark = newMark;
    }
  }
}

}  // namespace tessal
