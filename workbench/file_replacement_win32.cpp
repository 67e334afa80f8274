// On Windows a temporary is held open without sharing while its write runs, so it cannot be
// deleted then: a temporary that can be deleted is the leftover of a write that was killed. The
// handle is closed for the rename, and the rename is written through, which is what syncing the
// folder does on POSIX systems. The new version takes the folder's inherited permissions.
#include <windows.h>

#include <algorithm>
#include <string>
#include <system_error>

#include "workbench/file_replacement.h"
#include "workbench/file_replacement_names.h"

namespace wb {
namespace {

constexpr int kCreateAttempts = 8;

[[noreturn]] void ThrowLastError(const char* doing) {
  throw std::system_error(static_cast<int>(GetLastError()), std::system_category(), doing);
}

}  // namespace

namespace replacement {

// NTFS and FAT take 255 characters; counting bytes of UTF-8 stays within that.
std::size_t NameLimit(const std::filesystem::path&) { return 255; }

void RemoveIfStale(const std::filesystem::path& path) { DeleteFileW(path.c_str()); }

}  // namespace replacement

FileReplacement::FileReplacement(const std::filesystem::path& target, ReplacementStyle style)
    : target_(std::filesystem::absolute(target)), keepBackup_(style.keepBackup) {
  const replacement::TemporaryNames names(target_, style.suffix);
  for (int attempt = 1; file_ == nullptr; ++attempt) {
    temporary_ = names.Next();
    HANDLE file = CreateFileW(temporary_.c_str(), GENERIC_READ | GENERIC_WRITE, 0, nullptr, CREATE_NEW,
                              FILE_ATTRIBUTE_NORMAL, nullptr);
    if (file != INVALID_HANDLE_VALUE) {
      file_ = file;
    } else if (GetLastError() != ERROR_FILE_EXISTS || attempt == kCreateAttempts) {
      ThrowLastError("creating a temporary file");
    }
  }
}

FileReplacement::~FileReplacement() {
  if (file_ != nullptr) CloseHandle(file_);
  if (!committed_) DeleteFileW(temporary_.c_str());
}

void FileReplacement::Write(std::string_view content) {
  while (!content.empty()) {
    const auto chunk = static_cast<DWORD>(std::min<std::size_t>(content.size(), std::size_t{1} << 30));
    DWORD written = 0;
    if (WriteFile(file_, content.data(), chunk, &written, nullptr) == 0) ThrowLastError("writing the new file");
    content.remove_prefix(written);
  }
}

void FileReplacement::Commit() {
  // Whatever wrote the content, it must be on disk before the name points to it.
  if (FlushFileBuffers(file_) == 0) ThrowLastError("syncing the new file");
  // A write that starts for the same target between the close and the rename can take the
  // temporary for stale; the rename then fails and the target is untouched.
  CloseHandle(file_);
  file_ = nullptr;
  const DWORD attributes = GetFileAttributesW(target_.c_str());
  if (keepBackup_ && attributes != INVALID_FILE_ATTRIBUTES && (attributes & FILE_ATTRIBUTE_DIRECTORY) == 0 &&
      CopyFileW(target_.c_str(), BackupPath(target_).c_str(), FALSE) == 0) {
    ThrowLastError("keeping the backup copy");
  }
  if (MoveFileExW(temporary_.c_str(), target_.c_str(), MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH) == 0) {
    ThrowLastError("replacing the file");
  }
  committed_ = true;
}

}  // namespace wb
