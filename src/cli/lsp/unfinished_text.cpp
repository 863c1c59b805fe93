#include "cli/lsp/unfinished_text.h"

#include <algorithm>

#include "cli/lsp/symbol_places.h"
#include "platform/ascii.h"

namespace tessal::cli {

namespace {

constexpr std::string_view kEndOfSection = " EndSect";
constexpr std::string_view kExpressionStart = "'\"";
constexpr std::string_view kExpressionEnd = "\"'";
constexpr std::string_view kFileSyntax = "file-syntax";

LeftOut LineAround(std::string_view text, std::size_t place) {
  const std::size_t start = place == 0 ? 0 : text.rfind('\n', place - 1) + 1;
  const std::size_t end = std::min(text.find_first_of("\r\n", std::max(start, place)), text.size());
  return {start, end};
}

/// The line at which the reading stopped, from 1; 0 where it did for another reason.
int LineOfFault(const LoadedDocument& unread) {
  const auto& errors = unread.Messages().errors;
  const auto fault = std::find_if(errors.begin(), errors.end(),
                                  [](const TemplateMessage& message) { return message.code == kFileSyntax; });
  return fault == errors.end() ? 0 : fault->place.line;
}

/// Where the text after a keyword's `=` begins; none for a line without.
std::size_t ValueOfLine(std::string_view line) {
  const std::size_t sign = line.find('=');
  return KeywordOfLine(line).empty() ? std::string_view::npos : line.find_first_not_of(" \t", sign + 1);
}

/// The element that a line of a section is about: in a section of equations the one whose symbol the keyword
/// is.
const CEL_Element* ElementOfLine(const LoadedDocument& document, std::string_view line, std::size_t offset) {
  const SymbolRecord* equation = RecordOf(document.Core(), KeywordOfLine(line));
  return equation != nullptr ? equation->element : document.ElementAt(offset);
}

}  // namespace

std::vector<LeftOut> LeftOutAt(const LoadedDocument& unread, std::size_t place) {
  const LeftOut line = LineAround(unread.Text(), place);
  std::vector<LeftOut> all{line, {line.start, line.end, true}};
  for (const LeftOut& atFault : LeftOutAtFault(unread)) all.push_back(atFault);
  return all;
}

std::vector<LeftOut> LeftOutAtFault(const LoadedDocument& unread) {
  const int line = LineOfFault(unread);
  if (line < 1) return {};
  const std::string_view text = unread.Text();
  std::size_t place = 0;
  for (int count = 1; count < line; ++count) place = std::min(text.find('\n', place), text.size() - 1) + 1;
  const LeftOut last = LineAround(text, place);
  if (last.start == 0) return {last};
  // A text whose quote is missing ends at the next one, which is mostly in the next line.
  return {last, {LineAround(text, last.start - 1).start, last.end}};
}

std::string WithLeftOut(const LoadedDocument& unread, const LeftOut& leftOut) {
  std::string text = unread.Document().text;
  const auto skipped = static_cast<std::ptrdiff_t>(text.size() - unread.TypedText().size());
  const auto start = text.begin() + skipped + static_cast<std::ptrdiff_t>(leftOut.start);
  const auto end = text.begin() + skipped + static_cast<std::ptrdiff_t>(leftOut.end);
  std::replace_if(
      start, end, [](char byte) { return byte != '\r' && byte != '\n'; }, ' ');
  if (leftOut.endsSection) text.insert(end, kEndOfSection.begin(), kEndOfSection.end());
  return text;
}

std::string_view LineBefore(const LoadedDocument& document, std::size_t offset) {
  const std::string_view text = document.TypedText();
  const std::size_t start = LineAround(text, offset).start;
  return text.substr(start, offset - start);
}

std::string_view KeywordOfLine(std::string_view line) {
  const std::size_t sign = std::min(line.find_first_of("=[/"), line.size());
  if (sign == line.size() || line[sign] != '=') return {};
  std::string_view keyword = line.substr(0, sign);
  while (!keyword.empty() && (keyword.front() == ' ' || keyword.front() == '\t')) keyword.remove_prefix(1);
  while (!keyword.empty() && (keyword.back() == ' ' || keyword.back() == '\t')) keyword.remove_suffix(1);
  return std::all_of(keyword.begin(), keyword.end(), IsWordCharacter) ? keyword : std::string_view();
}

std::optional<ExpressionPlace> UnfinishedExpression(const LoadedDocument& document, std::size_t offset) {
  const std::string_view before = LineBefore(document, offset);
  const std::size_t value = ValueOfLine(before);
  if (value == std::string_view::npos || !before.substr(value).starts_with(kExpressionStart))
    return std::nullopt;
  const std::size_t caret = before.size() - value - kExpressionStart.size();
  const std::size_t start = offset - caret;
  const std::size_t lineEnd = LineAround(document.TypedText(), offset).end;
  std::string_view text = document.TypedText().substr(start, lineEnd - start);
  text = text.substr(0, text.find(kExpressionEnd));
  const CEL_Element* element = ElementOfLine(document, before, offset);
  if (element == nullptr || caret > text.size()) return std::nullopt;
  return ExpressionPlace{element, text, start, caret};
}

}  // namespace tessal::cli
