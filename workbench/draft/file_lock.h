// When a 2D target counts as "in use by another user": another process holds an advisory lock
// on its DXF file. Programs that keep the file open for editing take such a lock; FileLockGuard
// is how this one takes it.
#pragma once

#include <filesystem>

namespace wb::draft {

// True when some other process holds a read or a write lock on any part of the file: an open
// file description lock (fcntl F_OFD_SETLK) or a classic record lock (F_SETLK). Locks this
// process holds, through FileLockGuard or as record locks, do not count. A missing file, or a
// folder in its place, is not locked. Throws std::system_error when the file exists but cannot be opened to ask.
// Asking opens and closes the file, and closing any descriptor of a file drops the record locks
// the process holds on it: this process locks with FileLockGuard, never with record locks.
bool IsLockedByAnotherProcess(const std::filesystem::path& path);

// Holds an open file description lock on a whole existing file for as long as it lives; the
// kernel drops it when the process ends, however it ends. One guard per file and process: the
// lock answer above can only tell this process's lock from others' when there is one. A child
// forked without exec shares the guard's open file, and so its lock.
class FileLockGuard {
 public:
  enum class Mode { Shared, Exclusive };

  // Does not wait. Throws std::system_error when the file cannot be opened, when another
  // process holds a conflicting lock (EAGAIN), or when this process already guards the file
  // (EDEADLK).
  explicit FileLockGuard(const std::filesystem::path& path, Mode mode = Mode::Exclusive);
  ~FileLockGuard();
  FileLockGuard(const FileLockGuard&) = delete;
  FileLockGuard& operator=(const FileLockGuard&) = delete;

 private:
  int fd_ = -1;
};

}  // namespace wb::draft
