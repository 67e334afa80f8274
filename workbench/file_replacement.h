// A new version of a file, written under a temporary name in the same folder and then renamed
// over the old one, so that the path always holds one whole version. Drawing files and 2D files
// are both written this way.
#pragma once

#include <filesystem>
#include <string_view>

namespace wb {

// How the temporaries of one kind of file end (".saving" for drawings, ".tmp" for 2D files), and
// whether the version a save replaces is kept as its backup.
struct ReplacementStyle {
  std::string_view suffix;
  bool keepBackup = false;
};

class FileReplacement {
 public:
  // Creates the temporary file empty and holds a lock on it for as long as this object lives.
  // Temporaries of the same target left by writes that were killed are removed first: nobody
  // holds their lock any more. Throws std::system_error.
  FileReplacement(const std::filesystem::path& target, ReplacementStyle style);
  // Removes the temporary file unless committed.
  ~FileReplacement();
  FileReplacement(const FileReplacement&) = delete;
  FileReplacement& operator=(const FileReplacement&) = delete;

  // Absolute, so that nothing reads it as a URI.
  const std::filesystem::path& TemporaryPath() const { return temporary_; }

  // Writes the new version's content, for a caller that does not write it through the path.
  // Throws std::system_error.
  void Write(std::string_view content);

  // Syncs the temporary file, keeps the current file as the backup when the style asks for one,
  // renames the temporary over the target and syncs the folder so that the rename itself
  // survives a power cut. Throws std::system_error; the target is then untouched.
  void Commit();

 private:
  std::filesystem::path target_;
  std::filesystem::path temporary_;
  bool keepBackup_ = false;
#if defined(_WIN32)
  void* file_ = nullptr;  // the temporary's handle, held open without sharing while it is written
#else
  int lock_ = -1;  // the temporary's descriptor, locked
#endif
  bool committed_ = false;
};

// "<name>.bak" beside the target: the version a save replaced. A name too long for that keeps
// as much of itself as fits before ".bak".
std::filesystem::path BackupPath(const std::filesystem::path& target);

// Removes every temporary of the given suffix in the folder that no running write holds: what
// writes that were killed left behind. Best effort: what cannot be removed stays.
void RemoveStaleTemporaries(const std::filesystem::path& folder, std::string_view suffix);

}  // namespace wb
