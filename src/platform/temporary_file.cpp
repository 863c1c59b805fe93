#include "platform/temporary_file.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <charconv>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string_view>

namespace tessal {

namespace {

constexpr std::string_view kPlaceholders = "XXXXXX";

/// The FNV-1a hash of 64 bits (Fowler, Noll and Vo, 1991): the same in every build, unlike `std::hash`.
std::uint64_t Hash(std::string_view text) {
  constexpr std::uint64_t kOffsetBasis = 0xcbf29ce484222325U;
  constexpr std::uint64_t kPrime = 0x100000001b3U;
  std::uint64_t hash = kOffsetBasis;
  for (const char character : text) hash = (hash ^ static_cast<unsigned char>(character)) * kPrime;
  return hash;
}

/// The part of a temporary name that is the same for all files of one target.
std::string NameStart(const std::filesystem::path& target) {
  constexpr int kHexadecimal = 16;
  std::array<char, sizeof(std::uint64_t) * 2> digits{};
  const auto written = std::to_chars(digits.data(), digits.data() + digits.size(),
                                     Hash(target.filename().native()), kHexadecimal);
  return ".tessal-" + std::string(digits.data(), written.ptr) + '-';
}

/// Takes the lock at once. A file system without locks gives none, and then nobody removes rests there.
bool Lock(int descriptor) {
  return flock(descriptor, LOCK_EX | LOCK_NB) == 0 || errno != EWOULDBLOCK;
}

/// Whether the file is one that a maker with our rights has left, and no longer writes. The lock is then
/// ours.
bool IsRest(int descriptor, uid_t targetOwner) {
  struct stat status = {};
  if (fstat(descriptor, &status) != 0 || !S_ISREG(status.st_mode)) return false;
  if (status.st_uid != geteuid() && status.st_uid != targetOwner) return false;
  return flock(descriptor, LOCK_EX | LOCK_NB) == 0;
}

void RemoveRest(const std::string& path, uid_t targetOwner) {
  // Somebody may have put a link or a pipe there: neither is followed or waited for.
  const Descriptor rest(open(path.c_str(), O_RDWR | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC));
  if (rest.IsOpen() && IsRest(rest.Number(), targetOwner)) unlink(path.c_str());
}

}  // namespace

TemporaryFile::TemporaryFile(const std::filesystem::path& targetPath) : target(targetPath.native()) {
  constexpr int kMostTries = 100;
  const std::string pattern = (targetPath.parent_path() / (NameStart(targetPath) += kPlaceholders)).native();
  for (int tries = 0; tries < kMostTries; ++tries) {
    if (Make(pattern)) return;
  }
}

TemporaryFile::~TemporaryFile() {
  if (!path.empty()) unlink(path.c_str());
}

bool TemporaryFile::Make(const std::string& pattern) {
  path = pattern;
  lock = Descriptor(mkostemp(path.data(), O_CLOEXEC));
  if (!lock.IsOpen()) {
    path.clear();
    return true;
  }
  struct stat status = {};
  if (!Lock(lock.Number()) || fstat(lock.Number(), &status) != 0 || status.st_nlink == 0) {
    unlink(path.c_str());
    path.clear();
    errno = EBUSY;
    return false;
  }
  // The lock lives as long as one descriptor of this opening does.
  file = Descriptor(fcntl(lock.Number(), F_DUPFD_CLOEXEC, 0));
  return true;
}

bool TemporaryFile::TakePlace() {
  if (rename(path.c_str(), target.c_str()) != 0) return false;
  path.clear();
  return true;
}

void RemoveTemporaryRests(const std::filesystem::path& target) {
  const std::string start = NameStart(target);
  const std::filesystem::path folder = target.has_parent_path() ? target.parent_path() : ".";
  struct stat status = {};
  const uid_t owner = lstat(target.c_str(), &status) == 0 ? status.st_uid : geteuid();
  // Not the library's iterator, whose constructor ends the process when there is no memory.
  const std::unique_ptr<DIR, int (*)(DIR*)> listing(opendir(folder.c_str()), closedir);
  while (const dirent* entry = listing ? readdir(listing.get()) : nullptr) {
    const std::string_view name = entry->d_name;
    if (name.size() == start.size() + kPlaceholders.size() && name.starts_with(start)) {
      RemoveRest((folder / name).native(), owner);
    }
  }
}

}  // namespace tessal
