#include "cli/template_messages.h"

#include <set>
#include <tuple>
#include <unordered_map>

#include "cli/output.h"
#include "cli/template_files.h"
#include "cli/template_paths.h"
#include "core/error_registry.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "platform/text_encoding.h"

namespace tessal::cli {

namespace {

/// The elements that messages speak of, by their identities. A template may give as many messages as it has
/// elements, and a walk through the symbol table for each would take its square.
class ElementIndex final {
 public:
  explicit ElementIndex(const TemplateCore& indexed) : core(indexed) {}

  /// The element with that identity, or none.
  const CEL_Element* Find(Uid uid) {
    MakeOnce();
    const auto hit = entries.find(uid);
    return hit == entries.end() ? nullptr : hit->second.element;
  }
  /// Its first record, or none.
  const SymbolRecord* RecordOf(Uid uid) {
    MakeOnce();
    const auto hit = entries.find(uid);
    return hit == entries.end() ? nullptr : hit->second.record;
  }

 private:
  struct Entry {
    const CEL_Element* element;
    const SymbolRecord* record;
  };

  /// Most templates have no message, and need none of it.
  void MakeOnce() {
    if (!entries.empty()) return;
    for (const SymbolRecord& record : core.SymbolTable()) {
      entries.try_emplace(record.uid, Entry{record.element, &record});
    }
    Add(core.Root());
    for (const auto& head : core.ListHeads()) Add(*head);
    if (const CEL_Miscanellous* misc = core.GetMisc()) Add(*misc);
  }

  void Add(const CEL_Element& element) { entries.try_emplace(element.GetUid(), Entry{&element, nullptr}); }

  const TemplateCore& core;
  std::unordered_map<Uid, Entry> entries;
};

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
  message.line = element == nullptr ? record.line : element->SourceLine();
  return message;
}

UndefinedName Describe(const UndefinedSymbol& undefined, ElementIndex& elements, const TemplateCore& core) {
  UndefinedName name;
  name.symbol = undefined.symbol;
  std::set<std::string> listed;
  for (const Uid uid : undefined.usedBy) {
    const SymbolRecord* record = elements.RecordOf(uid);
    const UndefinedName::User user =
        record == nullptr ? UndefinedName::User{"unknown", 0}
                          : UndefinedName::User{core.RecordSymbol(*record), record->element->SourceLine()};
    if (listed.insert(user.symbol).second) name.usedBy.push_back(user);
  }
  return name;
}

}  // namespace

TemplateMessages CollectMessages(const std::string& file, int lowestLevel) {
  TemplateMessages messages;
  messages.path = file;
  // A comment that a file leaves open must not swallow the expressions of the next one.
  ResetExpressionScanner();
  TemplateCore& core = TheTemplate();
  messages.loaded = LoadPath(core, file);
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
