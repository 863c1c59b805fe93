#include "cli/template_messages.h"

#include "cli/output.h"
#include "core/error_registry.h"
#include "core/template_core.h"
#include "platform/text_encoding.h"

namespace tessal::cli {

namespace {

TemplateMessage Describe(const ErrorRecord& record, const TemplateCore& core) {
  TemplateMessage message;
  message.level = record.level;
  message.word = LevelWord(record.level);
  message.symbol = record.symbol;
  message.uid = record.uid > 0 ? record.uid : -1;
  message.text = WithoutLineFeed(record.text);
  const CEL_Element* element =
      record.uid > 0 ? core.GetElement(static_cast<std::uint32_t>(record.uid)) : nullptr;
  message.kind = element == nullptr ? 0 : element->Kind();
  message.line = element == nullptr ? 0 : element->SourceLine();
  return message;
}

UndefinedName Describe(const UndefinedSymbol& undefined, const TemplateCore& core) {
  UndefinedName name;
  name.symbol = undefined.symbol;
  name.line = 0;
  for (const std::uint32_t uid : undefined.usedBy) {
    std::string user = "unknown";
    core.GetSymbolOfUid(uid, user);
    name.usedBy.push_back(user);
    const CEL_Element* element = core.GetElement(uid);
    if (name.line == 0 && element != nullptr) name.line = element->SourceLine();
  }
  return name;
}

}  // namespace

TemplateMessages CollectMessages(const std::string& file, int lowestLevel) {
  TemplateMessages messages;
  messages.path = file;
  TemplateCore core;
  messages.loaded = core.LoadWrapper(file);
  for (const ErrorRecord& record : Errors().Records()) {
    if (static_cast<int>(record.level) >= lowestLevel) messages.errors.push_back(Describe(record, core));
  }
  for (const auto& undefined : core.UndefinedSymbols())
    messages.undefined.push_back(Describe(*undefined, core));
  return messages;
}

std::string JsonText(const std::string& bytes) {
  return ToUtf8(bytes);
}

}  // namespace tessal::cli
