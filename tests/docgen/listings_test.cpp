// The page and the overview of every example, as files hold them.
#include <gtest/gtest.h>

#include "core/template_core.h"
#include "docgen/html_documentation.h"
#include "docgen/overview.h"
#include "docgen/reference_pages.h"
#include "support/case_file.h"

namespace tessal {
namespace {

constexpr const char* kExamples = TESSAL_SOURCE_DIR "/examples";

std::string Without(std::string text, const std::string& part) {
  for (std::size_t place = 0; (place = text.find(part, place)) != std::string::npos;) {
    text.erase(place, part.size());
  }
  return text;
}

/// The rows as the editor's list shows them, each with the element that it leads to.
std::string OverviewRows(const TemplateCore& core) {
  std::string text;
  for (const OverviewRow& row : BuildOverview(core)) {
    const CEL_Element* element = core.GetElement(row.uid);
    for (const std::string& cell : row.cells) text += cell + " | ";
    const SymbolRecord* record = element == nullptr ? nullptr : core.RecordOfElement(*element);
    text += (record == nullptr ? "nowhere" : core.RecordSymbol(*record)) + "\n";
  }
  return text;
}

class Documentation : public testing::TestWithParam<std::string> {
 protected:
  void SetUp() override {
    ASSERT_TRUE(core.LoadWrapper(std::string(kExamples) + "/" + GetParam() + ".tessal"));
  }

  void ExpectIn(const std::string& file, const std::string& text) const {
    test::ExpectListing("docgen/cases/" + GetParam() + file, Without(text, std::string(kExamples) + "/"));
  }

  TemplateCore core;
};

TEST_P(Documentation, IsOnePage) {
  std::tm created = {};
  created.tm_year = 126;
  created.tm_mday = 4;
  std::string page = HtmlDocumentation(core, {}, created);
  // The style is the same in all.
  const std::size_t style = page.find("<style>");
  page.erase(style, page.find("</style>") - style);
  ExpectIn("_page.txt", page);
}

TEST_P(Documentation, IsOneOverview) {
  ExpectIn("_overview.txt", OverviewText(core, BuildOverview(core)) + OverviewRows(core));
}

INSTANTIATE_TEST_SUITE_P(Examples, Documentation,
                         testing::Values("streeter_phelps", "fasham", "eutrophication", "asm1", "fish_larvae",
                                         "lake_management", "faults"),
                         [](const auto& example) { return example.param; });

TEST(ReferencePages, AreTheFilesOfTheDocumentationAndTheHelp) {
  test::ExpectPage("../docs/functions.md", PageMarkdown(PageOfFunctions()));
  test::ExpectPage("../docs/builtins.md", PageMarkdown(PageOfBuiltins()));
  test::ExpectPage("../docs/help/Functions.html", PageHtml(PageOfFunctions()));
  test::ExpectPage("../docs/help/Builtins.html", PageHtml(PageOfBuiltins()));
}

TEST(EmptyTemplate, HasAPageAndAnOverviewWithoutRows) {
  TemplateCore core;
  EXPECT_EQ(OverviewText(core, BuildOverview(core)),
            "Template \r\nNo.\tSymbol\tType\tExpression/ Default value\tDescription\r\n");
  test::ExpectListing("docgen/cases/empty_page.txt",
                      HtmlDocumentation(core, {std::string(UsualMathJax())}, std::tm{}));
}

}  // namespace
}  // namespace tessal
