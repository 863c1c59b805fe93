// Any bytes load as a template or are refused with a message. What loads can be saved, and the saved file
// loads with the same content and stays what it is.
#include <cstdint>
#include <string>

#include "core/error_registry.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "stable_save.h"
#include "template_file.h"

namespace {

using namespace tessal;
using fuzz::Require;

void CheckTable(const TemplateCore& core) {
  for (const SymbolRecord& record : core.SymbolTable()) {
    Require(record.element->Kind() != ElementKind::None, "a record has an element of a kind");
    for (const std::uint32_t used : record.references) {
      Require(core.FindRecordBySequence(used) != nullptr, "a reference has a record");
    }
  }
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
  CheckTable(core);
  if (!core.SaveWrapper(copy)) {
    Require(!Errors().Records().empty(), "a failed save says why");
    return 0;
  }
  fuzz::RequireStable(core, copy);
  return 0;
}
