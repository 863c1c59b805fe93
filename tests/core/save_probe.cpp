// Loads a template, changes a text and saves it in place: what the fault tests interrupt. Exits with 0 when
// the save succeeded, 1 when it failed and told why, 3 when it failed without a reason, 2 when the load
// failed.
#include <cstdio>

#include "core/error_registry.h"
#include "core/template_core.h"

int main(int count, char** arguments) {
  if (count != 2) return 2;
  tessal::TemplateCore core;
  if (!core.LoadWrapper(arguments[1])) return 2;
  core.Root().description.SetText("changed");
  tessal::Errors().ClearErrors();
  if (core.SaveWrapper(arguments[1])) return 0;
  const std::string reasons = tessal::Errors().JoinErrors();
  std::fputs(reasons.c_str(), stderr);
  return reasons.empty() ? 3 : 1;
}
