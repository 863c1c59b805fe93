#include "cli/explanation.h"

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

}  // namespace

std::string HelpMarkdown(const MessageRow& row) {
  return "**Example:** " + MarkdownText(row.example) + "\n\n**Remedy:** " + MarkdownText(row.remedy);
}

std::string MessagesPage() {
  std::string page(kPageStart);
  for (const MessageRow& row : AllMessages()) {
    page += "\n## " + std::string(row.code) + "\n\n";
    page += std::string(LevelWordOf(row)) + ": `" + std::string(MessageText(row)) + "`\n\n";
    page += MarkdownText(row.meaning) + "\n\n" + HelpMarkdown(row) + "\n";
  }
  return page;
}

}  // namespace tessal::cli
