// Open file description locks belong to an open file, not to a process, so a lock query made
// through a new descriptor would see this process's own guard as a stranger's. The guards are
// therefore kept by file identity, and a query goes through the guard's own descriptor, from
// which its lock is invisible.
#include "workbench/draft/file_lock.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <map>
#include <mutex>
#include <system_error>
#include <utility>

namespace wb::draft {
namespace {

using FileId = std::pair<dev_t, ino_t>;

std::mutex guardsMutex;
std::map<FileId, int> guardDescriptors;  // by the file each guard locks

struct stat StatusOf(int fd) {
  struct stat status {};
  if (fstat(fd, &status) != 0) {
    const int error = errno;
    throw std::system_error(error, std::generic_category(), "identifying a locked file");
  }
  return status;
}

FileId IdOf(const struct stat& status) { return {status.st_dev, status.st_ino}; }

// The whole file, however long it grows.
struct flock WholeFile(short type) {
  struct flock range {};
  range.l_type = type;
  range.l_whence = SEEK_SET;
  return range;
}

class Descriptor {
 public:
  explicit Descriptor(int fd) : fd_(fd) {}
  ~Descriptor() {
    if (fd_ >= 0) close(fd_);
  }
  Descriptor(const Descriptor&) = delete;
  Descriptor& operator=(const Descriptor&) = delete;
  int Get() const { return fd_; }
  int Release() { return std::exchange(fd_, -1); }

 private:
  int fd_;
};

}  // namespace

bool IsLockedByAnotherProcess(const std::filesystem::path& path) {
  const Descriptor file(open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK));
  if (file.Get() < 0) {
    const int error = errno;
    if (error == ENOENT || error == ENOTDIR) return false;
    throw std::system_error(error, std::generic_category(), "asking whether " + path.string() + " is locked");
  }
  // Drawings are regular files; a folder or a device in their place is nobody's drawing.
  const struct stat status = StatusOf(file.Get());
  if (!S_ISREG(status.st_mode)) return false;
  struct flock query = WholeFile(F_WRLCK);
  {
    const std::lock_guard lock(guardsMutex);
    const auto guard = guardDescriptors.find(IdOf(status));
    const int probe = guard == guardDescriptors.end() ? file.Get() : guard->second;
    if (fcntl(probe, F_OFD_GETLK, &query) != 0) {
      const int error = errno;
      throw std::system_error(error, std::generic_category(), "asking whether " + path.string() + " is locked");
    }
  }
  if (query.l_type == F_UNLCK) return false;
  // An open file description lock answers -1; a record lock names the process that holds it.
  return query.l_pid != getpid();
}

FileLockGuard::FileLockGuard(const std::filesystem::path& path, Mode mode) {
  const bool exclusive = mode == Mode::Exclusive;
  // A write lock needs a descriptor open for writing.
  Descriptor file(open(path.c_str(), (exclusive ? O_RDWR : O_RDONLY) | O_CLOEXEC | O_NOCTTY | O_NONBLOCK));
  if (file.Get() < 0) {
    const int error = errno;
    throw std::system_error(error, std::generic_category(), "opening " + path.string() + " to lock it");
  }
  const std::lock_guard lock(guardsMutex);
  const FileId id = IdOf(StatusOf(file.Get()));
  if (guardDescriptors.contains(id)) {
    throw std::system_error(EDEADLK, std::generic_category(), path.string() + " is already locked by this process");
  }
  struct flock request = WholeFile(exclusive ? F_WRLCK : F_RDLCK);
  if (fcntl(file.Get(), F_OFD_SETLK, &request) != 0) {
    const int error = errno == EACCES ? EAGAIN : errno;
    throw std::system_error(error, std::generic_category(), path.string() + " is in use by another user");
  }
  fd_ = file.Release();
  guardDescriptors.emplace(id, fd_);
}

FileLockGuard::~FileLockGuard() {
  const std::lock_guard lock(guardsMutex);
  std::erase_if(guardDescriptors, [this](const auto& entry) { return entry.second == fd_; });
  // Closing the only descriptor of the open file description releases its lock.
  close(fd_);
}

}  // namespace wb::draft
