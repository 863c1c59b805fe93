// The tool when an allocation fails, each in turn: it finishes as ever, or ends with 2 and one line that says
// why. What is on disk is whole, and no other file is left.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <spawn.h>
#include <sys/socket.h>
#include <sys/wait.h>
#include <unistd.h>

#include <filesystem>
#include <map>
#include <ostream>
#include <sstream>
#include <string>
#include <vector>

#include "support/template_text.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::ReadFile;
using test::TemporaryFolder;

using Files = std::map<std::string, std::string>;

/// What a run has left: its wait status, what it printed, and the files of its folder.
struct Outcome {
  int status = 0;
  std::string output;
  std::string errors;
  Files files;
  bool operator==(const Outcome&) const = default;
};

/// What the shim hands over: the status is that of a child, or negative. The sizes are of what the parent has
/// printed.
struct Report {
  long call = 0;
  long status = 0;
  long outputBefore = 0;
  long errorsBefore = 0;
};
constexpr long kEnd = -2;

constexpr const char* kMain = "ALLOCATION_FAULT_FROM=main";
constexpr const char* kOpen = "ALLOCATION_FAULT_FROM=open";

struct Row {
  const char* name;
  const char* call;
  const char* from;  ///< where the count begins, for the shim
  bool hasFaults;    ///< whether the template has some that messages and the account name
  long step;         ///< each so many allocations are tried
  int exitCode = 0;
};

std::ostream& operator<<(std::ostream& stream, const Row& row) {
  return stream << row.name;
}

/// The command line is the same code for all: the first commands try it.
constexpr Row kRows[] = {
    {"Check", "check FILE", kMain, true, 1, 1},
    {"Save", "save FILE", kOpen, false, 1},
    {"SaveOutput", "save FILE --output FILE-saved", kOpen, true, 3},
    {"Repair", "repair FILE", kOpen, true, 11},
    {"Rename", "rename FILE k quota", kOpen, false, 11},
    {"Find", "find FILE k.*f|x --regex --ignore-case", kOpen, false, 11},
    {"Html", "html FILE", kOpen, false, 11},
    {"Json", "check FILE --format json", kOpen, true, 11, 1},
    {"Latex", "latex FILE", kOpen, false, 31},
    {"Tree", "tree FILE", kOpen, true, 1},
    {"Lint", "lint FILE --format gitlab", kOpen, true, 31, 1},
    {"Graph", "graph FILE --kinds all --format json", kOpen, false, 31},
    {"Describe", "functions --describe --format json", kMain, false, 101},
    {"Help", "--help", kMain, true, 11},
};

/// A name that no string holds without memory.
constexpr const char* kFile = "lake_templates_of_2026/summer_stratification.tessal";

std::string Repeated(std::string_view text, int count) {
  std::string repeated;
  while (count-- > 0) repeated += text;
  return repeated;
}

/// A template with each kind of section. Both parsers need a larger stack for it than they begin with.
std::string TemplateText(bool hasFaults) {
  constexpr int kDepth = 210;
  std::string lines = R"(constant k 0.3
forcing f
state Algae p - loss
auxiliary a )" + Repeated("(", kDepth) +
                      "k*f" + Repeated(")", kDepth) + R"(
process p IF Algae > a THEN SQRT(Algae)*a ELSE 0
process loss Algae*k
output Algae*2
class Fish
class.state Fish_s Fish_a
class.constant Fish_k 1
class.forcing Fish_f | -UNQ_TYPE; -UNQ_UNIT; -SCOPE
class.search Fish_d 1 | -UNQ_TYPE; -UNQ_UNIT
class.expression Fish_a Fish_s*Fish_k
class.movement 1 1
class.descent 0
settings
function USER
after [OTHER]
)" + Repeated("after // \n", kDepth) +
                      "after EndSect\n";
  if (hasFaults) lines += "constant c 1 | -UNIT\nauxiliary b (k +\nauxiliary u missing_symbol*2\n";
  return test::TemplateFromNotation(lines);
}

class AllocationFaults : public ::testing::TestWithParam<std::tuple<Row, std::string>> {
 protected:
  AllocationFaults() : row(std::get<0>(GetParam())), kind(std::get<1>(GetParam())) {
    row.step *= TESSAL_ONE_ALLOCATION_OF;
    before[kFile] = TemplateText(row.hasFaults);
    Restore();
    complete = Wait(Start({}));
    Restore();
    EXPECT_EQ(WEXITSTATUS(complete.status), row.exitCode) << complete.errors;
  }

  /// Puts the folder in the state before a run.
  void Restore() const {
    for (const auto& entry : std::filesystem::directory_iterator(folder.Path())) {
      std::filesystem::remove_all(entry.path());
    }
    for (const auto& [name, content] : before) {
      std::filesystem::create_directories((folder.Path() / name).parent_path());
      folder.Write(name, content);
    }
  }

  Files FilesInFolder() const {
    Files files;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(folder.Path())) {
      if (entry.is_regular_file())
        files[entry.path().lexically_relative(folder.Path())] = ReadFile(entry.path());
    }
    return files;
  }

  /// Starts the tool in the folder, under the shim.
  pid_t Start(std::vector<std::string> environment) const {
    environment.insert(environment.end(),
                       {"ASAN_OPTIONS=verify_asan_link_order=0:alloc_dealloc_mismatch=0", "LD_BIND_NOW=1",
                        std::string("LD_PRELOAD=") + TESSAL_ALLOCATION_SHIM, "ALLOCATION_FAULT_KIND=" + kind,
                        row.from, "ALLOCATION_FAULT_STEP=" + std::to_string(row.step)});
    std::vector<std::string> words = {"tessal"};
    std::istringstream call(row.call);
    for (std::string word; call >> word;) {
      words.push_back(word.starts_with("FILE") ? kFile + word.substr(4) : word);
    }
    const auto pointersTo = [](std::vector<std::string>& texts) {
      std::vector<char*> pointers;
      pointers.reserve(texts.size() + 1);
      for (std::string& text : texts) pointers.push_back(text.data());
      pointers.push_back(nullptr);
      return pointers;
    };
    constexpr int kAppending = O_WRONLY | O_CREAT | O_TRUNC | O_APPEND;
    constexpr mode_t kReadWrite = 0600;
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
    posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, outputFile.c_str(), kAppending, kReadWrite);
    posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, errorsFile.c_str(), kAppending, kReadWrite);
    posix_spawn_file_actions_addchdir_np(&actions, folder.Path().c_str());
    pid_t process = 0;
    EXPECT_EQ(posix_spawn(&process, TESSAL_TOOL, &actions, nullptr, pointersTo(words).data(),
                          pointersTo(environment).data()),
              0);
    posix_spawn_file_actions_destroy(&actions);
    return process;
  }

  Outcome Left(int status) const {
    return {status, ReadFile(outputFile), ReadFile(errorsFile), FilesInFolder()};
  }

  Outcome Wait(pid_t process) const {
    int status = 0;
    waitpid(process, &status, 0);
    return Left(status);
  }

  /// Judges a run whose n-th allocation failed, and clears up after it.
  void Judge(long number, const Outcome& run) {
    constexpr int kMachineFault = 2;
    constexpr long kMostShown = 20;
    constexpr std::string_view kLine = "tessal: not enough memory\n";
    ++runs;
    const std::string lead = run.errors.substr(0, std::max(run.errors.size(), kLine.size()) - kLine.size());
    const bool saysWhy = run.errors.ends_with(kLine) && complete.errors.starts_with(lead);
    const bool isWhole = run.files == before || run.files == complete.files;
    const bool failedWell =
        WIFEXITED(run.status) && WEXITSTATUS(run.status) == kMachineFault && saysWhy && isWhole;
    if (failedWell) {
      ++failedRuns;
    } else if (run != complete && ++badRuns <= kMostShown) {
      ADD_FAILURE() << row.call << ", " << kind << ", allocation " << number << ": "
                    << (WIFSIGNALED(run.status) ? "signal " : "exit ")
                    << (WIFSIGNALED(run.status) ? WTERMSIG(run.status) : WEXITSTATUS(run.status)) << ", '"
                    << run.errors.substr(0, run.errors.find('\n')) << "'"
                    << (isWhole ? "" : ", files differ");
    }
    if (run.files != before) Restore();
  }

  /// Leaves in a file what the parent has printed.
  static void CutBack(const std::string& file, const std::string& text, long printed) {
    const auto size = static_cast<std::size_t>(printed);
    if (text.size() != size) std::filesystem::resize_file(file, size);
  }

  /// Lets the allocations up to the first change on disk fail in children of one run. Returns the last of
  /// those, and the number of all.
  std::pair<long, long> FailInChildren() {
    int ends[2] = {};
    EXPECT_EQ(socketpair(AF_UNIX, SOCK_STREAM, 0, ends), 0);
    fcntl(ends[0], F_SETFD, FD_CLOEXEC);
    const pid_t parent = Start({"ALLOCATION_FAULT_CONTROL=" + std::to_string(ends[1])});
    close(ends[1]);
    Report report;
    long last = 0;
    while (report.status != kEnd && read(ends[0], &report, sizeof report) == sizeof report) {
      if (report.status >= 0) {
        const Outcome run = Left(static_cast<int>(report.status));
        Judge(report.call, run);
        CutBack(outputFile, run.output, report.outputBefore);
        CutBack(errorsFile, run.errors, report.errorsBefore);
      }
      if (report.status != kEnd) last = report.call;
      EXPECT_EQ(write(ends[0], "", 1), 1);
    }
    close(ends[0]);
    EXPECT_EQ(report.status, kEnd) << "the run came to its end";
    EXPECT_EQ(Wait(parent), complete) << "and was not disturbed";
    Restore();
    return {last, report.call};
  }

  Row row;
  std::string kind;
  TemporaryFolder folder;
  TemporaryFolder results;
  std::string outputFile = results.File("output");
  std::string errorsFile = results.File("errors");
  Files before;
  Outcome complete;
  long runs = 0;
  long failedRuns = 0;
  long badRuns = 0;
};

TEST_P(AllocationFaults, EndWithOneLineOrNotAtAll) {
  constexpr long kFewest = 20;
  const auto [last, all] = FailInChildren();
  for (long number = last + 1; number <= all; number += row.step) {
    Judge(number, Wait(Start({"ALLOCATION_FAULT_AT=" + std::to_string(number)})));
  }
  EXPECT_EQ(badRuns, 0);
  EXPECT_GE(all, kFewest) << "the tool allocates";
  EXPECT_GE(failedRuns, runs / 2) << "and the shim strikes";
}

INSTANTIATE_TEST_SUITE_P(Commands, AllocationFaults,
                         ::testing::Combine(::testing::ValuesIn(kRows),
                                            ::testing::Values(std::string("once"), std::string("on"))),
                         [](const auto& instance) {
                           return std::string(std::get<0>(instance.param).name) + "_" +
                                  std::get<1>(instance.param);
                         });

}  // namespace
}  // namespace tessal
