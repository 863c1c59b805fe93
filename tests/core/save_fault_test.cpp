// A save that is interrupted at any of its system calls leaves the old file or the new one, whole, and a save
// that fails says why.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdlib>
#include <filesystem>
#include <iterator>
#include <set>
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
  std::string errors;
};

/// Saves the file with a fault at the n-th call; 0 for none.
Outcome Probe(const TemporaryFolder& folder, const std::string& file, int faultAt, const char* kind) {
  const std::string messages = folder.File("messages");
  const std::string command =
      "ASAN_OPTIONS=verify_asan_link_order=0:detect_leaks=0 LD_PRELOAD='" TESSAL_SAVE_SHIM
      "' SAVE_FAULT_KIND=" +
      std::string(kind) + " SAVE_FAULT_AT=" + std::to_string(faultAt) + " '" TESSAL_SAVE_PROBE "' '" + file +
      "' 2>'" + messages + "'";
  const int status = std::system(("exec env " + command).c_str());
  return {WIFSIGNALED(status), WIFEXITED(status) ? WEXITSTATUS(status) : -1, ReadFile(messages)};
}

/// A template in a folder of its own, saved again and again.
class SaveFaults : public ::testing::Test {
 protected:
  SaveFaults() : text(test::RandomTemplate(9, 20)) {
    const std::string undisturbed = folder.Write("good.tessal", text);
    EXPECT_EQ(Probe(folder, undisturbed, 0, "none").exitCode, 0);
    complete = ReadFile(undisturbed);
    std::filesystem::remove(undisturbed);
    EXPECT_NE(complete, text);
  }

  /// Saves the old text with a fault at that call. Whatever happens, the old or the new file is there, whole.
  Outcome Interrupt(int at, const char* kind) {
    const std::string file = folder.Write("model.tessal", text);
    Outcome outcome = Probe(folder, file, at, kind);
    left = ReadFile(file);
    EXPECT_TRUE(left == text || left == complete) << kind << " at call " << at;
    return outcome;
  }

  std::size_t FilesInFolder() const {
    return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(folder.Path()),
                                                  std::filesystem::directory_iterator()));
  }

  // More calls than a save makes.
  static constexpr int kMostCalls = 40;
  // Making, writing, flushing and closing the new file, and the rename.
  static constexpr int kFewestFaults = 5;
  static constexpr std::size_t kModelAndMessages = 2;

  TemporaryFolder folder;
  std::string text;
  std::string complete;
  std::string left;
};

TEST_F(SaveFaults, KilledAtEachCall) {
  int faults = 0;
  bool hadOld = false;
  bool hadNew = false;
  for (int at = 1; at <= kMostCalls; ++at) {
    // A run that saves without meeting its fault has fewer calls than that: all have been tried.
    if (!Interrupt(at, "kill").killed) break;
    ++faults;
    hadOld = hadOld || left == text;
    hadNew = hadNew || left == complete;
    Interrupt(0, "none");
    EXPECT_EQ(FilesInFolder(), kModelAndMessages) << "the next save clears what was left at call " << at;
  }
  EXPECT_GE(faults, kFewestFaults) << "the shim strikes";
  EXPECT_LT(faults, kMostCalls) << "and all calls were tried";
  EXPECT_TRUE(hadOld && hadNew);
}

TEST_F(SaveFaults, AFullDiskAtEachCall) {
  int faults = 0;
  std::set<std::string> told;
  for (int at = 1; at <= kMostCalls; ++at) {
    for (const auto& entry : std::filesystem::directory_iterator(folder.Path()))
      std::filesystem::remove(entry.path());
    const Outcome outcome = Interrupt(at, "full");
    ASSERT_TRUE(outcome.exitCode == 0 || outcome.exitCode == 1) << "at call " << at << outcome.errors;
    if (outcome.exitCode == 0) {
      EXPECT_EQ(left, complete) << "at call " << at;
      continue;
    }
    ++faults;
    EXPECT_EQ(FilesInFolder(), kModelAndMessages) << "nothing is left behind at call " << at;
    const std::size_t start = outcome.errors.find("can not ");
    ASSERT_NE(start, std::string::npos) << "at call " << at << ": " << outcome.errors;
    told.insert(outcome.errors.substr(start, outcome.errors.find(" '", start) - start));
    // The rename is done then, and only its lasting in doubt.
    const bool onlyFolder = outcome.errors.find("flush the folder") != std::string::npos;
    EXPECT_EQ(left, onlyFolder ? complete : text) << outcome.errors;
  }
  EXPECT_GE(faults, kFewestFaults) << "the shim strikes";
  const std::set<std::string> steps = {"can not write file",
                                       "can not flush file",
                                       "can not close file",
                                       "can not create a file beside",
                                       "can not keep the permissions of file",
                                       "can not replace file",
                                       "can not flush the folder of file"};
  EXPECT_EQ(told, steps) << "each says which step failed";
}

}  // namespace
}  // namespace tessal
