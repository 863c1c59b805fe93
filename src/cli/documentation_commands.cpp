// Commands that document a template: the page and the overview.
#include "cli/commands.h"
#include "cli/template_files.h"
#include "core/template_core.h"
#include "docgen/html_documentation.h"
#include "docgen/overview.h"

namespace tessal::cli {

ExitCode RunOverview(const std::string& file) {
  TemplateCore core;
  if (!LoadOrComplain(core, file)) return kCallFault;
  WriteOverviewText(core, BuildOverview(core), [](const std::string& part) { Print(ForTerminal(part)); });
  return kFine;
}

ExitCode RunHtml(const std::string& file, const PageOptions& options, const std::string& output) {
  TemplateCore core;
  if (!LoadOrComplain(core, file)) return kCallFault;
  const std::string page = output.empty() ? PrepareUsualPagePath(file) : output;
  std::string failure;
  if (!ExportHtmlDocumentation(core, page, options, failure)) {
    Complain(failure);
    return kCallFault;
  }
  PrintLine(ForTerminal(page));
  return kFine;
}

}  // namespace tessal::cli
