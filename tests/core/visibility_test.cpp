#include <gtest/gtest.h>

#include "core/loaded_template.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::TemplateText;

using Items = std::vector<std::int32_t>;
using Memberships = std::vector<std::pair<std::int32_t, std::int32_t>>;

Items Collected(const TemplateCore& core, std::int32_t group, std::int32_t level, bool recursive = false) {
  Items items;
  core.CollectItems(group, level, items, recursive);
  return items;
}

TEST(Visibility, GroupsAndMembershipsChangeTogether) {
  LoadedTemplate loaded(TemplateText().Misc().Constant("a").Constant("b").Constant("c").Text());
  EXPECT_EQ(loaded->AddVisibilityGroup(), 1);
  EXPECT_EQ(loaded->AddVisibilityGroup(), 2);
  EXPECT_EQ(loaded->GroupText(2), "Group_2");
  EXPECT_EQ(loaded->GroupText(0) + loaded->GroupListText(0), "anyall variables");
  EXPECT_EQ(loaded->CreateLevel(2), 1);
  EXPECT_EQ(loaded->CreateLevel(2), 2);
  EXPECT_EQ(loaded->LevelText(2, 2) + loaded->LevelText(2, 0), "Level_2all");
  loaded->AddItemToLevel(2, 1, 1);
  loaded->AddItemToLevel(2, 2, 3);
  loaded->AddItemToLevel(2, 2, 3);
  EXPECT_EQ(Collected(*loaded, 2, 2), (Items{3}));
  EXPECT_EQ(Collected(*loaded, 2, 2, true), (Items{1, 3}));
  EXPECT_EQ(Collected(*loaded, 2, 9, true), (Items{1, 3}));
  EXPECT_EQ(Collected(*loaded, 2, 0), (Items{1, 3}));
  EXPECT_EQ(Collected(*loaded, 0, 0), (Items{1, 2, 3}));

  loaded->RemoveVisibilityGroup(1);
  EXPECT_EQ(loaded->GetConstant(2).Visibility(), (Memberships{{1, 2}}));
  loaded->DeleteLevel(1, 1);
  EXPECT_EQ(loaded->GetConstant(0).Visibility(), Memberships{});
  EXPECT_EQ(loaded->GetConstant(2).Visibility(), (Memberships{{1, 1}}));
  EXPECT_EQ(Collected(*loaded, 1, 1), (Items{3}));
}

TEST(Visibility, ADeletionThatIsRefusedLeavesTheGroupsAllTheSame) {
  LoadedTemplate loaded(TemplateText().Misc().Constant("a").Auxiliary("x", "a").Text());
  loaded->AddVisibilityGroup();
  loaded->CreateLevel(1);
  loaded->AddItemToLevel(1, 1, 1);
  EXPECT_FALSE(loaded->DeleteElement(loaded.Uid("a")));
  EXPECT_EQ(Collected(*loaded, 1, 1), Items{});
  EXPECT_EQ(loaded->GetConstant(0).Visibility(), Memberships{});
}

TEST(Visibility, ComesBackFromAFileBehindAnyNumberOfSaves) {
  LoadedTemplate loaded(TemplateText().Misc().Constant("a").Constant("b").Specie("A", "0", {}).Text());
  loaded->AddVisibilityGroup();
  loaded->CreateLevel(1);
  loaded->CreateLevel(1);
  loaded->AddItemToLevel(1, 1, 2);
  const std::uint32_t movement = loaded.Record("(A)Horizontal Vector1").sequence;
  loaded->AddItemToLevel(1, 2, movement + 1);
  ASSERT_TRUE(loaded->SaveWrapper(loaded.Path()));
  loaded->AddStateVariable();
  ASSERT_TRUE(loaded->SaveWrapper(loaded.Path()));
  TemplateCore again;
  ASSERT_TRUE(again.LoadWrapper(loaded.Path()));
  EXPECT_EQ(again.GetConstant(1).Visibility(), (Memberships{{1, 1}}));
  EXPECT_EQ(again.GetSpecie(0).horizontalVectors[0]->Visibility(), (Memberships{{1, 2}}));
}

TEST(Visibility, ATemplateWithoutSettingsHasNoGroups) {
  LoadedTemplate loaded(TemplateText().Constant("a").Text());
  EXPECT_EQ(loaded->AddVisibilityGroup(), 0);
  EXPECT_EQ(loaded->GroupText(0), "");
  EXPECT_EQ(Collected(*loaded, 0, 0), Items{});
}

}  // namespace
}  // namespace tessal
