// Any bytes load as a template or are refused with a message. What loads can be saved, and the saved file
// loads with the same elements.
#include <cstdint>
#include <string>
#include <vector>

#include "core/error_registry.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "template_file.h"

namespace {

using namespace tessal;
using fuzz::Require;

std::vector<std::string> SymbolsOf(const TemplateCore& core) {
  std::vector<std::string> symbols;
  for (const SymbolRecord& record : core.SymbolTable()) {
    Require(record.element->Kind() != ElementKind::None, "a record has an element of a kind");
    symbols.push_back(core.RecordSymbol(record));
    for (const std::uint32_t used : record.references) {
      const SymbolRecord* other = core.FindRecordBySequence(used);
      Require(other != nullptr, "a reference has a record");
    }
  }
  return symbols;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string path = fuzz::ScratchFile("in.tessal");
  const std::string copy = fuzz::ScratchFile("out.tessal");
  ResetExpressionScanner();
  Require(ReplaceFile(path, {reinterpret_cast<const char*>(data), size}).empty(),
          "the scratch file is written");
  TemplateCore core;
  if (!core.LoadWrapper(path)) {
    Require(!Errors().Records().empty(), "a failed load says why");
    return 0;
  }
  Errors().JoinErrors();
  const std::vector<std::string> symbols = SymbolsOf(core);
  if (!core.SaveWrapper(copy)) {
    Require(!Errors().Records().empty(), "a failed save says why");
    return 0;
  }
  ResetExpressionScanner();
  TemplateCore again;
  Require(again.LoadWrapper(copy), "what was saved loads");
  Require(SymbolsOf(again) == symbols, "and has the same symbols");
  return 0;
}
