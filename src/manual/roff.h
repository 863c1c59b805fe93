// A manual page in the making: sections, paragraphs and lists as roff with the man macros, so that every
// reader of manual pages shows them. Texts are UTF-8; signs that roff takes for its own are written so that
// they are shown.
#pragma once

#include <string>
#include <string_view>

namespace tessal::manual {

/// Words for people; a hyphen in them is a hyphen.
std::string Prose(std::string_view words);
/// What people type: bold, with plain quotes and minus signs, and no break in it.
std::string Typed(std::string_view text);
/// What people replace by something of their own.
std::string Placeholder(std::string_view name);

/// The heading of a page.
struct PageTitle {
  std::string_view name;
  int section;
  std::string_view summary;  ///< what it is, for lists of pages; no capital, no full stop
  std::string_view part;     ///< "User Commands"
};

class ManualPage final {
 public:
  /// The date is that of the version, not of the build.
  ManualPage(const PageTitle& title, std::string_view version, std::string_view date);

  // Titles are words. All other texts are pieces made by the functions above, joined.
  void Section(std::string_view title);
  void Subsection(std::string_view title);
  void Paragraph(const std::string& text);
  /// A term with what it means; a further term is one more for the same text.
  void Item(const std::string& term, const std::string& text);
  /// Lines that stay as they are.
  void Lines(std::string_view lines);
  /// What follows belongs to the last item.
  void Indent() { text += ".RS\n"; }
  void EndIndent() { text += ".RE\n"; }

  const std::string& Text() const { return text; }

 private:
  std::string text;
};

}  // namespace tessal::manual
