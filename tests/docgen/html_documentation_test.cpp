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

/// The part of a text from one mark up to the next.
std::string Between(const std::string& text, const std::string& first, const std::string& next) {
  const std::size_t place = text.find(first);
  return place == std::string::npos ? std::string() : text.substr(place, text.find(next, place) - place);
}

TEST(HtmlDocumentation, ThePageStandsInItsFixedOrderAndWording) {
  TemplateCore core;
  core.Root().description.SetText("D & d");
  core.AddConstant().symbol.SetText("k");
  core.AddSpecie().symbol.SetText("A");
  core.RebuildSymbolTable();
  std::tm time = {};
  time.tm_year = 126;
  time.tm_mday = 4;
  std::string text = HtmlDocumentation(core, true, time);
  const std::string style = Between(text, "<style>", "</head>");
  text.erase(text.find(style), style.size());
  const std::string script = Between(text, "src=\"", "/mathjax/latest/");
  ASSERT_EQ(script.substr(0, 13), "src=\"https://");
  for (std::size_t place = 0; (place = text.find(script)) != std::string::npos;) {
    text.replace(place, script.size(), "src=\"");
  }
  EXPECT_EQ(
      text.substr(0, text.find("<hr>")),
      R"(<!DOCTYPE HTML PUBLIC /"-//W3C//DTD HTML 4.01 Transitional//EN" "http://www.w3.org/TR/html4/loose.dtd">
<html>
<head>
<title>Model description for D & d</title>
<script type=text/javascript
src="/mathjax/latest/MathJax.js?config=MML_HTMLorMML">
</script>
<script type=text/javascript
src="/mathjax/latest/MathJax.js">
</script>
<meta http-equiv=X-UA-Compatible content=IE=EmulateIE7>
</head>
<body>
<div id=container>
<div id=header>
<h1>Model description for D & d</h1>
<h2>Template file : </h2>
<br>This document uses MathML and may render quite slow in IE8!
<br><h3>Summary</h3>
<ul>
<li>State variables : 0</li>
<li>Constants       : 1</li>
<li>Forcings        : 0</li>
<li>Auxiliaries     : 0</li>
<li>Processes       : 0</li>
<li>Derived outputs : 0</li>
<li>Species         : 1</li>
<ul>
<li>Specie 1</li>
<li>State variables          : 0</li>
<li>Constants                : 0</li>
<li>Spatial functions        : 0</li>
<li>Arithmetical expressions : 0</li>
<li>Horizontal vectors       : 1</li>
<li>Vertical vectors         : 1</li>
</ul>
</ul> <br>
)");
  EXPECT_EQ(Between(text, "<div id=left", "<div id=right"),
            R"(<div id=left style=background-color:#FFD700;width:35%;float:left;>
<h1>Elements</h1>
<ul>
<hr>
<p> <li> <h2>State Variables </h2>
-none- <br>
 </li> </p>
<hr>
<p> <li> <h2> Constants </h2>
<ul><li>
<h4> <a href=#ref_k>k</a></h4>
</li></ul>
</li> </p>
<hr>
<p> <li> <h2> Forcing </h2>
-none- <br>
</li> </p>
<hr>
<p> <li> <h2> Auxilliaries </h2>
-none- <br>
</li> </p>
<hr>
<p> <li> <h2> Process </h2>
-none- <br>
</li> </p>
<hr>
<p> <li> <h2> Derived Outputs </h2>
-none- <br>
</li> </p>
<hr>
<p> <h2>Lagrange particle classes</h2>
<ul>
<li> <h2> Particle Class &quotA&quot</h2>
<ul><li>
</li></ul>
<hr>
<p> <li> <h2> State Variables </h2>
-none- <br>
</li> </p>
<hr>
<p> <li> <h2> Constants</h2>
-none- <br>
</li> </p>
<hr>
<p> <li> <h2>  Remote Area Search Functions </h2>
-none- <br>
</li> </p>
<hr>
<p> <li> <h2> Arithmetic Expressions </h2>
-none- <br>
</li> </p>
<hr>
<p> <ul> <h2> Movement </h2>
<p> <li> <h3> Horizontal Vectors</h3>
<ul><li>
<h4> <a href=#ref_(A)Horizontal Vector1>(A)Horizontal Vector1</a></h4>
</li></ul>
</li> </p>
<li><h3> Vertical Vector </h3>
<ul><li>
<h4> <a href=#ref_(A)Downward Velocity>(A)Downward Velocity</a></h4>
</li></ul>
</li>
</ul> </p>
</ul>
</p>
</ul>
</div>
)");
  const std::string footer = text.substr(text.find("<div id=footer>"));
  EXPECT_EQ(Between(footer, "<div", "<a href"), R"(<div id=footer>
<hr>
<br>Document created : Sun Jan  4 00:00:00 2026

<br>Math rendered by )");
  EXPECT_EQ(footer.substr(footer.find("\">")), R"(">MathJax</a>
</div>
</div>
</body>
</html>
)");
}

/// The names of the rows of an element's table.
std::string RowsOf(const std::string& page, const std::string& symbol) {
  const std::string table = Between(page, "<a id=ref_" + symbol + ">", "</table>");
  const std::string start = "<tr>\n<td>\n";
  std::string names;
  for (std::size_t place = table.find(start); place != std::string::npos; place = table.find(start, place)) {
    place += start.size();
    names += table.substr(place, table.find('\n', place) - place) + "|";
  }
  return names;
}

TEST(HtmlDocumentation, EachKindShowsItsOwnRowsInOneOrder) {
  const Page page(TemplateText()
                      .Constant("k")
                      .Process("p", "k")
                      .StateVariable("S", "p")
                      .Specie("A", "A_e", {{"A_e", "k"}})
                      .Text());
  ASSERT_TRUE(page.loaded);
  const std::string text = page.Text();
  const std::string base = "ID|Description|Documentation|Online help|";
  EXPECT_EQ(RowsOf(text, "S"),
            base +
                "Scope|Transport|UNQ Type|UNQ Unit|Unit|Default Value|Min Value|Max Value|Equation|"
                "Referenced by|");
  EXPECT_EQ(RowsOf(text, "k"),
            base +
                "Scope|Spatial Variation|UNQ Type|UNQ Unit|Unit|Is user specified|Build in ID|"
                "Default Value|Min Value|Max Value|Referenced by|");
  EXPECT_EQ(RowsOf(text, "p"),
            base + "Scope|Spatial Variation|UNQ Type|UNQ Unit|Unit|Expression|Referenced by|");
  EXPECT_EQ(RowsOf(text, "A_Mass"),
            base + "UNQ Type|UNQ Unit|Unit|Default Value|Min Value|Max Value|Equation|Referenced by|");
  EXPECT_EQ(RowsOf(text, "(A)Horizontal Vector1"), "Speed|Direction|Referenced by|");
  EXPECT_EQ(CountOf(text, "<mi>dt</mi>"), 2U) << "equations are derivatives, other expressions are none";
}

TEST(HtmlDocumentation, TextsStandAsTheyAre) {
  const std::string description = "<b>1 & 2</b> \"3\" \xC3\xB8 \xF8\nand more";
  const Page page(TemplateText().Constant("k").With("DESCRIPTION", "'" + description + "'").Text());
  ASSERT_TRUE(page.loaded);
  EXPECT_NE(page.Text().find("<td>\n" + description + "\n</td>"), std::string::npos);
}

TEST(HtmlDocumentation, GoesBesideItsTemplateAndNeverOverIt) {
  const Page page(TemplateText().Constant("k").Text());
  const std::string file = page.folder.File("m.tessal");
  EXPECT_EQ(PrepareUsualPagePath(file), page.folder.File("HTML_doc/m.html"));
  EXPECT_TRUE(std::filesystem::is_directory(page.folder.File("HTML_doc")));
  std::string failure;
  const std::string before = test::ReadFile(file);
  std::filesystem::create_symlink("m.tessal", page.folder.File("link.html"));
  EXPECT_FALSE(ExportHtmlDocumentation(page.core, page.folder.File("link.html"), false, failure));
  EXPECT_NE(failure.find("over its template"), std::string::npos) << failure;
  EXPECT_EQ(test::ReadFile(file), before);
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
