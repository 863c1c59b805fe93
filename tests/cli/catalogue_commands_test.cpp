// Values of functions, as a script asks the tool for them.

#include <algorithm>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "cli/tool_run.h"
#include "support/temporary_folder.h"

namespace tessal::test {
namespace {

std::string Joined(const std::vector<std::string>& words) {
  std::string joined;
  for (const std::string& word : words) joined += word + ' ';
  return joined;
}

TEST(CatalogueCommands, ReadEveryNumberAndNothingElse) {
  const std::string zeros(400, '0');
  const struct {
    std::string value;
    std::string printed;  // empty for what is no number
  } rows[] = {
      {"+2", "2"},
      {"-.5", "-0.5"},
      {"1e400", "inf"},
      {"-1e400", "-inf"},
      {"1e-400", "0"},
      {"-inf", "-inf"},
      {"-nan", "nan"},
      {"0." + zeros + "1", "0"},
      {"5e-324", "5e-324"},
      {"1" + zeros + "e-395", "1e+05"},
      {"1" + zeros, "inf"},
      {"+-1", ""},
      {"++1", ""},
      {"1,5", ""},
      {"0x10", ""},
      {"1e", ""},
      {"", ""},
      {"1 ", ""},
  };
  for (const auto& row : rows) {
    const auto run = RunTool({"call", "MIN", row.value, "nan"});
    EXPECT_EQ(run.output, row.printed.empty() ? "" : row.printed + "\n") << row.value;
    EXPECT_EQ(run.exitCode, row.printed.empty() ? 2 : 0) << row.value;
    EXPECT_EQ(std::count(run.errors.begin(), run.errors.end(), '\n'), row.printed.empty() ? 1 : 0)
        << row.value;
  }
  EXPECT_EQ(RunTool({"eval", "sqrt", "-1"}).output, "nan\n");
  EXPECT_EQ(RunTool({"call", "MOD", "-inf", "3"}).output, "nan\n");
}

TEST(CatalogueCommands, CallMakesItsSettingsInOrder) {
  const struct {
    std::vector<std::string> arguments;
    int exitCode;
    std::string output;
  } rows[] = {
      {{"PEEK", "3", "--set", "SAVE=3,1", "--set", "SAVE=3,-2"}, 0, "-2\n"},
      {{"SETGET_SPECIE", "1", "-5", "--set", "SET_SPECIE_FACTORS=2,1,1,1,1", "--set=SETGET_SPECIE=1,7"},
       0,
       "7\n"},
      {{"_CALC_PH", "1000", "-100", "35", "25", "0"}, 0, "nan\n"},
      {{"ABS", "1", "--set", "RAND="}, 0, "1\n"},
      {{"ABS", "1", "--set", "NOBODY=1"}, 1, ""},
      {{"ABS", "1", "--set", "SAVE=3"}, 1, ""},
      {{"ABS", "1", "--set", "INSIDE=1,2,3,4,5,6"}, 1, ""},
      {{"ABS", "1", "--set", "SAVE=3,x"}, 2, ""},
      {{"ABS", "1", "--set", "SAVE"}, 2, ""},
  };
  for (const auto& row : rows) {
    std::vector<std::string> arguments{"call"};
    arguments.insert(arguments.end(), row.arguments.begin(), row.arguments.end());
    const auto run = RunTool(arguments);
    EXPECT_EQ(run.output, row.output) << Joined(arguments);
    EXPECT_EQ(run.exitCode, row.exitCode) << Joined(arguments);
    EXPECT_EQ(run.errors.empty(), row.exitCode == 0) << Joined(arguments);
  }
}

TEST(CatalogueCommands, OptionFileOfTheFolderCountsAndItsFaultsAreTold) {
  const TemporaryFolder folder;
  const std::string path = folder.Path().string();
  const std::vector<std::string> k1{"call", "GET_K1", "35", "25"};
  folder.Write("TESSALpH.set", "K1K2Option 10 Logfile ph.log\n");
  auto run = RunTool(k1, "", path);
  EXPECT_EQ(run.output, RunTool({"call", "GET_K1", "35", "25", "--set", "SET_K1K2_OPTION=10"}).output);
  EXPECT_EQ(run.errors, "");
  EXPECT_NE(ReadFile(folder.File("ph.log")).find("Using K1K2 option 10: Lueker"), std::string::npos);

  const struct {
    std::string text;
    std::string problem;
  } faults[] = {
      {"KOption ten",
       "tessal: Error reading file 'TESSALpH.set' at byte 8, behind 'KOption': the value is not a "
       "number in range; default settings are used\n"},
      {"Logfile missing/ph.log", "tessal: The log file 'missing/ph.log' cannot be opened\n"},
  };
  for (const auto& fault : faults) {
    folder.Write("TESSALpH.set", fault.text);
    run = RunTool(k1, "", path);
    EXPECT_EQ(run.exitCode, 0) << fault.text;
    EXPECT_EQ(run.errors, fault.problem);
    // A template is read under the same settings.
    EXPECT_EQ(RunTool({"new", "out.tessal", "--force"}, "", path).errors, fault.problem);
  }
}

}  // namespace
}  // namespace tessal::test
