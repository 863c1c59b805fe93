// What the tool says about messages: their explanations, and reports that name their codes.
#include <gtest/gtest.h>

#include <nlohmann/json.hpp>
#include <sstream>

#include "cli/tool_run.h"
#include "support/case_file.h"
#include "support/template_text.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using Json = nlohmann::ordered_json;
using test::RunTool;
using test::TemplateText;
using test::TemporaryFolder;

/// Values in the wrong range, an exact repeat, an undefined symbol with two users and one of the same name.
std::string FaultyTemplate() {
  return TemplateText()
      .Constant("k", "-1")
      .Constant("k", "-1")
      .Auxiliary("a", "SIN(1, 2) + nobody")
      .Auxiliary("a", "nobody")
      .Auxiliary("b", "(nobody")
      .Process("p", "q")
      .Process("q", "1")
      .Text();
}

TEST(Explain, GivesOneMessageOrAllOrThePage) {
  test::RunCases("cli/cases/explain.txt", [](const test::Case&) {
    return [](const test::CaseCall& call) {
      std::istringstream words(call.words);
      std::vector<std::string> arguments;
      for (std::string word; words >> word;) arguments.push_back(word);
      const auto run = RunTool(arguments);
      return run.output + run.errors + "exit " + std::to_string(run.exitCode) + "\n";
    };
  });
  test::ExpectPage("../docs/messages.md", RunTool({"explain", "--markdown"}).output);
}

TEST(Reports, NameTheCodeOfEachMessageAndLeaveRepeatsOut) {
  const TemporaryFolder folder;
  folder.Write("m.tessal", FaultyTemplate());
  std::string listed;
  for (const char* format : {"text", "json", "sarif"}) {
    const auto run = RunTool({"check", "--format", format, "m.tessal"}, "", folder.Path().string());
    EXPECT_EQ(run.exitCode, 1) << format;
    if (format == std::string("text")) {
      listed += run.output;
      continue;
    }
    Json report = Json::parse(run.output);
    if (format == std::string("sarif")) {
      Json& driver = report["runs"][0]["tool"]["driver"];
      EXPECT_TRUE(driver["version"].is_string());
      driver.erase("version");
      // The first and the undefined symbol's: all are made alike, and the list of codes shows their order.
      Json shown = Json::array();
      for (const Json& rule : driver["rules"]) {
        const bool isShown = shown.empty() || rule["id"] == "undefined-symbol";
        shown.push_back(isShown ? rule : rule["id"]);
      }
      driver["rules"] = shown;
    }
    listed += report.dump(1) + "\n";
  }
  test::ExpectListing("cli/cases/reports.txt", listed);
}

}  // namespace
}  // namespace tessal
