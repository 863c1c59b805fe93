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

TEST(FileReplacement, MakesANewFileWithTheUsualPermissions) {
  const TemporaryFolder folder;
  const mode_t former = umask(027);
  EXPECT_EQ(ReplaceFile(folder.File("fresh"), std::string(100'000, 'x')), "");
  umask(former);
  EXPECT_EQ(ModeOf(folder.File("fresh")), 0640U);
  EXPECT_EQ(FileSize(folder.File("fresh")), 100'000U);
}

TEST(FileReplacement, TellsWhyItFails) {
  const TemporaryFolder folder;
  EXPECT_NE(ReplaceFile(folder.Path().string(), "x").find("directory"), std::string::npos);
  EXPECT_NE(ReplaceFile(folder.File("no/such/folder"), "x"), "");
  EXPECT_NE(WriteWholeFile("/dev/full", "x").find("space"), std::string::npos);
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
