// A section's or plan's own cameras: the handle list on the owner's record and the camera
// entities behind it.
#include "views/owned_cameras.h"

#include "model/current_database.h"
#include "model/status_codes.h"
#include "shell/host/qeldll.h"

host::EntityHandle OwnedCameras::HandleAt(std::int32_t index) const {
  if (index < 0 || static_cast<std::size_t>(index) >= handles_.size()) return 0;
  return handles_[static_cast<std::size_t>(index)];
}

void OwnedCameras::ReadList(const HRPrimitive& owner) {
  std::int32_t count = 0;
  std::int32_t* list = nullptr;
  handles_.clear();
  if (owner.ReadLongVectorAttribute(listKey_, &count, &list) == 0 && list != nullptr && count > 0) {
    handles_.assign(list, list + count);
  }
  if (list != nullptr) log_free(list);
}

void OwnedCameras::WriteList(const HRPrimitive& owner, bool removeWhenEmpty) const {
  if (!handles_.empty()) {
    owner.SetLongVectorAttribute(listKey_, static_cast<std::int32_t>(handles_.size()), handles_.data());
  } else if (removeWhenEmpty) {
    owner.RemoveAttribute(listKey_);
  }
}

std::int32_t OwnedCameras::Add(const HRPrimitive& owner, const std::string& name) {
  HRCamera camera;
  const std::int16_t captured = camera.CaptureView();
  camera.SetName(name);
  camera.SetClassName(cameraClass_);
  if (captured != 0 || camera.Create() != 0) return 0;
  const auto index = static_cast<std::int32_t>(handles_.size());
  handles_.push_back(camera.GetHandle());
  WriteList(owner, false);
  return index;
}

std::int16_t OwnedCameras::Remove(const HRPrimitive& owner, std::int32_t index) {
  if (index < 0 || static_cast<std::size_t>(index) >= handles_.size()) return model_status::kHeaderNotRead;
  HRCamera camera;
  const std::int16_t loaded = camera.Load(handles_[static_cast<std::size_t>(index)]);
  handles_.erase(handles_.begin() + index);
  WriteList(owner, true);
  return loaded == 0 ? camera.Delete() : loaded;
}

void OwnedCameras::DeleteAll(host::DatabaseHandle database) {
  for (const host::EntityHandle handle : handles_) {
    HRCamera camera;
    camera.SetHandle(handle);
    camera.DeleteIn(database);
  }
  handles_.clear();
}

std::int16_t OwnedCameras::Save(std::int32_t index, HRCamera& camera) const {
  camera.SetHandle(HandleAt(index));
  return camera.SaveTo(GetCurrentDatabase());
}

std::string OwnedCameras::NameAt(std::int32_t index) const {
  HRCamera camera;
  return Load(index, camera) == 0 ? camera.GetName() : std::string();
}

std::uint16_t OwnedCameras::IsFor2D(std::int32_t index) const {
  HRCamera camera;
  return Load(index, camera) == 0 ? camera.IsFor2D() : 0;
}

void OwnedCameras::Rename(std::int32_t index, const std::string& name) const {
  HRCamera camera;
  if (Load(index, camera) != 0) return;
  camera.SetName(name);
  camera.Save();
}

void OwnedCameras::SetFor2D(std::int32_t index, std::int16_t for2D) const {
  HRCamera camera;
  if (Load(index, camera) != 0) return;
  camera.SetFor2D(for2D);
  camera.Save();
}
