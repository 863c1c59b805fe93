// An open text as the template that it is: loaded, with its messages, its sections and all that finds places
// in it. There is one template in the process, so one document is loaded at a time; what is kept of a loaded
// document is good until the next load.
#pragma once

#include <cstddef>
#include <map>
#include <optional>
#include <string_view>

#include "cli/file_place.h"
#include "cli/lsp/file_outline.h"
#include "cli/lsp/open_document.h"
#include "cli/lsp/text_positions.h"
#include "cli/template_messages.h"
#include "core/template_core.h"

namespace tessal::cli {

/// A place in an expression.
struct ExpressionPlace {
  const CEL_Element* element;
  std::string_view text;  ///< of the expression, its quotes stripped
  std::size_t start;      ///< where it begins in the text
  std::size_t caret;      ///< in it, from 0 to its size
};

class LoadedDocument final {
 public:
  /// Loads the document, which outlives it.
  LoadedDocument(const OpenDocument& loaded, ColumnUnit columnUnit)
      : LoadedDocument(loaded, columnUnit, loaded.text) {}
  /// The same, but what is read is another text (unfinished_text.h), which outlives it too.
  LoadedDocument(const OpenDocument& loaded, ColumnUnit columnUnit, std::string_view readInstead);

  const OpenDocument& Document() const { return document; }
  const TemplateCore& Core() const { return core; }
  /// Whether the text is that of a template, with whatever faults.
  bool IsLoaded() const { return messages.loaded; }
  /// What a check finds, in its places.
  const TemplateMessages& Messages() const { return messages; }
  const FileOutline& Outline() const { return outline; }
  /// The text as the template was read from it.
  std::string_view Text() const { return text; }
  /// The same as the client has it: here is what was left out of what is read.
  std::string_view TypedText() const { return std::string_view(document.text).substr(skipped); }

  /// Where a part of the text begins; none for a view that is none.
  std::optional<std::size_t> OffsetOf(std::string_view part) const;
  std::size_t OffsetOf(const Json& position) const;
  /// Ranges of the protocol.
  Json RangeOf(std::size_t start, std::size_t end) const;
  Json RangeOf(std::string_view part) const;
  Json RangeOf(const FilePlace& place) const;

  /// The element whose section, or equation, a place is in; none outside of them.
  const CEL_Element* ElementAt(std::size_t offset) const;
  /// The expression that a place is in, its ends included.
  std::optional<ExpressionPlace> ExpressionAt(std::size_t offset) const;
  /// The section that an element was read from; none for one that was not.
  std::optional<std::size_t> SectionOf(const CEL_Element& element) const;
  /// The keyword of an equation, by its text.
  std::string_view KeywordOf(std::string_view value) const;

 private:
  const OpenDocument& document;
  std::size_t skipped;  ///< bytes of the document before the text: its mark of the byte order
  std::string_view text;
  TextPositions positions;      ///< in the document
  TextPositions filePositions;  ///< in the text, as messages count
  FileOutline outline;
  TemplateCore& core;
  TemplateMessages messages;
  std::map<int, std::size_t> sectionsByLine;
  std::map<std::size_t, const CEL_Element*> elementsBySection;
};

/// Calls the visitor with each element that has a record, once.
template <class Visitor>
void ForEachElement(const TemplateCore& core, Visitor visit) {
  const CEL_Element* previous = nullptr;
  for (const SymbolRecord& record : core.SymbolTable()) {
    if (record.element != previous) visit(*record.element);
    previous = record.element;
  }
}

}  // namespace tessal::cli
