// Reading, writing and deleting group entities.
#include "model/hr_group.h"

#include "model/host_allocation.h"
#include "model/status_codes.h"
#include "shell/host/qeldll.h"

HRGroup::HRGroup() : HRPrimitive("HRGroup") { PresetNewHeader(); }

std::int16_t HRGroup::Read(host::DatabaseHandle database, host::EntityHandle entity) {
  if (!ReadHeader(database, entity)) return model_status::kHeaderNotRead;
  if (GetEntityType() != host::kTypeGroup) return model_status::kWrongEntity;
  char* hostName = nullptr;
  const host::Status result = qel_read_group(database, entity, &record_, &hostName);
  const HostAllocation<char> name(hostName);
  if (result != host::kOk) return model_status::kWrongEntity;
  name_ = CopyHostText(name.get());
  SetEntity(entity);
  return model_status::kSuccess;
}

std::int16_t HRGroup::Update(host::DatabaseHandle database) {
  if (qel_update_entity_header(database, GetEntity(), &Header()) != host::kOk) return model_status::kHeaderNotUpdated;
  if (qel_update_group(database, GetEntity(), &record_) != host::kOk) return model_status::kRecordNotUpdated;
  return model_status::kSuccess;
}

std::int16_t HRGroup::Create(host::DatabaseHandle database) {
  host::EntityHandle newEntity = 0;
  if (qel_create_group(database, &newEntity, 0, nullptr, "grp", &record_) != host::kOk) {
    return model_status::kGroupNotCreated;
  }
  if (!ReadHeader(database, newEntity)) return model_status::kHeaderNotRead;
  SetEntity(newEntity);
  WriteClassMarker();
  return model_status::kSuccess;
}

std::int16_t HRGroup::Delete(host::DatabaseHandle database) {
  if (qel_delete_group(database, GetEntity()) != host::kOk) return model_status::kNotDeleted;
  return HRPrimitive::Delete(database);
}

void HRGroup::Reserved() {}

HRGroup HRGroup::CopyOf(const HRGroup& group) const {
  HRGroup copy;
  copy.Header() = group.Header();
  copy.record_ = group.record_;
  copy.SetEntity(group.GetEntity());
  return copy;
}
