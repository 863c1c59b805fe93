#include "platform/kvf2004.h"

#include <gtest/gtest.h>

#include <bit>
#include <cmath>
#include <limits>
#include <random>

#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::ReadFile;
using test::TemporaryFolder;

/// A file of the library, closed at the end.
class Loaded final {
 public:
  explicit Loaded(std::string_view text) : handle(kvfLoadText(text)) {}
  Loaded(const Loaded&) = delete;
  Loaded& operator=(const Loaded&) = delete;
  ~Loaded() { kvfClose(&handle); }

  KvfHandle Handle() const { return handle; }
  KvfNode Keyword(std::string_view name) const {
    return kvfKeywordByNameNum(kvfTargetByNameNum(handle, "T", 1), name, 1);
  }
  KvfNode Parameter(std::string_view name, int number = 1) const {
    return kvfParamByNum(Keyword(name), number);
  }

 private:
  KvfHandle handle;
};

TEST(KvfLibrary, ReadsSectionsKeywordsAndParameters) {
  const Loaded file(
      "// head\n\n[t] // comment\n  A = 1, 2.5, TRUE, 'text', |path| // more\n\n  [S]\n  X = -7\n  EndSect\n"
      "  // between\n  [s]\n  EndSect // S\nEndSect");
  ASSERT_NE(file.Handle(), 0U);
  EXPECT_EQ(kvfGetErrorGlb(), 0);
  const KvfNode target = kvfTargetByNameNum(file.Handle(), "T", 1);
  EXPECT_EQ(kvfGetNameGlb(target), "t");
  EXPECT_EQ(kvfGetLine(target), 3);
  EXPECT_EQ(kvfGetNoSections(target), 2);
  EXPECT_EQ(kvfSectionByNameNum(target, "S", 2), kvfSectionByNum(target, 2));
  EXPECT_EQ(kvfSectionByNum(target, 3), nullptr);
  EXPECT_EQ(kvfGetNoParams(file.Keyword("a")), 5);
  std::string text;
  const char* const texts[] = {"1", "2.5", "TRUE", "text", "path"};
  for (int number = 1; number <= 5; ++number) {
    EXPECT_EQ(kvfGetString(file.Parameter("A", number), text), 0);
    EXPECT_EQ(text, texts[number - 1]);
  }
  std::int32_t integer = 5;
  double real = 0.0;
  EXPECT_EQ(kvfGetInt(file.Parameter("A", 2), integer), kKvfWrongType);
  EXPECT_EQ(integer, 5);
  EXPECT_EQ(kvfGetDouble(file.Parameter("A", 1), real), 0);
  EXPECT_EQ(real, 1.0);
  EXPECT_EQ(kvfGetDouble(file.Parameter("A", 3), real), kKvfWrongType);
  EXPECT_EQ(kvfGetDouble(file.Parameter("A", 4), real), kKvfWrongType);
}

TEST(KvfLibrary, ReadsWhatIsAtTheEdges) {
  const char* const good[] = {"",
                              "\n\n// only comments",
                              "[T]EndSect" /* refused below */,
                              "[T]\nEndSect",
                              "\xEF\xBB\xBF[T]\r\nendsect // x",
                              "[T]\n true = 1\n EndSect = 'x'\n ENDSECT\n",
                              "[T]\n a = 'two\n lines'\nEndSect"};
  for (const char* text : good) {
    const bool accepted = std::string_view(text) != "[T]EndSect";
    EXPECT_EQ(Loaded(text).Handle() != 0, accepted) << text;
  }
  const Loaded cut(std::string_view("[T]\n a = 1\nEndSect\n\0garbage", 28));
  EXPECT_NE(cut.Handle(), 0U);
  std::string text;
  const Loaded lines("[T]\r\n a = 'two\r\n lines'\r\nEndSect");
  EXPECT_EQ(kvfGetString(lines.Parameter("a"), text), 0);
  EXPECT_EQ(text, "two\n lines");
}

TEST(KvfLibrary, NumbersBeyondTheirTypeReadAsTheNearestLimit) {
  struct Row {
    const char* text;
    double value;
  };
  const double huge = std::numeric_limits<double>::max();
  const Row rows[] = {{"1e999", huge},
                      {"-1e999", -huge},
                      {"1e-999", 0.0},
                      {"0.0000001e400", huge},
                      {"99999999999", 99999999999.0},
                      {"+5.", 5.0},
                      {"1e99999999999999999999", huge},
                      {"1e-99999999999999999999", 0.0},
                      {"0e999", 0.0}};
  for (const Row& row : rows) {
    const Loaded file(std::string("[T]\n a = ") + row.text + "\nEndSect");
    double value = -1.0;
    EXPECT_EQ(kvfGetDouble(file.Parameter("a"), value), 0) << row.text;
    EXPECT_EQ(value, row.value) << row.text;
  }
  const Loaded file("[T]\n a = 99999999999\n b = -99999999999\nEndSect");
  std::int32_t value = 0;
  EXPECT_EQ(kvfGetInt(file.Parameter("a"), value), 0);
  EXPECT_EQ(value, std::numeric_limits<std::int32_t>::max());
  EXPECT_EQ(kvfGetInt(file.Parameter("b"), value), 0);
  EXPECT_EQ(value, std::numeric_limits<std::int32_t>::min());
}

TEST(KvfLibrary, TellsWhereASyntaxErrorLies) {
  struct Row {
    const char* text;
    int line;
    int position;
    const char* near;
  };
  const Row rows[] = {
      {"a = 1", 1, 1, "a = 1"},
      {"[T]\n a = ]\nEndSect", 2, 6, "]"},
      {"[T]\n a = 'open\nEndSect", 2, 6, "'open"},
      {"[T]\n a = 1\n", 3, 1, ""},
      {"EndSect", 1, 1, "EndSect"},
      {"[T]\n a = .5\nEndSect", 2, 6, ".5"},
      {"[T x]\nEndSect", 1, 4, "x]"},
      {"[T]\n a = 1 2\nEndSect", 2, 8, "2"},
      {"[T]\n \x01\x02 0123456789012345678901234567890123456789\nEndSect", 2, 2,
       "\x01\x02 0123456789012345678901234567890123456"},
  };
  for (const Row& row : rows) {
    EXPECT_EQ(kvfLoadText(row.text), 0U) << row.text;
    EXPECT_EQ(kvfGetErrorGlb(), kKvfSyntaxError);
    int line = 0;
    int position = 0;
    std::string near;
    EXPECT_EQ(kvfGetSyntaxErr(0, line, position, near), 0);
    EXPECT_EQ(line, row.line) << row.text;
    EXPECT_EQ(position, row.position) << row.text;
    EXPECT_EQ(near, row.near) << row.text;
  }
}

TEST(KvfLibrary, FilesThatCannotBeReadAreToldApart) {
  const TemporaryFolder folder;
  EXPECT_EQ(kvfLoadFile(folder.File("missing"), 1), 0U);
  EXPECT_EQ(kvfGetErrorGlb(), kKvfCannotOpen);
  EXPECT_EQ(kvfLoadFile(folder.Path().string(), 1), 0U);
  EXPECT_EQ(kvfGetErrorGlb(), kKvfCannotOpen);
  KvfHandle none = 0;
  kvfClose(&none);
  EXPECT_EQ(kvfTargetByNameNum(12345, "T", 1), nullptr);
  EXPECT_EQ(kvfGetErrorGlb(), kKvfBadHandle);
}

TEST(KvfLibrary, NestsWithoutEnd) {
  std::string text;
  constexpr int kDepth = 100'000;
  for (int depth = 0; depth < kDepth; ++depth) text += "[S]\n";
  EXPECT_EQ(kvfLoadText(text), 0U) << "nothing is closed";
  for (int depth = 0; depth < kDepth; ++depth) text += "EndSect\n";
  const Loaded file(text);
  EXPECT_NE(file.Handle(), 0U);
  const Loaded broad("[T]\n a = '" + std::string(10'000'000, 'x') + "'\nEndSect");
  std::string value;
  EXPECT_EQ(kvfGetString(broad.Parameter("a"), value), 0);
  EXPECT_EQ(value.size(), 10'000'000U);
}

TEST(KvfLibrary, WritesItsLayout) {
  const TemporaryFolder folder;
  KvfHandle file = kvfCreate();
  EXPECT_EQ(kvfAddSection(file, "S"), kKvfBadNode) << "outside a target";
  EXPECT_EQ(kvfAddTarget(file, "TESSAL_SETUP"), 0);
  EXPECT_EQ(kvfAddKeyword(file, "TEXT"), 0);
  EXPECT_EQ(kvfAddString(file, "it's"), 0);
  EXPECT_EQ(kvfAddSection(file, "LIST"), 0);
  EXPECT_EQ(kvfAddKeyword(file, "NUMBERS"), 0);
  EXPECT_EQ(kvfAddInt(file, -3), 0);
  EXPECT_EQ(kvfAddDouble(file, 0.1), 0);
  EXPECT_EQ(kvfAddDouble(file, 8.0), 0);
  EXPECT_EQ(kvfAddString(file, "two\nlines"), 0);
  EXPECT_EQ(kvfEndSection(file), 0);
  EXPECT_EQ(kvfEndSection(file), 0);
  EXPECT_EQ(kvfEndSection(file), kKvfBadNode);
  EXPECT_EQ(kvfWrite(file, folder.File("out")), 0);
  EXPECT_EQ(ReadFile(folder.File("out")),
            "// Tessal template\r\n"
            "// Key-file text: sections, keywords, parameters\r\n"
            "// Written by the template editor\r\n"
            "\r\n"
            "[TESSAL_SETUP]\r\n"
            "   TEXT = |it's|\r\n"
            "   [LIST]\r\n"
            "      NUMBERS = -3, 0.1, 8, 'two\r\nlines'\r\n"
            "   EndSect  // LIST\r\n"
            "\r\n"
            "EndSect  // TESSAL_SETUP\r\n"
            "\r\n");
  EXPECT_EQ(kvfWrite(file, folder.Path().string()), kKvfWriteFailed);
  EXPECT_NE(kvfGetWriteFailure().find(folder.Path().string()), std::string::npos);
  kvfClose(&file);
  EXPECT_EQ(file, 0U);
}

TEST(KvfLibrary, RefusesWhatTheFormatCannotHold) {
  KvfHandle file = kvfCreate();
  kvfAddTarget(file, "T");
  for (const char* name : {"", "two words", "1a", "a-b", "\xC3\xA4"}) {
    EXPECT_EQ(kvfAddKeyword(file, name), kKvfNotWritable) << name;
    EXPECT_EQ(kvfAddInt(file, 1), kKvfBadNode) << "no keyword takes it";
  }
  EXPECT_EQ(kvfAddKeyword(file, "True"), 0);
  EXPECT_EQ(kvfAddString(file, "a ' and a |"), kKvfNotWritable);
  EXPECT_EQ(kvfAddString(file, std::string_view("a\0b", 3)), kKvfNotWritable);
  EXPECT_EQ(kvfAddDouble(file, std::nan("")), kKvfNotWritable);
  EXPECT_EQ(kvfAddDouble(file, std::numeric_limits<double>::infinity()), kKvfNotWritable);
  kvfClose(&file);
}

TEST(KvfLibrary, RealsComeBackToTheBit) {
  const TemporaryFolder folder;
  std::mt19937_64 random(20261124);
  std::vector<double> values = {0.0,
                                -0.0,
                                1.0,
                                1e300,
                                -1e-300,
                                5e-324,
                                1e20,
                                123456789012.0,
                                0.1,
                                std::numeric_limits<double>::max(),
                                std::numeric_limits<double>::lowest()};
  while (values.size() < 5000) {
    const double value = std::bit_cast<double>(random());
    if (std::isfinite(value)) values.push_back(value);
  }
  KvfHandle file = kvfCreate();
  kvfAddTarget(file, "T");
  kvfAddKeyword(file, "V");
  for (const double value : values) ASSERT_EQ(kvfAddDouble(file, value), 0);
  ASSERT_EQ(kvfWrite(file, folder.File("reals")), 0);
  kvfClose(&file);
  KvfHandle read = kvfLoadFile(folder.File("reals"), 1);
  const KvfNode keyword = kvfKeywordByNameNum(kvfTargetByNameNum(read, "T", 1), "V", 1);
  for (std::size_t place = 0; place < values.size(); ++place) {
    double value = 0.0;
    ASSERT_EQ(kvfGetDouble(kvfParamByNum(keyword, static_cast<int>(place) + 1), value), 0);
    ASSERT_EQ(std::bit_cast<std::uint64_t>(value), std::bit_cast<std::uint64_t>(values[place]))
        << values[place];
  }
  kvfClose(&read);
}

}  // namespace
}  // namespace tessal
