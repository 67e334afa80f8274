// The child locks, reports, and waits to be killed; it never returns into the test runner.
#include "tests/draft_output/locking_child.h"

#include <fcntl.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <optional>
#include <stdexcept>

#include "workbench/draft/file_lock.h"

namespace draft_output_samples {

LockingChild::LockingChild(const std::filesystem::path& path, Lock lock) {
  using wb::draft::FileLockGuard;
  int report[2];
  if (pipe2(report, O_CLOEXEC) != 0) throw std::runtime_error("no pipe");
  pid_ = fork();
  if (pid_ < 0) throw std::runtime_error("cannot fork");
  if (pid_ == 0) {
    try {
      std::optional<FileLockGuard> guard;
      struct flock range {};
      range.l_type = F_WRLCK;
      if (lock != Lock::RecordLock) {
        guard.emplace(path, lock == Lock::SharedGuard ? FileLockGuard::Mode::Shared : FileLockGuard::Mode::Exclusive);
      } else if (fcntl(open(path.c_str(), O_RDWR), F_SETLK, &range) != 0) {
        _exit(1);
      }
      if (write(report[1], "y", 1) == 1) {
        for (;;) pause();
      }
    } catch (...) {
    }
    _exit(1);
  }
  close(report[1]);
  char ready = 'n';
  const bool holds = read(report[0], &ready, 1) == 1;
  close(report[0]);
  if (!holds) {
    Release();
    throw std::runtime_error("the child could not lock " + path.string());
  }
}

LockingChild::~LockingChild() { Release(); }

void LockingChild::Release() {
  if (pid_ <= 0) return;
  kill(pid_, SIGKILL);
  waitpid(pid_, nullptr, 0);
  pid_ = -1;
}

}  // namespace draft_output_samples
