// What programs read of the tool is JSON, whatever the bytes of the template.
#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "cli/shell_session.h"

namespace tessal::test {
namespace {

TEST(Json, IsValidWhateverTheBytes) {
  const ShellSession session;
  // Every byte but the quote marks, in a name, an expression and a text.
  std::string bytes;
  for (int byte = 1; byte < 256; ++byte) {
    if (byte != '\'' && byte != '"') bytes += static_cast<char>(byte);
  }
  std::string text = ReadFile(TESSAL_SOURCE_DIR "/examples/streeter_phelps.tessal");
  for (const std::string place : {"k1_20'", "100*DO", "Water temperature"}) {
    text.insert(text.find(place), bytes);
  }
  session.Write("odd \xE9 name.tessal", text);
  for (const std::string command : {
           "tessal check --format json *.tessal",
           "tessal check --format sarif *.tessal",
           "tessal symbols --format json *.tessal",
       }) {
    const ShellRun run = session.Run(command);
    EXPECT_TRUE(nlohmann::json::accept(run.output)) << command << "\n" << run.errors;
    EXPECT_GT(run.output.size(), 500U) << command;
  }
}

}  // namespace
}  // namespace tessal::test
