// The elements that messages speak of, by their identities. A template may give as many messages as it has
// elements, and a walk through the symbol table for each would take its square.
#pragma once

#include <unordered_map>

#include "core/template_core.h"

namespace tessal::cli {

class ElementIndex final {
 public:
  /// The template outlives the index, and does not change while it is used.
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

}  // namespace tessal::cli
