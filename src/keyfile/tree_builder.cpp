#include "keyfile/tree_builder.h"

#include <algorithm>
#include <string>

#include "platform/kvf_number.h"

namespace tessal {

namespace {

/// A template's tree takes about twice the bytes of its text. What is not used is not touched.
constexpr std::size_t kUsualTimes = 2;

constexpr bool IsDroppedInComments(char character) {
  return character == '\b' || character == '\r' || character == '\t';
}

/// A text without some of its characters, in a memory.
template <class IsDropped>
std::string_view Without(std::string_view text, IsDropped isDropped, ItemMemory& memory) {
  std::string kept;
  std::ranges::remove_copy_if(text, std::back_inserter(kept), isDropped);
  return memory.Copy(kept);
}

}  // namespace

TreeBuilder::TreeBuilder(const KeyFileScan& textScan, std::size_t textSize)
    : scan(textScan),
      mostBytes(kFreeBytes + kMostTimes * textSize),
      tree(std::make_unique<CKvfItemTree>(kUsualTimes * textSize + 1024)),
      memory(tree->Memory()) {}

std::string_view TreeBuilder::CommentText(KeyFilePiece piece) {
  std::string_view text = piece.View();
  // As nearly every line ends.
  if (text.ends_with('\r')) text.remove_suffix(1);
  if (std::ranges::none_of(text, IsDroppedInComments)) return text;
  return Without(text, IsDroppedInComments, memory);
}

std::string_view TreeBuilder::QuotedText(KeyFilePiece piece) {
  const std::string_view text = piece.View();
  if (text.find('\r') == std::string_view::npos) return text;
  return Without(
      text, [](char character) { return character == '\r'; }, memory);
}

CKvfBaseItem* TreeBuilder::NewComment(KeyFilePiece line) {
  auto& block = memory.Make<CKvfCommentItem>();
  block.SetPosition(scan.Line(), scan.Column());
  return PrependComment(line, &block);
}

CKvfBaseItem* TreeBuilder::PrependComment(KeyFilePiece line, CKvfBaseItem* block) {
  static_cast<CKvfCommentItem*>(block)->Prepend(CommentText(line), memory);
  return block;
}

CKvfBaseItem* TreeBuilder::NewTargets(CKvfBaseItem* section) {
  return PrependTarget(section, tree.get());
}

CKvfBaseItem* TreeBuilder::PrependTarget(CKvfBaseItem* section, CKvfBaseItem* targets) {
  tree->PrependChild(*section);
  return targets;
}

CKvfBaseItem* TreeBuilder::NewSection() {
  auto& section = memory.Make<CKvfSectionItem>(memory);
  section.SetDepth(++openSections);
  return &section;
}

CKvfBaseItem* TreeBuilder::AppendItem(CKvfBaseItem* section, CKvfBaseItem* item) {
  if (item != nullptr) static_cast<CKvfSectionItem*>(section)->AppendChild(*item);
  return section;
}

CKvfBaseItem* TreeBuilder::EndSection(CKvfBaseItem* section, KeyFilePiece name, KeyFilePiece startComment,
                                      KeyFilePiece endComment) {
  auto& ended = static_cast<CKvfSectionItem&>(*section);
  --openSections;
  ended.SetName(name.View());
  ended.SetStartComment(CommentText(startComment));
  ended.SetComment(CommentText(endComment));
  // The line of the last head inside the section: nested heads have overwritten it.
  ended.SetPosition(sectionLine, 0);
  return section;
}

void TreeBuilder::AddReal(KeyFilePiece digits) {
  values.push_back(KvfValue::Real(KvfReal(digits.View())));
}

void TreeBuilder::AddInteger(KeyFilePiece digits) {
  values.push_back(KvfValue::Integer(KvfInteger(digits.View())));
}

void TreeBuilder::AddBoolean(KeyFilePiece word) {
  values.push_back(KvfValue::Boolean(*word.begin == 't' || *word.begin == 'T'));
}

void TreeBuilder::AddQuoted(KeyFilePiece content) {
  values.push_back(KvfValue::Quoted(QuotedText(content)));
}

void TreeBuilder::AddPath(KeyFilePiece content) {
  values.push_back(KvfValue::Path(QuotedText(content)));
}

CKvfBaseItem* TreeBuilder::EndKey(KeyFilePiece name, KeyFilePiece comment) {
  CKvfKeyItem& key = CKvfKeyItem::Make(memory, values);
  values.clear();
  key.SetName(name.View());
  key.SetComment(CommentText(comment));
  key.SetPosition(scan.Line(), scan.Column());
  return &key;
}

void TreeBuilder::Finish(CKvfBaseItem* header, CKvfBaseItem* /*targets*/) {
  tree->SetName(".");
  if (header != nullptr) tree->PrependChild(*header);
}

}  // namespace tessal
