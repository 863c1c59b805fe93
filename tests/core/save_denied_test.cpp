// Saves that the system refuses: no room, no permission. Each runs in a process of its own, with fewer
// rights.
#include <gtest/gtest.h>
#include <sys/mount.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <filesystem>
#include <fstream>

#include "core/error_registry.h"
#include "core/loaded_template.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::ReadFile;

constexpr int kSaved = 0;
constexpr int kRefusedWithReason = 1;
constexpr int kRefusedInSilence = 2;

/// Saves a loaded template in a child process behind `restrain`; what became of it.
template <class Restrain>
int SaveInChild(LoadedTemplate& loaded, Restrain restrain) {
  const pid_t child = fork();
  if (child == 0) {
    restrain();
    Errors().ClearErrors();
    if (loaded->SaveWrapper(loaded.Path())) _exit(kSaved);
    _exit(Errors().GetErrorCount(3) > 0 ? kRefusedWithReason : kRefusedInSilence);
  }
  int status = 0;
  waitpid(child, &status, 0);
  return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

class DeniedSave : public ::testing::Test {
 protected:
  DeniedSave()
      : loaded(test::RandomTemplate(4, 40)),
        before(ReadFile(loaded.Path())),
        folder(std::filesystem::path(loaded.Path()).parent_path()) {}

  ~DeniedSave() override { chmod(folder.c_str(), 0700); }

  /// The superuser writes everywhere: the child becomes nobody, who owns nothing.
  void TakeRights(mode_t folderMode, mode_t fileMode) {
    constexpr uid_t kNobody = 65534;
    chmod(folder.c_str(), folderMode);
    chmod(loaded.Path().c_str(), fileMode);
    if (geteuid() == 0) {
      ASSERT_EQ(chown(folder.c_str(), kNobody, kNobody) | chown(loaded.Path().c_str(), kNobody, kNobody), 0);
    }
  }
  static void BecomeNobody() {
    constexpr uid_t kNobody = 65534;
    if (geteuid() == 0 && setuid(kNobody) != 0) _exit(99);
  }

  void ExpectUntouched() {
    EXPECT_EQ(ReadFile(loaded.Path()), before);
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder), {}), 1) << "nothing is left behind";
  }

  LoadedTemplate loaded;
  std::string before;
  std::filesystem::path folder;
};

TEST_F(DeniedSave, NoRoomForTheFile) {
  for (const rlim_t room : {rlim_t{0}, rlim_t{1}, rlim_t{before.size() / 2}}) {
    const int outcome = SaveInChild(loaded, [room] {
      std::signal(SIGXFSZ, SIG_IGN);
      const rlimit limit{room, room};
      setrlimit(RLIMIT_FSIZE, &limit);
    });
    EXPECT_EQ(outcome, kRefusedWithReason) << room;
    ExpectUntouched();
  }
}

TEST_F(DeniedSave, AFolderThatMayNotBeWritten) {
  TakeRights(0500, 0600);
  EXPECT_EQ(SaveInChild(loaded, BecomeNobody), kRefusedWithReason);
  ExpectUntouched();
}

TEST_F(DeniedSave, AFileThatMayNotBeWritten) {
  TakeRights(0700, 0400);
  EXPECT_EQ(SaveInChild(loaded, BecomeNobody), kRefusedWithReason);
  ExpectUntouched();
  TakeRights(0700, 0600);
  EXPECT_EQ(SaveInChild(loaded, BecomeNobody), kSaved);
}

TEST_F(DeniedSave, AFileOfAnotherUser) {
  if (geteuid() != 0) GTEST_SKIP() << "only the superuser makes files of others";
  constexpr uid_t kNobody = 65534;
  TakeRights(0700, 0644);
  ASSERT_EQ(chown(loaded.Path().c_str(), 0, 0), 0);
  EXPECT_EQ(SaveInChild(loaded, BecomeNobody), kRefusedWithReason) << "only its owner may write it";
  ExpectUntouched();
  // One that all may write becomes the file of who saves it, as open to others as before.
  ASSERT_EQ(chmod(loaded.Path().c_str(), 0666), 0);
  EXPECT_EQ(SaveInChild(loaded, BecomeNobody), kSaved);
  struct stat saved = {};
  ASSERT_EQ(stat(loaded.Path().c_str(), &saved), 0);
  EXPECT_EQ(saved.st_uid, kNobody);
  EXPECT_EQ(saved.st_mode & 07777, 0666U);
  EXPECT_NE(ReadFile(loaded.Path()), before);
  // The superuser leaves the file with its owner.
  EXPECT_EQ(SaveInChild(loaded, [] {}), kSaved);
  ASSERT_EQ(stat(loaded.Path().c_str(), &saved), 0);
  EXPECT_EQ(saved.st_uid, kNobody);
}

TEST_F(DeniedSave, ASmallDiskThatRunsFull) {
  const test::TemporaryFolder mountPoint;
  const std::string path = mountPoint.File("small.tessal");
  // Room for the old file and for one, two or three quarters, and all of the next.
  for (const std::size_t quarters : {1U, 2U, 3U, 4U, 6U}) {
    const std::string room = "size=" + std::to_string(before.size() * (4 + quarters) / 4);
    if (mount("tmpfs", mountPoint.Path().c_str(), "tmpfs", 0, room.c_str()) != 0)
      GTEST_SKIP() << "no file systems of our own here";
    std::ofstream(path, std::ios::binary) << before;
    TemplateCore core;
    EXPECT_TRUE(core.LoadWrapper(path));
    Errors().ClearErrors();
    EXPECT_FALSE(core.SaveWrapper(path));
    EXPECT_NE(test::Messages().find("No space left"), std::string::npos) << test::Messages();
    EXPECT_EQ(ReadFile(path), before);
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(mountPoint.Path()), {}), 1);
    EXPECT_EQ(umount(mountPoint.Path().c_str()), 0);
  }
}

}  // namespace
}  // namespace tessal
