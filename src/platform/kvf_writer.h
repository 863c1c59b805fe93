// Key-file text as it is written: the layout of the library's own files, made item by item.
#pragma once

#include <string>
#include <string_view>
#include <vector>

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
  KvfWriter() { AppendText(kKvfHeader); }

  bool HasOpenSection() const { return !openSections.empty(); }
  /// Whether the next value has a keyword to belong to.
  bool HasOpenKeyword() const { return keyword != Keyword::None; }

  void OpenSection(std::string_view name);
  void CloseSection();
  void AddKeyword(std::string_view name);
  void EndKeyword();
  void AddNumber(std::string_view number);
  /// The quote is ' or |.
  void AddText(std::string_view value, char quote);

  /// Ends the sections that are still open, and gives the text away.
  std::string TakeText();
  std::string Text() const { return KvfWriter(*this).TakeText(); }

 private:
  enum class Keyword { None, Fresh, HasValues };

  void BeginLine();
  void BeginValue();
  /// Line feeds become line ends.
  void AppendText(std::string_view value);

  std::string text;
  std::vector<std::string> openSections;
  Keyword keyword = Keyword::None;
};

}  // namespace tessal
