// What the file makes of texts, expressions and numbers of an element.
#include <gtest/gtest.h>

#include <memory>
#include <vector>

#include "core/error_registry.h"
#include "elements/expression_elements.h"
#include "elements/read_status.h"
#include "elements/specie_expressions.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::ReadFile;
using test::TemporaryFolder;

void WriteElement(CEL_Element& element, const std::string& path) {
  int status = 0;
  KvfHandle image = kvfCreate();
  kvfAddTarget(image, "T");
  element.Write(image, status);
  kvfEndSection(image);
  EXPECT_EQ(status, 0);
  EXPECT_EQ(kvfWrite(image, path), kKvfOk);
  kvfClose(&image);
}

void ReadElement(CEL_Element& element, const std::string& path) {
  // The element's texts are views into those of the files.
  static std::vector<std::shared_ptr<const std::string>> texts;
  LoadAccount account;
  ReadStatus status(account);
  KvfHandle file = kvfLoadFile(path, 1);
  ASSERT_NE(file, 0U);
  element.Read(kvfTargetByNameNum(file, "T", 1), status);
  texts.push_back(kvfShareText(file));
  kvfClose(&file);
}

TEST(ElementFiles, LoseBlanksAtTheEndsOfTextsOnly) {
  const TemporaryFolder folder;
  CEL_Auxilliary_Variable written("a");
  written.description.SetText(" \t\n two\n lines \r\n");
  written.expression.SetText("\n IF a > 1\n THEN 2 ELSE 3 ");
  WriteElement(written, folder.File("element"));
  EXPECT_NE(ReadFile(folder.File("element")).find("EXPRESSION = '\"IF a > 1\r\n THEN 2 ELSE 3\"'"),
            std::string::npos);
  CEL_Auxilliary_Variable read("b");
  ReadElement(read, folder.File("element"));
  EXPECT_EQ(read.description.Text(), "two\n lines");
  EXPECT_EQ(read.expression.Text(), "IF a > 1\n THEN 2 ELSE 3");
}

TEST(ElementFiles, AnExpressionStandsBetweenItsOuterQuotes) {
  const std::pair<const char*, const char*> rows[] = {
      {"'\"a + b\"'", "a + b"},
      {"'a + b'", "a + b"},
      {"|\" it's \"|", "it's"},
      {"'x \"a\" y'", "a"},
      {"'\"one\" and \"two\"'", "one\" and \"two"},
      {"''", ""},
  };
  const TemporaryFolder folder;
  for (const auto& [stored, expected] : rows) {
    const std::string path =
        folder.Write("element", "[T]\nEXPRESSION_VERTICAL_SPEED = " + std::string(stored) + "\nEndSect\n");
    CEL_Lagrange_Vertical_Equation equation("v");
    ReadElement(equation, path);
    EXPECT_EQ(equation.speed.Text(), expected) << stored;
  }
}

TEST(ElementFiles, AForcedRealStaysAReal) {
  const TemporaryFolder folder;
  CEL_Process process("p");
  process.controlValue.SetForceReal(true);
  process.controlValue.SetReal(2.0);
  WriteElement(process, folder.File("element"));
  EXPECT_NE(ReadFile(folder.File("element")).find("CONTROLVALUE = 2.000000000001\r\n"), std::string::npos);
}

TEST(ElementFiles, AnEmptySectionIsReportedAndKeepsTheNumbers) {
  const TemporaryFolder folder;
  const std::string path = folder.Write("element", "[T]\nEndSect\n");
  Errors().Reset();
  CEL_Process process("p");
  ReadElement(process, path);
  EXPECT_EQ(process.controlValue.RealValue(), 0.8);
  EXPECT_FALSE(process.output.BoolValue()) << "a missing boolean reads as no";
  EXPECT_EQ(process.scope.TextOf() + process.expression.TextOf() + process.symbol.TextOf(), "");
  std::string missing;
  for (const ErrorRecord& record : Errors().Records()) {
    EXPECT_EQ(record.level, 3U);
    EXPECT_EQ(NumberOf(record.uid), -1);
    missing += record.text.substr(std::string("could not find key ").size()) + ";";
  }
  // The number behind a missing text is not looked for.
  EXPECT_EQ(missing,
            "SYMBOL in T;DESCRIPTION in T;ONLINE_HELP in T;DOCUMENTATION in T;OUTPUT in T;PROCESS_TYPE in T;"
            "SCOPE in T;SPATIAL_VARIATION in T;UNIT in T;EXPRESSION in T;");
}

}  // namespace
}  // namespace tessal
