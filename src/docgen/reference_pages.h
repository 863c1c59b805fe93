// The reference of functions, built-ins and words laid out for people: an entry as plain text, Markdown or
// HTML, and pages of all entries. docs/functions.md, docs/builtins.md and the help's pages of functions and
// of built-ins are these pages.
#pragma once

#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "expr/builtin_catalogue.h"
#include "expr/function_reference.h"
#include "expr/word_reference.h"

namespace tessal {

/// What a reader is shown of one function or built-in.
struct ReferenceEntry {
  /// An argument, or the result.
  struct Quantity {
    std::string_view name;
    std::string_view meaning;
    std::string unit;  ///< in words
  };
  /// One thing to know, with what it is: "Range", "Source".
  struct Fact {
    std::string_view label;
    std::string text;
  };
  std::string name;     ///< and the anchor on the page
  std::string heading;  ///< the call, or the name again
  std::string_view purpose;
  std::vector<Quantity> quantities;  ///< the arguments in order, then the result; none for a built-in
  std::vector<Fact> facts;
  std::vector<std::string_view> formulae;  ///< by option number from 1; empty where nothing is chosen
};

ReferenceEntry EntryOf(const FunctionReference& function);
ReferenceEntry EntryOf(const CatalogueBuiltin& builtin);
/// Of a property of particles, or a verb.
ReferenceEntry EntryOf(const WordReference& word);

/// Lines of plain text, the heading first.
std::string EntryText(const ReferenceEntry& entry);
/// A piece of a page, beginning with the heading; in HTML with its anchor, and made of what Qt can show.
std::string EntryMarkdown(const ReferenceEntry& entry);
std::string EntryHtml(const ReferenceEntry& entry);

struct ReferenceSection {
  std::string_view title;
  std::vector<ReferenceEntry> entries;
};

struct ReferencePage {
  std::string_view title;
  std::string_view introduction;
  std::vector<ReferenceSection> sections;
};

/// All functions by subject, and then the other words of the language; all built-ins by kind.
ReferencePage PageOfFunctions();
ReferencePage PageOfBuiltins();

std::string PageMarkdown(const ReferencePage& page);
std::string PageHtml(const ReferencePage& page);

}  // namespace tessal
