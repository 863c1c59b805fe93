#include <gtest/gtest.h>

#include "core/loaded_template.h"
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
  EXPECT_EQ(forcing.scope.Text() + forcing.spatialVariation.Text(), "WSHORISONTAL");
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

}  // namespace
}  // namespace tessal
