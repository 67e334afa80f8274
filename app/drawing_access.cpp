// Drawing files opened and saved under the drawing lock.
#include "app/drawing_access.h"

#include "app/plugin_session.h"
#include "workbench/drawing_file.h"
#include "workbench/drawing_file_lock.h"

namespace app {

wb::Drawing ReadDrawing(const std::filesystem::path& path) {
  const wb::DrawingFileLock lock(path, wb::DrawingFileLock::Mode::Shared);
  return wb::OpenDrawingFile(path);
}

void EditDrawing(const std::filesystem::path& path, const std::function<void()>& edit) {
  const wb::DrawingFileLock lock(path, wb::DrawingFileLock::Mode::Exclusive);
  const PluginSession session(wb::OpenDrawingFile(path));
  edit();
  wb::SaveDrawingFile(session.Drawing(), path);
}

}  // namespace app
