// The tool as people see it: shell sessions in files of cases, the blocks of the project's front page and of
// its guide, and the page of messages, which the tool writes.
//
// The input of a case gives files: `--- NAME`, and what is in it. After a command comes what it printed;
// lines of standard error begin with `2> `, and an exit code other than 0 ends it, as `[1]`.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <algorithm>
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
  void Write(const std::string& name, const std::string& content) const {
    std::filesystem::create_directories((folder.Path() / name).parent_path());
    folder.Write(name, content);
  }

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

/// What a page has its reader do: a command, or a file to write.
struct PageStep {
  std::string command;  ///< empty where a file is written
  std::string file;
  std::string text;  ///< what the command prints, or what is in the file
};

/// The steps of a page: indented or fenced blocks that begin with a prompt, and whole files, fenced as
/// ```tessal NAME or as another kind.
std::vector<PageStep> StepsOn(const std::string& page) {
  const std::string indent = "    ";
  const std::string fence = "```";
  const std::string prompt = "$ ";
  std::vector<PageStep> steps;
  bool isFenced = false;
  bool isStep = false;
  std::istringstream lines(page);
  for (std::string line; std::getline(lines, line);) {
    if (line.starts_with(fence)) {
      isFenced = !isFenced;
      const std::size_t name = line.find(' ');
      isStep = isFenced && name != std::string::npos;
      if (isStep) steps.push_back({"", line.substr(name + 1), ""});
      continue;
    }
    const bool isBlock = isFenced || line.starts_with(indent);
    const std::string text = isFenced || !isBlock ? line : line.substr(indent.size());
    isStep = isStep && isBlock;
    if (isBlock && text.starts_with(prompt) && (!isStep || steps.back().file.empty())) {
      steps.push_back({text.substr(prompt.size()), "", ""});
      isStep = true;
    } else if (isStep) {
      steps.back().text += text + "\n";
    }
  }
  return steps;
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

/// The front page, those on repositories, and the chapters of the guide, below the project's folder.
std::vector<std::string> PagesOfProject() {
  std::vector<std::string> pages{"README.md", "docs/ci.md", "docs/teams.md"};
  for (const auto& entry : std::filesystem::directory_iterator(TESSAL_SOURCE_DIR "/docs/guide"))
    if (entry.path().extension() == ".md") pages.push_back("docs/guide/" + entry.path().filename().string());
  return pages;
}

/// What a page says, as it reads here: where a package puts the examples, there is the session's copy.
std::string ReadPage(const std::string& name) {
  const std::string installed = "/usr/share/tessal/examples";
  std::string page = ReadFile(std::string(TESSAL_SOURCE_DIR "/") + name);
  for (std::size_t at = page.find(installed); at != std::string::npos; at = page.find(installed, at))
    page.replace(at, installed.size(), "examples");
  return page;
}

void ExpectOutput(const ShellRun& run, const PageStep& step) {
  std::string given = run.output + run.errors;
  std::erase(given, '\r');
  std::string expected = step.text;
  // Three points at the end mean the rest.
  if (expected.ends_with("\n...\n")) {
    expected.erase(expected.size() - 4);
    given.resize(std::min(given.size(), expected.size()));
  }
  EXPECT_EQ(given, expected) << step.command;
}

/// Runs what a file of another program calls the tool with. A build server's file has one call a line.
void ExpectCallsToRun(const ShellSession& session, const PageStep& step) {
  std::istringstream lines(step.text);
  for (std::string line; std::getline(lines, line);) {
    const std::size_t call = line.find(" tessal ");
    if (call == std::string::npos || call == 0 || (line[call - 1] != '-' && line[call - 1] != ':')) continue;
    const ShellRun run = session.Run(line.substr(call));
    EXPECT_EQ(run.exitCode, 0) << step.file << ": " << line << "\n" << run.output << run.errors;
  }
}

class Pages : public testing::TestWithParam<std::string> {};

TEST_P(Pages, ShowWhatTheToolPrintsAndTemplatesThatLoad) {
  const ShellSession session;
  for (const PageStep& step : StepsOn(ReadPage(GetParam()))) {
    if (!step.file.empty()) {
      session.Write(step.file, step.text);
      if (!step.file.ends_with(".tessal")) {
        ExpectCallsToRun(session, step);
        continue;
      }
      const ShellRun run = session.Run("tessal check '" + step.file + "'");
      EXPECT_NE(run.exitCode, 2) << step.file << "\n" << run.errors;
    } else {
      ExpectOutput(session.Run(step.command), step);
    }
  }
}

INSTANTIATE_TEST_SUITE_P(Project, Pages, testing::ValuesIn(PagesOfProject()), [](const auto& page) {
  std::string name = page.param;
  std::replace_if(
      name.begin(), name.end(), [](char each) { return each == '/' || each == '.'; }, '_');
  return name;
});

TEST(Pages, AreReadStepByStep) {
  const std::vector<PageStep> steps = StepsOn(
      "text\n\n    $ one\n    printed\n      more\n    $ two\n\n    not of it\n"
      "```tessal a.tessal\n[A]\n$ no command\nEndSect\n```\n```\n$ three\n```\n");
  std::string text;
  for (const PageStep& step : steps) text += step.command + "|" + step.file + "|" + step.text + ";";
  EXPECT_EQ(text, "one||printed\n  more\n;two||;|a.tessal|[A]\n$ no command\nEndSect\n;three||;");
}

}  // namespace
}  // namespace tessal::test
