// Key-file text as it is written: the layout of the library's own files, made item by item.
#pragma once

#include <cstddef>
#include <cstring>
#include <string>
#include <string_view>
#include <vector>

#include "platform/text_source.h"

namespace tessal {

/// What every written file begins with, its line ends as line feeds.
inline constexpr std::string_view kKvfHeader =
    "// Tessal template\n"
    "// Key-file text: sections, keywords, parameters\n"
    "// Written by the template editor\n"
    "\n";

/// The text of one file under construction, with CRLF line ends. Names and values are taken as they are: who
/// calls has checked that the format can hold them.
class KvfWriter final {
 public:
  /// Keeps the text until it is taken.
  KvfWriter() : KvfWriter(TextSink(), "") {}
  /// Gives the text to a sink, part by part. A further comment comes last in the head, where there is one.
  KvfWriter(TextSink textSink, std::string_view lastComment);

  bool HasOpenSection() const { return !openSections.empty(); }
  /// Whether the next value has a keyword to belong to.
  bool HasOpenKeyword() const { return keyword != Keyword::None; }

  void OpenSection(std::string_view name);
  void CloseSection();
  void AddKeyword(std::string_view name);
  void EndKeyword();
  void AddNumber(std::string_view number);
  /// The quote is ' or |. The text is on one line.
  void AddText(std::string_view value, char quote);
  /// The same for a text of several lines. Line feeds become line ends.
  void AddLines(std::string_view value, char quote);

  /// Ends the sections that are still open. All of the text is then with the sink.
  void Finish();
  /// The same of a text that is kept, which is given away.
  std::string TakeText();
  std::string Text() const { return KvfWriter(*this).TakeText(); }

 private:
  enum class Keyword { None, Fresh, HasValues };

  /// Room at the end of the part for a few bytes.
  char* Room(std::size_t size) {
    if (size > part.size() - used) Flush();
    return part.data() + used;
  }
  void Put(std::string_view piece) {
    // Most pieces are a few bytes, and fit.
    if (piece.size() > part.size() - used) return PutLarge(piece);
    piece.copy(part.data() + used, piece.size());
    used += piece.size();
  }
  /// The same for a text of the layout.
  template <std::size_t kSize>
  void Put(const char (&literal)[kSize]) {
    std::memcpy(Room(kSize - 1), literal, kSize - 1);
    used += kSize - 1;
  }
  void Put(char character) {
    *Room(1) = character;
    ++used;
  }
  void PutLarge(std::string_view piece);
  void Flush();
  void BeginLine();
  void BeginValue();
  void PutLines(std::string_view value);

  TextSink sink;
  std::string kept;  ///< without a sink
  std::vector<char> part;
  std::size_t used = 0;  ///< of the part
  std::vector<std::string> openSections;
  Keyword keyword = Keyword::None;
};

}  // namespace tessal
