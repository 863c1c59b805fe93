// The writing of recovery files, killed or refused at each of its system calls: what is found afterwards is
// whole, for its owner only, and no older than the last writing that was done.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <QFileInfo>
#include <QString>
#include <cstdlib>
#include <filesystem>
#include <iterator>
#include <sstream>
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

  /// The probe's exit status, with the shim's settings. `said` has its lines.
  int Probe(const std::string& settings, const char* end) {
    for (const auto& entry : fs::directory_iterator(folder.Path())) fs::remove_all(entry.path());
    fs::create_directory(folder.File("docs"));
    path = GetParam() ? folder.Write("docs/m.tessal", "saved") : std::string();
    const std::string command =
        "exec env ASAN_OPTIONS=verify_asan_link_order=0:detect_leaks=0 LD_PRELOAD='" TESSAL_SAVE_SHIM "' " +
        settings + " '" TESSAL_RECOVERY_PROBE "' '" + path + "' " + end + " >'" + folder.File("said") + "'";
    const int status = std::system(command.c_str());
    said = ReadFile(folder.File("said"));
    return status;
  }

  /// The same with a fault at the n-th call.
  int Probe(int at, const std::string& kind, const char* end) {
    return Probe("SAVE_FAULT_FROM=start SAVE_FAULT_KIND=" + kind + " SAVE_FAULT_AT=" + std::to_string(at),
                 end);
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

  /// Each writing is done or says why it is not. What is found is none older than the last that is done:
  /// where only the folder could not be flushed, the newer is in place.
  void ExpectTheLastOne() {
    char last = 0;
    std::istringstream lines(said);
    for (std::string line; std::getline(lines, line);) {
      if (line.size() == 1) {
        last = line[0];
        continue;
      }
      EXPECT_TRUE(line.starts_with("can not ")) << line;
      ++refusals;
    }
    EXPECT_GE(Found(), last) << said;
  }

  TemporaryFolder folder;
  int refusals = 0;
  std::string path;
  std::string said;
};

TEST_P(RecoveryFaults, KilledAtEachCall) {
  int at = 1;
  std::string seen;
  for (; at <= kMostCalls; ++at) {
    if (!WIFSIGNALED(Probe(at, "kill", "remove"))) break;
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

TEST_P(RecoveryFaults, ADiskThatIsFullForOneCallOrStaysSo) {
  int calls = 0;
  while (calls < kMostCalls && WIFSIGNALED(Probe(calls + 1, "kill", "leave"))) ++calls;
  EXPECT_GT(calls, 20) << "the shim strikes";
  EXPECT_LT(calls, kMostCalls) << "and all calls are tried";
  for (int at = 1; at <= calls; ++at) {
    SCOPED_TRACE("at call " + std::to_string(at));
    EXPECT_EQ(Probe(at, "full", "leave"), 0);
    ExpectTheLastOne();
  }
  // The other place takes the work when one refuses it.
  EXPECT_EQ(refusals == 0, GetParam());
  refusals = 0;
  for (int at = 1; at <= calls; ++at) {
    SCOPED_TRACE("from call " + std::to_string(at));
    EXPECT_EQ(Probe(at, "stays-full", "leave"), 0);
    ExpectTheLastOne();
    EXPECT_EQ(Probe(at, "stays-full", "again"), 0);
    EXPECT_TRUE(Says("3")) << said;
    EXPECT_EQ(Found(), '3');
  }
  EXPECT_GT(refusals, 20);
}

TEST_P(RecoveryFaults, AFolderThatIsWriteProtected) {
  const std::string docs = folder.File("docs");
  EXPECT_EQ(Probe("SAVE_FAULT_DENIED='" + docs + "'", "leave"), 0);
  EXPECT_TRUE(Says("1") && Says("2")) << said;
  EXPECT_EQ(Found(), '2');
  const auto files = std::distance(fs::directory_iterator(docs), fs::directory_iterator());
  EXPECT_EQ(files, GetParam() ? 1 : 0) << "the work is in the state folder";
}

INSTANTIATE_TEST_SUITE_P(Documents, RecoveryFaults, ::testing::Bool(), [](const auto& hasFile) {
  return std::string(hasFile.param ? "WithAFile" : "WithoutAFile");
});

}  // namespace
}  // namespace tessal
