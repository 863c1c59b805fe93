// The numbers of particle classes, and what refers to a class by its number.
#include <gtest/gtest.h>

#include "core/error_registry.h"
#include "core/loaded_template.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::TemplateText;

constexpr std::int32_t kOwnSpecie = -1;
constexpr std::int32_t kAnyParticle = -2;

/// Three classes with a search function in the last one.
class ThreeClasses : public ::testing::Test {
 protected:
  ThreeClasses()
      : loaded(TemplateText()
                   .Misc("DOCUMENT_REVISION = 1\n")
                   .Constant("k")
                   .Specie("A", "A_p", {{"A_p", "1"}})
                   .Specie("B", "B_p", {{"B_p", "1"}})
                   .Specie("C", "C_p", {{"C_p", "1"}})
                   .Text()),
        search(loaded->GetSpecie(2).AddSpatialFunction()) {
    loaded->RebuildSymbolTable();
    search.radius.SetReal(5.0);
    search.framework.SetText("LAGRANGE");
    search.math.SetText("MIN");
    search.property.SetText("AGE");
  }

  std::string VariablesOffered() {
    loaded->RefreshSearchFunctionChoices();
    std::string names;
    for (const CEL_Choice& choice : search.variableId.Choices()) names += choice.display + " ";
    return names;
  }

  LoadedTemplate loaded;
  CEL_Lagrange_Spatial_Function& search;
};

TEST_F(ThreeClasses, ASearchOffersTheValuesOfTheClassItLooksFor) {
  search.lookFor.SetInt(kOwnSpecie);
  EXPECT_EQ(VariablesOffered(), "NONE C_Mass ");
  search.lookFor.SetInt(2);
  EXPECT_EQ(VariablesOffered(), "NONE B_Mass ");
  search.lookFor.SetInt(kAnyParticle);
  EXPECT_EQ(VariablesOffered(), "NONE ");
  EXPECT_EQ(search.specieId.IntValue(), 3);
  EXPECT_TRUE(loaded->GetMisc()->buildSpatialTree.BoolValue());
  search.framework.SetText("EULER");
  EXPECT_EQ(VariablesOffered(), "NONE k ");
  EXPECT_FALSE(loaded->GetMisc()->buildSpatialTree.BoolValue()) << "follows the searches";
}

TEST_F(ThreeClasses, ASearchFollowsItsClassToANewNumber) {
  search.lookFor.SetInt(2);
  ASSERT_TRUE(loaded->DeleteElement(loaded.Uid("A")));
  EXPECT_EQ(loaded->GetSpecie(0).Index(), 1);
  EXPECT_EQ(search.lookFor.IntValue(), 1) << "still B";
  EXPECT_EQ(VariablesOffered(), "NONE B_Mass ");
  ASSERT_TRUE(loaded->MoveElement(loaded.Uid("B"), loaded.Uid("C"), false));
  EXPECT_EQ(search.lookFor.IntValue(), 2);
  EXPECT_EQ(loaded->AddSpecie().Index(), 3) << "no number twice";
  EXPECT_EQ(loaded->GetSpecie(1).arithmeticExpressions[0]->specie.IntValue(), 2);
  EXPECT_TRUE(search.Check());

  ASSERT_TRUE(loaded->SaveWrapper(loaded.Path()));
  TemplateCore again;
  ASSERT_TRUE(again.LoadWrapper(loaded.Path()));
  EXPECT_EQ(again.GetSpecie(0).spatialFunctions[0]->lookFor.IntValue(), 2);
  EXPECT_EQ(again.GetSpecie(1).symbol.Text(), "B");
}

TEST_F(ThreeClasses, ASearchForADeletedClassLooksForNone) {
  search.lookFor.SetInt(2);
  ASSERT_TRUE(loaded->DeleteElement(loaded.Uid("B")));
  Errors().Reset();
  EXPECT_FALSE(search.Check());
  EXPECT_EQ(test::Messages(), "2 C_Search_Function_1: No valid specie selected\n");
  loaded->AddSpecie();
  EXPECT_FALSE(search.Check()) << "and not for the one that is made next";
}

TEST_F(ThreeClasses, AChangeOfPurposeLeavesTheProperty) {
  search.property.SetText("HDIR");
  search.purpose.SetText("MAGNITUDE");
  EXPECT_EQ(search.property.Text(), "HDIR");
  EXPECT_EQ(search.variableId.IntValue(), -1);
}

TEST_F(ThreeClasses, TheSpatialTreeGoesWithTheLastSearchThatNeedsIt) {
  loaded->RefreshSearchFunctionChoices();
  ASSERT_TRUE(loaded->GetMisc()->buildSpatialTree.BoolValue());
  ASSERT_TRUE(loaded->MoveElement(loaded.Uid("C"), loaded.Uid("A"), true));
  EXPECT_EQ(search.specieId.IntValue(), 1) << "the number of its class";
  ASSERT_TRUE(loaded->DeleteElement(search.GetUid()));
  EXPECT_FALSE(loaded->GetMisc()->buildSpatialTree.BoolValue());
}

TEST_F(ThreeClasses, ResetLeavesMembersInTheirClass) {
  auto& specie = loaded->GetSpecie(2);
  specie.stateVariables[0]->Reset();
  specie.arithmeticExpressions[0]->Reset();
  EXPECT_EQ(specie.stateVariables[0]->specie.IntValue(), 3);
  EXPECT_EQ(specie.arithmeticExpressions[0]->specie.IntValue(), 3);
  specie.AddHorizontalVector();
  specie.AddHorizontalVector();
  loaded->RebuildSymbolTable();
  ASSERT_TRUE(loaded->DeleteElement(specie.horizontalVectors[0]->GetUid()));
  EXPECT_EQ(specie.AddHorizontalVector().symbol.Text(), "Horizontal Vector4") << "no name twice";
}

TEST_F(ThreeClasses, AClassWithoutMembersWritesAllItsLists) {
  TemplateCore core;
  core.AddSpecie();
  const std::string path = loaded.Path() + ".new";
  ASSERT_TRUE(core.SaveWrapper(path));
  const std::string text = test::ReadFile(path);
  std::size_t place = text.find("[SPECIE_1]");
  for (const char* name :
       {"STATE_VARIABLES", "CONSTANTS", "FORCINGS", "SPATIAL_FUNCTIONS", "ARITHMETICAL_EXPRESSIONS",
        "LAGRANGE_STATE_VARIABLE_EQUATIONS", "HORIZONTAL_VECTORS_SECTION", "VERTICAL_SPEED_EQUATION"}) {
    place = text.find("[" + std::string(name) + "]", place);
    ASSERT_NE(place, std::string::npos) << name;
  }
}

}  // namespace
}  // namespace tessal
