// A vertical section: its symbol in the drawing (a placed block of line, end marks and labels),
// its record, its cut view and its own cameras.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "math/matrix.h"
#include "math/vector.h"
#include "model/hr_block.h"
#include "model/hr_line.h"
#include "model/hr_object.h"
#include "model/hr_placed_block.h"
#include "model/hr_placed_object.h"
#include "model/hr_point.h"
#include "model/hr_text.h"
#include "views/hr_camera.h"
#include "views/owned_cameras.h"
#include "views/section_settings.h"

class HRSection : public HRObject {
 public:
  // How the host shows the cut.
  static constexpr char kCutByColor = 'b';
  static constexpr char kCutOff = 'o';
  static constexpr char kCutWhole = 'w';

  HRSection();
  ~HRSection() override;

  // The virtual operations keep this order.
  virtual void BuildFromFloats(const std::string& name, const std::string& symbolFile, const float start[3],
                               const float end[3]);
  virtual void BuildFromPoints(const std::string& name, const std::string& symbolFile, const HRPoint& start,
                               const HRPoint& end);
  virtual void Build(const std::string& name, const std::string& symbolFile, const double start[3],
                     const double end[3]);
  virtual host::EntityHandle GetHandle() const;
  virtual void Move(const double start[3], const double end[3]);
  virtual std::int16_t CreateIn(host::DatabaseHandle database);
  virtual std::int16_t Create();
  virtual std::int16_t Unused(std::int32_t argument);
  virtual std::int16_t Delete();
  virtual std::int16_t LoadFrom(host::DatabaseHandle database, host::EntityHandle entity);
  virtual std::int16_t Load(host::EntityHandle entity);
  virtual std::int16_t SaveTo(host::DatabaseHandle database);
  virtual std::int16_t Save();
  virtual void SetCutType(char cutType);
  virtual std::int16_t ShowView(std::int32_t cameraIndex);
  virtual std::string GetName() const;
  virtual void SetFor2D(std::int16_t for2D);
  virtual std::uint16_t IsFor2D() const;
  virtual void SetCameraFor2D(std::int32_t index, std::int16_t for2D);
  virtual std::uint16_t IsCameraFor2D(std::int32_t index);
  virtual std::int32_t AddCamera(const std::string& name);
  virtual std::int16_t RemoveCamera(std::int32_t index);
  virtual std::int16_t GetCameraCount() const;
  virtual void CopyCameraName(std::int32_t index, std::string& name);
  virtual std::string GetCameraName(std::int32_t index);
  virtual void RenameCamera(const std::string& name, std::int32_t index);
  virtual std::int16_t LoadCamera(std::int32_t index, HRCamera& camera);
  virtual void SetName(const std::string& name);
  virtual std::int16_t HideSymbol();
  virtual std::int16_t ShowSymbol();
  virtual std::int16_t SaveCamera(std::int32_t index, HRCamera& camera);

  void GetSettings(SectionSettings& settings) const;
  void SetSettings(const SectionSettings& settings);

  char GetCutType() const { return cutType_; }
  const std::vector<host::EntityHandle>& Cameras() const { return cameras_.Handles(); }

 private:
  // Lays out line, marks, labels and the instance's placement for a cut from start to end.
  void LayOut(const double start[3], const double end[3]);
  // The line's two ends in drawing coordinates.
  void CutLine(HRMath::Vector& start, HRMath::Vector& end) const;
  void WriteMarkRoles() const;

  HRPlacedBlock instance_;
  HRBlock block_;
  HRPlacedObject startMark_;
  HRPlacedObject endMark_;
  HRLine line_;
  HRText startLabel_;
  HRText endLabel_;
  float labelOffset_ = 0.3F;
  std::uint16_t for2D_ = 0;
  char cutType_ = kCutByColor;
  OwnedCameras cameras_{"hrSecCam", "@CamLst="};
};
