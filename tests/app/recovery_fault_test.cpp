// The writing of recovery files, interrupted at each of its system calls: what is found afterwards is whole,
// for its owner only, and no older than the last writing that was done.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <QFileInfo>
#include <QString>
#include <cstdlib>
#include <filesystem>
#include <string>

#include "app/recovery_file.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

namespace fs = std::filesystem;
using test::ReadFile;
using test::TemporaryFolder;

constexpr int kMostCalls = 400;
constexpr std::size_t kLength = 100000;

class RecoveryFaults : public ::testing::TestWithParam<bool> {
 protected:
  RecoveryFaults() { qputenv("XDG_STATE_HOME", QByteArray::fromStdString(folder.File("state"))); }

  /// The probe's exit status, with a fault at the n-th call. `said` has its lines.
  int Probe(int at, const char* kind) {
    fs::remove_all(folder.File("state"));
    for (const auto& entry : fs::directory_iterator(folder.Path())) fs::remove_all(entry.path());
    path = GetParam() ? folder.Write("m.tessal", "saved") : std::string();
    const std::string command =
        "exec env ASAN_OPTIONS=verify_asan_link_order=0:detect_leaks=0 LD_PRELOAD='" TESSAL_SAVE_SHIM
        "' SAVE_FAULT_FROM=start SAVE_FAULT_KIND=" +
        std::string(kind) + " SAVE_FAULT_AT=" + std::to_string(at) + " '" TESSAL_RECOVERY_PROBE "' '" + path +
        "' >'" + folder.File("said") + "'";
    const int status = std::system(command.c_str());
    said = ReadFile(folder.File("said"));
    return status;
  }

  /// The first character of the work that the next start finds, 0 for none.
  char Found() {
    if (GetParam()) {
      EXPECT_EQ(ReadFile(path), "saved");
    }
    const auto works = FindAllWork();
    const FoundWork byPath = FindWork(QString::fromStdString(path));
    if (works.isEmpty() && !(GetParam() && byPath.IsThere())) return 0;
    const std::string file = (works.isEmpty() ? byPath : works.first()).file.toStdString();
    EXPECT_LE(works.size(), 1);
    EXPECT_EQ(fs::status(file).permissions(), fs::perms::owner_read | fs::perms::owner_write);
    const std::string content = ReadFile(file);
    EXPECT_EQ(content, std::string(kLength, content.at(0)));
    return content.at(0);
  }

  bool Says(const char* line) const {
    return ("\n" + said).find("\n" + std::string(line) + "\n") != std::string::npos;
  }

  TemporaryFolder folder;
  std::string path;
  std::string said;
};

TEST_P(RecoveryFaults, KilledAtEachCall) {
  int at = 1;
  std::string seen;
  for (; at <= kMostCalls; ++at) {
    if (!WIFSIGNALED(Probe(at, "kill"))) break;
    const char found = Found();
    if (seen.find(found) == std::string::npos) seen += found;
    const bool hasOne = Says("1");
    const bool hasTwo = Says("2");
    if (hasOne && !hasTwo) {
      EXPECT_TRUE(found == '1' || found == '2') << "at call " << at;
    }
    if (hasTwo) {
      EXPECT_TRUE(found == '2' || found == 0) << "at call " << at;
    }
  }
  EXPECT_GT(at, 20) << "the shim strikes";
  EXPECT_LT(at, kMostCalls) << "and all calls were tried";
  EXPECT_EQ(seen.size(), 3U) << "none, the first and the second were found";
  EXPECT_TRUE(Says("removed"));
  EXPECT_EQ(Found(), 0);
}

INSTANTIATE_TEST_SUITE_P(Documents, RecoveryFaults, ::testing::Bool(), [](const auto& hasFile) {
  return std::string(hasFile.param ? "WithAFile" : "WithoutAFile");
});

}  // namespace
}  // namespace tessal
