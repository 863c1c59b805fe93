// Every element class writes its keywords in the order of the format, and reads back what it wrote.
#include <gtest/gtest.h>

#include <functional>
#include <sstream>

#include "core/error_registry.h"
#include "elements/area_search.h"
#include "elements/expression_elements.h"
#include "elements/input_elements.h"
#include "elements/miscellaneous.h"
#include "elements/specie.h"
#include "elements/state_variable.h"
#include "expr/user_function_names.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::ReadFile;
using test::TemporaryFolder;

struct ElementRow {
  const char* name;
  std::function<std::unique_ptr<CEL_Element>()> make;
  std::string keywords;      ///< in the order of the file
  std::string notInTheFile;  ///< labels of values that the element's own section does not carry over
};

template <class Element>
ElementRow Row(const char* name, const std::string& keywords, const std::string& notInTheFile = "") {
  return {name, [] { return std::make_unique<Element>("Caption"); }, keywords, notInTheFile};
}

std::vector<ElementRow> ElementRows() {
  const std::string texts = "DESCRIPTION ONLINE_HELP DOCUMENTATION ";
  const std::string base = "SYMBOL ID " + texts;
  const std::string units = base + "UNQ_TYPE UNQ_UNIT ";
  const std::string range = "DEFAULT_VALUE MIN_VALUE MAX_VALUE ";
  const std::string input = units + "IS_USER_SPECIFIED BUILT_IN_ID SCOPE SPATIAL_VARIATION UNIT " + range;
  const std::string search =
      "FUNCTION_ID VARIABLE_ID SPECIE_ID RADIUS DIMENSION SPATIAL_VARIATION PURPOSE FRAMEWORK PROPERTY MATH "
      "LOOKFOR ";
  const std::string settings =
      "TESSAL_VERSION PARSER_VERSION DOCUMENT_REVISION RANDSEED DEBUG_LEVEL DEBUG_LOG RANDOM_PARTICLE_DIR "
      "BUILD_SPATIAL_TREE CHECKSUM OPTIMISE TRIGONOMETRICS ";
  const std::string noUnits = "UNQ Type|UNQ Unit|";
  return {
      {"settings", [] { return std::make_unique<CEL_Miscanellous>(); }, texts + settings,
       "Symbol|ID|Revision|" + noUnits},
      Row<CEL_ExternalFunction>("user function", base + "PUBLICNAME PARAMETERS USED_AS DLL ENTRYPOINT ",
                                noUnits),
      Row<CEL_StateVariable>("state variable", units + "SCOPE TRANSPORT UNIT " + range, "Equation|"),
      Row<CEL_Constant>("constant", input),
      Row<CEL_Forcing>("forcing", input),
      Row<CEL_Auxilliary_Variable>("auxiliary", units + "OUTPUT SCOPE SPATIAL_VARIATION UNIT EXPRESSION "),
      Row<CEL_Process>(
          "process",
          units + "OUTPUT PROCESS_TYPE SCOPE SPATIAL_VARIATION UNIT EXPRESSION CONTROLID CONTROLVALUE "),
      Row<CEL_Derived_Output>(
          "derived output",
          "ID " + texts + "UNQ_TYPE UNQ_UNIT SCOPE SPATIAL_VARIATION UNIT FORMAT EXPRESSION ", "Symbol|"),
      Row<CEL_Lagrange_StateVariable>("particle state variable", units + "SPECIE UNIT " + range, "Equation|"),
      Row<CEL_Lagrange_Constant>("particle constant", units + "SPATIAL_VARIATION UNIT " + range),
      Row<CEL_Lagrange_Forcing>("particle forcing", base + "SCOPE UNIT " + range,
                                "Spatial Variation|" + noUnits),
      Row<CEL_Lagrange_Spatial_Function>("search function", base + search, noUnits),
      Row<CEL_Lagrange_Arithmetical_Expression>(
          "arithmetic expression",
          units + "EXPRESSION_TYPE SPECIE OUTPUT SPATIAL_VARIATION UNIT EXPRESSION "),
      Row<CEL_Lagrange_Horizontal_Vector>("horizontal vector",
                                          "EXPRESSION_HORIZONTAL_SPEED EXPRESSION_HORIZONTAL_DIRECTION "),
      Row<CEL_Lagrange_Vertical_Equation>("vertical equation", "EXPRESSION_VERTICAL_SPEED "),
      Row<CEL_Lagrange_Specie>("particle class",
                               "NAME " + texts + "SCOPE PROJECTION_TIME FIELD_OF_VIEW TRANSPORT "),
  };
}

/// Gives every field a value of its own; one with choices keeps to them, as far as texts are concerned.
void FillFields(CEL_Element& element) {
  std::vector<ElementField> fields;
  element.GetFields(fields);
  int number = 0;
  for (ElementField& field : fields) {
    ++number;
    if (field.choiceTexts.empty()) field.text = "inner  blank " + std::to_string(number);
    field.intValue = 1000 + number;
    field.realValue = number + 0.1;
    field.boolValue = !field.boolValue;
  }
  element.SetFields(fields);
}

std::string FieldTexts(const CEL_Element& element, const std::string& without) {
  std::vector<ElementField> fields;
  element.GetFields(fields);
  std::string texts;
  for (const ElementField& field : fields) {
    if (("|" + without).find("|" + field.name + "|") == std::string::npos) {
      texts += field.name + "=" + FieldText(field) + "\n";
    }
  }
  return texts;
}

/// The keywords that stand directly in the target, parted by blanks.
std::string KeywordsOf(const std::string& file) {
  std::istringstream lines(file);
  std::string keywords;
  for (std::string line; std::getline(lines, line);) {
    const std::size_t end = line.find(" = ");
    if (end != std::string::npos && line.find_first_not_of(' ') == 3) keywords += line.substr(3, end - 2);
  }
  return keywords;
}

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
  int status = 0;
  KvfHandle file = kvfLoadFile(path, 1);
  ASSERT_NE(file, 0U);
  element.Read(kvfTargetByNameNum(file, "T", 1), status);
  kvfClose(&file);
}

TEST(ElementFiles, HoldEveryValueUnderItsKeyword) {
  const TemporaryFolder folder;
  const std::string path = folder.File("element");
  for (const ElementRow& row : ElementRows()) {
    Errors().Reset();
    const auto written = row.make();
    FillFields(*written);
    WriteElement(*written, path);
    EXPECT_EQ(KeywordsOf(ReadFile(path)), row.keywords) << row.name;

    const auto read = row.make();
    ReadElement(*read, path);
    EXPECT_EQ(FieldTexts(*read, row.notInTheFile), FieldTexts(*written, row.notInTheFile)) << row.name;
    EXPECT_TRUE(read->Loaded() || row.keywords.find("ID ") == std::string::npos) << row.name;
    const std::size_t messages = row.keywords.find("SCOPE UNIT DEFAULT") != std::string::npos &&
                                         std::string(row.name) == "particle forcing"
                                     ? 1
                                     : 0;
    EXPECT_EQ(Errors().Records().size(), messages) << row.name << Errors().JoinErrors();
  }
  ResetUserFunctionNames();
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
  EXPECT_EQ(process.scope.Text() + process.expression.Text() + process.symbol.Text(), "");
  std::string missing;
  for (const ErrorRecord& record : Errors().Records()) {
    EXPECT_EQ(record.level, 3U);
    EXPECT_EQ(record.uid, -1);
    missing += record.text.substr(std::string("could not find key ").size()) + ";";
  }
  // The number behind a missing text is not looked for.
  EXPECT_EQ(missing,
            "SYMBOL in T;DESCRIPTION in T;ONLINE_HELP in T;DOCUMENTATION in T;OUTPUT in T;PROCESS_TYPE in T;"
            "SCOPE in T;SPATIAL_VARIATION in T;UNIT in T;EXPRESSION in T;");
}

TEST(ElementFiles, AnOilSpillSearchIsKept) {
  const TemporaryFolder folder;
  CEL_Lagrange_Spatial_Function written("s");
  written.purpose.SetText("OILSPILL");
  written.math.SetText("MAX");
  written.radius.SetReal(10);
  WriteElement(written, folder.File("element"));
  CEL_Lagrange_Spatial_Function read("t");
  ReadElement(read, folder.File("element"));
  EXPECT_EQ(read.purpose.Text(), "OILSPILL");
  EXPECT_TRUE(read.purpose.HasChoice("Oilspill(deprecated)"));
  EXPECT_TRUE(read.Check());
  // A text that the framework does not know gives way to the first choice.
  written.purpose.SetText("SOMETHING");
  WriteElement(written, folder.File("element"));
  ReadElement(read, folder.File("element"));
  EXPECT_EQ(read.purpose.Text(), "DIRECTION");
}

}  // namespace
}  // namespace tessal
