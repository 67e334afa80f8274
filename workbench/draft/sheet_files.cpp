// Both files are serialized in memory and written to synced temporaries before either name is
// touched, so every failure that can be foreseen happens while the old files are still whole.
#include "workbench/draft/sheet_files.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <map>
#include <optional>
#include <random>
#include <sstream>
#include <string>
#include <system_error>
#include <utility>

#include "workbench/draft/dxf_reader.h"
#include "workbench/draft/dxf_writer.h"
#include "workbench/draft/file_lock.h"
#include "workbench/draft/svg_writer.h"

namespace wb::draft {
namespace {

[[noreturn]] void Fail(const std::filesystem::path& path, const char* doing, int error) {
  throw SheetFileError("cannot " + std::string(doing) + ' ' + path.string() + ": " +
                       std::generic_category().message(error));
}

std::filesystem::path FolderOf(const std::filesystem::path& path) {
  return path.has_parent_path() ? path.parent_path() : std::filesystem::path(".");
}

// ".<name>.<16 hex digits>.tmp" beside the target: hidden, and on the same file system, which
// is what makes the rename atomic.
std::filesystem::path TemporaryName(const std::filesystem::path& target) {
  std::random_device random;
  char digits[17];
  std::snprintf(digits, sizeof digits, "%08x%08x", random(), random());
  return FolderOf(target) / ('.' + target.filename().string() + '.' + digits + ".tmp");
}

void WriteAll(int fd, std::string_view content, const std::filesystem::path& path) {
  while (!content.empty()) {
    const ssize_t written = write(fd, content.data(), content.size());
    if (written < 0 && errno == EINTR) continue;
    if (written < 0) Fail(path, "write", errno);
    content.remove_prefix(static_cast<std::size_t>(written));
  }
}

void SyncFolder(const std::filesystem::path& folder) {
  const int fd = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (fd < 0) Fail(folder, "open the folder", errno);
  const int result = fsync(fd);
  const int error = errno;
  close(fd);
  if (result != 0) Fail(folder, "sync the folder", error);
}

// A new version of one file, complete and on disk under its temporary name until Commit.
class PendingFile {
 public:
  PendingFile(const std::filesystem::path& target, std::string_view content) : target_(target) {
    int fd = -1;
    for (int attempt = 0; fd < 0; ++attempt) {
      temporary_ = TemporaryName(target);
      fd = open(temporary_.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
      if (fd < 0 && (errno != EEXIST || attempt == 8)) Fail(target, "write", errno);
    }
    try {
      // The new version keeps the permissions the user gave the old one.
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
  ~PendingFile() {
    if (!committed_) unlink(temporary_.c_str());
  }
  PendingFile(const PendingFile&) = delete;
  PendingFile& operator=(const PendingFile&) = delete;

  void Commit() {
    if (rename(temporary_.c_str(), target_.c_str()) != 0) Fail(target_, "replace", errno);
    committed_ = true;
  }

 private:
  std::filesystem::path target_;
  std::filesystem::path temporary_;
  bool committed_ = false;
};

// Renaming a file over a folder fails; found before the first rename, it leaves both old files.
void RefuseFolderAt(const std::filesystem::path& path) {
  std::error_code ignored;
  if (std::filesystem::is_directory(std::filesystem::symlink_status(path, ignored))) Fail(path, "replace", EISDIR);
}

std::string Serialize(const SheetWriter& writer, const Sheet& sheet, const std::filesystem::path& path) {
  std::ostringstream out;
  try {
    writer.Write(sheet, out);
  } catch (const std::invalid_argument& error) {
    throw SheetFileError("cannot write " + path.string() + ": " + error.what());
  }
  return std::move(out).str();
}

Sheet SheetToWrite(const Sheet& sheet, const std::filesystem::path& dxfPath, bool overwrite,
                   std::optional<Sheet>* before) {
  std::error_code error;
  if (overwrite || !std::filesystem::exists(std::filesystem::symlink_status(dxfPath, error))) return sheet;
  try {
    Sheet existing = ReadDxfSheet(dxfPath);
    Sheet merged = MergeSheets(existing, sheet);
    if (before != nullptr) *before = std::move(existing);
    return merged;
  } catch (const DxfReadError& problem) {
    throw SheetFileError(std::string("cannot merge into ") + problem.what());
  }
}

}  // namespace

std::filesystem::path DxfPathOf(const std::filesystem::path& target) {
  std::filesystem::path path = target;
  return path += ".dxf";
}

std::filesystem::path SvgPathOf(const std::filesystem::path& target) {
  std::filesystem::path path = target;
  return path += ".svg";
}

Sheet MergeSheets(const Sheet& existing, const Sheet& added) {
  const std::array<bool, kSheetLayerCount> usedBefore = UsedLayers(existing);
  const std::array<bool, kSheetLayerCount> usedAdded = UsedLayers(added);
  std::map<std::string, int> existingByName;
  for (int i = 0; i < kSheetLayerCount; ++i) {
    if (usedBefore[static_cast<std::size_t>(i)]) existingByName.try_emplace(DxfNameKey(BaseDxfLayerName(existing, i)), i);
  }

  std::array<int, kSheetLayerCount> moved{};
  moved.fill(-1);
  std::array<bool, kSheetLayerCount> taken = usedBefore;
  for (int i = 0; i < kSheetLayerCount; ++i) {
    const auto slot = static_cast<std::size_t>(i);
    if (!usedAdded[slot]) continue;
    const auto same = existingByName.find(DxfNameKey(BaseDxfLayerName(added, i)));
    if (same != existingByName.end()) {
      moved[slot] = same->second;
    } else if (!taken[slot]) {
      moved[slot] = i;
      taken[slot] = true;
    }
  }
  Sheet merged = existing;
  for (int i = 0; i < kSheetLayerCount; ++i) {
    const auto slot = static_cast<std::size_t>(i);
    if (!usedAdded[slot]) continue;
    for (int free = 0; moved[slot] < 0 && free < kSheetLayerCount; ++free) {
      if (!taken[static_cast<std::size_t>(free)]) {
        moved[slot] = free;
        taken[static_cast<std::size_t>(free)] = true;
      }
    }
    if (moved[slot] < 0) throw SheetFileError("cannot merge: the drawings use more than 256 layers together");
    if (!usedBefore[static_cast<std::size_t>(moved[slot])]) {
      const std::string name = EffectiveLayerName(added, i);
      merged.layerNames[static_cast<std::size_t>(moved[slot])] = name == DefaultLayerName(moved[slot]) ? "" : name;
    }
  }

  for (Stroke stroke : added.strokes) {
    stroke.layer = static_cast<std::uint8_t>(moved[stroke.layer]);
    merged.strokes.push_back(stroke);
  }
  for (Label label : added.labels) {
    label.layer = static_cast<std::uint8_t>(moved[label.layer]);
    merged.labels.push_back(std::move(label));
  }
  return merged;
}

void WriteSheetFiles(const Sheet& sheet, const std::filesystem::path& target, bool overwrite,
                     std::optional<Sheet>* before) {
  if (before != nullptr) before->reset();
  const std::filesystem::path dxfPath = DxfPathOf(target);
  const std::filesystem::path svgPath = SvgPathOf(target);
  try {
    if (IsLockedByAnotherProcess(dxfPath)) throw SheetFileError(dxfPath.string() + " is in use by another user");
  } catch (const std::system_error& error) {
    throw SheetFileError(error.what());
  }
  const Sheet content = SheetToWrite(sheet, dxfPath, overwrite, before);
  const std::string dxf = Serialize(DxfWriter(), content, dxfPath);
  const std::string svg = Serialize(SvgWriter(), content, svgPath);
  RefuseFolderAt(dxfPath);
  RefuseFolderAt(svgPath);
  PendingFile newDxf(dxfPath, dxf);
  PendingFile newSvg(svgPath, svg);
  // The drawing first: should the preview's rename fail, the drawing is still the newest.
  newDxf.Commit();
  newSvg.Commit();
  SyncFolder(FolderOf(dxfPath));
}

}  // namespace wb::draft
