// Drawing files: a whole drawing saved to one SQLite database file and opened from it again.
#pragma once

#include <filesystem>
#include <stdexcept>
#include <string>

#include "workbench/drawing.h"

namespace wb {

// Why a drawing file could not be opened or saved. The message is one line a user can read
// and names the file.
class DrawingFileError : public std::runtime_error {
 public:
  enum class Reason : std::uint8_t {
    CannotRead,    // missing, a folder, no permission
    NotADrawing,   // empty, text, another program's database
    Damaged,       // a drawing file whose content does not hold together
    NewerVersion,  // written by a later Pandex in a format this one does not know
    CannotWrite,   // the save failed; the previous file is untouched
    InUse,         // another program holds the drawing locked (see DrawingFileLock)
  };

  DrawingFileError(Reason reason, const std::string& message) : std::runtime_error(message), reason_(reason) {}
  Reason GetReason() const { return reason_; }

 private:
  Reason reason_;
};

// Replaces the file atomically: after a crash at any moment the path holds either the previous
// drawing or this one, and the previous version stays beside it as "<name>.bak". A path that is
// a symbolic link saves to the file the link leads to (its backup beside that file). Refuses
// (CannotWrite) a drawing that OpenDrawingFile would refuse, so every saved file opens again.
void SaveDrawingFile(const Drawing& drawing, const std::filesystem::path& path);

// Reads the whole drawing without changing the file. Anything damaged or foreign is refused
// with a DrawingFileError; nothing half-read is ever returned.
Drawing OpenDrawingFile(const std::filesystem::path& path);

}  // namespace wb
