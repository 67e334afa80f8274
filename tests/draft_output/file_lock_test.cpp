// The "in use by another user" rule: another process's lock counts while it is held and not
// after; this process's own lock never counts; a missing file is free.
#include "workbench/draft/file_lock.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <fstream>
#include <system_error>

#include "tests/draft_output/locking_child.h"
#include "tests/drawing_file/scratch_folder.h"

namespace {

using draft_output_samples::LockingChild;
using wb::draft::FileLockGuard;
using wb::draft::IsLockedByAnotherProcess;

class FileLock : public ::testing::Test {
 protected:
  void SetUp() override { std::ofstream(file_) << "0\nEOF\n"; }

  // The error number a guard fails with, or 0 when it is taken.
  static int GuardError(const std::filesystem::path& path, FileLockGuard::Mode mode) {
    try {
      const FileLockGuard guard(path, mode);
      return 0;
    } catch (const std::system_error& error) {
      return error.code().value();
    }
  }

  drawing_file_samples::ScratchFolder folder_;
  const std::filesystem::path file_ = folder_ / "plan.dxf";
};

TEST_F(FileLock, AnotherProcesssLockCountsWhileItIsHeld) {
  for (const auto lock : {LockingChild::Lock::SharedGuard, LockingChild::Lock::ExclusiveGuard,
                          LockingChild::Lock::RecordLock}) {
    EXPECT_FALSE(IsLockedByAnotherProcess(file_));
    LockingChild child(file_, lock);
    EXPECT_TRUE(IsLockedByAnotherProcess(file_)) << static_cast<int>(lock);
    child.Release();
    EXPECT_FALSE(IsLockedByAnotherProcess(file_)) << static_cast<int>(lock);
  }
}

TEST_F(FileLock, ThisProcesssOwnLockDoesNotCount) {
  {
    const FileLockGuard guard(file_, FileLockGuard::Mode::Exclusive);
    EXPECT_FALSE(IsLockedByAnotherProcess(file_));
  }
  // Both hold read locks; the other one still counts. (The child comes first: a forked child
  // shares the open files of its parent, guards included.)
  LockingChild child(file_, LockingChild::Lock::SharedGuard);
  const FileLockGuard guard(file_, FileLockGuard::Mode::Shared);
  EXPECT_TRUE(IsLockedByAnotherProcess(file_));
  child.Release();
  EXPECT_FALSE(IsLockedByAnotherProcess(file_));
}

TEST_F(FileLock, AMissingFileOrAFolderIsNotLocked) {
  EXPECT_FALSE(IsLockedByAnotherProcess(folder_ / "missing.dxf"));
  EXPECT_FALSE(IsLockedByAnotherProcess(file_ / "below a file.dxf"));
  EXPECT_FALSE(IsLockedByAnotherProcess(folder_.Path()));
}

TEST_F(FileLock, AConflictingLockIsRefusedWithoutWaiting) {
  {
    LockingChild child(file_, LockingChild::Lock::ExclusiveGuard);
    EXPECT_EQ(GuardError(file_, FileLockGuard::Mode::Shared), EAGAIN);
    EXPECT_EQ(GuardError(file_, FileLockGuard::Mode::Exclusive), EAGAIN);
  }
  {
    LockingChild child(file_, LockingChild::Lock::SharedGuard);
    EXPECT_EQ(GuardError(file_, FileLockGuard::Mode::Shared), 0);
    EXPECT_EQ(GuardError(file_, FileLockGuard::Mode::Exclusive), EAGAIN);
  }
  EXPECT_EQ(GuardError(file_, FileLockGuard::Mode::Exclusive), 0);
}

TEST_F(FileLock, OneGuardPerFileAndProcess) {
  {
    const FileLockGuard guard(file_, FileLockGuard::Mode::Shared);
    EXPECT_EQ(GuardError(file_, FileLockGuard::Mode::Shared), EDEADLK);
    // Through another name it is still the same file.
    std::filesystem::create_hard_link(file_, folder_ / "alias.dxf");
    EXPECT_EQ(GuardError(folder_ / "alias.dxf", FileLockGuard::Mode::Shared), EDEADLK);
  }
  EXPECT_EQ(GuardError(file_, FileLockGuard::Mode::Shared), 0);
  EXPECT_EQ(GuardError(folder_ / "missing.dxf", FileLockGuard::Mode::Shared), ENOENT);
}

TEST_F(FileLock, AReleasedGuardLetsOthersLock) {
  { const FileLockGuard guard(file_, FileLockGuard::Mode::Exclusive); }
  LockingChild child(file_, LockingChild::Lock::ExclusiveGuard);
  EXPECT_TRUE(IsLockedByAnotherProcess(file_));
}

}  // namespace
