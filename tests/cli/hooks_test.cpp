// The project's hooks for pre-commit, run by it over a repository of templates. It reads them from a clone,
// which it makes from a local folder.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdlib>
#include <string>

#include "support/temporary_folder.h"

namespace tessal::test {
namespace {

int RunIn(const TemporaryFolder& folder, const std::string& commands) {
  const std::string identity = "-c user.name=M -c user.email=m@example.org";
  const std::string line =
      "cd '" + folder.Path().string() +
      "' && unset GIT_DIR GIT_INDEX_FILE; export LC_ALL=C PRE_COMMIT_HOME=\"$PWD/cache\" "
      "PATH='" TESSAL_TOOL_FOLDER "':\"$PATH\"; save() { git add -A && git " +
      identity + " commit -qm saved; }; (" + commands + ") >output 2>&1 </dev/null";
  const int status = std::system(line.c_str());
  return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

TEST(PreCommit, RunsTheHooksOverTheTemplatesOfARepository) {
  if (std::system("pre-commit --version >/dev/null 2>&1 && git --version >/dev/null 2>&1") != 0) {
    GTEST_SKIP() << "needs pre-commit and git";
  }
  const TemporaryFolder folder;
  ASSERT_EQ(
      RunIn(folder, "set -e; git init -q hooks; cp '" TESSAL_SOURCE_DIR "/.pre-commit-hooks.yaml' hooks; "
                    "(cd hooks; save; git tag v1); git init -q models; cd models; "
                    "cp '" TESSAL_SOURCE_DIR "/examples/streeter_phelps.tessal' 'a river.tessal'; "
                    "cp '" TESSAL_SOURCE_DIR "/examples/fasham.tessal' .; echo text >note.txt; "
                    "printf '%s\\n' 'repos:' '  - repo: ../hooks' '    rev: v1' '    hooks:' "
                    "'      - id: tessal-check' '      - id: tessal-lint' '      - id: tessal-units' "
                    "'      - id: tessal-balance' >.pre-commit-config.yaml; save"),
      0)
      << ReadFile(folder.File("output"));
  const std::string run = "cd models; pre-commit run --all-files";
  EXPECT_EQ(RunIn(folder, run), 0) << ReadFile(folder.File("output"));
  EXPECT_EQ(RunIn(folder, "cd models; sed -i \"s/'k1_20'/'kd'/; s/UNIT = 'mg.l'/UNIT = 'm'/\" a*; save"), 0);
  EXPECT_EQ(RunIn(folder, run), 1);
  const std::string output = ReadFile(folder.File("output"));
  for (const std::string words : {"Undefined symbol k1_20", "hook id: tessal-units", "a river.tessal:"}) {
    EXPECT_NE(output.find(words), std::string::npos) << words << "\n" << output;
  }
}

}  // namespace
}  // namespace tessal::test
