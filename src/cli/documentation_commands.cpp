// Commands that document a template: the page and the overview.
#include <filesystem>
#include <optional>
#include <system_error>

#include "cli/commands.h"
#include "cli/template_files.h"
#include "core/template_core.h"
#include "docgen/html_documentation.h"
#include "docgen/overview.h"

namespace tessal::cli {

namespace {

/// Where the page goes. Nothing, with the reason, when something else is there.
std::optional<std::string> PagePath(const HtmlCall& call, std::string& failure) {
  if (call.output.empty()) return PrepareUsualPagePath(call.file, failure);
  std::error_code notThere;
  // The export refuses the template itself, forced or not.
  if (call.force || std::filesystem::equivalent(call.output, call.file, notThere)) return call.output;
  failure = PageRefusal(call.output);
  if (failure.empty()) return call.output;
  failure += "; --force replaces it";
  return std::nullopt;
}

}  // namespace

namespace {

PageOptions PageOf(const HtmlCall& call) {
  PageOptions page;
  page.mathJax = call.mathJax == "true" ? UsualMathJax() : call.mathJax;
  page.isSafe = call.isSafe;
  return page;
}

}  // namespace

ExitCode RunOverview(const std::string& file) {
  TemplateCore& core = TheTemplate();
  if (!LoadOrComplain(core, file)) return kCallFault;
  WriteOverviewText(core, BuildOverview(core),
                    [](std::string_view part) { Print(ForTerminal(std::string(part))); });
  return kFine;
}

ExitCode RunHtml(const HtmlCall& call) {
  TemplateCore& core = TheTemplate();
  if (!LoadOrComplain(core, call.file)) return kCallFault;
  std::string failure;
  const std::optional<std::string> page = PagePath(call, failure);
  if (!page || !ExportHtmlDocumentation(core, *page, PageOf(call), failure)) {
    Complain(failure);
    return kCallFault;
  }
  PrintLine(ForTerminal(*page));
  return kFine;
}

}  // namespace tessal::cli
