// A save that is interrupted at any of its system calls leaves the old file or the new one, whole, and a save
// that fails says why.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdlib>
#include <string>

#include "support/template_text.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::ReadFile;
using test::TemporaryFolder;

struct Outcome {
  bool killed;
  int exitCode;
};

/// Saves the file with a fault at the n-th call; 0 for none.
Outcome Probe(const std::string& file, int faultAt, const char* kind) {
  const std::string command =
      "ASAN_OPTIONS=verify_asan_link_order=0:detect_leaks=0 LD_PRELOAD='" TESSAL_SAVE_SHIM
      "' SAVE_FAULT_KIND=" +
      std::string(kind) + " SAVE_FAULT_AT=" + std::to_string(faultAt) + " '" TESSAL_SAVE_PROBE "' '" + file +
      "' 2>/dev/null";
  const int status = std::system(("exec env " + command).c_str());
  return {WIFSIGNALED(status), WIFEXITED(status) ? WEXITSTATUS(status) : -1};
}

void InterruptEverywhere(const char* kind) {
  const TemporaryFolder folder;
  const std::string text = test::RandomTemplate(9, 20);
  const std::string undisturbed = folder.Write("good.tessal", text);
  ASSERT_EQ(Probe(undisturbed, 0, kind).exitCode, 0);
  const std::string complete = ReadFile(undisturbed);
  ASSERT_NE(complete, text);
  constexpr int kMostCalls = 200;
  int faults = 0;
  for (int at = 1; at <= kMostCalls; ++at) {
    const std::string file = folder.Write("model.tessal", text);
    const Outcome outcome = Probe(file, at, kind);
    const std::string left = ReadFile(file);
    ASSERT_TRUE(left == text || left == complete) << kind << " at call " << at;
    if (outcome.killed) {
      ++faults;
      continue;
    }
    ASSERT_TRUE(outcome.exitCode == 0 || outcome.exitCode == 1)
        << kind << " at call " << at << ": " << outcome.exitCode;
    ASSERT_EQ(left == complete, outcome.exitCode == 0) << kind << " at call " << at;
    // A run that saves without meeting its fault has fewer calls than that: all have been tried. Faults in
    // cleaning up do not fail a save.
    if (outcome.exitCode == 1) ++faults;
    if (outcome.exitCode == 0 && at > 30) break;
  }
  EXPECT_GT(faults, 5) << "the shim strikes";
}

TEST(SaveFaults, KilledAtEachCall) {
  InterruptEverywhere("kill");
}

TEST(SaveFaults, AFullDiskAtEachCall) {
  InterruptEverywhere("full");
}

}  // namespace
}  // namespace tessal
