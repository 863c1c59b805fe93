#include "core/error_registry.h"

#include <gtest/gtest.h>

namespace tessal {
namespace {

TEST(ErrorRegistry, CountsAndFormatsItsRecords) {
  ErrorRegistry registry;
  EXPECT_EQ(registry.JoinErrors(), "");
  registry.AddError(2, "K", 5, "wrong");
  registry.AddError(3, "", -1, "missing");
  registry.AddError(9, "odd", 0, "level");
  registry.ReportElementError("K", 5, "again");
  EXPECT_EQ(registry.GetErrorCount(2), 2U);
  EXPECT_EQ(registry.GetErrorCount(3), 1U);
  EXPECT_EQ(registry.GetErrorCount(0), 4U);
  EXPECT_EQ(registry.GetErrorCount(9), 4U);
  EXPECT_EQ(registry.ExpressionWarningCount(), 1);
  EXPECT_EQ(
      registry.JoinErrors(),
      "Warningwrong symbol \"K\" ( UID=5)\nCriticalmissing\nlevel\nWarningagain symbol \"K\" ( UID=5)\n");

  std::string symbol;
  std::string text;
  std::int32_t uid = 0;
  registry.GetErrorForList(2, symbol, uid, text);
  EXPECT_EQ(uid, -1);
  EXPECT_EQ(text, ": level");
  registry.GetErrorForList(4, symbol, uid, text);
  EXPECT_EQ(symbol + std::to_string(uid) + text, "-1no errors");
  EXPECT_FALSE(registry.FormatError(4, text));
  EXPECT_EQ(text, "invalid error number!");
  registry.ClearErrors();
  EXPECT_EQ(registry.GetErrorCount(2) + registry.GetErrorCount(0), 0U);
  EXPECT_EQ(registry.ExpressionWarningCount(), 1);
}

}  // namespace
}  // namespace tessal
