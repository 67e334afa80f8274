// The child takes its lock, reports one byte and blocks reading a pipe; the parent closing its
// end is the signal to exit. The child leaves with _exit so that nothing of the test runner's
// state (at-exit handlers, buffered output) runs twice.
#include "tests/draft_output/locking_child.h"

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <stdexcept>

#include "workbench/draft/file_lock.h"

namespace draft_output_samples {
namespace {

void HoldUntilReleased(int report, int release) {
  const char ready = 'y';
  if (write(report, &ready, 1) != 1) _exit(2);
  char ignored;
  while (read(release, &ignored, 1) > 0) {
  }
}

[[noreturn]] void RunChild(const std::filesystem::path& path, LockingChild::Lock lock, int report, int release) {
  using wb::draft::FileLockGuard;
  try {
    if (lock == LockingChild::Lock::RecordLock) {
      const int fd = open(path.c_str(), O_RDWR);
      struct flock range {};
      range.l_type = F_WRLCK;
      range.l_whence = SEEK_SET;
      if (fd < 0 || fcntl(fd, F_SETLK, &range) != 0) _exit(1);
      HoldUntilReleased(report, release);
    } else {
      const FileLockGuard guard(path, lock == LockingChild::Lock::SharedGuard ? FileLockGuard::Mode::Shared
                                                                             : FileLockGuard::Mode::Exclusive);
      HoldUntilReleased(report, release);
    }
  } catch (...) {
    _exit(1);
  }
  _exit(0);
}

}  // namespace

LockingChild::LockingChild(const std::filesystem::path& path, Lock lock) {
  int report[2];
  int release[2];
  if (pipe2(report, O_CLOEXEC) != 0 || pipe2(release, O_CLOEXEC) != 0) throw std::runtime_error("no pipes");
  pid_ = fork();
  if (pid_ < 0) throw std::runtime_error("cannot fork");
  if (pid_ == 0) {
    close(report[0]);
    close(release[1]);
    RunChild(path, lock, report[1], release[0]);
  }
  close(report[1]);
  close(release[0]);
  toChild_ = release[1];
  char ready = 'n';
  const bool holds = read(report[0], &ready, 1) == 1 && ready == 'y';
  close(report[0]);
  if (!holds) {
    Release();
    throw std::runtime_error("the child could not lock " + path.string());
  }
}

LockingChild::~LockingChild() { Release(); }

void LockingChild::Release() {
  if (pid_ <= 0) return;
  close(toChild_);
  int status = 0;
  waitpid(pid_, &status, 0);
  pid_ = -1;
}

}  // namespace draft_output_samples
