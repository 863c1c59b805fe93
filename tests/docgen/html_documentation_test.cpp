#include "docgen/html_documentation.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "core/template_core.h"
#include "support/template_text.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::TemplateText;
using test::TemporaryFolder;

/// A template loaded for its page.
class Page final {
 public:
  explicit Page(const std::string& text) { loaded = core.LoadWrapper(folder.Write("m.tessal", text)); }

  std::string Text(bool mathJax = false) const {
    std::tm time = {};
    time.tm_year = 126;
    time.tm_mon = 10;
    time.tm_mday = 4;
    time.tm_wday = 3;
    return HtmlDocumentation(core, mathJax, time);
  }

  TemporaryFolder folder;
  TemplateCore core;
  bool loaded = false;
};

std::size_t CountOf(const std::string& text, const std::string& part) {
  std::size_t count = 0;
  for (std::size_t place = text.find(part); place != std::string::npos; place = text.find(part, place + 1))
    ++count;
  return count;
}

TEST(HtmlDocumentation, DocumentsEveryElementOnceInEachColumn) {
  const Page page(TemplateText()
                      .Misc()
                      .Constant("k")
                      .Process("p", "k")
                      .StateVariable("S", "p")
                      .Auxiliary("bad", "1 +")
                      .Specie("A", "A_e", {{"A_e", "k"}})
                      .Text());
  ASSERT_TRUE(page.loaded);
  const std::string text = page.Text();
  for (const char* symbol :
       {"k", "p", "S", "bad", "A_Mass", "A_e", "(A)Horizontal Vector1", "(A)Downward Velocity"}) {
    EXPECT_EQ(CountOf(text, "<h4> <a href=#ref_" + std::string(symbol) + ">"), 1U) << symbol;
    EXPECT_EQ(CountOf(text, "<h4> <a id=ref_" + std::string(symbol) + ">"), 1U) << symbol;
  }
  EXPECT_NE(text.find("Referenced by\n</td>\n<td>\n<a href=#ref_p>p</a>, <a href=#ref_A_e>A_e</a>\n"),
            std::string::npos);
  EXPECT_NE(text.find("- not used -"), std::string::npos);
  EXPECT_NE(text.find("<td>\nExpression\n</td>\n<td>\n\n</td>"), std::string::npos) << "an empty cell";
  EXPECT_NE(text.find("<li>Species         : 1</li>\n<ul>\n<li>Specie 1</li>\n"), std::string::npos);
  EXPECT_NE(text.find("UNQ Type\n</td>\n<td>\n999\n (Undefined)\n"), std::string::npos);
  EXPECT_NE(text.find("<br>Document created : Wed Nov  4 00:00:00 2026\n\n"), std::string::npos);
  EXPECT_NE(text.find("<!DOCTYPE HTML PUBLIC /\"-//W3C"), std::string::npos);
  // What is opened is closed.
  EXPECT_EQ(CountOf(text, "<table"), CountOf(text, "</table>"));
  EXPECT_EQ(CountOf(text, "<div"), CountOf(text, "</div>"));
  EXPECT_EQ(CountOf(text, "<math "), CountOf(text, "</math>"));
}

TEST(HtmlDocumentation, ScriptsComeOnRequestOnly) {
  const Page page(TemplateText().Constant("k").Text());
  EXPECT_EQ(CountOf(page.Text(), "<script"), 0U);
  EXPECT_EQ(page.Text().find("Lagrange"), std::string::npos);
  EXPECT_EQ(page.Text().find("Species"), std::string::npos);
  const std::string text = page.Text(true);
  EXPECT_EQ(CountOf(text, "<script type=text/javascript\nsrc=\""), 2U);
  EXPECT_EQ(CountOf(text, "?config=MML_HTMLorMML"), 1U);
  EXPECT_EQ(CountOf(text, "slow in IE8!"), 1U);
  EXPECT_EQ(CountOf(text, "Math rendered by"), 1U);
}

TEST(HtmlDocumentation, APageThatCannotBeWrittenIsTold) {
  const Page page(TemplateText().Constant("k").Text());
  std::string failure;
  EXPECT_FALSE(ExportHtmlDocumentation(page.core, "/nowhere/page.html", false, failure));
  EXPECT_NE(failure.find("/nowhere/page.html"), std::string::npos);
  EXPECT_FALSE(ExportHtmlDocumentation(page.core, "/dev/full", false, failure));
  EXPECT_NE(failure.find("space"), std::string::npos);
  EXPECT_TRUE(ExportHtmlDocumentation(page.core, page.folder.File("page.html"), false, failure));
  EXPECT_GT(std::filesystem::file_size(page.folder.File("page.html")), 1000U);
}

}  // namespace
}  // namespace tessal
