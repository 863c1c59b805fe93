#include <gtest/gtest.h>

#include <array>
#include <map>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "core/error_registry.h"
#include "core/loaded_template.h"
#include "keyfile/reader.h"
#include "platform/kvf2004.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::Messages;

TEST(Load, TruncatedAnywhereIsAMessageOrATemplate) {
  const std::string text = test::RandomTemplate(3, 4);
  for (std::size_t length = 0; length < text.size(); length += 7) {
    LoadedTemplate loaded(text.substr(0, length));
    EXPECT_TRUE(loaded.Loaded() || Errors().GetErrorCount(4) > 0) << length;
  }
}

TEST(Load, LineEndsAndByteOrderMarkMakeNoDifference) {
  const std::string text = test::RandomTemplate(5, 12);
  std::string full;
  for (const char character : text)
    full += character == '\n' ? std::string("\r\n") : std::string(1, character);
  LoadedTemplate bare(text);
  EXPECT_EQ(Messages(), "");
  LoadedTemplate windows("\xEF\xBB\xBF" + full);
  EXPECT_EQ(Messages(), "");
  EXPECT_EQ(bare->KeptTree().CountChildren(CKvfBaseItem::kSection), 2U);
  EXPECT_EQ(windows->KeptTree().CountChildren(CKvfBaseItem::kSection), 2U);
  EXPECT_EQ(bare->GetAuxiliary(0).expression.Text(), windows->GetAuxiliary(0).expression.Text());
}

/// What a modeller's editor, a merge or a broken disk does to a line of a file.
std::string Damaged(const std::string& text, std::mt19937& random) {
  constexpr std::array<const char*, 12> kLines = {"",
                                                  "// a comment",
                                                  "[EXTRA]",
                                                  "EndSect",
                                                  "EndSect // x",
                                                  "true = 1",
                                                  "endsect = 2",
                                                  "a = 1, 2,3 // c",
                                                  "b = 'x\ny'",
                                                  "c = |p|",
                                                  "  d = -1.5e3",
                                                  "[True]"};
  std::vector<std::string> lines{""};
  for (const char each : text) each == '\n' ? void(lines.emplace_back()) : lines.back().push_back(each);
  for (unsigned left = random() % 4; left > 0; --left) {
    const auto place = lines.begin() + static_cast<std::ptrdiff_t>(random() % lines.size());
    random() % 3 == 0 ? lines.erase(place) : lines.insert(place, kLines.at(random() % kLines.size()));
    if (lines.empty()) lines.emplace_back();
  }
  std::string damaged;
  for (const std::string& line : lines) damaged += line + '\n';
  if (random() % 3 == 0) damaged.pop_back();
  return damaged;
}

TEST(Load, ATextThatIsCalledStrictIsReadAsATree) {
  const std::string text =
      "// Head\n// more\n\n[T]\nk = 1\n// c\n\n[S]\nEndSect // S\n\nEndSect\n[U]\nEndSect\n";
  std::mt19937 random(7);
  std::map<std::pair<bool, int>, int> counts;
  for (int turn = 0; turn < 20'000; ++turn) {
    const std::string damaged = Damaged(text, random);
    KvfHandle file = kvfLoadText(damaged);
    if (file == 0) continue;
    const bool isStrict = kvfIsStrict(file);
    kvfClose(&file);
    const int isRead = CheckKeyFileText(damaged);
    EXPECT_TRUE(!isStrict || isRead == 1) << damaged << KeyFileFailureText();
    ++counts[{isStrict, isRead}];
  }
  // What is strict is called so, so that few texts are read twice.
  EXPECT_GT((counts[{true, 1}]), 2000);
  EXPECT_EQ((counts[{false, 1}]), 0);
  EXPECT_GT((counts[{false, 0}]), 1000);
}

}  // namespace
}  // namespace tessal
