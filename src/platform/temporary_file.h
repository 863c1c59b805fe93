// The file that takes a target's place when it is complete. Its name is a fixed short one, so that it fits
// wherever the target's does, says by a hash which target it is for, and ends in letters that nobody can
// guess. It is locked as long as its maker lives, so that what a killed maker left can be told from a file
// that is being written.
#pragma once

#include <filesystem>
#include <string>

#include "platform/descriptor.h"

namespace tessal {

/// A new file in the target's folder that only its owner may read. It is removed unless it has taken the
/// target's place.
class TemporaryFile final {
 public:
  /// Not open, with the cause in `errno`, when it could not be made.
  explicit TemporaryFile(const std::filesystem::path& target);
  TemporaryFile(const TemporaryFile&) = delete;
  TemporaryFile& operator=(const TemporaryFile&) = delete;
  ~TemporaryFile();

  bool IsOpen() const { return file.IsOpen(); }
  int Number() const { return file.Number(); }

  /// Closes what was written; the lock stays. False, with `errno`, when not all of it could be written.
  bool Close() { return file.Close(); }

  /// Puts the file in the place of whatever has the target's name. False, with `errno`, if that fails.
  bool TakePlace();

 private:
  /// Makes the file, or gives up. False when another saver met the file before it was locked, and took it for
  /// a rest.
  bool Make(const std::string& pattern);

  std::string target;
  std::string path;
  Descriptor file;
  Descriptor lock;
};

/// Removes the temporary files that killed makers have left for this target. A file that is locked, that is
/// no plain file, or that belongs to somebody else stays.
void RemoveTemporaryRests(const std::filesystem::path& target);

}  // namespace tessal
