#include "keyfile/item_tree.h"

#include <gtest/gtest.h>

#include <sstream>

#include "keyfile/reader.h"

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
  ASSERT_EQ(ParseKeyFileTree("\n[S] //s\nK = 1\nEndSect //e\n", root), 1);
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

TEST(ItemTree, KeywordsSayHowTheyDiffer) {
  const auto key = [](std::vector<KvfValue> values, const char* name = "K") {
    CKvfKeyItem item;
    item.name = name;
    item.values = std::move(values);
    return item;
  };
  const IgnoredNames ignored = {"K"};
  const auto compare = [](CKvfKeyItem left, CKvfKeyItem right, const IgnoredNames* names = nullptr) {
    std::ostringstream report;
    const bool same = left.Compare(right, &report, names, false);
    return (same ? "same " : "different ") + report.str();
  };
  const std::vector<KvfValue> one = {KvfValue::Integer(1)};
  const std::vector<KvfValue> two = {KvfValue::Integer(1), KvfValue::Integer(2)};
  const std::vector<KvfValue> other = {KvfValue::Integer(1), KvfValue::Integer(3)};
  EXPECT_EQ(compare(key(two), key(two)), "same K matches\n");
  EXPECT_EQ(compare(key(two), key(other)), "different K Value #2 is different\n");
  EXPECT_EQ(compare(key(one), key(two)), "different K different value count\n");
  EXPECT_EQ(compare(key({}), key({})), "different ");
  EXPECT_EQ(compare(key(one), key(one, "L")), "different Different key names K<>L\n");
  EXPECT_EQ(compare(key(one), key(two), &ignored), "same ignored key name K\n");
  CKvfSectionItem section;
  EXPECT_FALSE(section.Compare(*key(one).Copy(), nullptr, nullptr, false));
  EXPECT_FALSE(key(one).Copy()->Compare(section, nullptr, nullptr, false));
}

}  // namespace
}  // namespace tessal
