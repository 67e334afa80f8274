// The files of one 2D target: "<target>.dxf" and its preview "<target>.svg", replaced whole or
// with the new drawing merged into what the target already holds.
#pragma once

#include <filesystem>
#include <optional>
#include <stdexcept>

#include "workbench/draft/sheet.h"

namespace wb::draft {

// A target that cannot be written or merged into; its old files are left as they were.
class SheetFileError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

// Removes what writes of 2D files that were killed left in the folder: temporaries that no
// running write holds. Best effort.
void RemoveStaleSheetTemporaries(const std::filesystem::path& folder);

std::filesystem::path DxfPathOf(const std::filesystem::path& target);
std::filesystem::path SvgPathOf(const std::filesystem::path& target);

// The existing sheet with the added one's strokes and labels after its own. Layers meet by the
// name the DXF file shows (without regard to case); an added layer whose name the existing sheet
// does not use keeps its index when that is free, else takes the first free one, and keeps its
// name. Existing layer names are never changed. Throws SheetFileError when more than 256 layers
// would be needed.
Sheet MergeSheets(const Sheet& existing, const Sheet& added);

// Writes both files of target (a path without extension). Without overwrite, an existing
// "<target>.dxf" is read back and the sheet merged into it first. Each file is written under a
// temporary name in the same folder, synced and renamed over the old one, and the folder synced,
// so the target holds the old drawing or the new one, never part of one. Throws SheetFileError
// (the target in use by another user, a folder missing or not writable, an old file that cannot
// be merged into, a value no file can carry), leaving the old files and no temporary behind.
// When the sheet was merged into an old drawing and `before` is given, it receives that drawing.
void WriteSheetFiles(const Sheet& sheet, const std::filesystem::path& target, bool overwrite,
                     std::optional<Sheet>* before = nullptr);

}  // namespace wb::draft
