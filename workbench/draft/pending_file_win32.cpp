// File replacement on Windows: the temporary is flushed before the rename, and the rename is
// written through, which is what syncing the folder does on POSIX systems. The new version takes
// the folder's inherited permissions, as any file made there does.
#include <windows.h>

#include <algorithm>

#include "workbench/draft/pending_file.h"

namespace wb::draft {
namespace {

std::error_code LastError() { return {static_cast<int>(GetLastError()), std::system_category()}; }

[[noreturn]] void Fail(const std::filesystem::path& path, const char* doing) { FailOnFile(path, doing, LastError()); }

}  // namespace

void SyncFolder(const std::filesystem::path&) {}

PendingFile::PendingFile(const std::filesystem::path& target, std::string_view content) : target_(target) {
  HANDLE file = INVALID_HANDLE_VALUE;
  for (int attempt = 0; file == INVALID_HANDLE_VALUE; ++attempt) {
    temporary_ = TemporaryName(target);
    file = CreateFileW(temporary_.c_str(), GENERIC_WRITE, 0, nullptr, CREATE_NEW, FILE_ATTRIBUTE_NORMAL, nullptr);
    if (file == INVALID_HANDLE_VALUE && (GetLastError() != ERROR_FILE_EXISTS || attempt == 8)) Fail(target, "write");
  }
  std::error_code error;
  const char* doing = "write";
  while (!error && !content.empty()) {
    const auto chunk = static_cast<DWORD>(std::min<std::size_t>(content.size(), 1U << 30));
    DWORD done = 0;
    if (WriteFile(file, content.data(), chunk, &done, nullptr) == 0) error = LastError();
    content.remove_prefix(done);
  }
  if (!error && FlushFileBuffers(file) == 0) {
    error = LastError();
    doing = "sync";
  }
  if (CloseHandle(file) == 0 && !error) error = LastError();
  if (error) {
    DeleteFileW(temporary_.c_str());
    FailOnFile(target, doing, error);
  }
}

PendingFile::~PendingFile() {
  if (!committed_) DeleteFileW(temporary_.c_str());
}

void PendingFile::Commit() {
  if (MoveFileExW(temporary_.c_str(), target_.c_str(), MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH) == 0) {
    Fail(target_, "replace");
  }
  committed_ = true;
}

}  // namespace wb::draft
