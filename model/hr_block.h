// A block definition and the member entities it owns.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "model/hr_primitive.h"

class HRBlock : public HRPrimitive {
 public:
  HRBlock();

  using HRPrimitive::Create;
  using HRPrimitive::Delete;
  using HRPrimitive::Read;
  using HRPrimitive::Update;
  std::int16_t Read(host::DatabaseHandle database, host::EntityHandle entity) override;
  std::int16_t Update(host::DatabaseHandle database) override;
  std::int16_t Create(host::DatabaseHandle database) override;
  std::int16_t Delete(host::DatabaseHandle database) override;
  void Reserved() override;

  virtual HRBlock AssignFrom(const HRPrimitive& primitive);
  // A copy of `block` with its header, record and handle, but no name and no members.
  virtual HRBlock CopyOf(const HRBlock& block) const;
  virtual std::int32_t GetMemberCount() const;
  // 0 for an index outside the members.
  virtual host::EntityHandle GetMember(std::int32_t index) const;
  virtual std::int16_t WrapMember(std::int32_t index, std::unique_ptr<HRPrimitive>& object) const;
  // An unstored member is created in the database first.
  virtual std::int16_t AddMember(host::DatabaseHandle database, HRPrimitive& member);
  virtual std::int16_t AddMember(HRPrimitive& member);
  virtual std::int16_t RemoveAndDeleteMember(host::DatabaseHandle database, HRPrimitive& member);
  virtual std::int16_t RemoveAndDeleteMember(HRPrimitive& member);
  // Only the first of equal handles leaves the member list.
  virtual std::int16_t RemoveMember(host::DatabaseHandle database, HRPrimitive& member);
  virtual std::int16_t RemoveMember(HRPrimitive& member);
  virtual std::int16_t DeleteAllMembers();
  virtual std::int16_t UnlinkAllMembers();

  const std::string& GetName() const { return name_; }

 private:
  // Unlinks every member the host lists; deletes each known member's entity when asked to.
  std::int16_t ReleaseAllMembers(bool deleteEntities);

  host::BlockRecord record_{};
  std::string name_;
  std::vector<host::EntityHandle> members_;
};
