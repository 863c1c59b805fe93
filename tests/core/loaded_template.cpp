#include "core/loaded_template.h"

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
