// Finds a pattern in the texts and expressions of a template.
#include "core/find.h"

#include <nlohmann/json.hpp>

#include "cli/commands.h"
#include "cli/template_files.h"
#include "cli/template_messages.h"
#include "core/template_core.h"
#include "platform/text_encoding.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

Json ToJson(const FoundText& found) {
  Json matches = Json::array();
  for (const TextMatch& match : found.matches)
    matches.push_back({{"start", match.start}, {"length", match.length}});
  return {{"symbol", JsonText(found.owner)}, {"kind", found.kind}, {"kindText", KindText(found.kind)},
          {"field", found.place.field},      {"line", found.line}, {"text", JsonText(found.text)},
          {"matches", std::move(matches)}};
}

}  // namespace

ExitCode RunFind(const FindCall& call) {
  TemplateCore& core = TheTemplate();
  if (!LoadOrComplain(core, call.file)) return kCallFault;
  // The libraries of patterns and of JSON lose the exception.
  const EndsWithoutMemory end;
  FindQuery query{{ToUtf8(call.pattern), call.isRegex, call.wholeSymbols, call.ignoreCase}, call.in};
  const FindResult result = FindTexts(core, query);
  if (!result.failure.empty()) {
    Complain(OnOneLine(result.failure));
    return kCallFault;
  }
  if (call.format == Format::Json) {
    Json list = Json::array();
    for (const FoundText& found : result.found) list.push_back(ToJson(found));
    PrintLine(Json{{"path", JsonText(call.file)}, {"found", std::move(list)}}.dump());
  } else {
    for (const FoundText& found : result.found) {
      PrintLine(ForTerminal(OnOneLine(found.owner) + ": " + std::string(found.place.field) + ": " +
                            OnOneLine(found.text)));
    }
  }
  return result.found.empty() ? kContentFault : kFine;
}

}  // namespace tessal::cli
