// Commands that write a template: save, new and rename.
#include <filesystem>
#include <system_error>

#include "cli/commands.h"
#include "cli/template_files.h"
#include "core/rename.h"
#include "core/template_core.h"
#include "elements/property_io.h"

namespace tessal::cli {

ExitCode RunSave(const std::string& file, const std::string& output) {
  TemplateCore core;
  if (!LoadToSave(core, file)) return kCallFault;
  return SaveOrComplain(core, output.empty() ? file : output) ? kFine : kCallFault;
}

ExitCode RunNew(const std::string& output, bool overwrite) {
  std::error_code error;
  if (!overwrite && std::filesystem::exists(std::filesystem::symlink_status(output, error))) {
    Complain("'" + output + "' exists already; --force replaces it");
    return kCallFault;
  }
  TemplateCore core;
  return SaveOrComplain(core, output) ? kFine : kCallFault;
}

ExitCode RunRename(const RenameCall& call) {
  TemplateCore core;
  if (!LoadToSave(core, call.file)) return kCallFault;
  const std::string newSymbol(CleanText(call.newSymbol));
  std::string refusal = RenameRefusal(core, newSymbol);
  if (refusal.empty() && !core.RenameSymbol(call.oldSymbol, newSymbol, !call.onlySymbol)) {
    refusal = RenameFailure(newSymbol);
  }
  if (!refusal.empty()) {
    PrintLine(refusal);
    return kContentFault;
  }
  return SaveOrComplain(core, call.output.empty() ? call.file : call.output) ? kFine : kCallFault;
}

}  // namespace tessal::cli
