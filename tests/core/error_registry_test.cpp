#include "core/error_registry.h"

#include <gtest/gtest.h>

namespace tessal {
namespace {

TEST(ErrorRegistry, CountsAndFormatsItsRecords) {
  ErrorRegistry registry;
  EXPECT_EQ(registry.JoinErrors(), "");
  registry.AddError(2, "K", Uid{5}, "wrong");
  registry.AddError(3, "", Uid{-1}, "missing");
  registry.AddError(9, "odd", Uid::None, "level");
  registry.ReportElementError("K", Uid{5}, "again");
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
  Uid uid = Uid::None;
  registry.GetErrorForList(2, symbol, uid, text);
  EXPECT_EQ(NumberOf(uid), -1);
  EXPECT_EQ(text, ": level");
  registry.GetErrorForList(4, symbol, uid, text);
  EXPECT_EQ(symbol + std::to_string(NumberOf(uid)) + text, "-1no errors");
  EXPECT_FALSE(registry.FormatError(4, text));
  EXPECT_EQ(text, "invalid error number!");
  registry.ClearErrors();
  EXPECT_EQ(registry.GetErrorCount(2) + registry.GetErrorCount(0), 0U);
  EXPECT_EQ(registry.ExpressionWarningCount(), 1);
}

}  // namespace
}  // namespace tessal
