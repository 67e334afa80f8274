// A group entity; cameras, plans and selection sets keep their records on one.
#pragma once

#include <cstdint>
#include <string>

#include "model/hr_primitive.h"

class HRGroup : public HRPrimitive {
 public:
  HRGroup();

  using HRPrimitive::Create;
  using HRPrimitive::Delete;
  using HRPrimitive::Read;
  using HRPrimitive::Update;
  std::int16_t Read(host::DatabaseHandle database, host::EntityHandle entity) override;
  std::int16_t Update(host::DatabaseHandle database) override;
  std::int16_t Create(host::DatabaseHandle database) override;
  std::int16_t Delete(host::DatabaseHandle database) override;
  void Reserved() override;

  // A copy of `group` with its header, record and handle, but no name.
  virtual HRGroup CopyOf(const HRGroup& group) const;

  const std::string& GetName() const { return name_; }

 private:
  host::GroupRecord record_{};
  std::string name_;
};
