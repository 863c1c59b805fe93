// References, undefined symbols, and the rules of order and scope.
#include <gtest/gtest.h>

#include "core/error_registry.h"
#include "core/loaded_template.h"
#include "core/scope_rule.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::Messages;
using test::TemplateText;

TEST(References, StandOnceAndInBothDirections) {
  LoadedTemplate loaded(TemplateText()
                            .Constant("k")
                            .Auxiliary("a", "k + k*2 + IF k > 1 THEN k ELSE SIN(k)")
                            .Process("p", "a*k")
                            .StateVariable("S", "p")
                            .Text());
  EXPECT_EQ(Messages(), "");
  EXPECT_EQ(loaded.References("a"), "k ");
  EXPECT_EQ(loaded.References("p"), "a k ");
  std::vector<std::string> users;
  EXPECT_TRUE(loaded->GetReferrerSymbols(loaded.Uid("k"), users));
  EXPECT_EQ(users, (std::vector<std::string>{"a", "p"}));
  EXPECT_TRUE(loaded->IsReferenced(loaded.Uid("p")));
  EXPECT_FALSE(loaded->IsReferenced(loaded.Uid("S")));
}

TEST(References, NamesThatNobodyDefinesAreListedWithTheirUsers) {
  LoadedTemplate loaded(TemplateText()
                            .Auxiliary("a", "new1 + sin + 2 + XPOS + xpos + new2")
                            .Auxiliary("b", "new1 + foo(1) + IF x1 > 0 THEN 1 ELSE 2")
                            .Text());
  EXPECT_EQ(loaded.Undefined(), "new1 xpos new2 foo x1 ");
  EXPECT_EQ(loaded->UndefinedSymbols()[0]->usedBy,
            (std::vector<std::uint32_t>{loaded.Uid("a"), loaded.Uid("b")}));
  // An answer outlives a rebuild as long as the name is in use.
  loaded->UndefinedSymbols()[0]->asked = true;
  loaded->GetAuxiliary(0).expression.SetText("xpos");
  EXPECT_EQ(loaded.Undefined(), "new1 xpos foo x1 ");
  EXPECT_TRUE(loaded->UndefinedSymbols()[0]->asked);
  loaded->GetAuxiliary(1).expression.SetText("1");
  EXPECT_EQ(loaded.Undefined(), "xpos ");
}

TEST(Order, AUseComesBehindItsDefinition) {
  LoadedTemplate loaded(TemplateText()
                            .Auxiliary("a", "b + a")
                            .Auxiliary("b", "1")
                            .Process("p", "q")
                            .Process("q", "1")
                            .Constant("k")
                            .StateVariable("S", "p + k")
                            .Text());
  EXPECT_EQ(Messages(),
            "3 S: The symbol 'k' is not a process!\n"
            "3 a: The symbol 'b' can not be used as it is declared after 'a'!\n"
            "3 p: The symbol 'q' can not be used as it is declared after 'p'!\n");
}

TEST(Scope, CodesAreThoseOfTheFormat) {
  const std::pair<const char*, int> scopes[] = {
      {"Global", 0}, {"WS", 1}, {"WB", 2}, {"SED", 3}, {"WC", 4}, {"NOT_SPECIFIED", 5}, {"ws", 5}, {"", 5}};
  for (const auto& [text, code] : scopes) EXPECT_EQ(ScopeFromText(text), code) << text;
  const std::pair<const char*, int> variations[] = {
      {"NONE", 0}, {"HORISONTAL", 1}, {"HORISONTAL_AND_VERTICAL", 2}, {"HORIZONTAL", 3}};
  for (const auto& [text, code] : variations) EXPECT_EQ(SpatialFromText(text), code) << text;
}

TEST(Scope, WhatDoesNotVaryUsesNothingThatDoes) {
  struct Row {
    const char* scope;
    const char* variation;
    const char* inputScope;
    const char* inputVariation;
    bool allowed;
  };
  const Row rows[] = {
      {"WC", "NONE", "WC", "NONE", true},
      {"WC", "NONE", "WC", "HORISONTAL", false},
      {"WS", "NONE", "WC", "HORISONTAL_AND_VERTICAL", false},
      {"WC", "HORISONTAL", "WC", "HORISONTAL_AND_VERTICAL", false},
      {"WS", "HORISONTAL", "WC", "HORISONTAL_AND_VERTICAL", true},
      {"WC", "HORISONTAL", "WS", "HORISONTAL_AND_VERTICAL", true},
      {"WC", "HORISONTAL", "WC", "HORISONTAL", true},
      {"WC", "HORISONTAL_AND_VERTICAL", "WC", "HORISONTAL_AND_VERTICAL", true},
      {"WC", "HORIZONTAL", "WC", "HORISONTAL_AND_VERTICAL", true},
  };
  for (const Row& row : rows) {
    const auto quoted = [](const char* text) { return "'" + std::string(text) + "'"; };
    LoadedTemplate loaded(TemplateText()
                              .Forcing("f")
                              .With("SCOPE", quoted(row.inputScope))
                              .With("SPATIAL_VARIATION", quoted(row.inputVariation))
                              .Process("p", "f + f")
                              .With("SCOPE", quoted(row.scope))
                              .With("SPATIAL_VARIATION", quoted(row.variation))
                              .Text());
    Errors().ClearErrors();
    EXPECT_EQ(loaded->CheckScopeRule(), row.allowed) << row.scope << row.variation << row.inputVariation;
    EXPECT_EQ(Messages(), row.allowed ? "" : "2 p: 'f' has invalid scope and/or spatial variation\n");
  }
}

TEST(Scope, TheProcessRuleStandsBehindIt) {
  LoadedTemplate loaded(TemplateText()
                            .Constant("k")
                            .With("SPATIAL_VARIATION", "'HORISONTAL_AND_VERTICAL'")
                            .Auxiliary("a", "k")
                            .With("SPATIAL_VARIATION", "'NONE'")
                            .StateVariable("S", "k")
                            .Text());
  loaded->SetStrictScopeRule(0);
  Errors().ClearErrors();
  EXPECT_FALSE(loaded->CheckProcessRule());
  EXPECT_EQ(Messages(),
            "2 S: k is no process!\n2 a: k has invalid scope and/or spatial variation in expression of\n");
}

TEST(Particles, UsesAcrossClassBordersAreTold) {
  LoadedTemplate loaded(TemplateText()
                            .Auxiliary("aux", "1")
                            .Constant("k")
                            .Specie("A", "A_p", {{"A_p", "k + A_Mass"}, {"A_a", "aux"}})
                            .Specie("B", "A_p + k", {{"B_e", "A_Mass + A_p"}})
                            .Text());
  EXPECT_EQ(Messages(),
            "3 A_a: The symbol 'aux' does not belong to current specie A\n"
            "3 B_Mass: The expression 'A_p' does not belong to current specie B\n"
            "3 B_Mass: The symbol'k' is not a process of the current current specie B\n"
            "2 B_e: The state variable 'A_Mass' does not belong to current specie B (only allowed if "
            "interaction!)\n"
            "3 B_e: The expression 'A_p' does not belong to current specie B\n");
  const auto& specie = loaded->GetSpecie(0);
  EXPECT_EQ(specie.arithmeticExpressions[0]->expressionType.Text(), "PROCESS");
  EXPECT_EQ(specie.arithmeticExpressions[1]->expressionType.Text(), "AUXILIARY_VARIABLE");
}

TEST(Particles, ASearchFunctionKeepsItsVariableThroughRenumbering) {
  LoadedTemplate loaded(TemplateText().Constant("k").Specie("A", "0", {}).Text());
  auto& function = loaded->GetSpecie(0).AddSpatialFunction();
  loaded->RebuildSymbolTable();
  function.variableId.SetInt(loaded->GetConstant(0).id.IntValue());
  EXPECT_EQ(function.VariableName(), "k");
  loaded->AddStateVariable();
  EXPECT_EQ(function.variableId.IntValue(), loaded->GetConstant(0).id.IntValue());
  loaded->RenameSymbol("k", "kk", true);
  EXPECT_EQ(function.VariableName(), "kk");
  EXPECT_TRUE(loaded->IsReferenced(loaded.Uid("kk")));
  loaded->RefreshSearchFunctionChoices();
  EXPECT_TRUE(function.variableId.HasChoice("kk"));
  EXPECT_FALSE(loaded->GetMisc() != nullptr && loaded->GetMisc()->buildSpatialTree.BoolValue());
  function.variableId.SetInt(999);
  EXPECT_EQ(function.VariableName(), "unkown");
}

TEST(Validation, FindsTheTextThatFilesCannotCarry) {
  LoadedTemplate loaded(TemplateText().Constant("k").With("DESCRIPTION", "'wow!'").Text());
  EXPECT_EQ(Messages(), "2 k: Decription, online help or documentation contain illegal characters ('!')\n");
  Errors().ClearErrors();
  loaded->Root().onlineHelp.SetText("!");
  EXPECT_FALSE(loaded->ValidateTemplate());
  EXPECT_FALSE(loaded->ValidateTemplate());
  EXPECT_EQ(Errors().GetErrorCount(0), 4U) << "nothing clears the registry between";
  EXPECT_EQ(Errors().ExpressionWarningCount(), 2);
}

}  // namespace
}  // namespace tessal
