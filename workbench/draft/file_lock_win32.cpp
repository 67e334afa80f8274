// Whether a 2D target is in use on Windows: another program holds it open without sharing, or
// holds a byte-range lock on it. The Windows host only asks; it never holds a guard itself, so
// FileLockGuard is not built here.
#include <windows.h>

#include <system_error>

#include "workbench/draft/file_lock.h"

namespace wb::draft {

bool IsLockedByAnotherProcess(const std::filesystem::path& path) {
  const DWORD attributes = GetFileAttributesW(path.c_str());
  // A missing file, or a folder in its place, is nobody's drawing.
  if (attributes == INVALID_FILE_ATTRIBUTES || (attributes & FILE_ATTRIBUTE_DIRECTORY) != 0) return false;
  HANDLE file = CreateFileW(path.c_str(), GENERIC_READ, FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE,
                            nullptr, OPEN_EXISTING, FILE_ATTRIBUTE_NORMAL, nullptr);
  if (file == INVALID_HANDLE_VALUE) {
    const DWORD error = GetLastError();
    if (error == ERROR_SHARING_VIOLATION) return true;
    if (error == ERROR_FILE_NOT_FOUND || error == ERROR_PATH_NOT_FOUND) return false;
    throw std::system_error(static_cast<int>(error), std::system_category(),
                            "asking whether " + path.string() + " is locked");
  }
  // A lock on the whole file, however long it grows, is refused while anyone locks any part.
  OVERLAPPED whole{};
  const bool free = LockFileEx(file, LOCKFILE_EXCLUSIVE_LOCK | LOCKFILE_FAIL_IMMEDIATELY, 0, MAXDWORD, MAXDWORD,
                               &whole) != 0;
  if (free) UnlockFileEx(file, 0, MAXDWORD, MAXDWORD, &whole);
  CloseHandle(file);
  return !free;
}

}  // namespace wb::draft
