#include <gtest/gtest.h>

#include "core/loaded_template.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::TemplateText;

std::string Order(const TemplateCore& core) {
  std::string symbols;
  for (const SymbolRecord& record : core.SymbolTable()) symbols += core.RecordSymbol(record) + " ";
  return symbols;
}

TEST(Editing, NewElementsHaveFreeNamesAndTheTemplatesDocumentation) {
  TemplateCore core;
  core.Root().documentation.SetText("model.pdf");
  EXPECT_EQ(core.AddConstant().symbol.Text(), "Constant_1");
  core.AddConstant();
  EXPECT_TRUE(core.DeleteElement(core.GetConstant(0).GetUid()));
  EXPECT_EQ(core.AddConstant().symbol.Text(), "Constant_3");
  EXPECT_EQ(core.AddDerivedOutput().symbol.Text(), "Derived Output 1");
  auto& specie = core.AddSpecie();
  EXPECT_EQ(specie.horizontalVectors.size(), 1U);
  EXPECT_EQ(specie.AddStateVariable().symbol.Text(), "Specie_1_StateVariable_1");
  EXPECT_EQ(core.GetConstant(1).documentation.Text(), "model.pdf");
  core.RebuildSymbolTable();
  EXPECT_EQ(
      Order(core),
      "Constant_2 Constant_3 Derived Output 1 Specie_1_StateVariable_1 Specie_1 (Specie_1)Horizontal Vector1 "
      "(Specie_1)Horizontal Vector1 (Specie_1)Downward Velocity ");
  EXPECT_TRUE(core.Modified());
}

TEST(Editing, IdentitiesAreNeverReused) {
  TemplateCore first;
  TemplateCore second;
  const std::uint32_t uid = first.AddConstant().GetUid();
  EXPECT_NE(second.AddConstant().GetUid(), uid);
  first.DeleteElement(uid);
  EXPECT_GT(first.AddConstant().GetUid(), uid);
  EXPECT_EQ(first.GetElement(uid), nullptr);
}

TEST(Editing, OnlyUnusedElementsAreDeleted) {
  LoadedTemplate loaded(TemplateText().Constant("k").Process("p", "k").StateVariable("S", "p").Text());
  EXPECT_FALSE(loaded->CanDelete(loaded.Uid("k")));
  EXPECT_FALSE(loaded->DeleteElement(loaded.Uid("k")));
  EXPECT_TRUE(loaded->DeleteElement(loaded.Uid("S")));
  EXPECT_TRUE(loaded->DeleteElement(loaded.Uid("p")));
  EXPECT_TRUE(loaded->DeleteElement(loaded.Uid("k")));
  EXPECT_EQ(loaded->SymbolTable().size(), 0U);
  EXPECT_FALSE(loaded->DeleteElement(4711));

  auto& specie = loaded->AddSpecie();
  EXPECT_FALSE(loaded->DeleteElement(specie.horizontalVectors[0]->GetUid())) << "the only one stays";
  EXPECT_FALSE(loaded->DeleteElement(specie.verticalEquation->GetUid()));
  specie.AddHorizontalVector();
  loaded->RebuildSymbolTable();
  EXPECT_TRUE(loaded->DeleteElement(specie.horizontalVectors[0]->GetUid()));
  EXPECT_TRUE(loaded->DeleteElement(specie.GetUid()));
  EXPECT_EQ(loaded->GetSpecieCount(), 0U);
}

TEST(Editing, MovesKeepUsesBehindDefinitions) {
  LoadedTemplate loaded(TemplateText()
                            .Process("p1", "1")
                            .Process("p2", "p1")
                            .Process("p3", "1")
                            .StateVariable("S", "p3")
                            .StateVariable("R", "p1")
                            .Text());
  EXPECT_FALSE(loaded->MoveElement(loaded.Uid("p1"), loaded.Uid("p2"), false));
  EXPECT_FALSE(loaded->MoveElement(loaded.Uid("p2"), loaded.Uid("p1"), true));
  EXPECT_TRUE(loaded->MoveElement(loaded.Uid("p3"), loaded.Uid("p1"), true));
  EXPECT_EQ(Order(*loaded), "S R p3 p1 p2 ");
  EXPECT_TRUE(loaded->MoveElement(loaded.Uid("R"), loaded.Uid("S"), true));
  EXPECT_EQ(Order(*loaded), "R S p3 p1 p2 ");
  EXPECT_TRUE(loaded->MoveElement(loaded.Uid("p3"), loaded.Uid("p2"), false));
  EXPECT_EQ(Order(*loaded), "R S p1 p2 p3 ");
  EXPECT_FALSE(loaded->MoveElement(loaded.Uid("S"), loaded.Uid("p1"), true)) << "no siblings";
}

TEST(Editing, LooksUp) {
  LoadedTemplate loaded(TemplateText().Constant("k").Specie("A", "0", {}).Text());
  const std::uint32_t uid = loaded.Uid("k");
  EXPECT_NE(loaded->GetElement(uid, kind::kConstant), nullptr);
  EXPECT_EQ(loaded->GetElement(uid, kind::kForcing), nullptr);
  auto& head = loaded->GetSpecie(0).Head(kind::kSpecieConstantList);
  EXPECT_EQ(loaded->GetElement(head.GetUid(), kind::kForcing), &head) << "the filter is for records";
  EXPECT_EQ(loaded->GetParentSpecie(head.GetUid()), &loaded->GetSpecie(0));
  EXPECT_TRUE(loaded->IsSymbolTakenByOther(uid, "A_Mass"));
  EXPECT_FALSE(loaded->IsSymbolTakenByOther(uid, "k"));
  EXPECT_FALSE(loaded->SymbolExists("K"));
  std::int32_t id = 0;
  std::int32_t elementKind = 0;
  EXPECT_TRUE(loaded->FindElementBySymbol("A_Mass", id, elementKind));
  EXPECT_EQ(elementKind, kind::kSpecieStateVariable);
  EXPECT_FALSE(loaded->FindElementBySymbol("A", id, elementKind));
  EXPECT_EQ(elementKind, kind::kUnknown);
  EXPECT_THROW(loaded->GetSpecie(1), std::out_of_range);
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

}  // namespace
}  // namespace tessal
