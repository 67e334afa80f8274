// Reading, writing and placing block insertions.
#include "model/hr_placed_block.h"

#include "model/host_allocation.h"
#include "model/status_codes.h"
#include "shell/host/qeldll.h"

HRPlacedBlock::HRPlacedBlock() : HRPrimitive("HRPlacedBlock") { Reset(); }

void HRPlacedBlock::Reset() {
  record_ = host::PlacedBlockRecord{};
  HRMath::Matrix().CopyTo(record_.placement);
  name_ = "blk";
  PresetNewHeader();
  SetEntity(0);
}

std::int16_t HRPlacedBlock::Read(host::DatabaseHandle database, host::EntityHandle entity) {
  const std::int16_t result = HRPrimitive::Read(database, entity);
  if (result != model_status::kSuccess) return result;
  char* hostName = nullptr;
  const host::Status placedResult = qel_read_placed_block(database, entity, &record_, &hostName);
  const HostAllocation<char> name(hostName);
  if (placedResult != host::kOk) return model_status::kPlacedBlockNotRead;
  name_ = CopyHostText(name.get());
  return model_status::kSuccess;
}

std::int16_t HRPlacedBlock::Update(host::DatabaseHandle database) {
  if (qel_update_placed_block(database, GetEntity(), &record_, 0) != host::kOk) {
    return model_status::kPlacedBlockNotUpdated;
  }
  name_.clear();
  return model_status::kSuccess;
}

std::int16_t HRPlacedBlock::Create(host::DatabaseHandle database) {
  host::EntityHandle newEntity = 0;
  if (qel_add_placed_block(database, &newEntity, "blk", &record_) != host::kOk) {
    return model_status::kPlacedBlockNotAdded;
  }
  SetEntity(newEntity);
  WriteClassMarker();
  return HRPrimitive::Read(database, newEntity);
}

std::int16_t HRPlacedBlock::Delete(host::DatabaseHandle database) {
  write_to_record(GetEntity(), 2);
  qel_delete_entity(database, GetEntity());
  Reset();
  return model_status::kSuccess;
}

void HRPlacedBlock::Reserved() {}

std::int16_t HRPlacedBlock::SetBlock(const HRPrimitive& block) {
  record_.block = block.GetEntity();
  return model_status::kSuccess;
}

void HRPlacedBlock::SetPlacement(const HRMath::Matrix& placement) { placement.CopyTo(record_.placement); }

HRMath::Matrix HRPlacedBlock::GetPlacement() const { return HRMath::Matrix(record_.placement); }

host::EntityHandle HRPlacedBlock::GetBlock() const { return record_.block; }
