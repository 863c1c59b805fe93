// Lists what the editor would show: the registry's records in order, then the undefined symbols.
#include <nlohmann/json.hpp>

#include "cli/commands.h"
#include "cli/explanation.h"
#include "cli/file_progress.h"
#include "cli/finding_report.h"
#include "cli/message_places.h"
#include "cli/template_files.h"
#include "cli/template_messages.h"
#include "cli/template_paths.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

void PrintText(const TemplateMessages& messages) {
  for (const TemplateMessage& message : messages.errors) {
    PrintLine(OnOneLine(messages.path) + ": " + Coloured(message.word, message.level) + ": " +
              (message.symbol.empty() ? "generic" : OnOneLine(message.symbol)) + ": " +
              OnOneLine(message.text));
  }
  for (const UndefinedName& undefined : messages.undefined) {
    for (const UndefinedName::User& user : undefined.usedBy) {
      PrintLine(OnOneLine(messages.path) + ": " + Coloured(kUndefinedWord, 0) + ": " +
                OnOneLine(user.symbol) + ": " + Finding("undefined-symbol", {undefined.symbol}).text);
    }
  }
  for (const AccountEntry& entry : messages.account) PrintLine(AccountLine(messages.path, entry));
}

Json ToJson(const TemplateMessages& messages) {
  Json errors = Json::array();
  for (const TemplateMessage& message : messages.errors) {
    errors.push_back({{"level", message.level},
                      {"word", message.word},
                      {"code", message.code},
                      {"symbol", JsonText(message.symbol)},
                      {"uid", NumberOf(message.uid)},
                      {"kind", NumberOf(message.kind)},
                      {"text", JsonText(message.text)},
                      {"line", message.place.line},
                      {"column", message.place.column}});
  }
  Json undefined = Json::array();
  for (const UndefinedName& name : messages.undefined) {
    Json users = Json::array();
    for (const UndefinedName::User& user : name.usedBy) users.push_back(JsonText(user.symbol));
    undefined.push_back({{"symbol", JsonText(name.symbol)}, {"usedBy", users}});
  }
  Json account = Json::array();
  for (const AccountEntry& entry : messages.account) {
    account.push_back({{"code", entry.code},
                       {"symbol", JsonText(entry.symbol)},
                       {"text", JsonText(entry.text)},
                       {"line", entry.line}});
  }
  return {{"path", JsonText(messages.path)},
          {"loaded", messages.loaded},
          {"errors", errors},
          {"undefined", undefined},
          {"account", account}};
}

/// Why a file could not be loaded.
void ComplainOfLoad(const TemplateMessages& messages) {
  for (const TemplateMessage& message : messages.errors) {
    Complain(OnOneLine(messages.path) + ": " + OnOneLine(message.text));
  }
}

void PrintAll(Format format, std::vector<TemplateMessages>& all) {
  if (format != Format::Json) {
    std::vector<FileReport> reports;
    for (TemplateMessages& messages : all) reports.push_back(ReportOf(std::move(messages)));
    return PrintReport(format, reports, {"check", AllMessages()});
  }
  Json list = Json::array();
  for (const TemplateMessages& messages : all) list.push_back(ToJson(messages));
  PrintLine(Json{{"files", list}}.dump());
}

}  // namespace

ExitCode RunCheck(const CheckCall& call) {
  const std::optional<std::vector<std::string>> files = FilesOf(call.paths);
  if (!files) return kCallFault;
  ExitCode exitCode = kFine;
  std::vector<TemplateMessages> all;
  MessageCount count;
  FileProgress progress(call.isQuiet ? 0 : files->size());
  for (const std::string& file : *files) {
    progress.Next();
    TemplateMessages messages = CollectMessages(file, call.lowestLevel);
    // The other files may be smaller.
    if (RanOutOfMemory()) ComplainOfMemory();
    if (!messages.loaded) exitCode = Worse(exitCode, kCallFault);
    if (!messages.IsClean()) exitCode = Worse(exitCode, kContentFault);
    count.AddFile(messages.Count());
    if (call.isQuiet) {
      if (!messages.loaded) ComplainOfLoad(messages);
    } else if (call.format == Format::Text) {
      if (messages.Count() + messages.account.size() > 0) progress.Hide();
      PrintText(messages);
    } else {
      FindPlaces(TheTemplate(), messages);
      all.push_back(std::move(messages));
    }
  }
  progress.Hide();
  if (call.isQuiet) return exitCode;
  const EndsWithoutMemory end;
  if (call.format != Format::Text) PrintAll(call.format, all);
  ShowCount(count);
  return exitCode;
}

}  // namespace tessal::cli
