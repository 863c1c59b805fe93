#include "keyfile/tree_builder.h"

#include <iterator>
#include <utility>

#include "platform/kvf_number.h"

namespace tessal {

std::uint32_t TreeBuilder::KeepLiteral() {
  return texts.Put(std::exchange(literal, {}));
}

std::uint32_t TreeBuilder::NewComment(std::uint32_t line) {
  auto block = std::make_unique<CKvfCommentItem>();
  block->line = Line();
  block->column = Column();
  block->lines.push_back(TextAt(line));
  return PutNew(std::move(block));
}

std::uint32_t TreeBuilder::PrependComment(std::uint32_t line, std::uint32_t block) {
  // Blocks are built from their last line on; `AppendItem` and `Finish` turn them round.
  static_cast<CKvfCommentItem&>(*items.At(block)).lines.push_back(TextAt(line));
  return block;
}

std::uint32_t TreeBuilder::NewTargets(std::uint32_t section) {
  targetsBackwards.clear();
  targetsBackwards.push_back(items.Take(section));
  return kNothing;
}

std::uint32_t TreeBuilder::PrependTarget(std::uint32_t section, std::uint32_t targets) {
  targetsBackwards.push_back(items.Take(section));
  return targets;
}

std::uint32_t TreeBuilder::NewSection() {
  return PutNew(std::make_unique<CKvfSectionItem>());
}

namespace {

/// A comment block was built from its last line on.
void TurnRound(CKvfBaseItem& item) {
  if (item.ItemKind() != CKvfBaseItem::kComment) return;
  auto& lines = static_cast<CKvfCommentItem&>(item).lines;
  lines = {std::make_move_iterator(lines.rbegin()), std::make_move_iterator(lines.rend())};
}

}  // namespace

std::uint32_t TreeBuilder::AppendItem(std::uint32_t section, std::uint32_t item) {
  if (item == kNothing) return section;
  TurnRound(*items.At(item));
  SectionAt(section).AdoptChild(items.Take(item));
  return section;
}

std::uint32_t TreeBuilder::EndSection(std::uint32_t section, std::uint32_t name, std::uint32_t startComment,
                                      std::uint32_t endComment) {
  CKvfSectionItem& ended = SectionAt(section);
  ended.name = TextAt(name);
  ended.startComment = TextAt(startComment);
  ended.comment = TextAt(endComment);
  // The line of the last head inside the section: nested heads have overwritten it.
  ended.line = SectionLine();
  ended.column = 0;
  return section;
}

std::uint32_t TreeBuilder::RealValue(std::uint32_t digits) {
  return PutValue(KvfValue::Real(KvfReal(TextAt(digits))));
}

std::uint32_t TreeBuilder::IntegerValue(std::uint32_t digits) {
  return PutValue(KvfValue::Integer(KvfInteger(TextAt(digits))));
}

std::uint32_t TreeBuilder::BooleanValue(std::uint32_t word) {
  const std::string letters = TextAt(word);
  return PutValue(KvfValue::Boolean(letters.front() == 't' || letters.front() == 'T'));
}

std::uint32_t TreeBuilder::QuotedValue(std::uint32_t content) {
  return PutValue(KvfValue::Quoted(TextAt(content)));
}

std::uint32_t TreeBuilder::PathValue(std::uint32_t content) {
  return PutValue(KvfValue::Path(TextAt(content)));
}

std::uint32_t TreeBuilder::NewKey(std::uint32_t value) {
  const std::uint32_t key = PutNew(std::make_unique<CKvfKeyItem>());
  return AppendValue(key, value);
}

std::uint32_t TreeBuilder::AppendValue(std::uint32_t key, std::uint32_t value) {
  KeyAt(key).values.push_back(values.Take(value));
  return key;
}

std::uint32_t TreeBuilder::EndKey(std::uint32_t key, std::uint32_t name, std::uint32_t comment) {
  CKvfKeyItem& ended = KeyAt(key);
  ended.name = TextAt(name);
  ended.comment = TextAt(comment);
  ended.line = Line();
  ended.column = Column();
  return key;
}

void TreeBuilder::Finish(std::uint32_t header, std::uint32_t /*targets*/) {
  root = std::make_unique<CKvfSectionItem>();
  root->name.assign(1, '.');  // GCC 12 warns, wrongly, of an overlap when a literal is assigned here
  if (header != kNothing) {
    TurnRound(*items.At(header));
    root->AdoptChild(items.Take(header));
  }
  // NOLINTNEXTLINE(modernize-loop-convert)
  for (auto target = targetsBackwards.rbegin(); target != targetsBackwards.rend(); ++target) {
    root->AdoptChild(std::move(*target));
  }
  root->SetDepth(0);
}

}  // namespace tessal
