// Temporary files are named ".<name>.<16 hex digits><suffix>" and locked with flock while their
// write runs. The kernel drops the lock when the process dies, which is how a later write tells
// the leftovers of a killed one from a write still running in another process. Where a long
// name leaves no room for the rest, the name is cut: temporaries and backups must fit in a file
// name wherever their target does.
#include "workbench/file_replacement.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <random>
#include <string>
#include <system_error>

namespace wb {
namespace {

constexpr std::size_t kRandomDigits = 16;
constexpr int kCreateAttempts = 8;
constexpr std::string_view kBackupSuffix = ".bak";

[[noreturn]] void ThrowErrno(const char* doing) { throw std::system_error(errno, std::generic_category(), doing); }

// The longest file name the folder's file system takes.
std::size_t NameLimit(const std::filesystem::path& folder) {
  constexpr long kUsual = 255;
  const long limit = pathconf(folder.c_str(), _PC_NAME_MAX);
  return static_cast<std::size_t>(limit > 0 ? limit : kUsual);
}

// At most `bytes` bytes of the name, cut between characters, never inside one.
std::string CutTo(std::string name, std::size_t bytes) {
  if (name.size() <= bytes) return name;
  while (bytes > 0 && (static_cast<unsigned char>(name[bytes]) & 0xC0) == 0x80) --bytes;
  name.resize(bytes);
  return name;
}

std::string TemporaryPrefix(const std::filesystem::path& target, std::string_view suffix) {
  const std::size_t room = NameLimit(target.parent_path()) - 2 - kRandomDigits - suffix.size();
  return '.' + CutTo(target.filename().string(), room) + '.';
}

// ".<name>.<16 hex digits><suffix>"
bool IsTemporary(std::string_view name, std::string_view suffix) {
  if (name.size() < 2 + kRandomDigits + suffix.size() || !name.starts_with('.') || !name.ends_with(suffix)) {
    return false;
  }
  name.remove_suffix(suffix.size());
  const std::string_view digits = name.substr(name.size() - kRandomDigits);
  return digits.find_first_not_of("0123456789abcdef") == std::string_view::npos &&
         name[name.size() - kRandomDigits - 1] == '.';
}

// A temporary of the target whose temporaries start with the prefix.
bool IsTemporaryOf(std::string_view name, std::string_view suffix, std::string_view prefix) {
  return name.size() == prefix.size() + kRandomDigits + suffix.size() && name.starts_with(prefix) &&
         IsTemporary(name, suffix);
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

// The temporaries the test picks out, when no running write holds them.
template <typename Pick>
void RemoveStale(const std::filesystem::path& folder, Pick pick) {
  std::error_code error;
  for (std::filesystem::directory_iterator entry(folder, error), end; !error && entry != end; entry.increment(error)) {
    if (pick(entry->path().filename().string())) RemoveIfStale(entry->path());
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
  const std::size_t room = NameLimit(target.parent_path()) - kBackupSuffix.size();
  return target.parent_path() / (CutTo(target.filename().string(), room) + std::string(kBackupSuffix));
}

void RemoveStaleTemporaries(const std::filesystem::path& folder, std::string_view suffix) {
  RemoveStale(folder, [suffix](std::string_view name) { return IsTemporary(name, suffix); });
}

FileReplacement::FileReplacement(const std::filesystem::path& target, ReplacementStyle style)
    : target_(std::filesystem::absolute(target)), keepBackup_(style.keepBackup) {
  const std::filesystem::path folder = target_.parent_path();
  const std::string prefix = TemporaryPrefix(target_, style.suffix);
  RemoveStale(folder, [&](std::string_view name) { return IsTemporaryOf(name, style.suffix, prefix); });
  for (int attempt = 1; lock_ < 0; ++attempt) {
    temporary_ = folder / (prefix + RandomDigits() + std::string(style.suffix));
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
