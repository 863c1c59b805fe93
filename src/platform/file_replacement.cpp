#include "platform/file_replacement.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <system_error>
#include <utility>

namespace tessal {

namespace {

std::string Reason(std::string_view what, const std::string& path, int error) {
  std::string text(what);
  text += " '" + path + "': ";
  text += std::generic_category().message(error);
  return text;
}

/// An open file descriptor. Closing it is a step that can fail, so it is told apart from letting go.
class Descriptor final {
 public:
  explicit Descriptor(int number) : descriptor(number) {}
  Descriptor(const Descriptor&) = delete;
  Descriptor& operator=(const Descriptor&) = delete;
  ~Descriptor() {
    if (descriptor >= 0) close(descriptor);
  }

  bool IsOpen() const { return descriptor >= 0; }
  int Number() const { return descriptor; }
  bool Close() { return close(std::exchange(descriptor, -1)) == 0; }

 private:
  int descriptor;
};

bool WriteAll(int descriptor, std::string_view content) {
  while (!content.empty()) {
    const ssize_t written = write(descriptor, content.data(), content.size());
    if (written < 0) {
      if (errno == EINTR) continue;
      return false;
    }
    content.remove_prefix(static_cast<std::size_t>(written));
  }
  return true;
}

/// The permissions that a new file gets where no old one gives them.
mode_t UsualMode() {
  constexpr mode_t kReadWriteForAll = 0666;
  const mode_t mask = umask(0);
  umask(mask);
  return kReadWriteForAll & ~mask;
}

/// Gives the new file the old one's permissions and, as far as that is allowed, its owner.
bool TakeAttributes(int descriptor, const std::string& target) {
  struct stat old = {};
  if (stat(target.c_str(), &old) != 0) return fchmod(descriptor, UsualMode()) == 0;
  struct stat fresh = {};
  if (fstat(descriptor, &fresh) != 0) return false;
  if (fresh.st_uid != old.st_uid || fresh.st_gid != old.st_gid) {
    // Only the superuser may give files away; for others the file becomes the one who saves it.
    if (fchown(descriptor, old.st_uid, old.st_gid) != 0 && errno != EPERM) return false;
  }
  constexpr mode_t kPermissionBits = 07777;
  return fchmod(descriptor, old.st_mode & kPermissionBits) == 0;
}

/// Makes the rename itself last through a power failure. A file system that cannot do so is no failure.
void FlushFolder(const std::filesystem::path& folder) {
  const Descriptor opened(open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
  if (opened.IsOpen()) fsync(opened.Number());
}

/// The file that a path means, through symbolic links; the path itself when there is none yet.
std::filesystem::path RealTarget(const std::string& path) {
  std::error_code error;
  std::filesystem::path real = std::filesystem::weakly_canonical(path, error);
  return error ? std::filesystem::path(path) : real;
}

/// Why an existing target may not be written, or the empty text. A rename would pass over a write protection.
std::string Protection(const std::string& target) {
  if (access(target.c_str(), F_OK) != 0) return {};
  if (access(target.c_str(), W_OK) != 0) return Reason("can not write file", target, errno);
  std::error_code error;
  if (std::filesystem::is_directory(target, error)) return Reason("can not write file", target, EISDIR);
  return {};
}

}  // namespace

std::optional<std::string> ReadWholeFile(const std::string& path, std::string& failure) {
  std::error_code unknown;
  const auto type = std::filesystem::status(path, unknown).type();
  if (type == std::filesystem::file_type::character || type == std::filesystem::file_type::block) {
    // A device may have no end.
    failure = "can not read file '" + path + "': it is a device";
    return std::nullopt;
  }
  std::ifstream file(path, std::ios::binary);
  std::ostringstream content;
  if (!file) {
    failure = Reason("can not read file", path, errno);
    return std::nullopt;
  }
  if (file.peek() != std::ifstream::traits_type::eof()) content << file.rdbuf();
  if (file.bad() || content.fail()) {
    failure = Reason("can not read file", path, errno != 0 ? errno : EIO);
    return std::nullopt;
  }
  return std::move(content).str();
}

std::uintmax_t FileSize(const std::string& path) {
  std::error_code error;
  const std::uintmax_t size = std::filesystem::file_size(path, error);
  return error || access(path.c_str(), R_OK) != 0 ? 0 : size;
}

std::string WriteWholeFile(const std::string& path, std::string_view content) {
  constexpr mode_t kReadWriteForAll = 0666;
  Descriptor file(open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, kReadWriteForAll));
  if (!file.IsOpen()) return Reason("can not open file for writing", path, errno);
  if (WriteAll(file.Number(), content) && fsync(file.Number()) == 0 && file.Close()) return {};
  return Reason("can not write file", path, errno);
}

std::string ReplaceFile(const std::string& target, std::string_view content) {
  const std::filesystem::path real = RealTarget(target);
  if (std::string reason = Protection(real.string()); !reason.empty()) return reason;
  std::string fresh = real.string() + "$XXXXXX";
  Descriptor file(mkostemp(fresh.data(), O_CLOEXEC));
  if (!file.IsOpen()) return Reason("can not create a file beside", target, errno);
  const bool written = WriteAll(file.Number(), content) && TakeAttributes(file.Number(), real.string()) &&
                       fsync(file.Number()) == 0 && file.Close();
  if (!written || rename(fresh.c_str(), real.c_str()) != 0) {
    const int error = errno;
    unlink(fresh.c_str());
    return Reason(written ? "can not replace file" : "can not write file", target, error);
  }
  FlushFolder(real.parent_path());
  return {};
}

std::string RemoveFile(const std::string& path) {
  if (unlink(path.c_str()) == 0) return {};
  return Reason("can not remove file", path, errno);
}

}  // namespace tessal
