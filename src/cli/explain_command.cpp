// Says what the messages mean: one of them, all in a list, or all on a page.
#include "cli/commands.h"
#include "cli/explanation.h"

namespace tessal::cli {

ExitCode RunExplain(const std::string& code) {
  const MessageRow* row = FindMessage(code);
  if (row == nullptr) {
    Complain("no message has the code '" + code + "'");
    return kContentFault;
  }
  PrintLine(ExplanationText(*row));
  return kFine;
}

ExitCode RunExplainAll() {
  for (const auto rows : {AllMessages(), AnalysisMessages()}) {
    for (const MessageRow& row : rows) {
      PrintLine(std::string(row.code) + '\t' + std::string(LevelWordOf(row)) + '\t' +
                std::string(MessageText(row)));
    }
  }
  return kFine;
}

ExitCode RunExplainPage() {
  Print(MessagesPage());
  return kFine;
}

}  // namespace tessal::cli
