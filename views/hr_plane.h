// A plan view: a horizontal cut at a base point, kept on a group entity, with its own cameras
// ("hrPlnCam" entities listed under "@pln_cams=").
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "model/hr_group.h"
#include "model/hr_object.h"
#include "views/hr_camera.h"
#include "views/owned_cameras.h"

class HRPlane : public HRObject {
 public:
  HRPlane();
  ~HRPlane() override;

  // The virtual operations keep this order.
  virtual void DefineFromPoints(const std::string& name, const float base[3], const float dir[3]);
  virtual void Define(const std::string& name, const double base[3], const double dir[3]);
  virtual host::EntityHandle GetHandle() const;
  virtual void SetFor2D(std::int16_t for2D);
  virtual std::uint16_t IsFor2D() const;
  virtual void SetCameraFor2D(std::int32_t index, std::int16_t for2D);
  virtual std::uint16_t IsCameraFor2D(std::int32_t index);
  virtual std::int16_t CreateIn(host::DatabaseHandle database);
  virtual std::int16_t Create();
  virtual std::int16_t Unused(std::int32_t argument);
  virtual std::int16_t Delete();
  virtual std::int16_t LoadFrom(host::DatabaseHandle database, host::EntityHandle entity);
  virtual std::int16_t Load(host::EntityHandle entity);
  virtual std::int16_t SaveTo(host::DatabaseHandle database);
  virtual std::int16_t Save();
  virtual void SetCutType(char cutType);
  virtual std::int16_t ShowView(std::int32_t cameraIndex, const void* context = nullptr);
  virtual std::string GetName() const;
  virtual std::int32_t AddCamera(const std::string& name);
  virtual std::int16_t LoadCamera(std::int32_t index, HRCamera& camera);
  virtual std::int16_t RemoveCamera(std::int32_t index);
  virtual std::int16_t GetCameraCount() const;
  virtual std::string GetCameraName(std::int32_t index);
  virtual void RenameCamera(const std::string& name, std::int32_t index);
  virtual void SetName(const std::string& name);
  virtual std::int16_t SaveCamera(std::int32_t index, HRCamera& camera);

  const double* GetBase() const { return base_; }
  const double* GetDir() const { return dir_; }
  char GetCutType() const { return cutType_; }
  const std::vector<host::EntityHandle>& Cameras() const { return cameras_.Handles(); }

 private:
  void WriteRecord(bool removeEmptyCameraList);

  HRGroup group_;
  std::string name_;
  double base_[3] = {0.0, 0.0, 0.0};
  double dir_[3] = {0.0, 0.0, 0.0};
  char cutType_ = 'b';
  std::uint16_t for2D_ = 0;
  OwnedCameras cameras_{"hrPlnCam", "@pln_cams="};
};

// True when the entity's "@Class=" is exactly "HRPlane".
bool IsPlaneEntity(host::DatabaseHandle database, host::EntityHandle entity);
