#include "keyfile/item_tree.h"

#include <gtest/gtest.h>

#include <sstream>

namespace tessal {
namespace {

std::string Written(const CKvfBaseItem& item) {
  std::ostringstream stream;
  item.Write(stream);
  return stream.str();
}

TEST(KvfValue, ChecksItsTypeAndComparesExactly) {
  EXPECT_EQ(KvfValue::Integer(1), KvfValue::Integer(1));
  EXPECT_FALSE(KvfValue::Integer(1) == KvfValue::Real(1.0));
  EXPECT_FALSE(KvfValue::Quoted("a") == KvfValue::Path("a"));
  EXPECT_EQ(KvfValue::Path("a").AsString(), "a");
  try {
    KvfValue::Quoted("1").AsInteger();
    FAIL() << "a text is no integer";
  } catch (const std::exception& failure) {
    EXPECT_STREQ(failure.what(), "Incompatible type!");
  }
}

TEST(ItemTree, WritesValuesAndBlocks) {
  CKvfKeyItem key;
  key.name = "K";
  key.values = {KvfValue::Integer(1),     KvfValue::Real(2.5),   KvfValue::Real(0.1),
                KvfValue::Boolean(false), KvfValue::Quoted("q"), KvfValue::Path("p")};
  key.comment = " c";
  EXPECT_EQ(Written(key), "K = 1,2.5,0.1,false,'q',|p| // c\n");
  CKvfCommentItem block;
  block.lines = {" one"};
  EXPECT_EQ(Written(block), "// one\n");
  block.lines = {"1", "2", "3"};
  EXPECT_EQ(Written(block), "//1\n//2\n//3\n\n");
  CKvfSectionItem root;
  root.AppendChild(block.Copy());
  EXPECT_EQ(Written(root), "//1\n//2\n//3\n\n\n\n");
}

TEST(ItemTree, CopiesKeepEverythingButParentAndDepth) {
  CKvfSectionItem root;
  auto section = std::make_unique<CKvfSectionItem>();
  section->name = "S";
  section->startComment = "s";
  section->comment = "e";
  auto key = std::make_unique<CKvfKeyItem>();
  key->name = "K";
  key->values = {KvfValue::Integer(1)};
  key->line = 3;
  section->AppendChild(std::move(key));
  root.AppendChild(std::move(section));

  CKvfSectionItem other;
  other.Assign(root);
  other.Assign(root);
  other.Assign(other);
  EXPECT_EQ(other.CountChildren(CKvfBaseItem::kSection), 2U);
  const auto& copy = static_cast<const CKvfSectionItem&>(*other.ChildByKind(1, CKvfBaseItem::kSection));
  EXPECT_EQ(copy.parent, &other);
  EXPECT_EQ(copy.depth, 1U);
  EXPECT_EQ(copy.Children()[0]->depth, 2U);
  EXPECT_EQ(copy.Children()[0]->line, 3);
  EXPECT_EQ(Written(copy), "[S] //s\n   K = 1\nEndSect //e\n\n");
  EXPECT_EQ(other.ChildByKind(2, CKvfBaseItem::kSection), nullptr);
  other.startComment = "kept";
  other.Clear();
  EXPECT_EQ(other.startComment, "kept");
  EXPECT_TRUE(other.Children().empty());
  EXPECT_EQ(other.ItemKind(), CKvfBaseItem::kNone);
  other.Assign(root);
  EXPECT_EQ(other.ItemKind(), CKvfBaseItem::kSection);
  EXPECT_EQ(other.startComment, "");
}

}  // namespace
}  // namespace tessal
