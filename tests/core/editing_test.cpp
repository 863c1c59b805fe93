#include <gtest/gtest.h>

#include "core/loaded_template.h"
#include "expr/carbonate/options.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::TemplateText;

TEST(Editing, IdentitiesAreNeverReused) {
  TemplateCore first;
  TemplateCore second;
  const Uid uid = first.AddConstant().GetUid();
  EXPECT_NE(second.AddConstant().GetUid(), uid);
  first.DeleteElement(uid);
  EXPECT_GT(first.AddConstant().GetUid(), uid);
  EXPECT_EQ(first.GetElement(uid), nullptr);
}

TEST(Editing, AHeadIsOfItsKindAndMarksItsTemplate) {
  TemplateCore core;
  core.SetModified(false);
  core.Root().description.SetText("a model");
  EXPECT_TRUE(core.Modified());
  EXPECT_EQ(core.ListHead(ElementKind::DerivedOutputList).Kind(), ElementKind::DerivedOutputList);
  EXPECT_THROW(core.ListHead(ElementKind::SpecieStateVariableList), std::out_of_range);
}

TEST(Editing, TheLastTemplateTakesTheCarbonateSettingsWithIt) {
  {
    const TemplateCore last;
    SetGetSpecie(5.0, 7.0);
  }
  const TemplateCore fresh;
  EXPECT_EQ(SetGetSpecie(5.0, -2.0), 0.0) << "the silicate that was stored before";
}

TEST(Editing, AnElementOfTheTemplateIsMadeForAnyOwner) {
  LoadedTemplate loaded(TemplateText().Specie("A", "0", {}).Text());
  const Uid list = loaded->GetSpecie(0).Head(ElementKind::SpecieConstantList).GetUid();
  const CreatedElement created = loaded->CreateElement({"k", ElementKind::Constant, list});
  EXPECT_EQ(loaded->GetConstant(0).GetUid(), created.uid);
  SetNotifyChanges(false);
}

TEST(Editing, ARefreshedSearchShowsItsValuesAsSelected) {
  LoadedTemplate loaded(TemplateText().Specie("A", "0", {}).Specie("B", "0", {}).Text());
  CEL_Lagrange_Spatial_Function& search = loaded->GetSpecie(1).AddSpatialFunction();
  loaded->RefreshSearchFunctionChoices();
  EXPECT_EQ(search.specieId.Selected(), 1) << "its own class";
  EXPECT_EQ(search.variableId.Selected(), 0) << "no variable";
  EXPECT_EQ(search.lookFor.Selected(), 0) << "its own class";
}

TEST(Editing, ABuiltinTakesItsFieldsAlongAndLocksThem) {
  TemplateCore core;
  SetNotifyChanges(true);
  CEL_Forcing& forcing = core.AddForcing();
  EXPECT_FALSE(forcing.builtInId.HasChoice("WEIRHEIGHT_old"));
  forcing.unqType.SetInt(100150);  // a rate, whose unit is fixed in another way
  forcing.builtInId.SelectChoice("RELATIVE_DEPTH");
  forcing.builtInId.ApplySelection();
  EXPECT_EQ(forcing.unit.Text(), "()");
  EXPECT_EQ(forcing.defaultValue.RealValue(), -1.0);
  EXPECT_EQ(forcing.scope.TextOf() + forcing.spatialVariation.TextOf(), "WSHORISONTAL");
  EXPECT_FALSE(forcing.isUserSpecified.BoolValue());
  for (const CEL_Property* taken :
       {&forcing.scope, &forcing.spatialVariation, &forcing.unqType, &forcing.unqUnit, &forcing.unit,
        &forcing.defaultValue, &forcing.minValue, &forcing.maxValue}) {
    EXPECT_FALSE(taken->Editable());
  }
  forcing.builtInId.SelectChoice("User defined");
  forcing.builtInId.ApplySelection();
  EXPECT_TRUE(forcing.maxValue.Editable());
  EXPECT_EQ(forcing.unit.Text(), "()");
  forcing.builtInId.SetInt(1);  // a constant's row
  EXPECT_EQ(forcing.unit.Text(), "()");
  core.SetShowAllBuiltIns(true);
  EXPECT_TRUE(forcing.builtInId.HasChoice("WEIRHEIGHT_old"));
  SetNotifyChanges(false);
}

TEST(Editing, ResetLeavesMembersInTheirClass) {
  LoadedTemplate loaded(TemplateText().Specie("A", "0", {}).Specie("B", "0", {{"B_e", "1"}}).Text());
  auto& specie = loaded->GetSpecie(1);
  specie.stateVariables[0]->Reset();
  specie.arithmeticExpressions[0]->Reset();
  EXPECT_EQ(specie.stateVariables[0]->specie.IntValue(), 2);
  EXPECT_EQ(specie.arithmeticExpressions[0]->specie.IntValue(), 2);
  EXPECT_THROW(loaded->GetSpecie(2), std::out_of_range);
}

TEST(Editing, ASymbolIsCheckedAgainWhenAUserFunctionTakesItsName) {
  LoadedTemplate loaded(TemplateText().Misc().Constant("Mix").Text());
  SetNotifyChanges(true);
  EXPECT_TRUE(loaded->ValidateTemplate());
  CEL_ExternalFunction& function = loaded->GetMisc()->AddExternalFunction();
  function.publicName.SetText("Mix");
  EXPECT_FALSE(loaded->ValidateTemplate());
  function.publicName.SetText("Blend");
  EXPECT_TRUE(loaded->ValidateTemplate());
  loaded->GetConstant(0).symbol.SetText("1st");
  EXPECT_FALSE(loaded->ValidateTemplate()) << "a change is checked";
  SetNotifyChanges(false);
}

}  // namespace
}  // namespace tessal
