#include "elements/element.h"

#include <gtest/gtest.h>

#include <cstdlib>

#include "core/error_registry.h"
#include "elements/area_search.h"
#include "elements/expression_elements.h"
#include "elements/external_function.h"
#include "elements/input_elements.h"
#include "elements/miscellaneous.h"
#include "elements/specie.h"
#include "elements/state_variable.h"
#include "elements/visibility.h"
#include "platform/number_text.h"

namespace tessal {
namespace {

std::string Labels(const CEL_Element& element) {
  std::vector<ElementField> fields;
  element.GetFields(fields);
  std::string labels;
  for (const ElementField& field : fields) labels += field.name + "|";
  return labels;
}

constexpr const char* kBase = "Caption|Symbol|ID|Description|Documentation|Online help|UNQ Type|UNQ Unit|";

TEST(Elements, ListTheirFieldsInOrder) {
  const std::string base = kBase;
  EXPECT_EQ(Labels(CEL_StateVariable("S")),
            base + "Scope|Transport|Unit|Default Value|Min Value|Max Value|Equation|");
  EXPECT_EQ(
      Labels(CEL_Constant("c")),
      base + "Is user specified|Build in ID|Scope|Spatial Variation|Unit|Default Value|Min Value|Max Value|");
  EXPECT_EQ(Labels(CEL_Forcing("f")), Labels(CEL_Constant("c")));
  EXPECT_EQ(Labels(CEL_Lagrange_Constant("c")),
            base + "Spatial Variation|Unit|Default Value|Min Value|Max Value|");
  EXPECT_EQ(Labels(CEL_Lagrange_Forcing("f")), Labels(CEL_Lagrange_Constant("c")));
  EXPECT_EQ(Labels(CEL_Lagrange_Arithmetical_Expression("a")),
            base + "Expression type|Specie|Output|Spatial Variation|Unit|Expression|");
  EXPECT_EQ(Labels(CEL_ExternalFunction("x")), base + "Public Name|Parameter Count|Used as|DLL|Entry Point|");
  EXPECT_EQ(Labels(CEL_Visibility()), "");
  EXPECT_EQ(Labels(CEL_ListHead(kind::kRoot, "r")), base.substr(base.find('|') + 1));
  EXPECT_EQ(Labels(CEL_Auxilliary_Variable("a")), base + "Output|Scope|Spatial Variation|Unit|Expression|");
  EXPECT_EQ(Labels(CEL_Process("p")),
            base +
                "Output|Process type|Scope|Spatial Variation|Unit|Expression|Control "
                "ID|Control Value|");
  EXPECT_EQ(Labels(CEL_Derived_Output("d")), base + "Scope|Spatial Variation|Unit|Format|Expression|");
  EXPECT_EQ(
      Labels(CEL_Miscanellous()),
      base +
          "Tessal version|Parser version|Randseed|Debug level|Debug log|Inital random particle dir|Build "
          "spatial tree|Checksum|Optimise expressions|Trigonometric unit|Revision|");
  EXPECT_EQ(
      Labels(CEL_Lagrange_Specie("A")),
      "Caption|Name|Description|Documentation|Online help|Scope|Transport|Projection time|Field of view|");
  EXPECT_EQ(Labels(CEL_Lagrange_Horizontal_Vector("h")), "Caption|Speed|Direction|");
  EXPECT_EQ(Labels(CEL_Lagrange_Vertical_Equation("v")), "Caption|Speed|");
  EXPECT_EQ(Labels(CEL_Lagrange_StateVariable("s")),
            base + "Specie|Unit|Default Value|Min Value|Max Value|Equation|");
  EXPECT_EQ(Labels(CEL_Lagrange_Spatial_Function("f")),
            base +
                "Function_ID|Variable ID|Specie ID|Radius|Dimension|Spatial "
                "Variation|Purpose|Framework|Property|Math|Lookfor|");
}

TEST(Elements, TellTheirFieldsAsText) {
  CEL_Process process("p");
  process.controlValue.SetReal(0.0001);
  process.expression.SetText("1 +");
  std::vector<ElementField> fields;
  process.GetFields(fields);
  const std::pair<const char*, const char*> rows[] = {{"Caption", "Process"},
                                                      {"Symbol", "p"},
                                                      {"UNQ Type", "999"},
                                                      {"Output", "True/Yes"},
                                                      {"Control ID", "-1"},
                                                      {"Control Value", "0.0001"},
                                                      {"Spatial Variation", "HORISONTAL_AND_VERTICAL"},
                                                      {"Expression", "1 +"}};
  for (const auto& [name, text] : rows) {
    const ElementField* field = FindField(fields, name);
    ASSERT_NE(field, nullptr) << name;
    EXPECT_EQ(FieldText(*field), text) << name;
  }
  EXPECT_EQ(FindField(fields, "Expression")->kind, FieldKind::Expression);
  EXPECT_EQ(FindField(fields, "Scope")->choiceTexts, (std::vector<std::string>{"WS", "WC", "WB", "SED"}));
  EXPECT_EQ(FindField(fields, "Spatial Variation")->choiceTexts,
            (std::vector<std::string>{"NONE", "HORIZONTAL", "HORIZONTAL_AND_VERTICAL"}));
  EXPECT_TRUE(FindField(fields, "Unit")->choiceTexts.empty());
  EXPECT_EQ(FieldText(ElementField()), "invalid");
}

TEST(Elements, NumbersReadAsPeopleWriteThem) {
  const std::pair<double, const char*> rows[] = {{0.0, "0"},
                                                 {0.0001, "0.0001"},
                                                 {0.00001, "1e-05"},
                                                 {100000.0, "100000"},
                                                 {1234567.0, "1234567"},
                                                 {1e15, "1e+15"},
                                                 {-2.5, "-2.5"},
                                                 {0.1 + 0.2, "0.30000000000000004"},
                                                 {1e-35, "1e-35"},
                                                 {123456789012345.6, "123456789012345.6"},
                                                 {-1.7976931348623157e308, "-1.7976931348623157e+308"}};
  for (const auto& [value, text] : rows) {
    EXPECT_EQ(PlainNumberText(value), text);
    EXPECT_EQ(std::strtod(PlainNumberText(value).c_str(), nullptr), value);
  }
}

TEST(Elements, SetTheFieldsTheyKnowAndCountThem) {
  CEL_Auxilliary_Variable auxiliary("a");
  ElementField expression;
  expression.kind = FieldKind::Text;
  expression.name = "Expression";
  expression.text = "1+1";
  ElementField equation = expression;
  equation.name = "Equation";
  ElementField wrong = expression;
  wrong.name = "ID";
  EXPECT_EQ(auxiliary.SetFields({expression, equation, wrong}), 1);
  EXPECT_EQ(auxiliary.expression.Text(), "1+1");
  CEL_StateVariable variable("S");
  EXPECT_EQ(variable.SetFields({expression, equation}), 1);
  EXPECT_EQ(variable.equation.Text(), "1+1");
}

TEST(Elements, StartWithTheirDefaults) {
  const CEL_StateVariable variable("S");
  EXPECT_EQ(
      variable.scope.Text() + variable.transport.Text() + variable.unit.Text() + variable.equation.Text(),
      "WCADVECTION_DISPERSIONundefined0");
  EXPECT_EQ(variable.maxValue.RealValue(), 100.0);
  EXPECT_EQ(variable.unqType.IntValue(), 999);
  const CEL_Constant constant("c");
  EXPECT_EQ(constant.builtInId.IntValue(), -1);
  EXPECT_TRUE(constant.isUserSpecified.BoolValue());
  EXPECT_EQ(constant.scope.Text() + constant.spatialVariation.Text(), "NOT_SPECIFIEDNONE");
  EXPECT_EQ(CEL_Process("p").controlValue.RealValue(), 0.8);
  EXPECT_EQ(CEL_Derived_Output("d").format.Text(), "INSTANTANEOUS");
  EXPECT_EQ(CEL_Lagrange_Constant("c").maxValue.RealValue(), 10.0);
  EXPECT_EQ(CEL_Lagrange_Forcing("f").minValue.RealValue(), 1e-35);
  const CEL_Miscanellous misc;
  EXPECT_EQ(misc.trigonometrics.Text(), "Degree");
  EXPECT_TRUE(misc.optimise.BoolValue());
}

TEST(Elements, UnitTypesFixTheirUnits) {
  SetNotifyChanges(true);
  CEL_StateVariable variable("S");
  variable.unqType.SelectChoice("Volume");
  variable.unqType.ApplySelection();
  EXPECT_EQ(variable.unit.Text(), "m3");
  EXPECT_FALSE(variable.UnitEditable());
  variable.unqType.SetInt(4711);
  EXPECT_EQ(variable.unqType.IntValue(), 999);
  EXPECT_TRUE(variable.UnitEditable());
  CEL_Constant constant("c");
  constant.unqType.SelectChoice("Process rate");
  constant.unqType.ApplySelection();
  EXPECT_EQ(constant.unit.Text(), "/d");
  EXPECT_FALSE(constant.unit.Editable());
  CEL_Lagrange_Constant particle("p");
  particle.unqType.SetInt(100220);
  EXPECT_EQ(particle.unit.Text(), "per meter");
  particle.unqType.SetInt(1);
  EXPECT_EQ(particle.unit.Text(), "per meter");
  EXPECT_TRUE(particle.unit.Editable());
  SetNotifyChanges(false);
}

TEST(Elements, AScopeBringsItsVariation) {
  SetNotifyChanges(true);
  CEL_Process process("p");
  process.scope.SetText("SED");
  EXPECT_EQ(process.spatialVariation.Text(), "HORISONTAL");
  EXPECT_EQ(process.spatialVariation.SelectedFileText(), "HORISONTAL") << "or a form stores the old one";
  process.scope.SetText("WC");
  EXPECT_EQ(process.spatialVariation.Text(), "HORISONTAL_AND_VERTICAL");
  process.scope.SetText("elsewhere");
  EXPECT_EQ(process.spatialVariation.Text(), "HORISONTAL_AND_VERTICAL");
  SetNotifyChanges(false);
}

TEST(Elements, CheckTheirRanges) {
  struct Row {
    double minimum;
    double value;
    double maximum;
    std::size_t ofTemplate;
    std::size_t ofParticle;
  };
  const Row rows[] = {{1, 1, 1, 0, 0}, {0, -1, 5, 1, 1}, {0, 6, 5, 1, 1}, {9, 5, 1, 3, 2}};
  for (const Row& row : rows) {
    const auto check = [&row](auto&& element) {
      Errors().Reset();
      element.minValue.SetReal(row.minimum);
      element.defaultValue.SetReal(row.value);
      element.maxValue.SetReal(row.maximum);
      const bool good = element.Check();
      EXPECT_EQ(good, Errors().Records().empty());
      return Errors().Records().size();
    };
    EXPECT_EQ(check(CEL_StateVariable("S")), row.ofTemplate) << row.value;
    EXPECT_EQ(check(CEL_Forcing("f")), row.ofTemplate) << row.value;
    EXPECT_EQ(check(CEL_Lagrange_StateVariable("s")), row.ofParticle) << row.value;
    EXPECT_EQ(check(CEL_Lagrange_Forcing("f")), 0U) << "unchecked";
  }
}

TEST(AreaSearch, ChoicesFollowFrameworkAndPurpose) {
  SetNotifyChanges(true);
  CEL_Lagrange_Spatial_Function search("s");
  EXPECT_TRUE(search.math.HasChoice("MIN_ABSOLUTE"));
  EXPECT_FALSE(search.purpose.HasChoice("PARTICLE"));
  search.variableId.SetInt(5);
  search.framework.SetText("LAGRANGE");
  EXPECT_EQ(search.variableId.IntValue(), -1);
  search.purpose.SetText("MAGNITUDE");
  EXPECT_TRUE(search.math.HasChoice("SUM_NORM"));
  search.math.SetText("SUM_NORM");
  search.purpose.SetText("PARTICLE");
  EXPECT_EQ(search.math.Text(), "NONE") << "gives way to the first choice";
  search.framework.SetText("EULER");
  EXPECT_EQ(search.purpose.Text(), "DIRECTION");
  search.purpose.SetText("OILSPILL");
  EXPECT_TRUE(search.purpose.HasChoice("Oilspill(deprecated)"));
  EXPECT_EQ(search.purpose.Text(), "OILSPILL");
  SetNotifyChanges(false);
}

TEST(AreaSearch, ChecksWhatItNeeds) {
  CEL_Lagrange_Spatial_Function search("s");
  const auto findings = [&search] {
    Errors().Reset();
    search.Check();
    std::string texts;
    for (const ErrorRecord& record : Errors().Records()) texts += record.text + "|";
    return texts;
  };
  const std::string variable = "No valid variable/property selected|";
  const std::string math = "Invalid math function|";
  const std::string radius = "Search radius must be larger than zero|";
  EXPECT_EQ(findings(), variable + math + radius);
  search.purpose.SetText("OILSPILL");
  EXPECT_EQ(findings(), math + radius);
  search.purpose.SetText("DIRECTION");
  search.math.SetText("MIN");
  search.radius.SetReal(1e-9);
  search.variableId.SetInt(1'000'000);
  EXPECT_EQ(findings(), variable);
  search.framework.SetText("LAGRANGE");
  search.variableId.SetInt(-1);
  search.property.SetText("AGE");
  EXPECT_EQ(findings(), "");
  search.lookFor.SetInt(0);
  EXPECT_EQ(findings(), "No valid specie selected|");
  search.lookFor.SetInt(-2);
  EXPECT_EQ(findings(), "");
}

}  // namespace
}  // namespace tessal
