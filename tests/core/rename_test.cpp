#include "core/rename.h"

#include <gtest/gtest.h>

#include "core/error_registry.h"
#include "core/loaded_template.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::TemplateText;

TEST(Rename, ReplacesWholeWords) {
  struct Row {
    const char* text;
    const char* oldWord;
    const char* newWord;
    const char* result;
  };
  const Row rows[] = {
      {"\"K+K1\"", "K", "K1", "\"K1+K11\""},
      {"\"K+K\"", "K", "K1", "\"K1+K1\""},
      {"\"xK+Kx\"", "K", "L", "\"xK+Kx\""},
      {"\"K_2\"", "K", "K1", "\"K1_2\""},
      {"\"1a+a2\"", "a", "b", "\"1b+b2\""},
      {"\"ab+ba\"", "a", "c", "\"ab+ba\""},
      {"\"aa\"", "a", "b", "\"aa\""},
      {"\"a*a*a\"", "a", "", "\"**\""},
      {"", "a", "b", ""},
      {"\"k\"", "K", "x", "\"k\""},
      {"ab", "b", "c", "ac"},
  };
  for (const Row& row : rows)
    EXPECT_EQ(ReplaceWord(row.text, row.oldWord, row.newWord), row.result) << row.text;
}

TEST(Rename, RewritesEveryKindOfUser) {
  LoadedTemplate loaded(TemplateText()
                            .Constant("k")
                            .Auxiliary("a", "k*kk + k")
                            .Process("p", "k + p_k")
                            .StateVariable("S", "p")
                            .DerivedOutput("2*k")
                            .Specie("A", "A_e", {{"A_e", "k"}})
                            .Text());
  auto& specie = loaded->GetSpecie(0);
  specie.horizontalVectors[0]->direction.SetText("k");
  specie.horizontalVectors[0]->speed.SetText("k+1");
  specie.verticalEquation->speed.SetText("-k");
  ASSERT_TRUE(loaded->RenameSymbol("k", "rate", true));
  EXPECT_EQ(loaded->GetAuxiliary(0).expression.Text(), "rate*kk + rate");
  EXPECT_EQ(loaded->GetProcess(0).expression.Text(), "rate + p_rate") << "an underscore ends a word";
  EXPECT_EQ(loaded->GetDerivedOutput(0).expression.Text(), "2*rate");
  EXPECT_EQ(specie.arithmeticExpressions[0]->expression.Text(), "rate");
  EXPECT_EQ(specie.horizontalVectors[0]->direction.Text(), "rate");
  EXPECT_EQ(specie.horizontalVectors[0]->speed.Text(), "rate+1");
  EXPECT_EQ(specie.verticalEquation->speed.Text(), "-rate");
  EXPECT_EQ(loaded.Undefined(), "kk p_rate ");
  EXPECT_TRUE(loaded->RenameSymbol("p", "reaction", true));
  EXPECT_EQ(loaded->GetStateVariable(0).equation.Text(), "reaction");
}

TEST(Rename, LeavesTheUsesWhenToldTo) {
  LoadedTemplate loaded(TemplateText().Constant("k").Auxiliary("a", "k").Text());
  EXPECT_TRUE(loaded->RenameSymbol("k", "new_k", false));
  EXPECT_EQ(loaded.Undefined(), "k ");
  EXPECT_TRUE(loaded->RenameSymbol("new_k", "k", true));
  EXPECT_EQ(loaded.Undefined(), "") << "the name is defined again";
}

TEST(Rename, RefusesAndThenChangesNothing) {
  LoadedTemplate loaded(TemplateText().Constant("k").Constant("m").Text());
  EXPECT_FALSE(loaded->RenameSymbol("k", "m", true));
  EXPECT_FALSE(loaded->RenameSymbol("nobody", "n", true));
  EXPECT_FALSE(loaded->Modified());
  loaded->AddConstant();
  EXPECT_EQ(loaded->SymbolTable().size(), 3U) << "rebuilds are on";
  EXPECT_EQ(RenameRefusal(*loaded, "1a"), "'1a' is not a valid identifier!");
  EXPECT_EQ(RenameRefusal(*loaded, "sin"), "'sin' is invalid because it is an Tessal keyword!");
  EXPECT_EQ(RenameRefusal(*loaded, "m"), "An item with the name 'm' already exists!");
  EXPECT_EQ(RenameRefusal(*loaded, "fresh"), "");
}

TEST(Rename, AClassRefusesABadNameByItself) {
  LoadedTemplate loaded(TemplateText().Constant("k").Specie("A", "0", {}).Text());
  Errors().ClearErrors();
  loaded->GetSpecie(0).symbol.SetText("1A");
  loaded->GetSpecie(0).symbol.SetText("k");
  EXPECT_EQ(loaded->GetSpecie(0).symbol.Text(), "A");
  EXPECT_EQ(test::Messages(),
            "2 1A: 1A, illegal symbol name (keyword or illegal characters used)\n2 k: k, already defined!\n");
  loaded->GetSpecie(0).symbol.SetText("B");
  EXPECT_TRUE(loaded->SymbolExists("B"));
}

}  // namespace
}  // namespace tessal
