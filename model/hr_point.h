// A position value used to hand points around; it never creates an entity of its own.
#pragma once

#include "math/vector.h"
#include "model/hr_primitive.h"

class HRPoint : public HRPrimitive {
 public:
  HRPoint();
  HRPoint(float x, float y, float z);

  using HRPrimitive::Create;
  using HRPrimitive::Read;
  using HRPrimitive::Update;
  std::int16_t Read(host::DatabaseHandle database, host::EntityHandle entity) override;
  std::int16_t Update(host::DatabaseHandle database) override;
  std::int16_t Create(host::DatabaseHandle database) override;
  void Reserved() override;

  virtual HRMath::Vector GetPosition() const;

  void SetPosition(float x, float y, float z) { point_.position = {x, y, z}; }

 private:
  host::PointRecord point_{};
};
