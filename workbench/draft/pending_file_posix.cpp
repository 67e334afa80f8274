// File replacement on POSIX systems: the temporary is synced before the rename and the folder
// after it, and the new version keeps the permissions the user gave the old one.
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <utility>

#include "workbench/draft/pending_file.h"

namespace wb::draft {
namespace {

[[noreturn]] void Fail(const std::filesystem::path& path, const char* doing, int error) {
  FailOnFile(path, doing, std::error_code(error, std::generic_category()));
}

void WriteAll(int fd, std::string_view content, const std::filesystem::path& path) {
  while (!content.empty()) {
    const ssize_t written = write(fd, content.data(), content.size());
    if (written < 0 && errno == EINTR) continue;
    if (written < 0) Fail(path, "write", errno);
    content.remove_prefix(static_cast<std::size_t>(written));
  }
}

}  // namespace

void SyncFolder(const std::filesystem::path& folder) {
  const int fd = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (fd < 0) Fail(folder, "open the folder", errno);
  const int result = fsync(fd);
  const int error = errno;
  close(fd);
  if (result != 0) Fail(folder, "sync the folder", error);
}

PendingFile::PendingFile(const std::filesystem::path& target, std::string_view content) : target_(target) {
  int fd = -1;
  for (int attempt = 0; fd < 0; ++attempt) {
    temporary_ = TemporaryName(target);
    fd = open(temporary_.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
    if (fd < 0 && (errno != EEXIST || attempt == 8)) Fail(target, "write", errno);
  }
  try {
    struct stat old {};
    if (stat(target.c_str(), &old) == 0 && S_ISREG(old.st_mode)) fchmod(fd, old.st_mode & 07777);
    WriteAll(fd, content, target);
    if (fsync(fd) != 0) Fail(target, "sync", errno);
    const int closed = close(std::exchange(fd, -1));
    if (closed != 0) Fail(target, "write", errno);
  } catch (...) {
    if (fd >= 0) close(fd);
    unlink(temporary_.c_str());
    throw;
  }
}

PendingFile::~PendingFile() {
  if (!committed_) unlink(temporary_.c_str());
}

void PendingFile::Commit() {
  if (rename(temporary_.c_str(), target_.c_str()) != 0) Fail(target_, "replace", errno);
  committed_ = true;
}

}  // namespace wb::draft
