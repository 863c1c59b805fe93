// What one read of a key file works on: the scanner's counters, the texts and items under construction, and
// the failure text. The generated parser's values are places in the stores here, so that a failed read
// releases everything.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "keyfile/item_tree.h"
#include "keyfile/keyfile_grammar.h"
#include "platform/parser_memory.h"

namespace tessal {

class ReadState final {
 public:
  /// The place of what is not there.
  static constexpr std::uint32_t kNothing = 0xFFFFFFFFU;

  explicit ReadState(std::string text) : scanned(std::move(text)) { Install(); }
  ReadState(const ReadState&) = delete;
  ReadState& operator=(const ReadState&) = delete;
  ~ReadState() { Uninstall(); }

  ParserMemory& Memory() { return memory; }

  // The token side; `NextToken` is the generated scanner.
  int NextToken(std::uint32_t& text);
  void Fail(std::string_view text) { message = text; }

  // The tree side, one operation for each rule that builds something.
  std::uint32_t NewComment(std::uint32_t text);
  std::uint32_t PrependComment(std::uint32_t text, std::uint32_t block);
  std::uint32_t NewTargets(std::uint32_t section);
  std::uint32_t PrependTarget(std::uint32_t section, std::uint32_t targets);
  std::uint32_t NewSection();
  std::uint32_t AppendItem(std::uint32_t section, std::uint32_t item);
  std::uint32_t EndSection(std::uint32_t section, std::uint32_t name, std::uint32_t startComment,
                           std::uint32_t endComment);
  void NoteSectionLine() { sectionLine = position.lines; }
  std::uint32_t RealValue(std::uint32_t text);
  std::uint32_t IntegerValue(std::uint32_t text);
  std::uint32_t BooleanValue(std::uint32_t text);
  std::uint32_t QuotedValue(std::uint32_t text);
  std::uint32_t PathValue(std::uint32_t text);
  std::uint32_t NewKey(std::uint32_t value);
  std::uint32_t AppendValue(std::uint32_t key, std::uint32_t value);
  std::uint32_t EndKey(std::uint32_t key, std::uint32_t name, std::uint32_t comment);
  void Finish(std::uint32_t header, std::uint32_t targets);

  /// The finished tree; none after a failure.
  std::unique_ptr<CKvfSectionItem>& Root() { return root; }
  const std::string& Message() const { return message; }
  std::int32_t Line() const { return position.lines; }
  std::int32_t Column() const { return position.consumed - position.lineStart; }

 private:
  struct Position {
    std::int32_t lines = 0;
    std::int32_t consumed = 0;
    std::int32_t lineStart = 0;
  };

  /// Has the scanner read the text, in its place.
  void Install();
  static void Uninstall();
  int Take(int token, const char* start, int length, std::uint32_t& text);
  int TakeLiteral(int token, std::uint32_t& text);

  std::uint32_t PutValue(KvfValue value);
  std::uint32_t PutItem(std::unique_ptr<CKvfBaseItem> item);
  std::string TextAt(std::uint32_t place);
  CKvfSectionItem& SectionAt(std::uint32_t place) { return static_cast<CKvfSectionItem&>(*items[place]); }
  CKvfKeyItem& KeyAt(std::uint32_t place) { return static_cast<CKvfKeyItem&>(*items[place]); }

  std::string scanned;
  ParserMemory memory;
  Position position;
  std::int32_t sectionLine = 0;
  std::string literal;
  std::vector<std::string> texts;
  std::vector<KvfValue> values;
  std::vector<std::unique_ptr<CKvfBaseItem>> items;
  std::vector<std::unique_ptr<CKvfBaseItem>> targetsBackwards;
  std::unique_ptr<CKvfSectionItem> root;
  std::string message;
};

}  // namespace tessal
