#include "elements/version_stamp.h"

#include <gtest/gtest.h>

namespace tessal {
namespace {

TEST(VersionStamp, FollowsTheStampsOfTheBuild) {
  struct Row {
    const char* branch;
    const char* revision;
    const char* date;
    double version;
  };
  const Row rows[] = {
      {"$Branch: Rel2017", "$Revision: 1", "", 2017.001},
      {"$Branch: Rel2017 $", "$Revision: 25 $", "", 2017.025},
      {"$Branch: Rel2017", "", "", 2017.001},
      {"$Branch: main", "$Revision: 3", "Nov 24 2026", 2126.003},
      {"", "", "Nov  4 2026", 2126.001},
      {"", "$Revision: x", "never", 0.001},
  };
  for (const Row& row : rows) {
    EXPECT_DOUBLE_EQ(VersionFromStamps(row.branch, row.revision, row.date), row.version)
        << row.branch << row.date;
  }
  EXPECT_DOUBLE_EQ(RoundVersion(2017.0014), 2017.001);
  EXPECT_DOUBLE_EQ(RoundVersion(2017.0016), 2017.002);
}

}  // namespace
}  // namespace tessal
