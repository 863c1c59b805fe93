// What a word under the pointer means.
#include <string>

#include "cli/lsp/features.h"
#include "cli/lsp/field_words.h"
#include "cli/lsp/symbol_places.h"
#include "docgen/reference_pages.h"
#include "elements/format_words.h"
#include "expr/builtin_catalogue.h"
#include "expr/token_spans.h"
#include "platform/ascii.h"

namespace tessal::cli {

namespace {

Json HoverOf(const LoadedDocument& document, std::string_view part, const std::string& markdown) {
  if (markdown.empty()) return nullptr;
  return {{"contents", {{"kind", "markdown"}, {"value", markdown}}}, {"range", document.RangeOf(part)}};
}

/// A text as Markdown shows it to the letter.
std::string Literal(std::string_view text) {
  constexpr std::string_view kMarks = "\\`*_{}[]<>#|~&!";
  std::string literal;
  for (const char byte : text) {
    if (kMarks.find(byte) != std::string_view::npos) literal += '\\';
    literal += byte;
  }
  return literal;
}

struct ShownField {
  std::string_view label;
  const char* caption;
};

constexpr ShownField kFields[] = {
    {"Unit", "unit"},         {"Default Value", "value"}, {"Min Value", "minimum"},
    {"Max Value", "maximum"}, {"Scope", "scope"},         {"Spatial Variation", "spatial variation"},
};

/// An element as its section has it: what it is, its values, its expressions.
std::string MarkdownOf(const CEL_Element& element) {
  std::string markdown = "**" + Literal(element.FullSymbol()) + "** " + std::string(element.KindText());
  const std::string_view description = element.description.Text();
  if (!description.empty()) markdown += "\n\n" + Literal(description);
  std::string facts;
  for (const ShownField& field : kFields) {
    const PropertyPlace place = element.PlaceWithLabel(field.label);
    const std::string value = place == nullptr ? std::string() : (element.*place).TextOf();
    if (!value.empty()) facts += std::string("\n- ") + field.caption + ": " + Literal(value);
  }
  if (!facts.empty()) markdown += "\n" + facts;
  element.ForEachExpression([&markdown](const PropertyRow& row, const CEL_Property& expression) {
    const std::string_view text = StripExpressionQuotes(expression.Text());
    if (text.empty() || text.find("```") != std::string_view::npos) return;
    markdown += "\n\n" + std::string(row.label) + ":\n```\n" + std::string(text) + "\n```";
  });
  return markdown;
}

/// What a word of the language means that no element has as its symbol.
std::string MarkdownOfWord(std::string_view word) {
  if (const FunctionReference* function = ReferenceOfFunction(word)) return EntryMarkdown(EntryOf(*function));
  if (const WordReference* reference = ReferenceOfWord(word)) return EntryMarkdown(EntryOf(*reference));
  for (const CatalogueBuiltin& builtin : Builtins()) {
    if (builtin.name == word) return EntryMarkdown(EntryOf(builtin));
  }
  return {};
}

/// The token at a place of an expression. Between two, the one that begins there counts.
std::string_view TokenAt(const ExpressionPlace& place) {
  std::string_view found;
  for (const TokenSpan& token : TokenSpans(place.text)) {
    if (place.caret >= token.span.start && place.caret < token.End()) return TextOf(place.text, token);
    if (place.caret == token.End()) found = TextOf(place.text, token);
  }
  return found;
}

/// The word of letters, digits and underscores at a place.
std::string_view WordAround(std::string_view text, std::size_t place) {
  std::size_t start = place;
  while (start > 0 && IsWordCharacter(text[start - 1])) --start;
  std::size_t end = place;
  while (end < text.size() && IsWordCharacter(text[end])) ++end;
  return text.substr(start, end - start);
}

std::string MarkdownOfFormat(const LoadedDocument& document, std::size_t offset, std::string_view word) {
  const std::string_view ofFormat = document.Outline().WordAt(offset);
  if (!ofFormat.empty()) {
    if (const SectionWord* section = WordOfSection(ofFormat)) return std::string(section->meaning);
    return std::string(MeaningOfKeyword(UpperCase(ofFormat)));
  }
  const CEL_Element* element = document.ElementAt(offset);
  if (element == nullptr) return {};
  for (const ValueWord& choice : WordsOfValue(*element, document.Outline().KeywordBefore(offset))) {
    if (choice.word == word) return choice.meaning;
  }
  return {};
}

}  // namespace

Json Hover(const LoadedDocument& document, const Json& params) {
  const std::size_t offset = PositionIn(document, params);
  const auto name = NameAt(document, offset);
  if (name && name->record != nullptr)
    return HoverOf(document, name->name, MarkdownOf(*name->record->element));
  if (const auto expression = document.ExpressionAt(offset)) {
    const std::string_view token = TokenAt(*expression);
    return HoverOf(document, token, MarkdownOfWord(token));
  }
  const std::string_view word = WordAround(document.Core().SourceText(), offset);
  return HoverOf(document, word, MarkdownOfFormat(document, offset, word));
}

}  // namespace tessal::cli
