// Whatever is edited can be taken back and done again, to the byte.
#include <cstdint>
#include <cstdio>
#include <string>

#include "expr/scanner.h"
#include "expr/user_function_names.h"
#include "support/random_edits.h"
#include "template_file.h"

using namespace tessal;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  constexpr int kMostEdits = 60;
  ResetExpressionScanner();
  ResetUserFunctionNames();
  TemplateCore core;
  SetNotifyChanges(true);
  fuzz::Choices choices(data, size);
  const std::string fault =
      test::FaultOfHistory(core, choices, kMostEdits, fuzz::ScratchFile("history.tessal"));
  if (!fault.empty()) std::fprintf(stderr, "%s\n", fault.c_str());
  fuzz::Require(fault.empty(), "all can be taken back and done again");
  return 0;
}
