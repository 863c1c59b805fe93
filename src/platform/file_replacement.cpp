#include "platform/file_replacement.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <filesystem>
#include <system_error>

#include "platform/descriptor.h"
#include "platform/temporary_file.h"

namespace tessal {

namespace {

std::string Reason(std::string_view what, const std::string& path, int error) {
  std::string text(what);
  text += " '" + path + "': ";
  text += std::generic_category().message(error);
  return text;
}

/// Flushes to the disk. What is on no disk, a pipe or a terminal, is no failure.
bool Flush(int descriptor) {
  return fsync(descriptor) == 0 || errno == EINVAL || errno == ENOTSUP;
}

/// A content that is there as a whole.
TextSource Whole(std::string_view content) {
  return [content](const TextSink& write) {
    write(content);
    return true;
  };
}

/// Writes a content in pieces of some size. False, with the cause in `errno`, when one could not be written,
/// and those after it are dropped; and when the content could not be made.
bool WriteParts(int descriptor, const TextSource& content) {
  constexpr std::size_t kPiece = 1U << 16U;
  std::string piece;
  int error = 0;
  const auto write = [descriptor, &error](std::string_view bytes) {
    if (error == 0 && !WriteAll(descriptor, bytes)) error = errno;
  };
  const bool isWhole = content([&piece, &write](std::string_view part) {
    if (piece.size() + part.size() > kPiece) {
      write(piece);
      piece.clear();
    }
    if (part.size() > kPiece) {
      write(part);
    } else {
      piece += part;
    }
  });
  write(piece);
  errno = error;
  return isWhole && error == 0;
}

/// Writes everything and closes. The empty text, or what failed; `errno` then holds the cause.
template <class File>
std::string_view WriteAndClose(File& file, const TextSource& content) {
  if (!WriteParts(file.Number(), content)) return "can not write file";
  if (!Flush(file.Number())) return "can not flush file";
  if (!file.Close()) return "can not close file";
  return {};
}

/// The permissions that a new file gets where no old one gives them.
mode_t UsualMode() {
  constexpr mode_t kReadWriteForAll = 0666;
  const mode_t mask = umask(0);
  umask(mask);
  return kReadWriteForAll & ~mask;
}

/// What a file system refuses that knows no owners or permissions, or that leaves them to the superuser.
bool IsForOthersToDecide(int error) {
  return error == EPERM || error == ENOTSUP || error == ENOSYS;
}

/// Gives the new file the old one's owner and group, as far as that is allowed. Only the superuser may give
/// files away; for others it belongs to the one who saves, in the old group if they are a member of it.
bool TakeOwner(int descriptor, const struct stat& old, const struct stat& fresh) {
  constexpr uid_t kSameOwner = static_cast<uid_t>(-1);
  if (fresh.st_uid == old.st_uid && fresh.st_gid == old.st_gid) return true;
  if (fchown(descriptor, old.st_uid, old.st_gid) == 0) return true;
  if (!IsForOthersToDecide(errno)) return false;
  return fchown(descriptor, kSameOwner, old.st_gid) == 0 || IsForOthersToDecide(errno);
}

/// Gives the new file the owner and the permissions of the one at the target, or the usual permissions.
bool TakeAttributes(int descriptor, const std::string& target) {
  constexpr mode_t kPermissionBits = 07777;
  struct stat old = {};
  struct stat fresh = {};
  if (fstat(descriptor, &fresh) != 0) return false;
  mode_t mode = 0;
  if (lstat(target.c_str(), &old) == 0) {
    if (!TakeOwner(descriptor, old, fresh)) return false;
    mode = old.st_mode & kPermissionBits;
  } else {
    if (errno != ENOENT) return false;
    mode = UsualMode();
  }
  return mode == (fresh.st_mode & kPermissionBits) || fchmod(descriptor, mode) == 0 ||
         IsForOthersToDecide(errno);
}

/// Makes the rename itself last through a power failure. A folder that can not be opened or flushed as such
/// is no failure; a disk that refuses is.
bool FlushFolder(const std::filesystem::path& folder) {
  const Descriptor opened(open(folder.empty() ? "." : folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
  if (!opened.IsOpen() || fsync(opened.Number()) == 0) return true;
  return errno != EIO && errno != ENOSPC && errno != EDQUOT;
}

/// The file that a path means: where its symbolic links lead, also when nothing is there yet. Nothing,
/// with the error number, where that can not be found out.
std::optional<std::filesystem::path> RealTarget(const std::string& path, int& error) {
  constexpr int kMostLinks = 40;
  std::filesystem::path real = path;
  for (int links = 0; links <= kMostLinks; ++links) {
    std::error_code failure;
    const std::filesystem::path next = std::filesystem::read_symlink(real, failure);
    error = failure.value();
    if (error == EINVAL || error == ENOENT) return real;  // no link, or nothing there
    if (error != 0) return std::nullopt;
    real = real.parent_path() / next;
  }
  error = ELOOP;
  return std::nullopt;
}

/// Why a file may not take the place of what is there, or the empty text. A rename would pass over a write
/// protection, and would put a plain file in the place of a pipe or a device.
std::string Protection(const std::string& target, const struct stat& old) {
  if (S_ISDIR(old.st_mode)) return Reason("can not write file", target, EISDIR);
  if (!S_ISREG(old.st_mode)) return "can not replace '" + target + "': it is no plain file";
  if (access(target.c_str(), W_OK) != 0) return Reason("can not write file", target, errno);
  return {};
}

/// The same for a file that may have several names: the others would keep the old content from now on.
std::string ProtectionOfAllNames(const std::string& target) {
  struct stat old = {};
  if (stat(target.c_str(), &old) != 0) {
    return errno == ENOENT ? std::string() : Reason("can not write file", target, errno);
  }
  if (S_ISREG(old.st_mode) && old.st_nlink > 1) {
    return "can not replace '" + target + "': it is one of " + std::to_string(old.st_nlink) +
           " names (hard links) of a file, and the others would keep the old content; save under a new name";
  }
  return Protection(target, old);
}

/// The same for a file that others may have put there: what it leads to, or shares, is not touched.
std::string ProtectionOfName(const std::string& target) {
  struct stat old = {};
  if (lstat(target.c_str(), &old) != 0) {
    return errno == ENOENT ? std::string() : Reason("can not write file", target, errno);
  }
  return S_ISLNK(old.st_mode) ? "can not replace '" + target + "': it is a symbolic link"
                              : Protection(target, old);
}

/// Writes the content into the new file, lets it take its target's place, and flushes the folder. Returns the
/// empty text, or the reason.
std::string FillAndTakePlace(TemporaryFile& file, const std::filesystem::path& folder,
                             const std::string& shown, const TextSource& content) {
  std::string_view failed = WriteAndClose(file, content);
  if (failed.empty() && !file.TakePlace()) failed = "can not replace file";
  if (failed.empty() && !FlushFolder(folder)) failed = "can not flush the folder of file";
  return failed.empty() ? std::string() : Reason(failed, shown, errno);
}

/// Puts the content in the place of whatever has the name `target`; messages call it `shown`.
std::string PutInPlace(const std::filesystem::path& target, const std::string& shown,
                       const TextSource& content) {
  // Made before the file is replaced: nothing may fail after that.
  const std::filesystem::path folder = target.parent_path();
  RemoveTemporaryRests(target);
  TemporaryFile fresh(target);
  if (!fresh.IsOpen()) return Reason("can not create a file beside", shown, errno);
  if (!TakeAttributes(fresh.Number(), target.native())) {
    return Reason("can not keep the permissions of file", shown, errno);
  }
  return FillAndTakePlace(fresh, folder, shown, content);
}

std::string WriteStream(const std::string& path, const TextSource& content) {
  Descriptor stream(open(path.c_str(), O_WRONLY | O_NOCTTY | O_CLOEXEC));
  if (!stream.IsOpen()) return Reason("can not write file", path, errno);
  const std::string_view failed = WriteAndClose(stream, content);
  return failed.empty() ? std::string() : Reason(failed, path, errno);
}

}  // namespace

std::optional<std::string> ReadWholeFile(const std::string& path, std::string& failure) {
  constexpr std::size_t kPiece = 1U << 16U;
  std::error_code unknown;
  const auto type = std::filesystem::status(path, unknown).type();
  if (type == std::filesystem::file_type::character || type == std::filesystem::file_type::block) {
    // A device may have no end.
    failure = "can not read file '" + path + "': it is a device";
    errno = EINVAL;
    return std::nullopt;
  }
  const Descriptor file(open(path.c_str(), O_RDONLY | O_CLOEXEC));
  if (!file.IsOpen()) {
    failure = Reason("can not read file", path, errno);
    return std::nullopt;
  }
  std::string content;
  std::size_t size = FileSize(path);
  // Room for the whole, and for the read that finds its end.
  if (size <= kLargestFile) content.resize(std::exchange(size, 0) + kPiece);
  while (size <= kLargestFile) {
    if (size == content.size()) content.resize(size + size / 2);
    const ssize_t count = read(file.Number(), content.data() + size, content.size() - size);
    if (count == 0) {
      content.resize(size);
      return content;
    }
    if (count > 0) {
      size += static_cast<std::size_t>(count);
    } else if (errno != EINTR) {
      failure = Reason("can not read file", path, errno);
      return std::nullopt;
    }
  }
  failure = "can not read file '" + path + "': it is larger than " + std::to_string(kLargestFile) + " bytes";
  errno = EFBIG;
  return std::nullopt;
}

std::uintmax_t FileSize(const std::string& path) {
  std::error_code error;
  const std::uintmax_t size = std::filesystem::file_size(path, error);
  return error || access(path.c_str(), R_OK) != 0 ? 0 : size;
}

std::string WriteFreshFile(const std::string& path, std::string_view content) {
  const std::filesystem::path folder = std::filesystem::path(path).parent_path();
  RemoveTemporaryRests(path);
  TemporaryFile fresh(path);
  return fresh.IsOpen() ? FillAndTakePlace(fresh, folder, path, Whole(content))
                        : Reason("can not create a file beside", path, errno);
}

std::string ReplaceFile(const std::string& target, std::string_view content) {
  return ReplaceFile(target, Whole(content));
}

std::string ReplaceFile(const std::string& target, const TextSource& content) {
  int error = 0;
  const std::optional<std::filesystem::path> real = RealTarget(target, error);
  if (!real) return Reason("can not write file", target, error);
  std::string reason = ProtectionOfAllNames(real->native());
  return reason.empty() ? PutInPlace(*real, target, content) : reason;
}

bool IsStream(const std::string& path) {
  struct stat status = {};
  if (stat(path.c_str(), &status) != 0) return false;
  return S_ISCHR(status.st_mode) || S_ISFIFO(status.st_mode) || S_ISSOCK(status.st_mode);
}

std::string WriteOutputFile(const std::string& path, std::string_view content) {
  return WriteOutputFile(path, Whole(content));
}

std::string WriteOutputFile(const std::string& path, const TextSource& content) {
  if (IsStream(path)) return WriteStream(path, content);
  std::string reason = ProtectionOfName(path);
  return reason.empty() ? PutInPlace(path, path, content) : reason;
}

std::string RemoveFile(const std::string& path) {
  if (unlink(path.c_str()) == 0) return {};
  return Reason("can not remove file", path, errno);
}

}  // namespace tessal
