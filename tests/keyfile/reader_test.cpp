// Key files as trees: what the reader makes of a text, where it finds each item, how two trees compare, and
// the items by themselves. In the files of cases ^ is a line's end; a comparison has a line for each side.
#include "keyfile/reader.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <random>
#include <regex>
#include <sstream>

#include "keyfile/item_tree.h"
#include "platform/kvf_text.h"
#include "support/case_file.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::TemporaryFolder;

std::string Written(const CKvfBaseItem& item) {
  std::ostringstream stream;
  item.Write(stream);
  return stream.str();
}

/// The tree of a text, written again; or the reader's failure text. A mere check says the same.
std::string Read(const std::string& text) {
  const int isGood = CheckKeyFileText(text.substr(text.starts_with(kByteOrderMark) ? 3 : 0));
  const std::string failure = isGood == 0 ? KeyFileFailureText() : std::string();
  CKvfItemTree tree;
  EXPECT_EQ(ParseKeyFileTree(text, tree), isGood);
  EXPECT_EQ(KeyFileFailureText(), failure);
  return isGood == 0 ? failure : Written(tree);
}

std::string Exchanged(std::string text, char from, char to) {
  std::replace(text.begin(), text.end(), from, to);
  return text;
}

/// All items of a text with depth, place and mark.
std::string Items(const CKvfSectionItem& section) {
  std::string rows;
  for (const CKvfBaseItem& each : section.Children()) {
    EXPECT_EQ(each.Parent(), &section);
    rows += std::to_string(each.Depth()) + " " + each.Describe() + " " + std::to_string(each.Line()) + ":" +
            std::to_string(each.Column()) + " mark " + std::to_string(each.ComparisonMark()) + "\n";
    if (each.ItemKind() == CKvfBaseItem::kSection) rows += Items(static_cast<const CKvfSectionItem&>(each));
  }
  return rows;
}

/// The report of a comparison and the marks that it leaves.
std::string Compared(const std::string& lines, const IgnoredNames* ignored, bool onlyKeywords) {
  const std::size_t end = lines.find('\n');
  CKvfItemTree left;
  CKvfItemTree right;
  EXPECT_EQ(ParseKeyFileTree(Exchanged(lines.substr(0, end), '^', '\n'), left), 1) << KeyFileFailureText();
  EXPECT_EQ(ParseKeyFileTree(Exchanged(lines.substr(end + 1), '^', '\n'), right), 1) << KeyFileFailureText();
  std::ostringstream report;
  const bool same = left.Compare(right, &report, ignored, onlyKeywords);
  EXPECT_EQ(left.Compare(right, nullptr, ignored, onlyKeywords), same);
  return (same ? "same\n" : "different\n") + report.str() + Items(left) + Items(right);
}

class KeyFile : public testing::TestWithParam<const char*> {};

TEST_P(KeyFile, IsAsTheCasesSay) {
  test::RunCases(std::string("keyfile/cases/") + GetParam(), [](const test::Case& each) -> test::Answer {
    return [input = each.input](const test::CaseCall& call) {
      if (call.words == "read") return Read(input);
      if (call.words == "compare") return Compared(input, nullptr, false);
      if (call.words == "compare keywords") return Compared(input, nullptr, true);
      if (call.words == "each read") {
        return test::AnswerEach(input, [](const std::string& line) {
          return Exchanged(Read(Exchanged(line, '^', '\n')), '\n', '^');
        });
      }
      if (call.words == "items") {
        CKvfItemTree tree;
        return ParseKeyFileTree(input, tree) == 0 ? KeyFileFailureText() : Items(tree);
      }
      std::istringstream words(call.words);
      const IgnoredNames ignored{std::next(std::istream_iterator<std::string>(words), 2), {}};
      return Compared(input, &ignored, false);
    };
  });
}

INSTANTIATE_TEST_SUITE_P(Cases, KeyFile, testing::Values("reading.txt", "comparing.txt"));

TEST(Reader, DeepNestingIsAMessage) {
  const auto times = [](int count, const std::string& text) {
    std::string repeated;
    for (int number = 0; number < count; ++number) repeated += text;
    return repeated;
  };
  EXPECT_EQ(Read("\n" + times(100'000, "[S]\n")), "Error memory exhaustedin line 2500, column 1");
  // A section without content makes the stack higher, and a line feed counts for two characters.
  EXPECT_EQ(Read("\n[A]\nEndSect\n" + times(3000, "[S]\n")), "Error memory exhaustedin line 2502, column 0");
  EXPECT_EQ(Read("\n[S]\n" + times(10'050, "//c\n")), "Error memory exhaustedin line 9993, column 4");
}

TEST(Reader, LineEndsOfEitherKindReadTheSame) {
  const std::string bare = "// header\n\n[T]\n  A = 'two\nlines'\n\n  // c\nEndSect // T\n\n[U]\nEndSect\n";
  const std::string full = std::regex_replace(bare, std::regex("\n"), "\r\n");
  EXPECT_EQ(Read(full), Read(bare));
  EXPECT_EQ(Read("\xEF\xBB\xBF" + full), Read(bare));
  EXPECT_EQ(Read(full + std::string("\0[", 2)), Read(bare));
}

TEST(Reader, FilesThatCannotBeRead) {
  const TemporaryFolder folder;
  CKvfItemTree tree;
  EXPECT_EQ(LoadKeyFileTree(folder.File("missing"), tree), 0);
  EXPECT_EQ(KeyFileFailureText(), "File '" + folder.File("missing") + "'not found!");
  EXPECT_EQ(LoadKeyFileTree(folder.Write("empty", ""), tree), 0);
  EXPECT_EQ(LoadKeyFileTree(folder.Path().string(), tree), 0);
  EXPECT_TRUE(tree.Children().empty());
  EXPECT_EQ(LoadKeyFileTree(folder.Write("good", "\n[T]\nEndSect\n"), tree), 1);
  EXPECT_EQ(KeyFileFailureText(), "");
}

TEST(Reader, ATruncatedOrNoisyTextIsAMessage) {
  const std::string text = "// h\n\n[T] // s\n A = 1,'x',|y| // k\n [S]\n B = true\n EndSect\nEndSect // e\n";
  for (std::size_t length = 0; length < text.size(); ++length) {
    CKvfItemTree tree;
    const bool read = ParseKeyFileTree(text.substr(0, length), tree) != 0;
    EXPECT_EQ(read, KeyFileFailureText().empty()) << length;
  }
  std::mt19937 random(7);
  for (int round = 0; round < 200; ++round) {
    std::string noise = text;
    for (int change = 0; change < 5; ++change) noise[random() % noise.size()] = static_cast<char>(random());
    CKvfItemTree tree;
    const bool read = ParseKeyFileTree(noise, tree) != 0;
    EXPECT_EQ(read, KeyFileFailureText().empty()) << "seed 7, round " << round;
  }
}

TEST(Reader, WrittenTreesReadBackTheSame) {
  std::mt19937 random(11);
  for (int round = 0; round < 50; ++round) {
    std::string text = "\n";
    int open = 0;
    for (int line = 0; line < 60; ++line) {
      const std::string number = std::to_string(random() % 10'000);
      const auto kind = open == 0 ? 0 : random() % 6;
      text += kind == 0   ? "[S" + number + "]\n"
              : kind == 1 ? "EndSect // done\n"
              : kind == 2 ? "// remark " + number + "\n"
                          : "K = " + number + ", 0.25, 'a " + number + "'\n";
      open += kind == 0 ? 1 : kind == 1 ? -1 : 0;
    }
    for (; open > 0; --open) text += "EndSect\n";
    const std::string once = Read(text);
    ASSERT_TRUE(KeyFileFailureText().empty()) << "seed 11, round " << round << "\n"
                                              << KeyFileFailureText() << text;
    ASSERT_EQ(Read("\n" + once), once) << "seed 11, round " << round;
  }
}

TEST(Comparison, RefusesAFaultyOrEndlessExpression) {
  CKvfItemTree tree;
  ASSERT_EQ(ParseKeyFileTree("\n[T]\n" + std::string(1000, 'a') + " = 1\nEndSect\n", tree), 1);
  for (const std::string& expression :
       {std::string("["), std::string("(a*)*\\1b"), std::string(kLongestIgnoredName + 1, 'a')}) {
    const IgnoredNames faulty = {expression};
    EXPECT_THROW(tree.Compare(tree, nullptr, &faulty, false), std::regex_error);
  }
  const IgnoredNames backtracking = {"(a+)+b"};
  EXPECT_TRUE(tree.Compare(tree, nullptr, &backtracking, false)) << "too many ways, and no name is ignored";
}

TEST(KvfValue, ChecksItsTypeAndComparesExactly) {
  EXPECT_EQ(KvfValue::Integer(1), KvfValue::Integer(1));
  EXPECT_FALSE(KvfValue::Integer(1) == KvfValue::Real(1.0));
  EXPECT_FALSE(KvfValue::Quoted("a") == KvfValue::Path("a"));
  EXPECT_EQ(KvfValue::Path("a").AsString(), "a");
  EXPECT_THAT([] { KvfValue::Quoted("1").AsInteger(); },
              testing::ThrowsMessage<std::exception>("Incompatible type!"));
}

TEST(ItemTree, WritesValuesAndBlocks) {
  CKvfItemTree root;
  const std::vector<KvfValue> values = {
      KvfValue::Integer(1),     KvfValue::Real(2.5),   KvfValue::Real(0.1), KvfValue::Real(-1e300),
      KvfValue::Boolean(false), KvfValue::Quoted("q"), KvfValue::Path("p")};
  CKvfKeyItem& key = root.AppendKey("K", values);
  key.SetComment(" c");
  EXPECT_EQ(Written(key), "K = 1,2.5,0.1,-1e+300,false,'q',|p| // c\n");
  const std::vector<std::string_view> lines = {"1", "2", "3"};
  CKvfSectionItem& section = root.AppendSection("S").AppendSection("T");
  EXPECT_EQ(Written(section.AppendComment(std::span(lines).first(1))), "      //1\n");
  EXPECT_EQ(Written(section.AppendComment(lines)), "      //1\n      //2\n      //3\n      \n");
  EXPECT_EQ(Written(CKvfItemTree()), "\n\n");
}

TEST(ItemTree, CopiesKeepEverythingButParentAndDepth) {
  CKvfItemTree other;
  {
    CKvfItemTree root;
    ASSERT_EQ(ParseKeyFileTree("\n[S] //s\n//c\n//d\nK = 1,'t'\nEndSect //e\n", root), 1);
    EXPECT_EQ(root.Children().front().Copy(other.Memory()).Parent(), &root);
    root.SetMarks(CKvfBaseItem::kSame);
    other.Assign(root);
    other.Assign(root);
    other.Assign(other);
  }
  EXPECT_EQ(other.ComparisonMark(), CKvfBaseItem::kSame);
  EXPECT_EQ(other.CountChildren(CKvfBaseItem::kSection), 2U);
  auto& copy = static_cast<CKvfSectionItem&>(*other.ChildByKind(1, CKvfBaseItem::kSection));
  EXPECT_EQ(Items(copy), "2 Comment .S. 4:1 mark 0\n2 Keyword .S.K 5:0 mark 0\n");
  EXPECT_EQ(Written(copy), "[S] //s\n   //c\n   //d\n   \n   K = 1,'t'\nEndSect //e\n\n");
  EXPECT_EQ(other.ChildByKind(2, CKvfBaseItem::kSection), nullptr);
  CKvfSectionItem& deep = other.AppendSection("A").AppendSection("B");
  deep.AppendChild(copy.Copy(other.Memory()));
  EXPECT_EQ(Items(deep),
            "3 Section .A.B.S 1:0 mark 0\n4 Comment .A.B.S. 4:1 mark 0\n4 Keyword .A.B.S.K 5:0 mark 0\n");
  copy.Clear();
  EXPECT_EQ(copy.StartComment(), "s");
  EXPECT_TRUE(copy.Children().empty());
  EXPECT_EQ(copy.ItemKind(), CKvfBaseItem::kNone);
  copy.Assign(other);
  EXPECT_EQ(copy.ItemKind(), CKvfBaseItem::kSection);
  EXPECT_EQ(copy.StartComment(), "");
}

TEST(ItemTree, TakesSeveralTextsOver) {
  CKvfItemTree tree;
  tree.AppendSection("I");
  ASSERT_EQ(ParseKeyFileTree("//h\n\n[S]\nK = 1\nEndSect\n", tree), 1);
  ASSERT_EQ(ParseKeyFileTree("\n[T]\n[U]\nL = 'x'\nEndSect\nEndSect\n", tree), 1);
  EXPECT_EQ(ParseKeyFileTree("\n[V]\nEndSect\n[", tree), 0);
  EXPECT_EQ(Items(tree),
            "1 Section .I 0:0 mark 0\n1 Comment . 2:0 mark 0\n1 Section .S 2:0 mark 0\n"
            "2 Keyword .S.K 4:0 mark 0\n1 Section .T 2:0 mark 0\n2 Section .T.U 2:0 mark 0\n"
            "3 Keyword .T.U.L 4:0 mark 0\n");
}

TEST(ItemTree, KeywordsSayHowTheyDiffer) {
  CKvfItemTree tree;
  const auto key = [&tree](const std::vector<std::int32_t>& numbers, const char* name = "K") -> CKvfKeyItem& {
    std::vector<KvfValue> values;
    values.reserve(numbers.size());
    for (const std::int32_t number : numbers) values.push_back(KvfValue::Integer(number));
    return tree.AppendKey(name, values);
  };
  const IgnoredNames ignored = {"K"};
  const auto compare = [](CKvfKeyItem& left, CKvfKeyItem& right, const IgnoredNames* names = nullptr) {
    std::ostringstream report;
    const bool same = left.Compare(right, &report, names, false);
    return (same ? "same " : "different ") + report.str();
  };
  EXPECT_EQ(compare(key({1, 2}), key({1, 2})), "same K matches\n");
  EXPECT_EQ(compare(key({1, 2}), key({1, 3})), "different K Value #2 is different\n");
  EXPECT_EQ(compare(key({1}), key({1, 2})), "different K different value count\n");
  EXPECT_EQ(compare(key({}), key({})), "different ");
  EXPECT_EQ(compare(key({1}), key({1}, "L")), "different Different key names K<>L\n");
  EXPECT_EQ(compare(key({1}), key({1, 2}), &ignored), "same ignored key name K\n");
  EXPECT_FALSE(tree.Compare(key({1}), nullptr, nullptr, false));
  EXPECT_FALSE(key({1}).Compare(tree, nullptr, &ignored, false));
}

}  // namespace
}  // namespace tessal
