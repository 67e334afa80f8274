// Temporary files are named ".<name>.<16 hex digits>.saving" and locked with flock while their
// save runs. The kernel drops the lock when the process dies, which is how a later save tells
// the leftovers of a killed one from a save still running in another process.
#include "workbench/drawing_file_replace.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <random>
#include <string>
#include <string_view>
#include <system_error>

namespace wb::drawing_file {
namespace {

constexpr std::string_view kSuffix = ".saving";
constexpr std::size_t kRandomDigits = 16;
constexpr int kCreateAttempts = 8;

[[noreturn]] void ThrowErrno(const char* doing) { throw std::system_error(errno, std::generic_category(), doing); }

std::string TemporaryPrefix(const std::filesystem::path& target) {
  std::string prefix(1, '.');
  prefix.append(target.filename().string()).push_back('.');
  return prefix;
}

bool IsTemporaryOf(const std::string& name, const std::string& prefix) {
  return name.size() == prefix.size() + kRandomDigits + kSuffix.size() && name.starts_with(prefix) &&
         name.ends_with(kSuffix);
}

std::string RandomDigits() {
  std::random_device random;
  const std::uint64_t value = (std::uint64_t{random()} << 32) ^ random();
  char digits[kRandomDigits + 1];
  std::snprintf(digits, sizeof digits, "%016llx", static_cast<unsigned long long>(value));
  return digits;
}

void RemoveIfStale(const std::filesystem::path& path) {
  const int fd = open(path.c_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC);
  if (fd < 0) return;
  struct stat status {};
  if (fstat(fd, &status) == 0 && S_ISREG(status.st_mode) && flock(fd, LOCK_EX | LOCK_NB) == 0) unlink(path.c_str());
  close(fd);
}

// Best effort: a folder that cannot be listed leaves its leftovers, and the save goes on.
void RemoveStaleTemporaries(const std::filesystem::path& folder, const std::string& prefix) {
  std::error_code error;
  for (std::filesystem::directory_iterator entry(folder, error), end; !error && entry != end; entry.increment(error)) {
    if (IsTemporaryOf(entry->path().filename().string(), prefix)) RemoveIfStale(entry->path());
  }
}

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

std::filesystem::path BackupPath(const std::filesystem::path& target) {
  std::filesystem::path backup = target;
  backup += ".bak";
  return backup;
}

FileReplacement::FileReplacement(const std::filesystem::path& target) : target_(std::filesystem::absolute(target)) {
  const std::filesystem::path folder = target_.parent_path();
  const std::string prefix = TemporaryPrefix(target_);
  RemoveStaleTemporaries(folder, prefix);
  for (int attempt = 1; lock_ < 0; ++attempt) {
    temporary_ = folder / (prefix + RandomDigits() + std::string(kSuffix));
    const int fd = open(temporary_.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
    if (fd < 0 && (errno != EEXIST || attempt == kCreateAttempts)) ThrowErrno("creating a temporary file");
    if (fd < 0) continue;
    // Another save's clean-up can take the file for stale between its creation and the lock and
    // remove it; then the name no longer leads to this file and a new one is made. Where the file
    // system has no locks, no clean-up can lock it either.
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

void FileReplacement::Commit() {
  // Whatever wrote the content, it must be on disk before the name points to it.
  if (fsync(lock_) != 0) ThrowErrno("syncing the new file");
  struct stat old {};
  if (lstat(target_.c_str(), &old) == 0 && S_ISREG(old.st_mode)) {
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

}  // namespace wb::drawing_file
