// The host session: drawings by database handle, the current drawing, the loaded plug-in.
#include "workbench/workbench.h"

#include <stdexcept>
#include <utility>

#include "shell/host/argument_blocks.h"
#include "workbench/argument_blocks.h"

namespace wb {

Workbench& Workbench::Get() {
  static Workbench session;
  return session;
}

Workbench::Workbench() { Reset(); }

void Workbench::Reset() {
  // Faults first, so a plug-in's detach is not failed by a rule left over from a test.
  faults_.Clear();
  UnloadPlugin();
  drawings_.clear();
  nextDatabase_ = 1;
  cachedDatabase_ = 0;
  cachedDrawing_ = nullptr;
  records_.Clear();
  journal_.Clear();
  memory_.Clear();
  cameraManagerOn_ = false;
  commandLines_.clear();
  commandLineRunner_ = nullptr;
  output2D_.Reset();
  drawingPaths_.clear();
  // After the blocks are zeroed: view and display publish the values the host keeps in them.
  ResetArgumentBlocks();
  view_.Reset();
  display_.Reset();
  SetCurrent(Open(Drawing{}));
}

void Workbench::AddCommandLine(std::string commandLine) {
  commandLines_.push_back(commandLine);
  if (commandLineRunner_) commandLineRunner_(commandLine);
}

std::string Workbench::DrawingPath(host::DatabaseHandle database) const {
  const auto found = drawingPaths_.find(database);
  return found != drawingPaths_.end() ? found->second : std::string();
}

host::DatabaseHandle Workbench::Open(Drawing drawing) {
  const host::DatabaseHandle handle = nextDatabase_++;
  drawings_.emplace(handle, std::move(drawing));
  return handle;
}

void Workbench::Close(host::DatabaseHandle database) {
  if (drawings_.erase(database) == 0) return;
  records_.CloseAllOf(database);
  if (cachedDatabase_ == database) cachedDrawing_ = nullptr;
  if (db.handle == database) db.handle = 0;
}

Drawing* Workbench::FindAndCache(host::DatabaseHandle database) {
  auto found = drawings_.find(database);
  if (found == drawings_.end()) return nullptr;
  cachedDatabase_ = database;
  cachedDrawing_ = &found->second;
  return cachedDrawing_;
}

void Workbench::SetCurrent(host::DatabaseHandle database) {
  if (Find(database) == nullptr)
    throw std::out_of_range("no open drawing has database handle " + std::to_string(database));
  db.handle = database;
}

host::DatabaseHandle Workbench::Current() const { return db.handle; }

Drawing& Workbench::CurrentDrawing() {
  Drawing* drawing = Find(db.handle);
  if (drawing == nullptr) throw std::logic_error("no drawing is current");
  return *drawing;
}

void Workbench::LoadPlugin(const PluginExports& exports) {
  UnloadPlugin();
  plugin_ = exports;
  if (plugin_.attach != nullptr) plugin_.attach();
}

void Workbench::UnloadPlugin() {
  // Cleared before detach runs, so a detach that calls back into the host sees no plug-in.
  const PluginExports unloading = std::exchange(plugin_, PluginExports{});
  if (unloading.detach != nullptr) unloading.detach();
}

bool Workbench::RunPluginEntry() {
  if (plugin_.entry == nullptr) return false;
  plugin_.entry();
  return true;
}

}  // namespace wb
