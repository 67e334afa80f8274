// On POSIX systems temporary files are locked with flock while their write runs. The kernel
// drops the lock when the process dies, which is how a later write tells the leftovers of a
// killed one from a write still running in another process.
#include "workbench/file_replacement.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <string>
#include <system_error>

#include "workbench/file_replacement_names.h"

namespace wb {
namespace {

constexpr int kCreateAttempts = 8;

[[noreturn]] void ThrowErrno(const char* doing) { throw std::system_error(errno, std::generic_category(), doing); }

bool SameFile(int fd, const std::filesystem::path& path) {
  struct stat opened {};
  struct stat named {};
  return fstat(fd, &opened) == 0 && stat(path.c_str(), &named) == 0 && opened.st_dev == named.st_dev &&
         opened.st_ino == named.st_ino;
}

void SyncFolder(const std::filesystem::path& folder) {
  const int fd = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (fd < 0) ThrowErrno("opening the folder to sync it");
  const int result = fsync(fd);
  const int error = errno;
  close(fd);
  if (result != 0) throw std::system_error(error, std::generic_category(), "syncing the folder");
}

}  // namespace

namespace replacement {

std::size_t NameLimit(const std::filesystem::path& folder) {
  constexpr long kUsual = 255;
  const long limit = pathconf(folder.c_str(), _PC_NAME_MAX);
  return static_cast<std::size_t>(limit > 0 ? limit : kUsual);
}

void RemoveIfStale(const std::filesystem::path& path) {
  const int fd = open(path.c_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC);
  if (fd < 0) return;
  struct stat status {};
  if (fstat(fd, &status) == 0 && S_ISREG(status.st_mode) && flock(fd, LOCK_EX | LOCK_NB) == 0) unlink(path.c_str());
  close(fd);
}

}  // namespace replacement

FileReplacement::FileReplacement(const std::filesystem::path& target, ReplacementStyle style)
    : target_(std::filesystem::absolute(target)), keepBackup_(style.keepBackup) {
  const replacement::TemporaryNames names(target_, style.suffix);
  for (int attempt = 1; lock_ < 0; ++attempt) {
    temporary_ = names.Next();
    const int fd = open(temporary_.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
    if (fd < 0 && (errno != EEXIST || attempt == kCreateAttempts)) ThrowErrno("creating a temporary file");
    if (fd < 0) continue;
    // Another write's clean-up can take the file for stale between its creation and the lock
    // and remove it; then the name no longer leads to this file and a new one is made. Where the
    // file system has no locks, no clean-up can lock it either.
    flock(fd, LOCK_EX);
    if (SameFile(fd, temporary_)) {
      lock_ = fd;
    } else {
      close(fd);
      if (attempt == kCreateAttempts) {
        throw std::system_error(EAGAIN, std::generic_category(), "creating a temporary file");
      }
    }
  }
  // The new version keeps the permissions the user gave the old one.
  struct stat old {};
  if (stat(target_.c_str(), &old) == 0 && S_ISREG(old.st_mode)) fchmod(lock_, old.st_mode & 07777);
}

FileReplacement::~FileReplacement() {
  if (lock_ < 0) return;
  if (!committed_) unlink(temporary_.c_str());
  close(lock_);
}

void FileReplacement::Write(std::string_view content) {
  while (!content.empty()) {
    const ssize_t written = write(lock_, content.data(), content.size());
    if (written < 0 && errno == EINTR) continue;
    if (written < 0) ThrowErrno("writing the new file");
    content.remove_prefix(static_cast<std::size_t>(written));
  }
}

void FileReplacement::Commit() {
  // Whatever wrote the content, it must be on disk before the name points to it.
  if (fsync(lock_) != 0) ThrowErrno("syncing the new file");
  struct stat old {};
  if (keepBackup_ && lstat(target_.c_str(), &old) == 0 && S_ISREG(old.st_mode)) {
    const std::filesystem::path backup = BackupPath(target_);
    if (unlink(backup.c_str()) != 0 && errno != ENOENT) ThrowErrno("replacing the backup copy");
    if (link(target_.c_str(), backup.c_str()) != 0) {
      // File systems without hard links get a copy.
      std::error_code error;
      std::filesystem::copy_file(target_, backup, std::filesystem::copy_options::overwrite_existing, error);
      if (error) throw std::system_error(error, "keeping the backup copy");
    }
  }
  if (rename(temporary_.c_str(), target_.c_str()) != 0) ThrowErrno("replacing the file");
  committed_ = true;
  SyncFolder(target_.parent_path());
}

}  // namespace wb
