#include "cli/lsp/loaded_document.h"

#include <algorithm>
#include <functional>
#include <string>

#include "cli/message_places.h"
#include "cli/template_files.h"
#include "expr/scanner.h"

namespace tessal::cli {

namespace {

constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";

TemplateMessages Load(TemplateCore& core, const std::string& uri, std::string_view text) {
  // A comment that a text leaves open must not swallow the expressions of the next one.
  ResetExpressionScanner();
  const bool isLoaded = core.LoadText(std::string(text));
  TemplateMessages messages = CollectMessages(core, uri, 0);
  messages.loaded = isLoaded;
  FindPlaces(core, messages);
  return messages;
}

/// The part of the document that a template is read from.
std::string_view ReadPart(std::string_view document, std::size_t skipped) {
  const std::string_view text = document.substr(skipped);
  return text.substr(0, text.find('\0'));
}

}  // namespace

LoadedDocument::LoadedDocument(const OpenDocument& loaded, ColumnUnit columnUnit,
                               std::string_view readInstead)
    : document(loaded),
      skipped(loaded.text.starts_with(kByteOrderMark) ? kByteOrderMark.size() : 0),
      text(ReadPart(readInstead, skipped)),
      positions(loaded.text, columnUnit, LineEnds::AllKinds),
      filePositions(text, ColumnUnit::Characters, LineEnds::FeedsOnly),
      outline(text),
      core(TheTemplate()),
      messages(Load(core, loaded.uri, readInstead)) {
  const auto& sections = outline.Sections();
  for (std::size_t index = 0; index < sections.size(); ++index) {
    sectionsByLine.try_emplace(static_cast<int>(filePositions.PositionOf(sections[index].start).line) + 1,
                               index);
  }
  ForEachElement(core, [this](const CEL_Element& element) {
    if (const auto section = SectionOf(element)) elementsBySection.try_emplace(*section, &element);
    element.ForEachExpression([this, &element](const PropertyRow&, const CEL_Property& expression) {
      const auto offset = OffsetOf(expression.Text());
      const auto section = offset ? outline.SectionAt(*offset) : std::nullopt;
      if (section) elementsBySection.try_emplace(*section, &element);
    });
  });
}

std::optional<std::size_t> LoadedDocument::OffsetOf(std::string_view part) const {
  const std::string_view source = core.SourceText();
  const std::less<> isBefore;
  if (part.data() == nullptr || isBefore(part.data(), source.data()) ||
      isBefore(source.data() + source.size(), part.data() + part.size())) {
    return std::nullopt;
  }
  return static_cast<std::size_t>(part.data() - source.data());
}

std::size_t LoadedDocument::OffsetOf(const Json& position) const {
  const std::size_t offset = positions.OffsetOf(PositionFrom(position));
  return std::min(offset - std::min(offset, skipped), text.size());
}

Json LoadedDocument::RangeOf(std::size_t start, std::size_t end) const {
  return {{"start", ToJson(positions.PositionOf(skipped + start))},
          {"end", ToJson(positions.PositionOf(skipped + end))}};
}

Json LoadedDocument::RangeOf(std::string_view part) const {
  const std::size_t start = OffsetOf(part).value_or(0);
  return RangeOf(start, start + part.size());
}

Json LoadedDocument::RangeOf(const FilePlace& place) const {
  if (place.line < 1) return RangeOf(0, 0);
  const auto line = static_cast<std::size_t>(place.line) - 1;
  const std::size_t endOfLine = filePositions.EndOfLine(line);
  // A part that goes on in another line is shown up to the end of its first one.
  const auto offsetOf = [this, line, endOfLine](int column) {
    return column < 1 ? endOfLine : filePositions.OffsetOf({line, static_cast<std::size_t>(column) - 1});
  };
  std::size_t start = place.column < 1 ? filePositions.StartOfLine(line) : offsetOf(place.column);
  if (place.column < 1) {
    const std::size_t first = text.find_first_not_of(" \t", start);
    start = std::min(first, endOfLine);
  }
  std::size_t end = std::max(start, offsetOf(place.endColumn));
  while (place.endColumn < 1 && end > start && text[end - 1] == '\r') --end;
  return RangeOf(start, end);
}

const CEL_Element* LoadedDocument::ElementAt(std::size_t offset) const {
  for (auto section = outline.SectionAt(offset); section; section = outline.Sections()[*section].parent) {
    const auto hit = elementsBySection.find(*section);
    if (hit != elementsBySection.end()) return hit->second;
  }
  return nullptr;
}

std::optional<ExpressionPlace> LoadedDocument::ExpressionAt(std::size_t offset) const {
  const CEL_Element* element = ElementAt(offset);
  std::optional<ExpressionPlace> found;
  if (element == nullptr) return found;
  element->ForEachExpression([&](const PropertyRow&, const CEL_Property& expression) {
    const std::string_view inside = StripExpressionQuotes(expression.Text());
    const auto start = OffsetOf(inside);
    if (start && offset >= *start && offset <= *start + inside.size())
      found = ExpressionPlace{element, inside, *start, offset - *start};
  });
  return found;
}

std::optional<std::size_t> LoadedDocument::SectionOf(const CEL_Element& element) const {
  const auto hit = sectionsByLine.find(element.SourceLine());
  if (element.SourceLine() < 1 || hit == sectionsByLine.end()) return std::nullopt;
  return hit->second;
}

std::string_view LoadedDocument::KeywordOf(std::string_view value) const {
  const auto offset = OffsetOf(value);
  return offset ? outline.KeywordBefore(*offset) : std::string_view();
}

}  // namespace tessal::cli
