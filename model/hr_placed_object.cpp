// Reading, writing and placing library elements.
#include "model/hr_placed_object.h"

#include <cstring>

#include "model/attribute_record.h"
#include "model/host_allocation.h"
#include "model/status_codes.h"
#include "shell/host/qeldll.h"

namespace {

constexpr std::size_t kShortNameSize = sizeof(host::ElementRecord::shortName);

}  // namespace

HRPlacedObject::HRPlacedObject() : HRPrimitive("HRPlacedObject") { Reset(); }

void HRPlacedObject::Reset() {
  record_ = host::ElementRecord{};
  HRMath::Matrix().CopyTo(record_.placement);
  fileName_.clear();
  folder_.clear();
  PresetNewHeader();
  SetEntity(0);
}

std::int16_t HRPlacedObject::Read(host::DatabaseHandle database, host::EntityHandle entity) {
  if (!ReadHeader(database, entity)) return model_status::kHeaderNotRead;
  if (GetEntityType() != host::kTypeElement || qel_read_element(database, entity, &record_) != host::kOk) {
    return model_status::kWrongEntity;
  }
  // The record's short name need not end in a terminator; the host gets one that does.
  char shortName[kShortNameSize + 1] = {};
  std::memcpy(shortName, record_.shortName, kShortNameSize);
  const HostAllocation<char> folder(qel_get_config_path(database, entity));
  const HostAllocation<char> fileName(qel_get_element_name(database, entity, shortName));
  folder_ = CopyHostText(folder.get());
  fileName_ = CopyHostText(fileName.get());
  SetEntity(entity);
  return model_status::kSuccess;
}

std::int16_t HRPlacedObject::Update(host::DatabaseHandle database) {
  TakeShortName();
  if (qel_update_element(database, GetEntity(), &record_) != host::kOk) return model_status::kElementNotWritten;
  return WriteAttributesOf(database, GetEntity());
}

std::int16_t HRPlacedObject::Create(host::DatabaseHandle database) {
  TakeShortName();
  host::EntityHandle newEntity = 0;
  if (qel_add_element(database, &newEntity, &record_, 0) != host::kOk) return model_status::kElementNotWritten;
  const std::int16_t result = WriteAttributesOf(database, newEntity);
  if (result != model_status::kSuccess) return result;
  SetEntity(newEntity);
  WriteClassMarker();
  return model_status::kSuccess;
}

std::int16_t HRPlacedObject::Delete(host::DatabaseHandle database) {
  const host::EntityHandle entity = GetEntity();
  if (qel_delete_entity(database, entity) != host::kOk) return model_status::kElementNotDeleted;
  write_to_record(entity, 2);
  Reset();
  return HRPrimitive::Delete(database);
}

void HRPlacedObject::Reserved() {}

std::int16_t HRPlacedObject::WriteAttributesOf(host::DatabaseHandle database, host::EntityHandle entity) const {
  AttributeRecord record(database, entity);
  if (!record.IsOpen()) return model_status::kElementNotWritten;
  return WriteLibraryAttributes(record.Get()) ? model_status::kSuccess : model_status::kStringNotWritten;
}

bool HRPlacedObject::WriteLibraryAttributes(host::RecordHandle record) const {
  // The host answers the file name write with 0 alone when it fails; the folder writes must
  // answer exactly 1.
  if (qel_set_string_attribute(record, "@lfname=", fileName_.c_str()) == 0) return false;
  if (qel_set_string_attribute(record, "URL=", folder_.c_str()) != host::kOk) return false;
  return qel_set_string_attribute(record, "@lib=", folder_.c_str()) == host::kOk;
}

void HRPlacedObject::TakeShortName() {
  char buffer[kShortNameSize + 1] = {};
  const char* shortName = qel_get_short_name(fileName_.c_str(), buffer);
  if (shortName == nullptr) shortName = buffer;
  std::memset(record_.shortName, 0, kShortNameSize);
  std::memcpy(record_.shortName, shortName, strnlen(shortName, kShortNameSize));
}

HRPlacedObject HRPlacedObject::AssignFrom(const HRPrimitive& primitive) {
  if (const auto* object = dynamic_cast<const HRPlacedObject*>(&primitive)) {
    fileName_ = object->fileName_;
    folder_ = object->folder_;
    std::memcpy(record_.values, object->record_.values, sizeof(record_.values));
    std::memcpy(record_.placement, object->record_.placement, sizeof(record_.placement));
  }
  TakeIdentityOf(primitive);
  return *this;
}

HRPlacedObject HRPlacedObject::CopyOf(const HRPlacedObject& object) const {
  HRPlacedObject copy;
  copy.Header() = object.Header();
  copy.record_ = object.record_;
  copy.SetEntity(object.GetEntity());
  return copy;
}

void HRPlacedObject::SetFile(const std::string& path) {
  const std::size_t lastSeparator = path.rfind('\\');
  // A bare file name has no folder; giving it a lone "\" would turn it into a path at the root.
  if (lastSeparator == std::string::npos) {
    folder_.clear();
    fileName_ = path;
    return;
  }
  fileName_ = path.substr(lastSeparator + 1);
  folder_ = path.substr(0, lastSeparator + 1);
  folder_.erase(folder_.find_last_not_of('\\') + 1);
  folder_ += '\\';
}

void HRPlacedObject::SetPlacement(const HRMath::Matrix& placement) { placement.CopyTo(record_.placement); }
