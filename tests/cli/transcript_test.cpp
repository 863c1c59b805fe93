// The tool as people see it: shell sessions in files of cases, the blocks of the project's front page and of
// its guide, and the page of messages, which the tool writes.
//
// The input of a case gives files: `--- NAME`, and what is in it. After a command comes what it printed;
// lines of standard error begin with `2> `, and an exit code other than 0 ends it, as `[1]`.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdlib>
#include <filesystem>
#include <nlohmann/json.hpp>
#include <sstream>
#include <vector>

#include "support/case_file.h"
#include "support/temporary_folder.h"

namespace tessal::test {
namespace {

struct ShellRun {
  int exitCode = -1;
  std::string output;
  std::string errors;
};

/// A shell in which the tool is at hand: commands run in a folder of their own, beside a copy of the
/// examples.
class ShellSession final {
 public:
  ShellSession() {
    std::filesystem::copy(TESSAL_SOURCE_DIR "/examples", folder.Path() / "examples");
    std::filesystem::create_directory(folder.Path() / "build");
  }

  /// Makes a file in the session's folder.
  void Write(const std::string& name, const std::string& content) const { folder.Write(name, content); }

  /// Runs a command, pipes and redirections among it, with an empty standard input.
  ShellRun Run(const std::string& command) const {
    const std::string output = results.File("output");
    const std::string errors = results.File("errors");
    const std::string line = "unset NO_COLOR; export LC_ALL=C PATH='" TESSAL_TOOL_FOLDER "':\"$PATH\"; cd '" +
                             folder.Path().string() + "' && (" + command + "\n) </dev/null >'" + output +
                             "' 2>'" + errors + "'";
    const int status = std::system(line.c_str());
    return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, ReadFile(output), ReadFile(errors)};
  }

 private:
  TemporaryFolder folder;
  TemporaryFolder results;
};

void WriteFiles(const ShellSession& session, const std::string& input) {
  const std::string mark = "--- ";
  std::string name;
  std::string content;
  std::istringstream lines(input + "\n" + mark);
  for (std::string line; std::getline(lines, line);) {
    if (!line.starts_with(mark)) {
      content += line + "\n";
      continue;
    }
    if (!name.empty()) session.Write(name, content);
    name = line.substr(mark.size());
    content.clear();
  }
}

std::string Transcript(const ShellRun& run) {
  std::string shown = run.output;
  std::istringstream errors(run.errors);
  for (std::string line; std::getline(errors, line);) shown += "2> " + line + "\n";
  if (run.exitCode == 0) return shown;
  if (!shown.empty() && shown.back() != '\n') shown += '\n';
  return shown + "[" + std::to_string(run.exitCode) + "]\n";
}

std::vector<std::string> TranscriptFiles() {
  std::vector<std::string> names;
  for (const auto& entry : std::filesystem::directory_iterator(TESSAL_SOURCE_DIR "/tests/cli/cases")) {
    names.push_back(entry.path().stem().string());
  }
  return names;
}

class Transcripts : public testing::TestWithParam<std::string> {};

TEST_P(Transcripts, AreWhatTheToolPrints) {
  RunCases("cli/cases/" + GetParam() + ".txt", [](const Case& each) -> Answer {
    const auto session = std::make_shared<ShellSession>();
    WriteFiles(*session, each.input);
    return [session](const CaseCall& call) { return Transcript(session->Run(call.words)); };
  });
}

INSTANTIATE_TEST_SUITE_P(Tool, Transcripts, testing::ValuesIn(TranscriptFiles()),
                         [](const auto& file) { return file.param; });

/// The sessions of a page: indented blocks that begin with a prompt.
std::vector<CaseCall> CallsOn(const std::string& page) {
  const std::string indent = "    ";
  std::vector<CaseCall> calls;
  std::istringstream lines(page);
  bool isSession = false;
  for (std::string line; std::getline(lines, line);) {
    const bool isBlock = line.starts_with(indent);
    const std::string text = isBlock ? line.substr(indent.size()) : "";
    const bool isCall = text.starts_with("$ ");
    isSession = isBlock && (isSession || isCall);
    if (isCall) {
      calls.push_back({"$ ", text.substr(2), "", 0});
    } else if (isSession) {
      calls.back().expected += text + "\n";
    }
  }
  return calls;
}

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
  for (const std::string command : {"check --format json", "check --format sarif", "check --format gitlab",
                                    "symbols --format json", "find [^a]+ --regex --format json"}) {
    const std::size_t verb = command.find(' ');
    const ShellRun run =
        session.Run("tessal " + command.substr(0, verb) + " *.tessal" + command.substr(verb));
    EXPECT_TRUE(nlohmann::json::accept(run.output)) << command << "\n" << run.errors;
    EXPECT_GT(run.output.size(), 500U) << command;
  }
}

TEST(MessagesPage, ShowsEveryRowOfTheTable) {
  ExpectPage("../docs/messages.md", ShellSession().Run("tessal explain --markdown").output);
}

class Pages : public testing::TestWithParam<const char*> {};

TEST_P(Pages, ShowWhatTheToolPrints) {
  const ShellSession session;
  const std::vector<CaseCall> calls = CallsOn(ReadFile(std::string(TESSAL_SOURCE_DIR "/") + GetParam()));
  EXPECT_GE(calls.size(), 5U);
  for (const CaseCall& call : calls) {
    const ShellRun run = session.Run(call.words);
    std::string given = run.output + run.errors;
    std::erase(given, '\r');
    std::string expected = call.expected;
    // Three points at the end mean the rest.
    if (expected.ends_with("\n...\n")) {
      expected.erase(expected.size() - 4);
      given.resize(std::min(given.size(), expected.size()));
    }
    EXPECT_EQ(given, expected) << call.words;
  }
}

INSTANTIATE_TEST_SUITE_P(Project, Pages, testing::Values("README.md", "docs/guide/units_and_balance.md"));

}  // namespace
}  // namespace tessal::test
