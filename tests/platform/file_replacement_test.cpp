#include "platform/file_replacement.h"

#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <filesystem>
#include <vector>

#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::ReadFile;
using test::TemporaryFolder;

mode_t ModeOf(const std::string& path) {
  struct stat status = {};
  stat(path.c_str(), &status);
  return status.st_mode & 07777;
}

TEST(FileReplacement, KeepsPermissionsAndLinks) {
  const TemporaryFolder folder;
  const std::string target = folder.Write("target", "old");
  chmod(target.c_str(), 0640);
  const std::string link = folder.File("link");
  std::filesystem::create_symlink("target", link);
  EXPECT_EQ(ReplaceFile(link, "new"), "");
  EXPECT_TRUE(std::filesystem::is_symlink(link));
  EXPECT_EQ(ReadFile(target), "new");
  EXPECT_EQ(ModeOf(target), 0640U);
  // Nothing but the two is left in the folder.
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.Path()), {}), 2);
}

TEST(FileReplacement, ALinkToNothingYetStaysALink) {
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder.File("inner"));
  std::filesystem::create_symlink("inner/second", folder.File("first"));
  std::filesystem::create_symlink("../fresh", folder.File("inner/second"));
  EXPECT_EQ(ReplaceFile(folder.File("first"), "new"), "");
  EXPECT_TRUE(std::filesystem::is_symlink(folder.File("first")));
  EXPECT_TRUE(std::filesystem::is_symlink(folder.File("inner/second")));
  EXPECT_EQ(ReadFile(folder.File("fresh")), "new");
  std::filesystem::create_symlink("there", folder.File("here"));
  std::filesystem::create_symlink("here", folder.File("there"));
  EXPECT_NE(ReplaceFile(folder.File("here"), "x").find("symbolic links"), std::string::npos);
  EXPECT_TRUE(std::filesystem::is_symlink(folder.File("here")));
}

TEST(FileReplacement, LeavesWhatIsNoPlainFile) {
  const TemporaryFolder folder;
  const std::string pipe = folder.File("pipe");
  ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
  EXPECT_NE(ReplaceFile(pipe, "x").find("no plain file"), std::string::npos);
  EXPECT_TRUE(std::filesystem::is_fifo(pipe));
}

TEST(FileReplacement, AFileOfSeveralNamesIsRefused) {
  const TemporaryFolder folder;
  const std::string one = folder.Write("one", "old");
  std::filesystem::create_hard_link(one, folder.File("two"));
  EXPECT_NE(ReplaceFile(one, "new").find("hard links"), std::string::npos);
  EXPECT_EQ(ReadFile(one) + ReadFile(folder.File("two")), "oldold");
}

TEST(FileReplacement, AnOutputIsNeverWrittenThroughALink) {
  const TemporaryFolder folder;
  const std::string victim = folder.Write("victim", "precious");
  std::filesystem::create_symlink("victim", folder.File("soft"));
  std::filesystem::create_symlink("not there", folder.File("dangling"));
  for (const char* name : {"soft", "dangling"}) {
    EXPECT_NE(WriteOutputFile(folder.File(name), "new").find("symbolic link"), std::string::npos) << name;
    EXPECT_TRUE(std::filesystem::is_symlink(folder.File(name))) << name;
  }
  std::filesystem::create_hard_link(victim, folder.File("hard"));
  EXPECT_EQ(WriteOutputFile(folder.File("hard"), "new"), "");
  EXPECT_EQ(ReadFile(folder.File("hard")) + ReadFile(victim), "newprecious");
  EXPECT_FALSE(std::filesystem::exists(folder.File("not there")));
  std::filesystem::create_symlink("/dev/full", folder.File("full"));
  EXPECT_NE(WriteOutputFile(folder.File("full"), "x").find("space"), std::string::npos);
  EXPECT_EQ(WriteOutputFile("/dev/null", "x"), "") << "there is nothing to flush";
}

TEST(FileReplacement, ANameMayBeAsLongAsTheFileSystemAllows) {
  const TemporaryFolder folder;
  for (const std::size_t length : {249U, 255U}) {
    const std::string target = folder.File(std::string(length, 'n'));
    EXPECT_EQ(ReplaceFile(target, "old"), "");
    EXPECT_EQ(ReplaceFile(target, "new"), "");
    EXPECT_EQ(ReadFile(target), "new");
  }
  EXPECT_NE(ReplaceFile(folder.File(std::string(256, 'n')), "x").find("too long"), std::string::npos);
}

/// Replaces the file again and again in a process of its own; the process.
pid_t ReplaceInChild(const std::string& target, int times, std::string_view content) {
  const pid_t child = fork();
  if (child != 0) return child;
  for (int time = 0; time != times; ++time) {
    if (!ReplaceFile(target, content).empty()) _exit(1);
  }
  _exit(0);
}

TEST(FileReplacement, SeveralAtOnceDoNotDisturbEachOther) {
  constexpr int kTimes = 150;
  const TemporaryFolder folder;
  const std::string target = folder.Write("target", "old");
  std::vector<pid_t> savers;
  for (int saver = 0; saver < 6; ++saver) savers.push_back(ReplaceInChild(target, kTimes, "new"));
  for (const pid_t saver : savers) {
    int status = 0;
    waitpid(saver, &status, 0);
    EXPECT_EQ(status, 0);
  }
  EXPECT_EQ(ReadFile(target), "new");
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.Path()), {}), 1);
}

TEST(FileReplacement, ClearsWhatKilledReplacementsOfTheSameFileLeft) {
  constexpr std::size_t kLarge = 4'000'000;
  const TemporaryFolder folder;
  const auto files = [&folder] {
    return std::distance(std::filesystem::directory_iterator(folder.Path()), {});
  };
  const std::string content(kLarge, 'x');
  const auto killOne = [&](const char* name) {
    const pid_t saver = ReplaceInChild(folder.File(name), -1, content);
    usleep(20'000);
    kill(saver, SIGKILL);
    waitpid(saver, nullptr, 0);
  };
  for (const char* name : {"target", "other"}) {
    const auto before = files();
    // Until one was in the middle.
    for (int tries = 0; tries < 100 && files() < before + 2; ++tries) killOne(name);
  }
  EXPECT_EQ(files(), 4) << "two targets, and a rest of each";
  EXPECT_EQ(ReplaceFile(folder.File("target"), "new"), "");
  EXPECT_EQ(files(), 3) << "the rest of the other file is not ours to clear";
  EXPECT_EQ(ReplaceFile(folder.File("other"), "new"), "");
  EXPECT_EQ(files(), 2);
}

TEST(FileReplacement, AFreshFileIsNotWrittenThroughALinkAndNobodyElseReadsIt) {
  const TemporaryFolder folder;
  const std::string victim = folder.Write("victim", "precious");
  const std::string fresh = folder.File("fresh");
  std::filesystem::create_symlink("victim", fresh);
  EXPECT_EQ(WriteFreshFile(fresh, "new"), "");
  EXPECT_EQ(ReadFile(victim), "precious");
  EXPECT_FALSE(std::filesystem::is_symlink(fresh));
  EXPECT_EQ(ReadFile(fresh), "new");
  EXPECT_EQ(ModeOf(fresh), 0600U);
  EXPECT_NE(WriteFreshFile(folder.Path().string(), "x"), "");
}

TEST(FileReplacement, AFreshFileThatCannotBeWrittenLeavesTheOldOne) {
  const TemporaryFolder folder;
  const std::string fresh = folder.Write("fresh", "old");
  const auto formerHandler = std::signal(SIGXFSZ, SIG_IGN);
  rlimit former = {};
  getrlimit(RLIMIT_FSIZE, &former);
  const rlimit small = {4, former.rlim_max};
  setrlimit(RLIMIT_FSIZE, &small);
  const std::string failure = WriteFreshFile(fresh, "too long for it");
  setrlimit(RLIMIT_FSIZE, &former);
  std::signal(SIGXFSZ, formerHandler);
  EXPECT_TRUE(failure.starts_with("can not write file")) << failure;
  EXPECT_EQ(ReadFile(fresh), "old");
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.Path()), {}), 1);
}

TEST(FileReplacement, MakesANewFileWithTheUsualPermissions) {
  const TemporaryFolder folder;
  const mode_t former = umask(027);
  EXPECT_EQ(ReplaceFile(folder.File("fresh"), std::string(100'000, 'x')), "");
  umask(former);
  EXPECT_EQ(ModeOf(folder.File("fresh")), 0640U);
  EXPECT_EQ(FileSize(folder.File("fresh")), 100'000U);
}

TEST(FileReplacement, SaysWhyItFails) {
  const TemporaryFolder folder;
  EXPECT_NE(ReplaceFile(folder.Path().string(), "x").find("directory"), std::string::npos);
  EXPECT_NE(ReplaceFile(folder.File("no/such/folder"), "x"), "");
  std::string failure;
  EXPECT_FALSE(ReadWholeFile(folder.File("missing"), failure));
  EXPECT_NE(failure.find("missing"), std::string::npos);
  failure.clear();
  EXPECT_FALSE(ReadWholeFile(folder.Path().string(), failure));
  EXPECT_NE(failure, "");
  if (geteuid() == 0) GTEST_SKIP() << "the superuser writes everywhere";
  const std::string target = folder.Write("protected", "old");
  chmod(target.c_str(), 0444);
  EXPECT_NE(ReplaceFile(target, "new"), "");
  EXPECT_EQ(ReadFile(target), "old");
}

}  // namespace
}  // namespace tessal
