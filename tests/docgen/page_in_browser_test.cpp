// The page as a browser lays it out, with the style block alone and with a local MathJax.
#include <gtest/gtest.h>

#include <filesystem>
#include <vector>

#include "core/template_core.h"
#include "docgen/browser.h"
#include "docgen/html_documentation.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::BrowserRun;
using test::FindBrowser;
using test::RunBrowser;
using test::TemporaryFolder;

constexpr const char* kConstructs[] = {
    "a+b",
    "(a+b)/(c+d)/(e+f)",
    "a/(b/(c/(d/(e/f))))",
    "k*(a/(b+c) + 1)",
    "POW(a+b, c/d)",
    "SQRT(SQR(a/b) + EXP(-c))",
    "MAX(a, b+c, d/e, MIN(f, g))",
    "F()",
    "IF a<=1 THEN b/c ELSE IF a>2 THEN x ELSE y+1",
    "1 + IF NOT (a>1 AND b<2) OR c==3 THEN x ELSE y",
    "Age ::+ 1",
    "Age ::= IF a>1 THEN 2 ELSE 3",
    "TRANSFER{(Fish, x>y), (Mass, [XPOS], a+b, c, d, e/f)}",
    "-a*[YPOS]",
};

std::size_t CountOf(const std::string& text, const std::string& part) {
  std::size_t count = 0;
  for (std::size_t place = text.find(part); place != std::string::npos; place = text.find(part, place + 1))
    ++count;
  return count;
}

std::string PageOfConstructs(bool mathJax) {
  TemplateCore core;
  for (const char* expression : kConstructs) core.AddAuxiliary().expression.SetText(expression);
  core.AddStateVariable().equation.SetText("a+b/c");
  core.RebuildSymbolTable();
  return HtmlDocumentation(core, mathJax, {});
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
    pages += HtmlDocumentation(core, false, {});
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
