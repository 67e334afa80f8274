// A new version of a file, written whole under a temporary name beside it and renamed into
// place, so that a reader finds the old version or the new one, never part of one.
#pragma once

#include <filesystem>
#include <string_view>
#include <system_error>

namespace wb::draft {

// Throws SheetFileError "cannot <doing> <path>: <reason>".
[[noreturn]] void FailOnFile(const std::filesystem::path& path, const char* doing, std::error_code error);

// The folder a file is in; "." for a bare name.
std::filesystem::path FolderOf(const std::filesystem::path& path);

// ".<name>.<16 hex digits>.tmp" beside the target: hidden, and on the same file system, which
// is what makes the rename atomic.
std::filesystem::path TemporaryName(const std::filesystem::path& target);

// The new version, complete and on disk under its temporary name until Commit; dropped without
// Commit, it leaves nothing behind.
class PendingFile {
 public:
  // Throws SheetFileError when the temporary cannot be made, written or synced.
  PendingFile(const std::filesystem::path& target, std::string_view content);
  ~PendingFile();
  PendingFile(const PendingFile&) = delete;
  PendingFile& operator=(const PendingFile&) = delete;

  // Renames the new version over the target. Throws SheetFileError.
  void Commit();

 private:
  std::filesystem::path target_;
  std::filesystem::path temporary_;
  bool committed_ = false;
};

// Makes the renames done in the folder durable. Throws SheetFileError.
void SyncFolder(const std::filesystem::path& folder);

}  // namespace wb::draft
