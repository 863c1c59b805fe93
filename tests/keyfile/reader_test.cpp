#include "keyfile/reader.h"

#include <gtest/gtest.h>

#include <random>
#include <sstream>

#include "keyfile/item_tree.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::TemporaryFolder;

/// The tree of a text, written again; or the reader's failure text.
std::string Read(const std::string& text) {
  CKvfSectionItem tree;
  if (ParseKeyFileTree(text, tree) == 0) return KeyFileFailureText();
  std::ostringstream written;
  tree.Write(written);
  return written.str();
}

bool Accepts(const std::string& text) {
  CKvfSectionItem tree;
  return ParseKeyFileTree(text, tree) != 0;
}

TEST(Reader, KeepsCommentsWhereTheyStand) {
  const std::string text =
      "// first\n//second\n\n[T] // start\n"
      "   // of its own\n"
      "   A = 1,2.5,true,'text',|path| // behind\n"
      "   [S]\n      B = -7\n   EndSect // end of S\n\n"
      "EndSect // T\n\n";
  EXPECT_EQ(Read(text),
            "// first\n//second\n\n"
            "[T] // start\n"
            "   // of its own\n"
            "   A = 1,2.5,true,'text',|path| // behind\n"
            "   [S]\n"
            "      B = -7\n"
            "   EndSect // end of S\n\n"
            "EndSect // T\n\n"
            "\n\n");
}

TEST(Reader, AcceptsAndRefusesByTheGrammar) {
  struct Row {
    const char* text;
    bool accepted;
  };
  const Row rows[] = {
      {"\n[T]\nEndSect\n", true},
      {"[T]\nEndSect\n", false},           // no line feed ahead of the first section
      {"\n[T]\nEndSect", false},           // none behind the last
      {"\n", false},                       // no section
      {"\nA = 1\n[T]\nEndSect\n", false},  // a keyword outside
      {"\n[T]\nendsect\n", true},
      {"\n[T]\nENDSECT // x\n", true},
      {"\n[T]\nA = 1, 2\n, 3\nEndSect\n", false},
      {"\n[T]\nTRUE = 1\nEndSect\n", false},
      {"\n[T]\nTrueness = 1\nEndSection = 2\nEndSect\n", true},
      {"\n[T]\nA = .5\nEndSect\n", false},
      {"\n[T]\nA = 5., +5, 1e3, tRuE\nEndSect\n", true},
      {"\n[T]\nA = 'open\nEndSect\n", false},
      {"\n[T]\nA = 'a\nb'\nEndSect\n", true},
      {"\n[T]\nEndSect\n[U]\nEndSect\n", true},
      {"\n[T]\nEndSect\n// between\n[U]\nEndSect\n", false},
      {"// a header without a blank line\n[T]\nEndSect\n", false},
      {"// a header\n\n[T]\nEndSect\n", true},
      {"\n[T] EndSect\n", false},
      {"\n[T]\n\n\n// c\n\nA = 1\n\nEndSect\n", true},
  };
  for (const Row& row : rows) EXPECT_EQ(Accepts(row.text), row.accepted) << row.text << KeyFileFailureText();
}

TEST(Reader, WordsItsFailures) {
  EXPECT_EQ(Read("[T]\nEndSect\n"),
            "Error syntax error, unexpected LEFT_SQUARE, expecting NEWLINEin line 0, column 1");
  EXPECT_EQ(Read("\n[T]\nA = .5\nEndSect\n").substr(0, 43), "Error syntax error, unexpected $undefinedin");
  EXPECT_EQ(Read("\n[T]\n A = 'open").substr(0, 53), "Error syntax error, unexpected $end, expecting STRING");
  std::string nested = "\n";
  for (int depth = 0; depth < 100'000; ++depth) nested += "[S]\n";
  EXPECT_NE(Read(nested).find("memory exhausted"), std::string::npos);
}

TEST(Reader, LineEndsOfEitherKindReadTheSame) {
  const std::string bare = "// header\n\n[T]\n  A = 'two\nlines'\n\n  // c\nEndSect // T\n\n[U]\nEndSect\n";
  std::string full;
  for (const char character : bare)
    full += character == '\n' ? std::string("\r\n") : std::string(1, character);
  EXPECT_EQ(Read(full), Read(bare));
  EXPECT_EQ(Read("\xEF\xBB\xBF" + full), Read(bare));
  EXPECT_EQ(Read(full + std::string("\0[", 2)), Read(bare));
}

TEST(Reader, TellsWhereItemsEnd) {
  CKvfSectionItem tree;
  ASSERT_EQ(ParseKeyFileTree("\n[T]\n A = 1\n [S]\n EndSect\nEndSect\n", tree), 1);
  const auto& target = static_cast<const CKvfSectionItem&>(*tree.Children()[0]);
  // A section carries the line of the last head inside it.
  EXPECT_EQ(target.line, 3);
  EXPECT_EQ(target.depth, 1U);
  EXPECT_EQ(target.Children()[0]->line, 3) << "behind its line feed";
  EXPECT_EQ(target.Children()[1]->depth, 2U);
  EXPECT_EQ(target.Children()[1]->Path(), ".T.S");
  EXPECT_EQ(target.Children()[0]->Describe(), "Keyword .T.A");
}

TEST(Reader, DropsTabsFromCommentsOnly) {
  EXPECT_EQ(Read("\n[T] //a\tb\n A = 'a\tb'\nEndSect\n"), "[T] //ab\n   A = 'a\tb'\nEndSect\n\n\n\n");
}

TEST(Reader, FilesThatCannotBeRead) {
  const TemporaryFolder folder;
  CKvfSectionItem tree;
  EXPECT_EQ(LoadKeyFileTree(folder.File("missing"), tree), 0);
  EXPECT_EQ(KeyFileFailureText(), "File '" + folder.File("missing") + "'not found!");
  EXPECT_EQ(LoadKeyFileTree(folder.Write("empty", ""), tree), 0);
  EXPECT_EQ(LoadKeyFileTree(folder.Path().string(), tree), 0);
  EXPECT_EQ(tree.Children().size(), 0U);
  EXPECT_EQ(LoadKeyFileTree(folder.Write("good", "\n[T]\nEndSect\n"), tree), 1);
  EXPECT_EQ(KeyFileFailureText(), "");
}

TEST(Reader, ATruncatedOrNoisyTextIsAMessage) {
  const std::string text = "// h\n\n[T] // s\n A = 1,'x',|y| // k\n [S]\n B = true\n EndSect\nEndSect // e\n";
  for (std::size_t length = 0; length < text.size(); ++length) {
    CKvfSectionItem tree;
    const bool read = ParseKeyFileTree(text.substr(0, length), tree) != 0;
    EXPECT_EQ(read, KeyFileFailureText().empty()) << length;
  }
  std::mt19937 random(7);
  for (int round = 0; round < 200; ++round) {
    std::string noise = text;
    for (int change = 0; change < 5; ++change) noise[random() % noise.size()] = static_cast<char>(random());
    CKvfSectionItem tree;
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
      switch (open == 0 ? 0 : random() % 6) {
        case 0:
          text += "[S" + std::to_string(random() % 9) + "]\n";
          ++open;
          break;
        case 1:
          text += "EndSect // done\n";
          --open;
          break;
        case 2:
          text += "// remark " + std::to_string(random()) + "\n";
          break;
        default:
          text += "K = " + std::to_string(random()) + ", 0.25, 'a " + std::to_string(line) + "'\n";
          break;
      }
    }
    for (; open > 0; --open) text += "EndSect\n";
    const std::string once = Read(text);
    ASSERT_TRUE(KeyFileFailureText().empty()) << "seed 11, round " << round << "\n"
                                              << KeyFileFailureText() << text;
    ASSERT_EQ(Read("\n" + once).size(), once.size()) << "seed 11, round " << round;
  }
}

}  // namespace
}  // namespace tessal
