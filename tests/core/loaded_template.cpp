#include "core/loaded_template.h"

#include <stdexcept>

#include "core/error_registry.h"
#include "expr/scanner.h"

namespace tessal::test {

LoadedTemplate::LoadedTemplate(const std::string& text) : path(folder.Write("model.tessal", text)) {
  ResetExpressionScanner();
  loaded = core.LoadWrapper(path);
  SetNotifyChanges(true);
}

LoadedTemplate::~LoadedTemplate() {
  SetNotifyChanges(false);
}

std::uint32_t LoadedTemplate::Uid(const std::string& symbol) const {
  return Record(symbol).element->GetUid();
}

const SymbolRecord& LoadedTemplate::Record(const std::string& symbol) const {
  std::uint32_t sequence = 0;
  if (!core.FindSymbol(symbol, sequence)) throw std::runtime_error("no symbol " + symbol);
  return *core.FindRecordBySequence(sequence);
}

std::string LoadedTemplate::References(const std::string& symbol) const {
  std::string names;
  for (const std::uint32_t used : Record(symbol).references) {
    names += core.RecordSymbol(*core.FindRecordBySequence(used)) + " ";
  }
  return names;
}

std::string LoadedTemplate::Undefined() const {
  std::string names;
  for (const auto& undefined : core.UndefinedSymbols()) names += undefined->symbol + " ";
  return names;
}

std::string Messages() {
  std::string text;
  for (const ErrorRecord& record : Errors().Records()) {
    text += std::to_string(record.level) + " " + record.symbol + ": " + record.text;
    if (record.text.ends_with('\n')) text.pop_back();
    if (record.line > 0) text += " (line " + std::to_string(record.line) + ")";
    text += "\n";
  }
  return text;
}

}  // namespace tessal::test
