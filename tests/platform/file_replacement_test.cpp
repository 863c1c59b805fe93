#include "platform/file_replacement.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>

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
  EXPECT_NE(WriteWholeFile("/dev/full", "x").find("space"), std::string::npos);
  EXPECT_EQ(WriteWholeFile("/dev/null", "x"), "") << "there is nothing to flush";
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
