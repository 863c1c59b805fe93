#include "docgen/change_pages.h"

#include <algorithm>
#include <array>

#include "docgen/page_style.h"
#include "docgen/safe_text.h"
#include "platform/text_encoding.h"

namespace tessal {

namespace {

struct Heading {
  ChangeKind change;
  std::string_view text;
};
constexpr std::array<Heading, 4> kHeadings = {{
    {ChangeKind::Removed, "Removed"},
    {ChangeKind::Added, "Added"},
    {ChangeKind::Renamed, "Renamed"},
    {ChangeKind::Changed, "Changed"},
}};

constexpr std::string_view kSame = "The two hold the same.";

/// How a page writes a text, and marks what went and what came.
struct Markup {
  std::string (*write)(std::string_view text);
  std::string_view wentOpen;
  std::string_view wentClose;
  std::string_view cameOpen;
  std::string_view cameClose;
};

/// On one line, as a list has it.
std::string InMarkdown(std::string_view text) {
  std::string line(text);
  std::replace_if(
      line.begin(), line.end(), [](char each) { return each == '\n' || each == '\r'; }, ' ');
  return MarkdownText(ToUtf8(line));
}

std::string InHtml(std::string_view text) {
  return SafeText(ToUtf8(text));
}

constexpr Markup kMarkdown = {InMarkdown, "~~", "~~", "**", "**"};
constexpr Markup kHtml = {InHtml, "<del>", "</del>", "<ins>", "</ins>"};

struct BeforeAndAfter {
  std::string before;
  std::string after;
};

BeforeAndAfter Shown(const FieldChange& field, const Markup& markup) {
  ExpressionDifference difference;
  if (field.isExpression) difference = DifferenceOf(field.before, field.after);
  return {MarkedText(field.before, difference.before, markup.wentOpen, markup.wentClose, markup.write),
          MarkedText(field.after, difference.after, markup.cameOpen, markup.cameClose, markup.write)};
}

/// "kd, formerly k1, of Fish (Constant)".
std::string Caption(const SymbolChange& change, std::string (*write)(std::string_view)) {
  std::string caption = write(change.symbol.empty() ? change.kind : change.symbol);
  if (change.change == ChangeKind::Renamed) caption += ", formerly " + write(change.formerSymbol);
  if (!change.specie.empty()) caption += " of " + write(change.specie);
  if (!change.symbol.empty()) caption += " (" + write(change.kind) + ")";
  return caption;
}

std::string MarkdownOf(const SymbolChange& change) {
  std::string text = "- " + Caption(change, InMarkdown) + "\n";
  for (const FieldChange& field : change.fields) {
    const BeforeAndAfter shown = Shown(field, kMarkdown);
    const auto orNothing = [](const std::string& value) { return value.empty() ? "*nothing*" : value; };
    text += "  - " + InMarkdown(field.field) + ": " + orNothing(shown.before) + " → " +
            orNothing(shown.after) + "\n";
  }
  return text;
}

std::string Cell(const std::string& content) {
  return "<td>" + content + "</td>";
}

std::string HtmlOf(const SymbolChange& change) {
  std::string rows;
  const std::string caption = Cell(Caption(change, InHtml));
  for (const FieldChange& field : change.fields) {
    const BeforeAndAfter shown = Shown(field, kHtml);
    rows += "<tr>" + (rows.empty() ? caption : Cell("")) + Cell(InHtml(field.field)) + Cell(shown.before) +
            Cell(shown.after) + "</tr>\n";
  }
  if (rows.empty()) rows = "<tr>" + caption + Cell("") + Cell("") + Cell("") + "</tr>\n";
  return rows;
}

/// The changes of each sort after its heading; sorts without any are left out.
template <class Begin, class Write>
void ForEachSort(const std::vector<SymbolChange>& changes, Begin begin, Write write) {
  for (const Heading& heading : kHeadings) {
    bool isFirst = true;
    for (const SymbolChange& change : changes) {
      if (change.change != heading.change) continue;
      if (isFirst) begin(heading.text);
      isFirst = false;
      write(change);
    }
  }
}

}  // namespace

std::string ChangesMarkdown(const std::vector<SymbolChange>& changes, std::string_view former,
                            std::string_view later) {
  std::string text = "# Changes from " + InMarkdown(former) + " to " + InMarkdown(later) + "\n";
  if (changes.empty()) return text + "\n" + std::string(kSame) + "\n";
  ForEachSort(
      changes, [&text](std::string_view heading) { text += "\n## " + std::string(heading) + "\n\n"; },
      [&text](const SymbolChange& change) { text += MarkdownOf(change); });
  return text;
}

std::string ChangesHtml(const std::vector<SymbolChange>& changes, std::string_view former,
                        std::string_view later) {
  const std::string title = "Changes from " + InHtml(former) + " to " + InHtml(later);
  std::string page =
      "<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n<title>" + title +
      "</title>\n" + std::string(kPageStyle) +
      "\n<style>\nbody { margin: 1.5em; }\ntd, td + td { display: table-cell; padding: 0.2em 0.6em; }\n"
      "th { text-align: left; padding: 0.2em 0.6em; }\nins { font-weight: bold; }\n</style>\n"
      "</head>\n<body>\n<h1>" +
      title + "</h1>\n";
  if (changes.empty()) page += "<p>" + std::string(kSame) + "</p>\n";
  bool isOpen = false;
  ForEachSort(
      changes,
      [&page, &isOpen](std::string_view heading) {
        if (isOpen) page += "</table>\n";
        isOpen = true;
        page += "<h2>" + std::string(heading) +
                "</h2>\n<table>\n<tr><th>Item</th><th>Field</th><th>Before</th><th>After</th></tr>\n";
      },
      [&page](const SymbolChange& change) { page += HtmlOf(change); });
  if (isOpen) page += "</table>\n";
  return page + "</body>\n</html>\n";
}

}  // namespace tessal
