// A child process that holds a lock on a file until it is told to let go: the "other user" of
// the lock tests.
#pragma once

#include <sys/types.h>

#include <filesystem>

namespace draft_output_samples {

class LockingChild {
 public:
  enum class Lock { SharedGuard, ExclusiveGuard, RecordLock };

  // Returns once the child holds the lock; throws std::runtime_error when it could not take it.
  LockingChild(const std::filesystem::path& path, Lock lock);
  // Lets go and waits for the child, if that has not happened yet.
  ~LockingChild();
  LockingChild(const LockingChild&) = delete;
  LockingChild& operator=(const LockingChild&) = delete;

  // The child ends, which is what drops its lock; returns when it is gone.
  void Release();

 private:
  pid_t pid_ = -1;
};

}  // namespace draft_output_samples
