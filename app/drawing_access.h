// Reading a drawing file, and changing one from reading to saving, while other pandex commands
// are kept from changing it in between.
#pragma once

#include <filesystem>
#include <functional>

#include "workbench/drawing.h"

namespace app {

// Opens the drawing under a shared lock: no other command saves it while it is read.
wb::Drawing ReadDrawing(const std::filesystem::path& path);

// Opens the drawing with the plug-in loaded, runs the edit and saves the drawing back, all
// under an exclusive lock, so that two commands editing one drawing at once both keep their
// changes. Throws wb::DrawingFileError when another command holds the drawing for too long.
void EditDrawing(const std::filesystem::path& path, const std::function<void()>& edit);

}  // namespace app
