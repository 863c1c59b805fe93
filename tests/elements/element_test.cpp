#include "elements/element.h"

#include <gtest/gtest.h>

#include <cstdlib>

#include "core/error_registry.h"
#include "elements/expression_elements.h"
#include "elements/input_elements.h"
#include "elements/specie_values.h"
#include "elements/state_variable.h"
#include "platform/number_text.h"

namespace tessal {
namespace {

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

TEST(Elements, UnitTypesFixTheirUnits) {
  SetNotifyChanges(true);
  CEL_StateVariable variable("S");
  variable.unqType.SelectChoice("Volume");
  variable.unqType.ApplySelection();
  EXPECT_EQ(variable.unit.Text(), "m3");
  EXPECT_FALSE(variable.unit.Editable());
  variable.unqType.SetInt(4711);
  EXPECT_EQ(variable.unqType.IntValue(), 999);
  EXPECT_TRUE(variable.unit.Editable());
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

}  // namespace
}  // namespace tessal
