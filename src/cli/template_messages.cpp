#include "cli/template_messages.h"

#include <set>
#include <tuple>

#include "cli/element_index.h"
#include "cli/output.h"
#include "cli/template_files.h"
#include "cli/template_paths.h"
#include "core/error_registry.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "platform/text_encoding.h"

namespace tessal::cli {

namespace {

TemplateMessage Describe(const ErrorRecord& record, ElementIndex& elements) {
  TemplateMessage message;
  message.level = record.level;
  message.code = record.code;
  message.word = LevelWord(record.level);
  message.symbol = record.symbol;
  message.uid = IsElement(record.uid) ? record.uid : kNoElement;
  message.text = WithoutLineFeed(record.text);
  const CEL_Element* element = IsElement(record.uid) ? elements.Find(record.uid) : nullptr;
  message.kind = element == nullptr ? ElementKind::None : element->Kind();
  message.place.line = element == nullptr ? record.line : element->SourceLine();
  message.name = record.name;
  return message;
}

UndefinedName Describe(const UndefinedSymbol& undefined, ElementIndex& elements, const TemplateCore& core) {
  UndefinedName name;
  name.symbol = undefined.symbol;
  std::set<std::string> listed;
  for (const Uid uid : undefined.usedBy) {
    const SymbolRecord* record = elements.RecordOf(uid);
    UndefinedName::User user{"unknown", uid, {}, {}};
    if (record != nullptr) {
      user.symbol = core.RecordSymbol(*record);
      user.place.line = record->element->SourceLine();
    }
    if (listed.insert(user.symbol).second) name.usedBy.push_back(std::move(user));
  }
  return name;
}

}  // namespace

std::size_t TemplateMessages::Count() const {
  std::size_t count = errors.size();
  for (const UndefinedName& name : undefined) count += name.usedBy.size();
  return count;
}

TemplateMessages CollectMessages(const std::string& file, int lowestLevel) {
  // A comment that a file leaves open must not swallow the expressions of the next one.
  ResetExpressionScanner();
  TemplateCore& core = TheTemplate();
  const bool loaded = LoadPath(core, file);
  TemplateMessages messages = CollectMessages(core, file, lowestLevel);
  messages.loaded = loaded;
  return messages;
}

TemplateMessages CollectMessages(const TemplateCore& core, const std::string& file, int lowestLevel) {
  TemplateMessages messages;
  messages.path = file;
  messages.loaded = true;
  ElementIndex elements(core);
  std::set<std::tuple<std::uint32_t, std::string_view, std::string_view>> listed;
  for (const ErrorRecord& record : Errors().Records()) {
    if (static_cast<int>(record.level) < lowestLevel) continue;
    const bool isNew = listed.emplace(record.level, record.symbol, WithoutLineFeed(record.text)).second;
    if (isNew) messages.errors.push_back(Describe(record, elements));
  }
  for (const auto& undefined : core.UndefinedSymbols()) {
    messages.undefined.push_back(Describe(*undefined, elements, core));
  }
  if (lowestLevel <= static_cast<int>(ErrorLevel::Notice)) messages.account = core.Account().Entries();
  return messages;
}

std::string JsonText(const std::string& bytes) {
  return ToUtf8(bytes);
}

}  // namespace tessal::cli
