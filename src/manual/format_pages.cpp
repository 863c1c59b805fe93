// The pages of the file format and of the language of expressions.
#include <algorithm>

#include "docgen/reference_pages.h"
#include "expr/sign_reference.h"
#include "manual/format_tables.h"
#include "manual/pages.h"
#include "manual/roff.h"

namespace tessal::manual {

namespace {

constexpr std::string_view kSample =
    "[CONSTANTS]\n"
    "   [CONSTANT_1]\n"
    "      SYMBOL = 'k'\n"
    "      DEFAULT_VALUE = 0.3\n"
    "   EndSect  // CONSTANT_1\n"
    "\n"
    "EndSect  // CONSTANTS\n";

/// The keywords of a section, with what a new element has, in two columns.
std::string KeywordLines(const WrittenSection& section) {
  std::size_t width = 0;
  for (const WrittenKeyword& keyword : section.keywords) width = std::max(width, keyword.name.size());
  std::string lines;
  for (const WrittenKeyword& keyword : section.keywords) {
    lines += keyword.name + std::string(width - keyword.name.size(), ' ') + " = " + keyword.value + "\n";
  }
  return lines;
}

std::string SectionTitle(const WrittenSection& section) {
  const bool isNumbered = section.name.ends_with('_');
  return "[" + section.name + (isNumbered ? "N" : "") + "]";
}

void AddKeyword(ManualPage& page, const KeywordEntry& entry) {
  // More than a page can list, and all of them described elsewhere.
  constexpr std::size_t kMostChoices = 30;
  std::string text = Prose(entry.meaning);
  if (!entry.type.empty()) text += Prose(" Type: " + std::string(entry.type) + ".");
  const bool hasMany = entry.choices.size() > kMostChoices;
  if (hasMany) {
    text += Prose(" One of " + std::to_string(entry.choices.size()) + " numbers, which ") +
            Typed("tessal builtins --describe") + Prose(" explains; -1 for none.");
  }
  page.Item(Typed(entry.name), text);
  if (hasMany || entry.choices.empty()) return;
  page.Indent();
  for (const KeywordChoice& choice : entry.choices) page.Item(Typed(choice.value), Prose(choice.meaning));
  page.EndIndent();
}

void AddEntry(ManualPage& page, const ReferenceEntry& entry) {
  std::string text = Prose(entry.purpose);
  page.Item(Typed(entry.heading), text);
  if (entry.quantities.empty() && entry.facts.empty() && entry.formulae.empty()) return;
  page.Indent();
  for (const ReferenceEntry::Quantity& quantity : entry.quantities) {
    page.Item(Placeholder(quantity.name), Prose(std::string(quantity.meaning) + " [" + quantity.unit + "]"));
  }
  for (const ReferenceEntry::Fact& fact : entry.facts) {
    page.Paragraph(Prose(std::string(fact.label) + ": " + fact.text + "."));
  }
  for (std::size_t place = 0; place < entry.formulae.size(); ++place) {
    page.Paragraph(
        Prose("Option " + std::to_string(place + 1) + ": " + std::string(entry.formulae[place]) + "."));
  }
  page.EndIndent();
}

void AddPage(ManualPage& page, const ReferencePage& reference) {
  page.Section(reference.title);
  page.Paragraph(Prose(reference.introduction));
  for (const ReferenceSection& section : reference.sections) {
    page.Subsection(section.title);
    for (const ReferenceEntry& entry : section.entries) AddEntry(page, entry);
  }
}

}  // namespace

std::string TemplatePage(const Edition& edition) {
  const FormatTables format = ReadFormat();
  ManualPage page({"tessal-template", 5, "format of the templates of aquatic process models", "File Formats"},
                  edition.version, edition.date);
  page.Section("Description");
  page.Paragraph(
      Prose("A template is a text file with the ending .tessal. Its lines end in a carriage return "
            "and a line feed; a line feed alone is read too. A section begins with its name in "
            "square brackets and ends with EndSect; it holds keywords with their values, and "
            "further sections. What follows // is a comment. A save keeps further sections beside "
            "[TESSAL_SETUP]; it keeps no comments and no words of others within it."));
  page.Lines(kSample);
  page.Paragraph(
      Prose("A text is written between two apostrophes, or between two bars when it has an apostrophe "
            "in it; it may go over several lines. Commas come between several values of a "
            "keyword. A name that ends in N below is followed by a number, from 1, in the order "
            "of declaration: an element may use only those that are declared before it."));
  page.Section("Sections");
  page.Paragraph(
      Prose("In the order of the file, with the keywords that a save writes into each and the values "
            "of a new element."));
  for (const WrittenSection& section : format.sections) {
    page.Subsection(SectionTitle(section));
    page.Paragraph(Prose(section.meaning) + (section.path.empty() ? "" : Prose(" In " + section.path + ".")));
    if (!section.keywords.empty()) page.Lines(KeywordLines(section));
  }
  page.Section("Keywords");
  for (const KeywordEntry& entry : format.keywords) AddKeyword(page, entry);
  page.Section("See also");
  page.Paragraph("\\fBtessal\\fR(1), \\fBtessal\\-editor\\fR(1), \\fBtessal\\-expressions\\fR(7)");
  return page.Text();
}

std::string ExpressionsPage(const Edition& edition) {
  ManualPage page(
      {"tessal-expressions", 7, "language of the expressions in templates", "Miscellaneous Information"},
      edition.version, edition.date);
  page.Section("Description");
  page.Paragraph(
      Prose("An expression computes the value of an auxiliary, a process, a derived output or a "
            "movement, and the rate of change of a state variable. In a template it lies between "
            "double quotes within a text. It is made of numbers, the symbols of elements, signs "
            "and calls of functions."));
  page.Paragraph(
      Prose("A symbol begins with a letter, and goes on with letters, digits and underscores; "
            "capitals and small letters differ in it. The names of functions may be written in "
            "any case. A number has a point before its decimals and may have an exponent: 3, 0.5, "
            "1.2e-3. What lies between /* and */ is a comment."));
  page.Section("Signs and words");
  for (const SignGroup& group : SignGroups()) {
    page.Subsection(group.title);
    if (!group.note.empty()) page.Paragraph(Prose(group.note));
    for (const SignReference& sign : group.signs) {
      page.Item(Typed(sign.sign), Prose(std::string(sign.meaning) + " Example: ") + Typed(sign.example));
    }
  }
  AddPage(page, PageOfFunctions());
  AddPage(page, PageOfBuiltins());
  page.Section("See also");
  page.Paragraph("\\fBtessal\\fR(1), \\fBtessal\\-editor\\fR(1), \\fBtessal\\-template\\fR(5)");
  return page.Text();
}

}  // namespace tessal::manual
