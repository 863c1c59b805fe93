#include <gtest/gtest.h>

#include <string>

#include "core/error_registry.h"
#include "core/loaded_template.h"
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

}  // namespace
}  // namespace tessal
