// Any sequence of edits leaves a template whole: its table is consistent, and it comes back from a file as it
// was.
#include <algorithm>
#include <cstdint>
#include <string>
#include <vector>

#include "core/error_registry.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "expr/user_function_names.h"
#include "support/choices.h"
#include "support/random_edits.h"
#include "support/template_content.h"
#include "template_file.h"

namespace {

using namespace tessal;
using fuzz::Choices;
using fuzz::Require;

void CheckTable(const TemplateCore& core) {
  std::uint32_t place = 0;
  for (const SymbolRecord& record : core.SymbolTable()) {
    Require(record.sequence == ++place, "sequences are places");
    for (const std::uint32_t used : record.references) {
      const auto& users = core.FindRecordBySequence(used)->referencedBy;
      Require(std::find(users.begin(), users.end(), record.sequence) != users.end(), "references are mutual");
    }
  }
}

std::string StartText(const std::string& path) {
  std::string failure;
  return ReadWholeFile(path, failure).value_or("");
}

/// The sections that a template carries over for others, with comments wherever they may be.
void LoadFurtherSections(TemplateCore& core) {
  const std::string path = fuzz::ScratchFile("start.tessal");
  static const bool kWritten =
      TemplateCore().SaveWrapper(path) &&
      ReplaceFile(path, StartText(path) +
                            "[FIRST] // at its head\r\n// in it\r\nA = 1, -0.25, 'it', |is| // after it\r\n"
                            "[INNER]\r\nB = TRUE\r\nEndSect // inner\r\nEndSect // FIRST\r\n")
          .empty();
  Require(kWritten && core.LoadWrapper(path), "the start is there");
  SetNotifyChanges(true);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  constexpr int kMostEdits = 60;
  ResetExpressionScanner();
  ResetUserFunctionNames();
  TemplateCore core;
  Choices choices(data, size);
  LoadFurtherSections(core);
  for (int edit = 0; edit < kMostEdits && !choices.Done(); ++edit) {
    test::EditAtRandom(core, choices);
    CheckTable(core);
  }
  ResetExpressionScanner();
  core.RebuildSymbolTable();
  Errors().ClearErrors();
  core.ValidateTemplate();
  const std::string path = fuzz::ScratchFile("edited.tessal");
  if (!core.SaveWrapper(path)) {
    Require(!Errors().Records().empty(), "a failed save says why");
    return 0;
  }
  const std::string content = test::TemplateContent(core);
  ResetExpressionScanner();
  TemplateCore again;
  Require(again.LoadWrapper(path), "what was saved loads");
  const std::string loaded = test::TemplateContent(again);
  if (loaded != content) std::fprintf(stderr, "%s\n-- becomes --\n%s\n", content.c_str(), loaded.c_str());
  Require(loaded == content, "and holds the same values");
  Require(content.find("// at its head") != std::string::npos, "among them the further sections");
  return 0;
}
