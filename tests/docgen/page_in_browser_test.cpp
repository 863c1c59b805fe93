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

// What must hold of the layout. Each complaint names the expression by the text of its block.
constexpr const char* kLayoutScript = R"js(<script>
const complaints = [];
function box(node) { return node.getBoundingClientRect(); }
function expect(holds, what, node) {
  if (!holds) complaints.push(what + ' in "' + node.closest('math').textContent + '"');
}
const blocks = document.querySelectorAll('math');
for (const math of blocks) {
  const own = box(math);
  expect(math.textContent.trim() !== '' && own.width > 0 && own.height > 0, 'nothing shown', math);
  expect(own.left - box(math.parentElement).left < 5, 'not at the left', math);
}
const fences = document.querySelectorAll('mfenced');
for (const fence of fences) {
  const own = box(fence);
  const style = getComputedStyle(fence);
  const brace = fence.getAttribute('open') === '{';
  expect(own.width > 0 && own.height > 0, 'no fence', fence);
  expect(parseFloat(style.borderLeftWidth) >= (brace ? 5 : 0.5), 'no opening fence', fence);
  expect(brace || parseFloat(style.borderRightWidth) >= 0.5, 'no closing fence', fence);
  for (const part of fence.children) {
    const inner = box(part);
    expect(inner.left - own.left >= 2 && (brace || own.right - inner.right >= 2), 'a narrow fence', fence);
    expect(own.top <= inner.top + 1 && own.bottom >= inner.bottom - 1, 'a low fence', fence);
  }
}
const operands = 'mi, mn, mrow, mfrac, mfenced, mtext';
function gap(left, right) { return box(right).left - box(left).right; }
for (const argument of document.querySelectorAll('mfenced:not([separators]) > mrow:not(:last-child)')) {
  const room = box(argument).right - box(argument.lastElementChild).right;
  expect(room >= 6 && getComputedStyle(argument).backgroundImage !== 'none', 'no comma', argument);
}
for (const row of document.querySelectorAll('math > mrow, mtd, mfenced[separators]')) {
  for (const part of row.children) {
    const next = part.nextElementSibling;
    if (!next || !part.matches(operands) || !next.matches('mi, mn, mfrac')) continue;
    expect(gap(part, next) >= 3, 'members of an interaction run together', part);
  }
}
for (const sign of document.querySelectorAll('mi + mtext[mathcolor=green]')) {
  expect(gap(sign.previousElementSibling, sign) >= 2, 'a modification sticks to its target', sign);
}
for (const letter of document.querySelectorAll('mfrac mi, mfrac mn')) {
  const whole = parseFloat(getComputedStyle(letter.closest('math')).fontSize);
  expect(parseFloat(getComputedStyle(letter).fontSize) >= 0.49 * whole, 'too small', letter);
}
const report = document.createElement('pre');
report.id = 'report';
report.textContent = 'blocks ' + blocks.length + ' fences ' + fences.length + ' complaints ' +
  complaints.length + '\n' + complaints.slice(0, 200).join('\n') + '\nend of report';
document.body.append(report);
</script>)js";

// MathJax puts a frame of its own in the place of each block.
constexpr const char* kMathJaxScript = R"js(<script>
MathJax.Hub.Queue(() => {
  const frames = [...document.querySelectorAll('.MathJax')];
  const shown = frames.filter(frame => frame.getBoundingClientRect().width > 0).length;
  const report = document.createElement('pre');
  report.id = 'report';
  report.textContent = 'frames ' + shown + ' errors ' +
    document.querySelectorAll('.MathJax_Error, .merror').length + '\nend of report';
  document.body.append(report);
});
</script>)js";

std::size_t CountOf(const std::string& text, const std::string& part) {
  std::size_t count = 0;
  for (std::size_t place = text.find(part); place != std::string::npos; place = text.find(part, place + 1))
    ++count;
  return count;
}

std::string Page(const TemplateCore& core, bool mathJax) {
  return HtmlDocumentation(core, mathJax, std::tm{});
}

std::string PageOfConstructs(bool mathJax) {
  TemplateCore core;
  for (const char* expression : kConstructs) core.AddAuxiliary().expression.SetText(expression);
  core.AddStateVariable().equation.SetText("a+b/c");
  core.RebuildSymbolTable();
  return Page(core, mathJax);
}

class PageInBrowser : public testing::Test {
 protected:
  void SetUp() override {
    const auto found = FindBrowser();
    if (!found) GTEST_SKIP() << "no Chromium is installed: the look of the page is not checked";
    browser = *found;
  }

  /// What the script reports at the end of the page. Nothing, with the test marked as skipped, where the
  /// browser gives no document back at all; a document without a report is a failure.
  std::string Report(const std::string& page, const char* script) const {
    const BrowserRun run = RunBrowser(browser, folder.Write("page.html", page + script));
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
    const std::string report = Report(page, kLayoutScript);
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
  const std::string report = Report(page, kLayoutScript);
  if (IsSkipped()) return;
  EXPECT_NE(report.find("no opening fence"), std::string::npos) << report;
  EXPECT_NE(report.find("no comma"), std::string::npos) << report;
}

TEST_F(PageInBrowser, TheExamplesShow) {
  // One behind the other in one document: browsers go on behind the end of a page.
  std::string pages;
  for (const auto& entry : std::filesystem::directory_iterator(TESSAL_SOURCE_DIR "/examples")) {
    if (entry.path().extension() != ".tessal") continue;
    TemplateCore core;
    ASSERT_TRUE(core.LoadWrapper(entry.path().string())) << entry.path();
    pages += Page(core, false);
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
  const std::string report = Report(page, kMathJaxScript);
  if (IsSkipped()) return;
  EXPECT_EQ(report, "frames " + std::to_string(CountOf(page, "<math ")) + " errors 0");
}

}  // namespace
}  // namespace tessal
