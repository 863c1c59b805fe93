#include "keyfile/read_state.h"

#include <iterator>
#include <utility>

#include "platform/kvf_number.h"

namespace tessal {

int ReadState::Take(int token, const char* start, int length, std::uint32_t& text) {
  texts.emplace_back(start, static_cast<std::size_t>(length));
  text = static_cast<std::uint32_t>(texts.size() - 1);
  return token;
}

int ReadState::TakeLiteral(int token, std::uint32_t& text) {
  texts.push_back(std::exchange(literal, {}));
  text = static_cast<std::uint32_t>(texts.size() - 1);
  return token;
}

std::string ReadState::TextAt(std::uint32_t place) {
  return place == kNothing ? std::string() : std::move(texts[place]);
}

std::uint32_t ReadState::PutValue(KvfValue value) {
  values.push_back(std::move(value));
  return static_cast<std::uint32_t>(values.size() - 1);
}

std::uint32_t ReadState::PutItem(std::unique_ptr<CKvfBaseItem> item) {
  items.push_back(std::move(item));
  return static_cast<std::uint32_t>(items.size() - 1);
}

std::uint32_t ReadState::NewComment(std::uint32_t text) {
  auto block = std::make_unique<CKvfCommentItem>();
  block->line = Line();
  block->column = Column();
  block->lines.push_back(TextAt(text));
  return PutItem(std::move(block));
}

std::uint32_t ReadState::PrependComment(std::uint32_t text, std::uint32_t block) {
  // Blocks are built from their last line on; `AppendItem` and `Finish` turn them round.
  static_cast<CKvfCommentItem&>(*items[block]).lines.push_back(TextAt(text));
  return block;
}

std::uint32_t ReadState::NewTargets(std::uint32_t section) {
  targetsBackwards.clear();
  targetsBackwards.push_back(std::move(items[section]));
  return kNothing;
}

std::uint32_t ReadState::PrependTarget(std::uint32_t section, std::uint32_t targets) {
  targetsBackwards.push_back(std::move(items[section]));
  return targets;
}

std::uint32_t ReadState::NewSection() {
  return PutItem(std::make_unique<CKvfSectionItem>());
}

namespace {

/// A comment block was built from its last line on.
void TurnRound(CKvfBaseItem& item) {
  if (item.ItemKind() != CKvfBaseItem::kComment) return;
  auto& lines = static_cast<CKvfCommentItem&>(item).lines;
  lines = {std::make_move_iterator(lines.rbegin()), std::make_move_iterator(lines.rend())};
}

}  // namespace

std::uint32_t ReadState::AppendItem(std::uint32_t section, std::uint32_t item) {
  if (item == kNothing) return section;
  TurnRound(*items[item]);
  SectionAt(section).AdoptChild(std::move(items[item]));
  return section;
}

std::uint32_t ReadState::EndSection(std::uint32_t section, std::uint32_t name, std::uint32_t startComment,
                                    std::uint32_t endComment) {
  CKvfSectionItem& ended = SectionAt(section);
  ended.name = TextAt(name);
  ended.startComment = TextAt(startComment);
  ended.comment = TextAt(endComment);
  // The line of the last head inside the section: nested heads have overwritten it.
  ended.line = sectionLine;
  ended.column = 0;
  return section;
}

std::uint32_t ReadState::RealValue(std::uint32_t text) {
  return PutValue(KvfValue::Real(KvfReal(TextAt(text))));
}

std::uint32_t ReadState::IntegerValue(std::uint32_t text) {
  return PutValue(KvfValue::Integer(KvfInteger(TextAt(text))));
}

std::uint32_t ReadState::BooleanValue(std::uint32_t text) {
  const std::string word = TextAt(text);
  return PutValue(KvfValue::Boolean(word.front() == 't' || word.front() == 'T'));
}

std::uint32_t ReadState::QuotedValue(std::uint32_t text) {
  return PutValue(KvfValue::Quoted(TextAt(text)));
}

std::uint32_t ReadState::PathValue(std::uint32_t text) {
  return PutValue(KvfValue::Path(TextAt(text)));
}

std::uint32_t ReadState::NewKey(std::uint32_t value) {
  const std::uint32_t key = PutItem(std::make_unique<CKvfKeyItem>());
  return AppendValue(key, value);
}

std::uint32_t ReadState::AppendValue(std::uint32_t key, std::uint32_t value) {
  KeyAt(key).values.push_back(std::move(values[value]));
  return key;
}

std::uint32_t ReadState::EndKey(std::uint32_t key, std::uint32_t name, std::uint32_t comment) {
  CKvfKeyItem& ended = KeyAt(key);
  ended.name = TextAt(name);
  ended.comment = TextAt(comment);
  ended.line = Line();
  ended.column = Column();
  // Nothing looks back at the values and items of a finished keyword.
  values.clear();
  return key;
}

void ReadState::Finish(std::uint32_t header, std::uint32_t /*targets*/) {
  root = std::make_unique<CKvfSectionItem>();
  root->name.assign(1, '.');  // GCC 12 warns, wrongly, of an overlap when a literal is assigned here
  if (header != kNothing) {
    TurnRound(*items[header]);
    root->AdoptChild(std::move(items[header]));
  }
  // NOLINTNEXTLINE(modernize-loop-convert)
  for (auto target = targetsBackwards.rbegin(); target != targetsBackwards.rend(); ++target) {
    root->AdoptChild(std::move(*target));
  }
  root->SetDepth(0);
}

}  // namespace tessal
