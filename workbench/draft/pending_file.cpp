// The parts of file replacement that are the same on every system.
#include "workbench/draft/pending_file.h"

#include <cstdio>
#include <random>
#include <string>

#include "workbench/draft/sheet_files.h"

namespace wb::draft {

void FailOnFile(const std::filesystem::path& path, const char* doing, std::error_code error) {
  throw SheetFileError("cannot " + std::string(doing) + ' ' + path.string() + ": " + error.message());
}

std::filesystem::path FolderOf(const std::filesystem::path& path) {
  return path.has_parent_path() ? path.parent_path() : std::filesystem::path(".");
}

std::filesystem::path TemporaryName(const std::filesystem::path& target) {
  std::random_device random;
  char digits[17];
  std::snprintf(digits, sizeof digits, "%08x%08x", random(), random());
  return FolderOf(target) / ('.' + target.filename().string() + '.' + digits + ".tmp");
}

}  // namespace wb::draft
