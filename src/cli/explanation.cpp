#include "cli/explanation.h"

#include <span>
#include <string_view>

#include "docgen/safe_text.h"

namespace tessal::cli {

namespace {

constexpr std::string_view kPageStart =
    "# Messages\n\n"
    "Every message that a load, a check, a change or a save can give, under its code. `%1`, `%2` and so on "
    "are\n"
    "the places of its values. `tessal explain CODE` prints the same, and `tessal check --format json` "
    "names\n"
    "the code of each message.\n";

constexpr std::string_view kAnalysesStart =
    "\n# Findings of analyses\n\n"
    "What `tessal units`, `tessal balance` and `tessal lint` find in a template that is well formed.\n";

void AppendRows(std::string& page, std::span<const MessageRow> rows) {
  for (const MessageRow& row : rows) {
    page += "\n## " + std::string(row.code) + "\n\n";
    page += std::string(LevelWordOf(row)) + ": `" + std::string(MessageText(row)) + "`\n\n";
    page += MarkdownText(row.meaning) + "\n\n" + HelpMarkdown(row) + "\n";
  }
}

}  // namespace

std::string HelpMarkdown(const MessageRow& row) {
  return "**Example:** " + MarkdownText(row.example) + "\n\n**Remedy:** " + MarkdownText(row.remedy);
}

std::string MessagesPage() {
  std::string page(kPageStart);
  AppendRows(page, AllMessages());
  page += kAnalysesStart;
  AppendRows(page, AnalysisMessages());
  return page;
}

}  // namespace tessal::cli
