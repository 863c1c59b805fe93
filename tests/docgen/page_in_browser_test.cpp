// The page as a browser lays it out, with the style block alone and with a local MathJax.
// What a script in a page finds out reaches the test through the page's own document, which the browser
// prints.
#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <optional>
#include <sstream>

#include "core/template_core.h"
#include "docgen/html_documentation.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::TemporaryFolder;

struct BrowserRun {
  bool started = false;  ///< whether a document came back
  int exitCode = -1;
  std::string document;  ///< after its scripts have run
};

/// The browser's program, or nothing where none is installed.
std::optional<std::string> FindBrowser() {
  const char* path = std::getenv("PATH");
  std::istringstream folders(path == nullptr ? "" : path);
  for (std::string folder; std::getline(folders, folder, ':');) {
    for (const char* name : {"chromium", "chromium-browser", "google-chrome"}) {
      const std::string program = (std::filesystem::path(folder) / name).string();
      if (access(program.c_str(), X_OK) == 0) return program;
    }
  }
  return std::nullopt;
}

/// Opens the page in a headless browser, with a profile of its own that goes when the run ends, and waits no
/// longer than two minutes.
BrowserRun RunBrowser(const std::string& browser, const std::string& page) {
  const TemporaryFolder profile;
  // The sandbox refuses to run as root.
  const std::string sandbox = geteuid() == 0 ? " --no-sandbox" : "";
  const std::string home = profile.Path().string();
  const std::string line = "HOME='" + home + "' timeout -k 5 120 '" + browser +
                           "' --headless --disable-gpu --disable-dev-shm-usage --no-first-run" + sandbox +
                           " --allow-file-access-from-files --virtual-time-budget=20000 --user-data-dir='" +
                           home + "/profile' --dump-dom 'file://" + page + "' 2>/dev/null </dev/null";
  BrowserRun run;
  FILE* pipe = popen(line.c_str(), "r");
  if (pipe == nullptr) return run;
  std::array<char, 1U << 14U> buffer{};
  for (std::size_t count = 0; (count = fread(buffer.data(), 1, buffer.size(), pipe)) > 0;) {
    run.document.append(buffer.data(), count);
  }
  const int status = pclose(pipe);
  run.exitCode = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
  run.started = run.exitCode == 0 && run.document.find("</html>") != std::string::npos;
  return run;
}

std::size_t CountOf(const std::string& text, const std::string& part) {
  std::size_t count = 0;
  for (std::size_t place = text.find(part); place != std::string::npos; place = text.find(part, place + 1))
    ++count;
  return count;
}

/// A page with every construct of the language, one of each line of a file.
std::string PageOfConstructs(bool mathJax) {
  TemplateCore core;
  std::istringstream constructs(test::ReadFile(TESSAL_SOURCE_DIR "/tests/docgen/constructs.txt"));
  for (std::string line; std::getline(constructs, line);) core.AddAuxiliary().expression.SetText(line);
  core.AddStateVariable().equation.SetText("a+b/c");
  core.RebuildSymbolTable();
  return HtmlDocumentation(core, {mathJax ? std::string(UsualMathJax()) : ""}, {});
}

class PageInBrowser : public testing::Test {
 protected:
  void SetUp() override {
    const auto found = FindBrowser();
    if (!found) GTEST_SKIP() << "no Chromium is installed: the look of the page is not checked";
    browser = *found;
  }

  /// What a script of this folder, run at the end of the page, reports. Nothing, with the test marked as
  /// skipped, where the browser gives no document back at all; a document without a report is a failure.
  std::string Report(const std::string& page, const std::string& script) const {
    const std::string text = test::ReadFile(TESSAL_SOURCE_DIR "/tests/docgen/" + script);
    const BrowserRun run =
        RunBrowser(browser, folder.Write("page.html", page + "<script>\n" + text + "</script>"));
    if (!run.started) {
      Skip(run.exitCode);
      return {};
    }
    const std::string start = "<pre id=\"report\">";
    const std::size_t place = run.document.find(start);
    const std::size_t end = run.document.find("\nend of report", place);
    if (place == std::string::npos || end == std::string::npos) {
      ADD_FAILURE() << "no report from the page; the document has " << run.document.size() << " bytes";
      return {};
    }
    return run.document.substr(place + start.size(), end - place - start.size());
  }

  void Skip(int exitCode) const {
    GTEST_SKIP() << browser << " does not run here (exit code " << exitCode
                 << "): the look of the page is not checked";
  }

  void ExpectGoodLayout(const std::string& page) const {
    const std::string report = Report(page, "layout.js");
    if (IsSkipped()) return;
    const std::string counts = "blocks " + std::to_string(CountOf(page, "<math ")) + " fences " +
                               std::to_string(CountOf(page, "<mfenced")) + " complaints 0\n";
    EXPECT_EQ(report.substr(0, report.find('\n') + 1), counts) << report;
  }

  std::string browser;
  TemporaryFolder folder;
};

TEST_F(PageInBrowser, EveryConstructShowsWithTheStyleBlockAlone) {
  ExpectGoodLayout(PageOfConstructs(false));
}

TEST_F(PageInBrowser, WithoutTheStyleBlockFencesAreMissed) {
  // The check itself must be able to fail.
  std::string page = PageOfConstructs(false);
  page.erase(page.find("<style>"), page.find("</style>") - page.find("<style>"));
  const std::string report = Report(page, "layout.js");
  if (IsSkipped()) return;
  EXPECT_NE(report.find("no opening fence"), std::string::npos) << report;
  EXPECT_NE(report.find("no comma"), std::string::npos) << report;
}

TEST_F(PageInBrowser, TheExamplesShow) {
  // One after the other in one document: browsers go on after the end of a page.
  std::string pages;
  for (const auto& entry : std::filesystem::directory_iterator(TESSAL_SOURCE_DIR "/examples")) {
    if (entry.path().extension() != ".tessal") continue;
    TemplateCore core;
    ASSERT_TRUE(core.LoadWrapper(entry.path().string())) << entry.path();
    pages += HtmlDocumentation(core, {}, {});
  }
  ExpectGoodLayout(pages);
}

TEST_F(PageInBrowser, MathJaxShowsEveryBlock) {
  const std::string local = "/usr/share/javascript/mathjax/MathJax.js";
  if (!std::filesystem::exists(local)) {
    GTEST_SKIP() << "libjs-mathjax is not installed: the page with MathJax is not checked";
  }
  std::string page = PageOfConstructs(true);
  const std::string source = "src=\"";
  for (std::size_t place = page.find(source); place != std::string::npos; place = page.find(source, place)) {
    place += source.size();
    page.replace(place, page.find("MathJax.js", place) - place, "file:///usr/share/javascript/mathjax/");
  }
  const std::string report = Report(page, "mathjax.js");
  if (IsSkipped()) return;
  EXPECT_EQ(report, "frames " + std::to_string(CountOf(page, "<math ")) + " errors 0");
}

}  // namespace
}  // namespace tessal
