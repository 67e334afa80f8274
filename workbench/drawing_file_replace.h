// A new version of a file, written under a temporary name in the same folder and then renamed
// over the old one, so that the path always holds one whole version.
#pragma once

#include <filesystem>

namespace wb::drawing_file {

class FileReplacement {
 public:
  // Creates the temporary file empty and holds a lock on it for as long as this object lives.
  // Temporaries of saves that were killed first are removed: nobody holds their lock any more.
  // Throws std::system_error.
  explicit FileReplacement(const std::filesystem::path& target);
  // Removes the temporary file unless committed.
  ~FileReplacement();
  FileReplacement(const FileReplacement&) = delete;
  FileReplacement& operator=(const FileReplacement&) = delete;

  // Absolute, so that nothing reads it as a URI.
  const std::filesystem::path& TemporaryPath() const { return temporary_; }

  // Syncs the temporary file, keeps the current file as the backup, renames the temporary
  // over the target and syncs the folder so that the rename itself survives a power cut.
  // Throws std::system_error; the target is then untouched.
  void Commit();

 private:
  std::filesystem::path target_;
  std::filesystem::path temporary_;
  int lock_ = -1;
  bool committed_ = false;
};

// "<name>.bak" beside the target: the version a save replaced.
std::filesystem::path BackupPath(const std::filesystem::path& target);

}  // namespace wb::drawing_file
