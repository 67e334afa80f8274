// Reading, writing and editing block definitions and their members.
#include "model/hr_block.h"

#include <algorithm>

#include "model/current_database.h"
#include "model/host_allocation.h"
#include "model/host_member_list.h"
#include "model/status_codes.h"
#include "model/wrap_entity.h"
#include "shell/host/qeldll.h"

HRBlock::HRBlock() : HRPrimitive("HRBlock") {}

std::int16_t HRBlock::Read(host::DatabaseHandle database, host::EntityHandle entity) {
  members_.clear();
  if (!ReadHeader(database, entity)) return model_status::kHeaderNotRead;
  if (GetEntityType() != host::kTypeBlock) return model_status::kWrongEntity;
  char* hostName = nullptr;
  const host::Status blockResult = qel_read_block(database, entity, &record_, &hostName);
  const HostAllocation<char> name(hostName);
  if (blockResult != host::kOk) return model_status::kWrongEntity;
  const HostMemberList list = GetHostMemberList(database, entity);
  if (!list.valid) return model_status::kBlockNotCreated;
  members_.assign(list.handles.get(), list.handles.get() + list.count);
  name_ = CopyHostText(name.get());
  SetEntity(entity);
  return model_status::kSuccess;
}

std::int16_t HRBlock::Update(host::DatabaseHandle database) {
  if (qel_update_entity_header(database, GetEntity(), &Header()) != host::kOk) return model_status::kHeaderNotUpdated;
  if (qel_update_block(database, GetEntity(), &record_) != host::kOk) return model_status::kRecordNotUpdated;
  return model_status::kSuccess;
}

std::int16_t HRBlock::Create(host::DatabaseHandle database) {
  host::EntityHandle newEntity = 0;
  if (qel_create_block(database, &newEntity, 0, nullptr, "blk", &record_) != host::kOk) {
    return model_status::kBlockNotCreated;
  }
  if (!ReadHeader(database, newEntity)) return model_status::kHeaderNotRead;
  SetEntity(newEntity);
  WriteClassMarker();
  return model_status::kSuccess;
}

std::int16_t HRBlock::Delete(host::DatabaseHandle database) {
  write_to_record(GetEntity(), 2);
  if (qel_delete_block(database, GetEntity()) != host::kOk) return model_status::kNotDeleted;
  return HRPrimitive::Delete(database);
}

void HRBlock::Reserved() {}

HRBlock HRBlock::AssignFrom(const HRPrimitive& primitive) {
  if (const auto* block = dynamic_cast<const HRBlock*>(&primitive)) {
    record_ = block->record_;
    members_ = block->members_;
    name_ = block->name_;
  }
  TakeIdentityOf(primitive);
  return *this;
}

HRBlock HRBlock::CopyOf(const HRBlock& block) const {
  HRBlock copy;
  copy.Header() = block.Header();
  copy.record_ = block.record_;
  copy.SetEntity(block.GetEntity());
  return copy;
}

std::int32_t HRBlock::GetMemberCount() const { return static_cast<std::int32_t>(members_.size()); }

host::EntityHandle HRBlock::GetMember(std::int32_t index) const {
  if (index < 0 || index >= GetMemberCount()) return 0;
  return members_[static_cast<std::size_t>(index)];
}

std::int16_t HRBlock::WrapMember(std::int32_t index, std::unique_ptr<HRPrimitive>& object) const {
  return WrapEntity(GetCurrentDatabase(), GetMember(index), object);
}

std::int16_t HRBlock::AddMember(host::DatabaseHandle database, HRPrimitive& member) {
  if (!member.IsStored()) member.Create(database);
  const host::EntityHandle handle = member.GetEntity();
  if (qel_add_members_to_block(database, GetEntity(), 1, &handle) != host::kOk) return model_status::kMemberNotAdded;
  members_.push_back(handle);
  return model_status::kSuccess;
}

std::int16_t HRBlock::AddMember(HRPrimitive& member) { return AddMember(GetCurrentDatabase(), member); }

std::int16_t HRBlock::RemoveAndDeleteMember(host::DatabaseHandle database, HRPrimitive& member) {
  const std::int16_t result = RemoveMember(database, member);
  if (result != model_status::kSuccess) return result;
  return member.Delete(database);
}

std::int16_t HRBlock::RemoveAndDeleteMember(HRPrimitive& member) {
  return RemoveAndDeleteMember(GetCurrentDatabase(), member);
}

std::int16_t HRBlock::RemoveMember(host::DatabaseHandle database, HRPrimitive& member) {
  const host::EntityHandle handle = member.GetEntity();
  if (qel_unlink_members_from_block(database, GetEntity(), 1, &handle) != host::kOk) {
    return model_status::kMembersNotUnlinked;
  }
  const auto found = std::find(members_.begin(), members_.end(), handle);
  if (found != members_.end()) members_.erase(found);
  return model_status::kSuccess;
}

std::int16_t HRBlock::RemoveMember(HRPrimitive& member) { return RemoveMember(GetCurrentDatabase(), member); }

std::int16_t HRBlock::DeleteAllMembers() { return ReleaseAllMembers(true); }

std::int16_t HRBlock::UnlinkAllMembers() { return ReleaseAllMembers(false); }

std::int16_t HRBlock::ReleaseAllMembers(bool deleteEntities) {
  const host::DatabaseHandle database = GetCurrentDatabase();
  const HostMemberList list = GetHostMemberList(database, GetEntity());
  if (!list.valid) return model_status::kMemberListNotObtained;
  if (qel_unlink_members_from_block(database, GetEntity(), list.count, list.handles.get()) != host::kOk) {
    return model_status::kMembersNotUnlinked;
  }
  if (deleteEntities) {
    // Each member's own deletion result is not examined: the members are gone from the block
    // either way.
    for (const host::EntityHandle handle : members_) {
      std::unique_ptr<HRPrimitive> member;
      WrapEntity(database, handle, member);
      member->Delete();
      write_to_record(handle, 2);
      write_to_record(-1, -1);
    }
  }
  members_.clear();
  return model_status::kSuccess;
}
