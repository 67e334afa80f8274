// Both files are serialized in memory and written to synced temporaries before either name is
// touched, so every failure that can be foreseen happens while the old files are still whole.
#include "workbench/draft/sheet_files.h"

#include <cerrno>
#include <map>
#include <memory>
#include <optional>
#include <sstream>
#include <string>
#include <system_error>
#include <utility>

#include "workbench/draft/dxf_reader.h"
#include "workbench/draft/dxf_writer.h"
#include "workbench/draft/file_lock.h"
#include "workbench/draft/svg_writer.h"
#include "workbench/file_replacement.h"

namespace wb::draft {
namespace {

[[noreturn]] void Fail(const std::filesystem::path& path, const char* doing, int error) {
  throw SheetFileError("cannot " + std::string(doing) + ' ' + path.string() + ": " +
                       std::generic_category().message(error));
}

// Renaming a file over a folder fails; found before the first rename, it leaves both old files.
void RefuseFolderAt(const std::filesystem::path& path) {
  std::error_code ignored;
  if (std::filesystem::is_directory(std::filesystem::symlink_status(path, ignored))) Fail(path, "replace", EISDIR);
}

constexpr ReplacementStyle kSheetReplacement{".tmp", false};

// The new version of one file, complete and synced under its temporary name.
std::unique_ptr<FileReplacement> Prepared(const std::filesystem::path& path, std::string_view content) {
  try {
    auto file = std::make_unique<FileReplacement>(path, kSheetReplacement);
    file->Write(content);
    return file;
  } catch (const std::system_error& error) {
    Fail(path, "write", error.code().value());
  }
}

void Commit(FileReplacement& file, const std::filesystem::path& path) {
  try {
    file.Commit();
  } catch (const std::system_error& error) {
    Fail(path, "replace", error.code().value());
  }
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

void RemoveStaleSheetTemporaries(const std::filesystem::path& folder) {
  RemoveStaleTemporaries(folder, kSheetReplacement.suffix);
}

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
  const std::unique_ptr<FileReplacement> newDxf = Prepared(dxfPath, dxf);
  const std::unique_ptr<FileReplacement> newSvg = Prepared(svgPath, svg);
  // The drawing first: should the preview's rename fail, the drawing is still the newest.
  Commit(*newDxf, dxfPath);
  Commit(*newSvg, svgPath);
}

}  // namespace wb::draft
