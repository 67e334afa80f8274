// Locks drawing files with flock, polling so that a command waits only as long as it was told.
#include "workbench/drawing_file_lock.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <string>
#include <thread>

#include "workbench/drawing_file.h"

namespace wb {
namespace {

constexpr std::chrono::milliseconds kPoll{20};

// Whether the path still leads to the open file.
bool StillNamed(int fd, const std::filesystem::path& path) {
  struct stat opened {};
  struct stat named {};
  return fstat(fd, &opened) == 0 && stat(path.c_str(), &named) == 0 && opened.st_dev == named.st_dev &&
         opened.st_ino == named.st_ino;
}

std::string Seconds(std::chrono::milliseconds span) {
  const auto tenths = span.count() / 100;
  return std::to_string(tenths / 10) + (tenths % 10 != 0 ? "." + std::to_string(tenths % 10) : "") + " s";
}

}  // namespace

DrawingFileLock::DrawingFileLock(const std::filesystem::path& path, Mode mode, std::chrono::milliseconds patience) {
  const int operation = (mode == Mode::Exclusive ? LOCK_EX : LOCK_SH) | LOCK_NB;
  const auto deadline = std::chrono::steady_clock::now() + patience;
  for (;;) {
    // Non-blocking, so that a named pipe in the drawing's place is not waited on.
    const int fd = open(path.c_str(), O_RDONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC);
    if (fd < 0) return;
    bool locked = false;
    for (;;) {
      if (flock(fd, operation) == 0) {
        locked = true;
        break;
      }
      // A file system without locks cannot keep programs apart; the edit goes on as before.
      if (errno != EWOULDBLOCK && errno != EINTR) break;
      if (std::chrono::steady_clock::now() >= deadline) {
        close(fd);
        throw DrawingFileError(DrawingFileError::Reason::InUse,
                               "drawing file " + path.string() + " is in use by another program (waited " +
                                   Seconds(patience) + "); nothing was changed, try again when it has finished");
      }
      std::this_thread::sleep_for(kPoll);
    }
    if (!locked || StillNamed(fd, path)) {
      fd_ = fd;
      return;
    }
    close(fd);
  }
}

DrawingFileLock::~DrawingFileLock() {
  if (fd_ >= 0) close(fd_);
}

}  // namespace wb
