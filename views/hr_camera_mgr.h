// The list of the general cameras of the current drawing, by entity handle, and the one place
// that chooses which drawing the library works on.
#pragma once

#include <cstdint>
#include <vector>

#include "model/hr_object.h"
#include "shell/host/host_types.h"
#include "views/hr_camera.h"

class HRCameraMgr : public HRObject {
 public:
  HRCameraMgr();
  ~HRCameraMgr() override;

  // The virtual operations keep this order.
  virtual std::int32_t Add(HRCamera& camera);
  virtual std::int16_t AddCurrentView();
  virtual HRCamera GetCopy(std::int32_t index);
  virtual std::int32_t GetCount() const;
  virtual std::int16_t LoadAt(HRCamera& camera, std::int32_t index);
  virtual std::int16_t RemoveAt(std::int32_t index);
  virtual std::int16_t UpdateAt(HRCamera& camera, std::int32_t index);

  // Finds the general cameras of the current database again, in walk order.
  std::int16_t Reload();
  const std::vector<host::EntityHandle>& Handles() const { return cameras_; }

 private:
  bool ValidIndex(std::int32_t index) const { return index >= 0 && index < GetCount(); }

  std::vector<host::EntityHandle> cameras_;
};

// The manager of the loaded library; made on load, destroyed on unload.
void CreateCameraManager();
void DestroyCameraManager();
HRCameraMgr& CameraManager();

// Sets the current database and finds its cameras.
std::int16_t SetDatabase(host::DatabaseHandle database);
std::int32_t AddGeneralCamera(HRCamera& camera);
std::int32_t GetGeneralCameraCount();
std::int16_t LoadGeneralCamera(HRCamera& camera, std::int32_t index);
std::int16_t RemoveGeneralCamera(std::int32_t index);
std::int16_t UpdateGeneralCamera(HRCamera& camera, std::int32_t index);
