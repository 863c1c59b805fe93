// Commands that document a template: the page and the overview.
#include <filesystem>
#include <system_error>

#include "cli/commands.h"
#include "cli/template_files.h"
#include "core/template_core.h"
#include "docgen/html_documentation.h"
#include "docgen/overview.h"

namespace tessal::cli {

namespace {

/// The page that the editor writes: in a folder beside the template, under the template's plain name.
std::filesystem::path UsualPage(const std::string& file) {
  const std::filesystem::path folder = std::filesystem::path(file).parent_path() / "HTML_doc";
  std::error_code ignored;  // what cannot be made shows when the page is written
  std::filesystem::create_directories(folder, ignored);
  return folder / std::filesystem::path(file).filename().replace_extension(".html");
}

}  // namespace

ExitCode RunOverview(const std::string& file) {
  TemplateCore core;
  if (!LoadOrComplain(core, file)) return kCallFault;
  Print(OverviewText(core, BuildOverview(core)));
  return kFine;
}

ExitCode RunHtml(const std::string& file, bool withMathJax, const std::string& output) {
  TemplateCore core;
  if (!LoadOrComplain(core, file)) return kCallFault;
  const std::string page = output.empty() ? UsualPage(file).string() : output;
  std::string failure;
  if (!ExportHtmlDocumentation(core, page, withMathJax, failure)) {
    Complain(failure);
    return kCallFault;
  }
  PrintLine(page);
  return kFine;
}

}  // namespace tessal::cli
