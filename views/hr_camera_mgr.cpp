// The camera manager: finds general cameras by walking the drawing and keeps their handles.
#include "views/hr_camera_mgr.h"

#include <memory>

#include "model/current_database.h"
#include "model/status_codes.h"
#include "shell/host/qeldll.h"

namespace {
std::unique_ptr<HRCameraMgr> manager;
}

HRCameraMgr::HRCameraMgr() : HRObject("HRCameraMgr") {}

HRCameraMgr::~HRCameraMgr() = default;

std::int32_t HRCameraMgr::Add(HRCamera& camera) {
  const std::int16_t created = camera.CreateIn(GetCurrentDatabase());
  write_to_record(camera.GetHandle(), 1);
  write_to_record(-1, -1);
  if (created != 0) return created;
  cameras_.push_back(camera.GetHandle());
  return GetCount() - 1;
}

std::int16_t HRCameraMgr::AddCurrentView() {
  HRCamera camera;
  camera.CaptureView();
  const std::int16_t created = camera.CreateIn(GetCurrentDatabase());
  if (created == 0) cameras_.push_back(camera.GetHandle());
  return created;
}

HRCamera HRCameraMgr::GetCopy(std::int32_t index) {
  HRCamera camera;
  LoadAt(camera, index);
  return camera.Copy(camera);
}

std::int32_t HRCameraMgr::GetCount() const { return static_cast<std::int32_t>(cameras_.size()); }

// Indices outside the list answer the failure the same call would give for a missing entity,
// rather than reading past the list.
std::int16_t HRCameraMgr::LoadAt(HRCamera& camera, std::int32_t index) {
  if (!ValidIndex(index)) return model_status::kHeaderNotRead;
  return camera.LoadFrom(GetCurrentDatabase(), cameras_[static_cast<std::size_t>(index)]);
}

std::int16_t HRCameraMgr::RemoveAt(std::int32_t index) {
  if (!ValidIndex(index)) return model_status::kNotDeleted;
  HRCamera camera;
  camera.SetHandle(cameras_[static_cast<std::size_t>(index)]);
  if (const std::int16_t result = camera.DeleteIn(GetCurrentDatabase()); result != 0) return result;
  cameras_.erase(cameras_.begin() + index);
  return 0;
}

std::int16_t HRCameraMgr::UpdateAt(HRCamera& camera, std::int32_t index) {
  if (!ValidIndex(index)) return model_status::kRecordNotOpened;
  camera.SetHandle(cameras_[static_cast<std::size_t>(index)]);
  return camera.SaveTo(GetCurrentDatabase());
}

std::int16_t HRCameraMgr::Reload() {
  const host::DatabaseHandle database = GetCurrentDatabase();
  cameras_.clear();
  host::EntityHandle entity = 0;
  std::int32_t cursor = 0;
  host::EntityHeader header{};
  while (loop_on_database_blank_h(database, &entity, &cursor, &header) == host::kOk) {
    if (header.bytes[host::kHeaderType] != host::kTypeGroup) continue;
    HRCamera camera;
    if (camera.LoadFrom(database, entity) == 0 && camera.IsCamera()) cameras_.push_back(entity);
  }
  return 0;
}

void CreateCameraManager() { manager = std::make_unique<HRCameraMgr>(); }
void DestroyCameraManager() { manager.reset(); }
HRCameraMgr& CameraManager() { return *manager; }

std::int16_t SetDatabase(host::DatabaseHandle database) {
  SetCurrentDatabase(database);
  return CameraManager().Reload();
}

std::int32_t AddGeneralCamera(HRCamera& camera) { return CameraManager().Add(camera); }
std::int32_t GetGeneralCameraCount() { return CameraManager().GetCount(); }
std::int16_t LoadGeneralCamera(HRCamera& camera, std::int32_t index) { return CameraManager().LoadAt(camera, index); }
std::int16_t RemoveGeneralCamera(std::int32_t index) { return CameraManager().RemoveAt(index); }
std::int16_t UpdateGeneralCamera(HRCamera& camera, std::int32_t index) {
  return CameraManager().UpdateAt(camera, index);
}
