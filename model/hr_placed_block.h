// An insertion of a block with a 4x4 placement; a section shows itself through one.
#pragma once

#include <cstdint>
#include <string>

#include "math/matrix.h"
#include "model/hr_primitive.h"

class HRPlacedBlock : public HRPrimitive {
 public:
  HRPlacedBlock();

  using HRPrimitive::Create;
  using HRPrimitive::Delete;
  using HRPrimitive::Read;
  using HRPrimitive::Update;
  std::int16_t Read(host::DatabaseHandle database, host::EntityHandle entity) override;
  std::int16_t Update(host::DatabaseHandle database) override;
  std::int16_t Create(host::DatabaseHandle database) override;
  std::int16_t Delete(host::DatabaseHandle database) override;
  void Reserved() override;

  // Places the block the given wrapper stands for.
  virtual std::int16_t SetBlock(const HRPrimitive& block);
  virtual void SetPlacement(const HRMath::Matrix& placement);
  virtual HRMath::Matrix GetPlacement() const;
  virtual host::EntityHandle GetBlock() const;

  // Back to an unstored insertion of nothing, with the identity placement.
  void Reset();
  const std::string& GetName() const { return name_; }

 private:
  host::PlacedBlockRecord record_{};
  std::string name_;
};
