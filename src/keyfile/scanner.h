// Turns key-file text into tokens. A line may end in a line feed alone; it counts as if a carriage return
// were before it, as in every file that is written.
#pragma once

#include <cstdint>
#include <string_view>

namespace tessal {

/// The kinds of token, with the numbers of the grammar.
enum class KeyFileToken : std::int8_t {
  End = 0,
  Identifier = 3,
  Integer = 4,
  Real = 5,
  Boolean = 6,
  String = 7,
  Comment = 8,
  Path = 9,
  SectionEnd = 10,
  CommentStart = 11,
  StringStart = 12,
  PathStart = 13,
  LeftSquare = 14,
  RightSquare = 15,
  Assign = 16,
  Comma = 17,
  NewLine = 18,
  Other = 19,  ///< a character without a token
};

/// A piece of the text that is scanned.
struct KeyFilePiece {
  const char* begin;
  std::uint32_t size;

  std::string_view View() const { return {begin, size}; }
};

/// One scan of a text.
class KeyFileScan final {
 public:
  /// Begins a scan of a text that ends in a zero byte and outlives the scan.
  explicit KeyFileScan(const char* text)
      : begin(text), end(text + std::string_view(text).size()), here(text), lineStart(text) {}

  KeyFileToken Next();
  /// The text of the present token, as it is in the file. That of a string or path is what lies between its
  /// quotes, and that of a comment what follows the slashes in its line.
  KeyFilePiece Piece() const { return {piece, static_cast<std::uint32_t>(pieceEnd - piece)}; }

  /// Line feeds met so far.
  std::int32_t Line() const { return lines; }
  /// Characters taken since the last token of a line's end, the carriage returns that bare line feeds lack
  /// included.
  std::int32_t Column() const { return static_cast<std::int32_t>(here - lineStart) + bareFeeds; }

 private:
  KeyFileToken Single(KeyFileToken token) {
    ++here;
    return token;
  }
  KeyFileToken Start(KeyFileToken token, KeyFileToken content) {
    inside = content;
    return Single(token);
  }
  KeyFileToken Word();
  KeyFileToken Number();
  KeyFileToken CommentText();
  KeyFileToken QuotedText(char quote);
  /// Goes to a place, and counts the line feeds before it.
  void CountLinesTo(const char* place);
  bool IsBare(const char* feed) const { return feed == begin || feed[-1] != '\r'; }

  const char* begin;
  const char* end;  ///< a zero byte is there
  const char* here;
  const char* lineStart;
  const char* piece = nullptr;
  const char* pieceEnd = nullptr;
  KeyFileToken inside = KeyFileToken::End;  ///< the token of the text that has begun, if one has
  std::int32_t lines = 0;
  std::int32_t bareFeeds = 0;  ///< since the last token of a line's end
};

}  // namespace tessal
