// What one read of a key file works on: the scanner's counters, the failure text, and what is done for each
// rule of the grammar. This class does nothing for them, so that a read with it only says whether a text is
// a key file; `TreeBuilder` builds the item tree.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "keyfile/keyfile_grammar.h"
#include "platform/parser_memory.h"

namespace tessal {

class ReadState {
 public:
  /// The place of what is not there.
  static constexpr std::uint32_t kNothing = 0xFFFFFFFFU;

  /// The text is scanned in place, and is as it was when the read is over.
  explicit ReadState(std::string& scanned) : text(scanned) { Install(); }
  ReadState(const ReadState&) = delete;
  ReadState& operator=(const ReadState&) = delete;
  virtual ~ReadState() { Uninstall(); }

  /// What the generated parser takes its stack from.
  ParserMemory& Memory() { return memory; }

  /// The generated scanner.
  int NextToken(std::uint32_t& place);
  void Fail(std::string_view reason) { message = reason; }
  void NoteSectionLine() { sectionLine = position.lines; }

  // One operation for each rule that builds something. The grammar's values are places of what was built.
  virtual std::uint32_t NewComment(std::uint32_t /*line*/) { return kNothing; }
  virtual std::uint32_t PrependComment(std::uint32_t /*line*/, std::uint32_t /*block*/) { return kNothing; }
  virtual std::uint32_t NewTargets(std::uint32_t /*section*/) { return kNothing; }
  virtual std::uint32_t PrependTarget(std::uint32_t /*section*/, std::uint32_t /*targets*/) {
    return kNothing;
  }
  virtual std::uint32_t NewSection() { return kNothing; }
  virtual std::uint32_t AppendItem(std::uint32_t /*section*/, std::uint32_t /*item*/) { return kNothing; }
  virtual std::uint32_t EndSection(std::uint32_t /*section*/, std::uint32_t /*name*/,
                                   std::uint32_t /*startComment*/, std::uint32_t /*endComment*/) {
    return kNothing;
  }
  virtual std::uint32_t RealValue(std::uint32_t /*digits*/) { return kNothing; }
  virtual std::uint32_t IntegerValue(std::uint32_t /*digits*/) { return kNothing; }
  virtual std::uint32_t BooleanValue(std::uint32_t /*word*/) { return kNothing; }
  virtual std::uint32_t QuotedValue(std::uint32_t /*content*/) { return kNothing; }
  virtual std::uint32_t PathValue(std::uint32_t /*content*/) { return kNothing; }
  virtual std::uint32_t NewKey(std::uint32_t /*value*/) { return kNothing; }
  virtual std::uint32_t AppendValue(std::uint32_t /*key*/, std::uint32_t /*value*/) { return kNothing; }
  virtual std::uint32_t EndKey(std::uint32_t /*key*/, std::uint32_t /*name*/, std::uint32_t /*comment*/) {
    return kNothing;
  }
  virtual void Finish(std::uint32_t /*header*/, std::uint32_t /*targets*/) {}

  /// Whether more was built than may be. The read then ends as at a wrong token.
  virtual bool IsFull() const { return false; }

  const std::string& Message() const { return message; }
  std::int32_t Line() const { return position.lines; }
  std::int32_t Column() const { return position.consumed - position.lineStart; }

 protected:
  std::int32_t SectionLine() const { return sectionLine; }
  std::size_t TextSize() const { return text.size(); }

 private:
  struct Position {
    std::int32_t lines = 0;
    std::int32_t consumed = 0;
    std::int32_t lineStart = 0;
  };

  /// Has the scanner read the text, in its place.
  void Install();
  void Uninstall();

  // What the scanner finds: the text of a token, or the pieces of one between quotes or after slashes.
  virtual std::uint32_t Keep(std::string_view /*token*/) { return kNothing; }
  virtual void BeginLiteral() {}
  virtual void AppendLiteral(std::string_view /*piece*/) {}
  virtual std::uint32_t KeepLiteral() { return kNothing; }

  std::string& text;
  ParserMemory memory;
  Position position;
  std::int32_t sectionLine = 0;
  std::string message;
};

}  // namespace tessal
