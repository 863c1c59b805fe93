// The page of all messages is what the tool makes of the table.
#include <gtest/gtest.h>

#include "cli/shell_session.h"
#include "support/case_file.h"

namespace tessal::test {
namespace {

TEST(MessagesPage, ShowsEveryRowOfTheTable) {
  ExpectPage("../docs/messages.md", ShellSession().Run("tessal explain --markdown").output);
}

}  // namespace
}  // namespace tessal::test
