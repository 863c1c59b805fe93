#include "cli/explanation.h"

#include "cli/output.h"
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

std::string_view LevelWordOf(const MessageRow& row) {
  return row.level == ErrorLevel::Undefined ? kUndefinedWord
                                            : LevelWord(static_cast<std::uint32_t>(row.level));
}

std::string_view TextOf(const MessageRow& row) {
  return WithoutLineFeed(row.text);
}

std::string HelpText(const MessageRow& row) {
  return "Example: " + std::string(row.example) + "\nRemedy: " + std::string(row.remedy);
}

std::string HelpMarkdown(const MessageRow& row) {
  return "**Example:** " + MarkdownText(row.example) + "\n\n**Remedy:** " + MarkdownText(row.remedy);
}

std::string MessagesPage() {
  std::string page(kPageStart);
  for (const MessageRow& row : AllMessages()) {
    page += "\n## " + std::string(row.code) + "\n\n";
    page += std::string(LevelWordOf(row)) + ": `" + std::string(TextOf(row)) + "`\n\n";
    page += MarkdownText(row.meaning) + "\n\n" + HelpMarkdown(row) + "\n";
  }
  return page;
}

}  // namespace tessal::cli
