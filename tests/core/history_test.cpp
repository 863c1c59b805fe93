#include "core/edit_history.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <functional>
#include <random>
#include <string>
#include <vector>

#include "core/document.h"
#include "core/loaded_template.h"
#include "expr/scanner.h"
#include "expr/user_function_names.h"
#include "support/random_edits.h"
#include "support/template_text.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

std::vector<std::uint8_t> RandomBytes(unsigned seed, std::size_t count) {
  std::mt19937 engine(seed);
  std::vector<std::uint8_t> bytes(count);
  for (std::uint8_t& byte : bytes) byte = static_cast<std::uint8_t>(engine());
  return bytes;
}

TEST(History, TakesAnyEditsBackAndDoesThemAgain) {
  const test::TemporaryFolder folder;
  for (unsigned seed = 1; seed <= 60; ++seed) {
    ResetExpressionScanner();
    test::LoadedTemplate loaded(test::RandomTemplate(seed, static_cast<int>(5 + seed % 40)));
    SetNotifyChanges(true);
    const auto bytes = RandomBytes(seed, 40 + 10 * (seed % 30));
    fuzz::Choices choices(bytes.data(), bytes.size());
    const std::string fault = test::FaultOfHistory(*loaded, choices, 60, folder.File("again.tessal"));
    ASSERT_EQ(fault, "") << "seed " << seed;
  }
}

class Steps : public testing::Test {
 protected:
  Steps()
      : loaded(test::TemplateFromNotation("constant k 0.3\nconstant m 1\nauxiliary a k*2\nprocess p a + k\n"
                                          "state S p\nclass Fish\nclass.state Fish_w k\nsettings\n")),
        core(*loaded),
        history(core.History()) {
    history.Start();
  }

  std::string Undone() {
    const auto effect = core.Undo();
    return effect ? effect->name : "nothing";
  }
  CEL_Element& Named(const std::string& symbol) {
    std::uint32_t sequence = 0;
    EXPECT_TRUE(core.FindSymbol(symbol, sequence)) << symbol;
    return *core.GetElementBySequence(sequence);
  }

  test::LoadedTemplate loaded;
  TemplateCore& core;
  EditHistory& history;
};

TEST_F(Steps, AreNamedAfterWhatTheyChange) {
  core.RenameSymbol("k", "kd", true);
  core.GetConstant(1).unit.SetText("d");
  {
    const EditStep step(history);
    core.GetConstant(1).unit.SetText("g");
    core.GetConstant(1).defaultValue.SetReal(2);
  }
  core.DeleteElement(core.GetConstant(1).GetUid());
  CreateRequest request;
  request.kind = ElementKind::Process;
  request.symbol = "q";
  core.CreateElement(request);
  core.MoveElement(Named("q").GetUid(), Named("p").GetUid(), true);
  std::int32_t group = 0;
  const std::function<void()> acts[] = {
      [this] { core.SetShowAllBuiltIns(true); },
      [this, &group] { group = core.AddVisibilityGroup(); },
      [this, &group] { core.SetGroupName(group, "Sources"); },
      [this, &group] { core.CreateLevel(group); },
      [this, &group] { core.AddItemToLevel(group, 1, 1), core.AddItemToLevel(group, 1, 2); },
      [this, &group] { core.SetLevelDescription(group, 1, "all"); },
      [this, &group] { core.DeleteLevel(group, 1); },
      [this, &group] { core.RemoveVisibilityGroup(group); },
  };
  for (const auto& act : acts) {
    act();
    // What is edited without a beginning is one act until somebody asks.
    history.UndoCount();
  }
  std::string names;
  for (std::string name = Undone(); name != "nothing"; name = Undone()) names += name + "\n";
  EXPECT_EQ(names,
            "Delete group Sources\nDelete level Level_1\nChange description of Level_1\n"
            "Change 2 memberships of Level_1\nCreate level Level_1\nRename Group_1 to Sources\n"
            "Create group Group_1\nShow all built-ins\n"
            "Move q\nCreate q\nDelete m\nEdit m\nChange Unit of m\nRename k to kd\n");
  EXPECT_FALSE(core.Modified());
}

TEST_F(Steps, GoBackAndForthToTheSameTexts) {
  CEL_Lagrange_Specie& fish = core.GetSpecie(0);
  CEL_Lagrange_Specie& crab = core.AddSpecie();
  CEL_Forcing& sun = core.AddForcing();
  CEL_Lagrange_Spatial_Function& search = crab.AddSpatialFunction();
  core.RebuildSymbolTable();
  search.variableId.SetInt(sun.id.IntValue());
  search.lookFor.SetInt(crab.Index());
  core.RefreshSearchFunctionChoices();
  core.AddVisibilityGroup();
  core.CreateLevel(1);
  core.CreateLevel(1);
  history.Start();
  std::vector<std::string> texts;
  const auto look = [this] {
    std::string reason;
    std::string numbers;
    for (const auto& specie : core.Species()) numbers += std::to_string(specie->Index());
    return numbers + core.CopyText(reason).value_or(reason);
  };
  const std::function<void()> acts[] = {
      [this] { core.AddConstant(); },
      [this] { core.AddItemToLevel(1, 1, 1); },
      [this] { core.AddItemToLevel(1, 2, 2), core.AddItemToLevel(1, 2, 1); },
      [this] { core.RemoveItemFromLevel(1, 2, 2); },
      [this] { core.SetLevelDescription(1, 2, "second"); },
      [this] { core.DeleteLevel(1, 1); },
      [this, &fish] { core.DeleteElement(fish.GetUid()); },
      [this] { core.DeleteElement(Named("m").GetUid()); },
      [this, &search] { search.framework.SetText("LAGRANGE"); },
      [this] { core.RenameSymbol("k", "kd", true); },
      [this] { core.AddVisibilityGroup(); },
      [this] { core.RemoveVisibilityGroup(1); },
      [this] { core.GetMisc()->AddExternalFunction().publicName.SetText("Mix"); },
      [this] { core.GetMisc()->RemoveExternalFunction(0); },
  };
  for (const auto& act : acts) {
    texts.push_back(look());
    act();
    history.UndoCount();
  }
  texts.push_back(look());
  for (std::size_t step = std::size(acts); step-- > 0;) {
    Undone();
    EXPECT_EQ(look(), texts[step]) << "back to step " << step;
    // The name of a function that is away is free.
    EXPECT_EQ(IsUserFunctionName("Mix"), step == 13) << step;
  }
  for (std::size_t step = 1; step < texts.size(); ++step) {
    core.Redo();
    EXPECT_EQ(look(), texts[step]) << "forth to step " << step;
  }
}

TEST_F(Steps, LeaveNamesAndQuestionsAsTheyWere) {
  EXPECT_EQ(core.GroupText(core.AddVisibilityGroup()), "Group_1");
  core.Undo();
  EXPECT_EQ(core.GroupText(core.AddVisibilityGroup()), "Group_1");
  core.GetAuxiliary(0).expression.SetText("k*unknown");
  const auto offer = core.NextOffer();
  ASSERT_TRUE(offer && core.CreateElement(offer->requests[1]).uid != Uid::None);
  core.Undo();
  EXPECT_EQ(core.UndefinedSymbols().size(), 1U);
  EXPECT_FALSE(core.NextOffer()) << "who takes a definition back knows what is undefined";
}

TEST_F(Steps, ThatWereRefusedOrWentBackAreNone) {
  EXPECT_FALSE(core.RenameSymbol("k", "m", true));
  EXPECT_FALSE(core.DeleteElement(core.GetConstant(0).GetUid()));
  core.GetConstant(0).symbol.SetText("two words");
  {
    const EditStep step(history);
    core.GetConstant(1).unit.SetText("g");
    core.GetConstant(1).unit.SetText(std::string(core.GetConstant(1).unit.PrevText()));
  }
  EXPECT_EQ(history.UndoCount(), core.GetConstant(0).symbol.Text() == "two words" ? 1U : 0U);
}

TEST_F(Steps, KnowTheStateOfTheFile) {
  core.GetConstant(0).unit.SetText("a");
  core.GetConstant(1).unit.SetText("b");
  ASSERT_TRUE(core.SaveWrapper(loaded.Path()));
  EXPECT_EQ(history.UndoCount(), 1U) << "a save is no step";
  core.Undo();
  EXPECT_TRUE(core.Modified());
  core.Redo();
  EXPECT_FALSE(core.Modified());
  core.Undo();
  core.GetConstant(0).unit.SetText("c");
  // What the file holds can be reached by no step any more.
  core.Undo();
  EXPECT_TRUE(core.Modified());
  core.Redo();
  EXPECT_TRUE(core.Modified());
}

TEST_F(Steps, BringElementsBackAsTheyWere) {
  const std::int32_t group = core.AddVisibilityGroup();
  core.CreateLevel(group);
  CEL_Element& fish = *core.Species()[0];
  const Uid uid = core.GetConstant(1).GetUid();
  core.GetConstant(1).builtInId.SelectIndex(3);
  core.GetConstant(1).builtInId.ApplySelection();
  core.AddItemToLevel(group, 1, core.FindRecordByUid(uid)->sequence);
  EXPECT_FALSE(core.GetConstant(1).unit.Editable());
  const auto place = [this, uid] { return core.FindRecordByUid(uid)->index; };
  ASSERT_EQ(place(), 1U);
  ASSERT_TRUE(core.DeleteElement(uid));
  ASSERT_TRUE(core.DeleteElement(fish.GetUid()));
  core.Undo();
  EXPECT_EQ(core.Species()[0].get(), &fish);
  core.Undo();
  EXPECT_EQ(place(), 1U);
  EXPECT_EQ(core.IncludedItems(group, 1).size(), 1U);
  EXPECT_EQ(core.GetConstant(1).Visibility().size(), 1U);
  EXPECT_FALSE(core.GetConstant(1).unit.Editable()) << "locks are as before";
  EXPECT_EQ(core.GetConstant(1).builtInId.PresentChoice(), 3);
  core.Undo();
  EXPECT_TRUE(core.GetConstant(1).unit.Editable());
}

TEST_F(Steps, AreForgottenFromTheOldestOnWhenTheyTakeTooMuch) {
  const std::string longText(200'000, 'x');
  std::string reason;
  for (int step = 0; step < 700; ++step) {
    const EditStep act(history);
    core.GetConstant(0).documentation.SetText(longText + std::to_string(step));
  }
  EXPECT_LE(history.Bytes(), EditHistory::kMostBytes);
  EXPECT_GT(history.Bytes(), EditHistory::kMostBytes * 9 / 10);
  while (core.Undo()) continue;
  EXPECT_TRUE(core.Modified()) << "the oldest steps are still done";
}

}  // namespace
}  // namespace tessal
