#include "platform/kvf2004.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <bit>
#include <cmath>
#include <limits>
#include <random>
#include <sstream>

#include "support/case_file.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::ReadFile;
using test::TemporaryFolder;

/// A file of the library, closed at the end.
class Loaded final {
 public:
  explicit Loaded(std::string text) : handle(kvfLoadText(std::move(text))) {}
  Loaded(const Loaded&) = delete;
  Loaded& operator=(const Loaded&) = delete;
  ~Loaded() { kvfClose(&handle); }

  KvfHandle Handle() const { return handle; }
  KvfNode Target() const { return kvfTargetByNameNum(handle, "T", 1); }

 private:
  KvfHandle handle;
};

/// Why the last load failed.
std::string Failure() {
  int line = 0;
  int position = 0;
  std::string near;
  EXPECT_EQ(kvfGetSyntaxErr(0, line, position, near), 0);
  return "error " + std::to_string(kvfGetErrorGlb()) + " at " + std::to_string(line) + ":" +
         std::to_string(position) + " near '" + near + "'\n";
}

/// What each reader makes of each parameter of a keyword: text, integer and real.
std::string Keyword(KvfNode keyword) {
  std::ostringstream row;
  row.precision(15);
  row << kvfGetNameGlb(keyword) << " at " << kvfGetLine(keyword) << ":";
  for (int number = 1; number <= kvfGetNoParams(keyword); ++number) {
    const KvfNode parameter = kvfParamByNum(keyword, number);
    std::string text;
    std::int32_t integer = 0;
    double real = 0;
    EXPECT_EQ(kvfGetString(parameter, text), 0);
    row << " '" << text << "'";
    if (kvfGetInt(parameter, integer) == 0) row << " integer " << integer;
    if (kvfGetDouble(parameter, real) == 0) row << " real " << real;
  }
  return row.str() + "\n";
}

/// A section with its keywords of a name and its sections.
std::string Section(KvfNode section, std::string_view name) {
  std::string rows = "[" + kvfGetNameGlb(section) + "] at " + std::to_string(kvfGetLine(section)) + "\n";
  for (int number = 1; const KvfNode keyword = kvfKeywordByNameNum(section, name, number); ++number) {
    rows += Keyword(keyword);
  }
  for (int number = 1; number <= kvfGetNoSections(section); ++number) {
    EXPECT_TRUE(kvfIsSection(kvfSectionByNum(section, number)));
    rows += Section(kvfSectionByNum(section, number), name);
  }
  EXPECT_EQ(kvfSectionByNum(section, kvfGetNoSections(section) + 1), nullptr);
  return rows;
}

/// The target T with its keywords K; or why there is none. In the text ^ is a line's end.
std::string Read(std::string text) {
  std::replace(text.begin(), text.end(), '^', '\n');
  const Loaded file(text);
  if (file.Handle() == 0) return Failure();
  EXPECT_EQ(kvfGetErrorGlb(), 0);
  return file.Target() == nullptr ? "no target\n" : Section(file.Target(), "K");
}

TEST(KvfLibrary, ReadsAsTheCasesSay) {
  test::RunCases("platform/cases/kvf_reading.txt", [](const test::Case& each) -> test::Answer {
    return [input = each.input](const test::CaseCall&) { return test::AnswerEach(input, Read); };
  });
}

TEST(KvfLibrary, FindsSectionsByNameAndNumber) {
  const Loaded file("[t]\n[S]\nEndSect\n[R]\nEndSect\n[s]\nEndSect\nEndSect\n[T]\nEndSect");
  EXPECT_EQ(kvfGetLine(kvfTargetByNameNum(file.Handle(), "T", 2)), 9);
  EXPECT_EQ(kvfSectionByNameNum(file.Target(), "S", 2), kvfSectionByNum(file.Target(), 3));
  EXPECT_EQ(kvfSectionByNameNum(file.Target(), "S", 3), nullptr);
  std::int32_t integer = 5;
  const Loaded real("[T]\nK = 1.5\nEndSect");
  EXPECT_EQ(kvfGetInt(kvfParamByNum(kvfKeywordByNameNum(real.Target(), "K", 1), 1), integer), kKvfWrongType);
  EXPECT_EQ(integer, 5);
}

TEST(KvfLibrary, AFileThatCannotBeReadIsNoBadHandle) {
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
  EXPECT_EQ(kvfGetString(kvfParamByNum(kvfKeywordByNameNum(broad.Target(), "a", 1), 1), value), 0);
  EXPECT_EQ(value.size(), 10'000'000U);
}

TEST(KvfLibrary, WritesItsLayout) {
  const TemporaryFolder folder;
  KvfHandle file = kvfCreate();
  EXPECT_EQ(kvfAddSection(file, "S"), kKvfBadNode) << "outside a target";
  // A list is evaluated in its order.
  const std::vector<int> answers = {kvfAddTarget(file, "TESSAL_SETUP"),
                                    kvfAddKeyword(file, "TEXT"),
                                    kvfAddString(file, "it's"),
                                    kvfAddSection(file, "LIST"),
                                    kvfAddKeyword(file, "NUMBERS"),
                                    kvfAddInt(file, -3),
                                    kvfAddDouble(file, 0.1),
                                    kvfAddDouble(file, 8.0),
                                    kvfAddString(file, "two\nlines"),
                                    kvfEndSection(file),
                                    kvfEndSection(file)};
  EXPECT_EQ(answers, std::vector<int>(answers.size(), kKvfOk));
  EXPECT_EQ(kvfEndSection(file), kKvfBadNode);
  EXPECT_EQ(kvfWrite(file, folder.File("out")), 0);
  test::ExpectListing("platform/cases/kvf_layout.txt", ReadFile(folder.File("out")));
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
  std::mt19937_64 random(20261124);
  std::vector<double> values = {0.0, -0.0, 1e300, 5e-324, 1e20, 123456789012.0, 0.1};
  while (values.size() < 5000) {
    const double value = std::bit_cast<double>(random());
    if (std::isfinite(value)) values.push_back(value);
  }
  KvfHandle file = kvfCreate();
  kvfAddTarget(file, "T");
  kvfAddKeyword(file, "V");
  for (const double value : values) ASSERT_EQ(kvfAddDouble(file, value), 0);
  const Loaded read(kvfTakeText(&file));
  const KvfNode keyword = kvfKeywordByNameNum(read.Target(), "V", 1);
  for (std::size_t place = 0; place < values.size(); ++place) {
    double value = 0.0;
    ASSERT_EQ(kvfGetDouble(kvfParamByNum(keyword, static_cast<int>(place) + 1), value), 0);
    ASSERT_EQ(std::bit_cast<std::uint64_t>(value), std::bit_cast<std::uint64_t>(values[place]));
  }
}

}  // namespace
}  // namespace tessal
