// Host calls on compound entities: block definitions and their members, and groups.
#include <algorithm>
#include <vector>

#include "shell/host/qeldll.h"
#include "workbench/host_call_support.h"

using namespace wb;

namespace {

// Checks a member list handed over by the caller: every handle a live entity other than the
// owner. A list that fails the check changes nothing.
bool ValidMembers(const Drawing& drawing, EntityHandle owner, std::int32_t count, const EntityHandle* members) {
  if (count < 0 || (count > 0 && members == nullptr)) return false;
  return std::all_of(members, members + count,
                     [&](EntityHandle member) { return member != owner && drawing.Find(member) != nullptr; });
}

template <typename Record>
Status CreateCompound(const char* function, DatabaseHandle database, EntityHandle* newEntity, std::uint8_t type,
                      std::int32_t memberCount, const EntityHandle* members, const char* name, const Record* record) {
  if (auto fault = call::Fault(function)) return call::AsStatus(*fault);
  Drawing* drawing = Workbench::Get().Find(database);
  if (drawing == nullptr || newEntity == nullptr || record == nullptr) return 0;
  if (!ValidMembers(*drawing, 0, memberCount, members)) return 0;
  Entity& entity = drawing->Add(type);
  WriteRecord(entity, *record);
  entity.name = name == nullptr ? "" : name;
  entity.members.assign(members, members + memberCount);
  *newEntity = entity.handle;
  call::JournalHostCall(function, entity.handle);
  return host::kOk;
}

template <typename Record>
Status ReadCompound(const char* function, DatabaseHandle database, EntityHandle entity, std::uint8_t type,
                    Record* record, char** hostName) {
  if (auto fault = call::Fault(function, entity)) return call::AsStatus(*fault);
  const Entity* found = call::FindEntityOfType(database, entity, type);
  if (found == nullptr || record == nullptr) return 0;
  *record = ReadRecord<Record>(*found);
  call::HandOutName(*found, hostName);
  return host::kOk;
}

Status DeleteCompound(const char* function, DatabaseHandle database, EntityHandle entity, std::uint8_t type) {
  if (auto fault = call::Fault(function, entity)) return call::AsStatus(*fault);
  Drawing* drawing = Workbench::Get().Find(database);
  if (drawing == nullptr || call::FindEntityOfType(database, entity, type) == nullptr) return 0;
  call::DeleteEntity(*drawing, entity);
  call::JournalHostCall(function, entity);
  return host::kOk;
}

}  // namespace

Status qel_read_block(DatabaseHandle database, EntityHandle entity, host::BlockRecord* block, char** hostName) {
  return ReadCompound(__func__, database, entity, host::kTypeBlock, block, hostName);
}

Status qel_update_block(DatabaseHandle database, EntityHandle entity, const host::BlockRecord* block) {
  return call::UpdateTypedRecord(__func__, database, entity, host::kTypeBlock, block);
}

Status qel_create_block(DatabaseHandle database, EntityHandle* newEntity, std::int32_t memberCount,
                        const EntityHandle* members, const char* name, const host::BlockRecord* block) {
  return CreateCompound(__func__, database, newEntity, host::kTypeBlock, memberCount, members, name, block);
}

// The members outlive their block: deleting a definition only unlinks them.
Status qel_delete_block(DatabaseHandle database, EntityHandle entity) {
  return DeleteCompound(__func__, database, entity, host::kTypeBlock);
}

Status get_whole_vector_of_block_members(DatabaseHandle database, EntityHandle entity, EntityHandle** hostList,
                                         std::int32_t* count) {
  if (auto fault = call::Fault(__func__, entity)) return call::AsStatus(*fault);
  const Entity* block = call::FindEntityOfType(database, entity, host::kTypeBlock);
  if (block == nullptr || hostList == nullptr || count == nullptr) return 0;
  *count = static_cast<std::int32_t>(block->members.size());
  *hostList = nullptr;
  if (!block->members.empty()) {
    const std::size_t bytes = block->members.size() * sizeof(EntityHandle);
    *hostList = static_cast<EntityHandle*>(Workbench::Get().Memory().Allocate(bytes));
    std::copy(block->members.begin(), block->members.end(), *hostList);
  }
  return host::kOk;
}

Status qel_add_members_to_block(DatabaseHandle database, EntityHandle block, std::int32_t count,
                                const EntityHandle* members) {
  if (auto fault = call::Fault(__func__, block)) return call::AsStatus(*fault);
  Drawing* drawing = Workbench::Get().Find(database);
  Entity* owner = call::FindEntityOfType(database, block, host::kTypeBlock);
  if (owner == nullptr || !ValidMembers(*drawing, block, count, members)) return 0;
  owner->members.insert(owner->members.end(), members, members + count);
  call::JournalHostCall(__func__, block);
  return host::kOk;
}

// Each handle unlinks its first occurrence; when any handle is no member, nothing changes.
Status qel_unlink_members_from_block(DatabaseHandle database, EntityHandle block, std::int32_t count,
                                     const EntityHandle* members) {
  if (auto fault = call::Fault(__func__, block)) return call::AsStatus(*fault);
  Entity* owner = call::FindEntityOfType(database, block, host::kTypeBlock);
  if (owner == nullptr || count < 0 || (count > 0 && members == nullptr)) return 0;
  std::vector<EntityHandle> remaining = owner->members;
  for (std::int32_t i = 0; i < count; ++i) {
    auto found = std::find(remaining.begin(), remaining.end(), members[i]);
    if (found == remaining.end()) return 0;
    remaining.erase(found);
  }
  owner->members = std::move(remaining);
  call::JournalHostCall(__func__, block);
  return host::kOk;
}

Status qel_read_group(DatabaseHandle database, EntityHandle entity, host::GroupRecord* group, char** hostName) {
  return ReadCompound(__func__, database, entity, host::kTypeGroup, group, hostName);
}

Status qel_update_group(DatabaseHandle database, EntityHandle entity, const host::GroupRecord* group) {
  return call::UpdateTypedRecord(__func__, database, entity, host::kTypeGroup, group);
}

Status qel_create_group(DatabaseHandle database, EntityHandle* newEntity, std::int32_t memberCount,
                        const EntityHandle* members, const char* name, const host::GroupRecord* group) {
  return CreateCompound(__func__, database, newEntity, host::kTypeGroup, memberCount, members, name, group);
}

Status qel_delete_group(DatabaseHandle database, EntityHandle entity) {
  return DeleteCompound(__func__, database, entity, host::kTypeGroup);
}
