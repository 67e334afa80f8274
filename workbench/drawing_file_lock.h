// Keeps two programs from editing one drawing file at once: whoever changes a drawing holds an
// exclusive lock on it from reading it to saving it, whoever only reads it a shared one.
#pragma once

#include <chrono>
#include <filesystem>

namespace wb {

class DrawingFileLock {
 public:
  enum class Mode { Shared, Exclusive };

  // How long a command waits for another one to finish with the drawing before giving up.
  static constexpr std::chrono::milliseconds kPatience{5000};

  // Waits up to `patience` for conflicting holders to let go, then throws a DrawingFileError
  // (InUse) naming the file. A save replaces the file by renaming a new one over it, so a lock
  // won on the replaced file is given up and taken again on the new one. A file that cannot be
  // opened is not locked: opening it reports why. Locks are flock locks held through an open
  // file and dropped when it is closed or the process ends; a process takes one per file.
  DrawingFileLock(const std::filesystem::path& path, Mode mode, std::chrono::milliseconds patience = kPatience);
  ~DrawingFileLock();
  DrawingFileLock(const DrawingFileLock&) = delete;
  DrawingFileLock& operator=(const DrawingFileLock&) = delete;

 private:
  int fd_ = -1;
};

}  // namespace wb
