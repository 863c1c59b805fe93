#include "docgen/overview.h"

#include <gtest/gtest.h>

#include "core/template_core.h"
#include "support/template_text.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::TemplateText;
using test::TemporaryFolder;

TEST(Overview, NumbersRunOnAndMovementsDoNotCount) {
  const TemporaryFolder folder;
  TemplateCore core;
  ASSERT_TRUE(core.LoadWrapper(folder.Write("m.tessal", TemplateText()
                                                            .Constant("k", "0.1")
                                                            .Process("p", "k")
                                                            .StateVariable("S", "p")
                                                            .Specie("A", "A_e", {{"A_e", "1"}})
                                                            .Specie("B", "0", {})
                                                            .Text())));
  auto& search = core.GetSpecie(0).AddSpatialFunction();
  core.RebuildSymbolTable();
  std::string table;
  for (const OverviewRow& row : BuildOverview(core)) {
    table += row.cells[0] + " " + row.cells[1] + " [" + row.cells[2] + "] " + row.cells[3] + "\n";
  }
  EXPECT_EQ(table,
            "1 S [State Variable] p\n2 k [Constant] 0.1\n3 p [Process] k\n"
            "4 A_Mass [Lagrange State Variable (A)] A_e\n"
            "5 A_Search_Function_1 [Search function (A)] DIRECTION(NONE[unkown])\n"
            "6 A_e [Arithmetical Expression (A)] 1\n"
            "- Horizontal Vector1 [Direction (A)] 0\n- Horizontal Vector1 [Speed (A)] 0\n"
            "- Downward Velocity [Downward Velocity (A)] 0\n"
            "7 B_Mass [Lagrange State Variable (B)] 0\n"
            "- Horizontal Vector1 [Direction (B)] 0\n- Horizontal Vector1 [Speed (B)] 0\n"
            "- Downward Velocity [Downward Velocity (B)] 0\n");
  for (const OverviewRow& row : BuildOverview(core)) {
    const CEL_Element* element = core.GetElement(row.uid);
    ASSERT_NE(element, nullptr) << row.cells[1];
    EXPECT_EQ(element->symbol.Text(), row.cells[1]) << "a row leads to its element";
  }
  const auto summary = [&core] { return BuildOverview(core)[4].cells[3]; };
  search.variableId.SetInt(1);
  EXPECT_EQ(summary(), "DIRECTION(NONE[S])");
  search.framework.SetText("LAGRANGE");
  search.lookFor.SetInt(2);
  EXPECT_EQ(summary(), "DIRECTION(NONE[B.S])");
  search.lookFor.SetInt(-2);
  search.variableId.SetInt(-1);
  search.property.SetText("AGE");
  EXPECT_EQ(summary(), "DIRECTION(NONE[any.AGE])");
  search.purpose.SetText("OILSPILL");
  EXPECT_EQ(summary(), "Oilspill(deprecated)");
}

TEST(Overview, TheTextIsAlignedAndCleaned) {
  const TemporaryFolder folder;
  TemplateCore core;
  const std::string path = folder.Write("m.tessal", TemplateText()
                                                        .Misc("DOCUMENT_REVISION = 7\n")
                                                        .Auxiliary("a", "1\n + 2")
                                                        .With("DESCRIPTION", "'two\nlines'")
                                                        .Text());
  ASSERT_TRUE(core.LoadWrapper(path));
  EXPECT_EQ(OverviewText(core, BuildOverview(core)),
            "Template " + path +
                "\r\n\nRevision 7No.\tSymbol\t      Type\tExpression/ Default value\tDescription\r\n"
                " 1\t a\t Auxiliary\t1 + 2 \ttwolines \r\n");
  TemplateCore empty;
  EXPECT_EQ(OverviewText(empty, BuildOverview(empty)),
            "Template \r\nNo.\tSymbol\tType\tExpression/ Default value\tDescription\r\n");
}

}  // namespace
}  // namespace tessal
