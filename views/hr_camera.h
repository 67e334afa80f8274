// A named, stored view of the drawing, kept on a group entity's attribute record.
#pragma once

#include <array>
#include <cstdint>
#include <string>

#include "model/hr_group.h"
#include "model/hr_object.h"
#include "shell/host/host_types.h"
#include "views/camera_settings.h"

class HRCamera : public HRObject {
 public:
  static constexpr int kLayerCount = 256;
  using LayerTable = std::array<std::uint16_t, kLayerCount>;

  // View modes: 2D or 3D, parallel or perspective.
  enum ViewMode : std::int16_t { k2DParallel = 0, k2DPerspective = 1, k3DParallel = 2, k3DPerspective = 3 };

  HRCamera();
  HRCamera(const HRCamera&) = default;
  HRCamera& operator=(const HRCamera&) = default;
  ~HRCamera() override;

  // The virtual operations keep this order.
  virtual std::int16_t CaptureView();
  virtual std::int16_t Execute(const void* context);
  virtual std::string GetName() const;
  virtual void SetName(const std::string& name);
  virtual void GetLayerConfig(LayerTable& layers) const;
  virtual void SetLayerConfig(const LayerTable& layers);
  virtual void SetFor2D(std::int16_t for2D);
  virtual std::uint16_t IsFor2D() const;
  virtual HRCamera Copy(const HRCamera& camera) const;
  virtual void GetSettings(CameraSettings& settings) const;
  virtual void Set2DFile(const std::string& file);
  virtual std::string Get2DFile() const;
  virtual void SetComment(const std::string& comment);
  virtual std::string GetComment() const;
  virtual void SetHandle(host::EntityHandle entity);
  virtual void SetClassName(const std::string& className);
  virtual void ApplyView(std::int16_t phase);
  virtual bool IsCamera() const;
  virtual bool HasPatterns() const;
  virtual std::int16_t Create();
  virtual std::int16_t CreateIn(host::DatabaseHandle database);
  virtual std::int16_t Delete();
  virtual std::int16_t DeleteIn(host::DatabaseHandle database);
  virtual std::int16_t Load(host::EntityHandle entity);
  virtual std::int16_t LoadFrom(host::DatabaseHandle database, host::EntityHandle entity);
  virtual std::int16_t Save();
  virtual std::int16_t SaveTo(host::DatabaseHandle database);
  virtual void Reset();

  void SetSettings(const CameraSettings& settings);
  // Takes eye, target and view window from the host view; nothing else changes.
  void UpdateView();

  host::EntityHandle GetHandle() const { return group_.GetEntity(); }
  std::int16_t GetDisplayMode() const { return displayMode_; }
  std::int16_t GetViewMode() const { return viewMode_; }

  void SetShowSections(std::uint8_t value) { showSections_ = value; }
  void SetAutoClip(std::uint8_t value) { autoClip_ = value; }
  void SetOverwrite2D(std::uint8_t value) { overwrite2D_ = value; }
  void SetRemoveCoincident(std::uint8_t value) { removeCoincident_ = value; }
  void SetLineMerge(std::uint8_t value) { lineMerge_ = value; }
  std::uint8_t GetAutoClip() const { return autoClip_; }
  std::uint8_t GetOverwrite2D() const { return overwrite2D_; }
  std::uint8_t GetRemoveCoincident() const { return removeCoincident_; }
  std::uint8_t GetLineMerge() const { return lineMerge_; }
  std::uint8_t GetPreserveDimensions() const { return preserveDimensions_; }
  std::uint8_t GetPreserveText() const { return preserveText_; }
  std::uint8_t GetPreserveWalls() const { return preserveWalls_; }
  std::uint8_t GetPreserveLayer() const { return preserveLayer_; }
  std::int16_t GetPreserveLayerIndex() const { return preserveLayerIndex_; }

 private:
  // Switches the host's layers to this camera's table; false when a switch is refused and
  // stopAtRefusal asks to stop there.
  bool ApplyLayers(bool stopAtRefusal) const;
  void ApplyProjection() const;
  void ApplyEyeTargetCone() const;
  void ApplyScaleAndWindow() const;
  void ApplyPatterns() const;

  HRGroup group_;
  // Captured or loaded before use; zero until then so that nothing reads an unset value.
  float eye_[3] = {0.0F, 0.0F, 0.0F};
  float target_[3] = {0.0F, 0.0F, 0.0F};
  float cone_ = 0.0F;
  double viewWindow_[4] = {0.0, 0.0, 0.0, 0.0};
  std::uint16_t for2D_ = 0;
  std::int16_t displayMode_ = 0;
  std::int16_t viewMode_ = 0;
  LayerTable layers_{};
  std::string name_;
  std::string file2D_;
  std::string comment_;
  std::uint8_t patterns_ = 0;
  std::uint8_t showSections_ = 1;
  std::uint8_t autoClip_ = 1;
  std::uint8_t overwrite2D_ = 1;
  std::uint8_t removeCoincident_ = 1;
  std::uint8_t lineMerge_ = 1;
  char scaleMode_ = 'a';
  std::uint8_t preserveDimensions_ = 0;
  std::uint8_t preserveText_ = 0;
  std::uint8_t preserveWalls_ = 0;
  std::uint8_t preserveLayer_ = 0;
  std::int16_t preserveLayerIndex_ = 1;
};
