// Base behaviour of entity wrappers, their classification and the attribute-record family.
#include "model/hr_primitive.h"

#include <algorithm>
#include <utility>
#include <vector>

#include "model/attribute_record.h"
#include "model/class_marker.h"
#include "model/current_database.h"
#include "model/host_allocation.h"
#include "model/status_codes.h"
#include "shell/host/qeldll.h"

namespace {

// "@Class", "@Class=" and "@Class==" all reach the host as "@Class=".
std::string CanonicalName(const std::string& name) {
  const std::size_t last = name.find_last_not_of('=');
  return (last == std::string::npos ? std::string() : name.substr(0, last + 1)) + "=";
}

// Opens the entity's record in the current database, runs one host call on it and closes it.
// A call answering other than 1 gives `failure`.
template <typename HostCall>
std::int16_t WithRecord(host::EntityHandle entity, std::int16_t failure, HostCall call) {
  AttributeRecord record(GetCurrentDatabase(), entity);
  if (!record.IsOpen()) return model_status::kRecordNotOpened;
  return call(record.Get()) == host::kOk ? model_status::kSuccess : failure;
}

}  // namespace

HRPrimitive::HRPrimitive(std::string className) : HRObject(std::move(className)) {}

HRPrimitive::~HRPrimitive() = default;

host::EntityHandle HRPrimitive::GetEntity() const { return entity_; }

bool HRPrimitive::IsStored() const { return entity_ > 0; }

std::int16_t HRPrimitive::GetKind() const {
  switch (GetEntityType()) {
    case host::kTypeLine:
      return is_attribute_exist(GetCurrentDatabase(), entity_, "tb=") != 0 ? 11 : 2;
    case host::kTypeArc:
      return 4;
    case host::kTypeCircle:
      return 5;
    case host::kTypeElement:
      return 7;
    case host::kTypePolyline:
      return 3;
    case host::kTypePoint:
      return 1;
    case host::kTypeSolid:
      return 6;
    case host::kTypeGroup:
      return 9;
    case host::kTypeBlock:
      return 10;
    case host::kTypePlacedBlock:
      return 8;
    default:  // hatches, dimensions and anything unknown
      return 12;
  }
}

std::uint8_t HRPrimitive::GetHeaderByte8() const { return header_.bytes[host::kHeaderByte8]; }

std::uint8_t HRPrimitive::GetHeaderByte9() const { return header_.bytes[host::kHeaderByte9]; }

std::uint8_t HRPrimitive::GetFlags() const { return header_.bytes[host::kHeaderFlags]; }

std::uint8_t HRPrimitive::GetEntityType() const { return header_.bytes[host::kHeaderType]; }

std::int16_t HRPrimitive::Read(host::EntityHandle entity) { return Read(GetCurrentDatabase(), entity); }

std::int16_t HRPrimitive::Read(host::DatabaseHandle database, host::EntityHandle entity) {
  if (!ReadHeader(database, entity)) return model_status::kHeaderNotRead;
  entity_ = entity;
  return model_status::kSuccess;
}

std::int16_t HRPrimitive::Update() { return Update(GetCurrentDatabase()); }

std::int16_t HRPrimitive::Update(host::DatabaseHandle database) {
  return qel_update_entity_header(database, entity_, &header_) == 0 ? model_status::kHeaderNotUpdated
                                                                     : model_status::kSuccess;
}

std::int16_t HRPrimitive::Create() { return Create(GetCurrentDatabase()); }

std::int16_t HRPrimitive::Create(host::DatabaseHandle) { return model_status::kSuccess; }

std::int16_t HRPrimitive::Delete() { return Delete(GetCurrentDatabase()); }

std::int16_t HRPrimitive::Delete(host::DatabaseHandle) {
  entity_ = 0;
  return model_status::kSuccess;
}

std::int16_t HRPrimitive::Hide() { return ChangeVisibility(true); }

std::int16_t HRPrimitive::Show() { return ChangeVisibility(false); }

std::int16_t HRPrimitive::ChangeVisibility(bool hidden) {
  std::uint8_t& flags = header_.bytes[host::kHeaderFlags];
  flags = static_cast<std::uint8_t>(hidden ? flags | host::kFlagHidden : flags & ~host::kFlagHidden);
  qel_update_entity_header(GetCurrentDatabase(), entity_, &header_);
  write_to_record(entity_, 5);
  write_to_record(-1, -1);
  return model_status::kSuccess;
}

void HRPrimitive::PresetNewHeader() {
  header_.bytes[host::kHeaderByte8] = 0;
  header_.bytes[host::kHeaderByte9] = 1;
  header_.bytes[host::kHeaderType] = 11;
}

bool HRPrimitive::ReadHeader(host::DatabaseHandle database, host::EntityHandle entity) {
  return qel_read_entity_header(database, entity, &header_) == host::kOk;
}

void HRPrimitive::TakeIdentityOf(const HRPrimitive& other) {
  header_.bytes[host::kHeaderByte8] = other.GetHeaderByte8();
  header_.bytes[host::kHeaderByte9] = other.GetHeaderByte9();
  header_.bytes[host::kHeaderType] = other.GetEntityType();
  entity_ = other.GetEntity();
}

std::int16_t HRPrimitive::WriteClassMarker() const { return SetStringAttribute(kClassAttribute, GetClassName()); }

std::int16_t HRPrimitive::SetStringAttribute(const std::string& name, const std::string& text) const {
  const std::string canonical = CanonicalName(name);
  return WithRecord(entity_, model_status::kStringNotWritten, [&](host::RecordHandle record) {
    return qel_set_string_attribute(record, canonical.c_str(), text.c_str());
  });
}

std::int16_t HRPrimitive::GetStringAttribute(const std::string& name, std::string& text) const {
  const std::string canonical = CanonicalName(name);
  return WithRecord(entity_, model_status::kAttributeFailed, [&](host::RecordHandle record) {
    char* hostText = nullptr;
    const host::Status result = qel_read_string_attribute(record, canonical.c_str(), &hostText);
    const HostAllocation<char> owned(hostText);
    if (result == host::kOk) text = CopyHostText(owned.get());
    return result;
  });
}

std::int16_t HRPrimitive::GetShortAttribute(const std::string& name, std::int16_t& value) const {
  const std::string canonical = CanonicalName(name);
  return WithRecord(entity_, model_status::kAttributeFailed, [&](host::RecordHandle record) {
    return qel_read_short_attribute(record, canonical.c_str(), &value);
  });
}

std::int16_t HRPrimitive::SetShortAttribute(const std::string& name, std::int16_t value) const {
  return WithRecord(entity_, model_status::kAttributeFailed, [&](host::RecordHandle record) {
    return qel_set_short_attribute(record, name.c_str(), value);
  });
}

std::int16_t HRPrimitive::SetLongVectorAttribute(const std::string& name, std::int32_t count,
                                                 const std::int32_t* values) const {
  return WithRecord(entity_, model_status::kAttributeFailed, [&](host::RecordHandle record) {
    return qel_set_long_vector_attribute(record, name.c_str(), count, values);
  });
}

std::int16_t HRPrimitive::SetFloatVectorAttribute(const std::string& name, const float* values,
                                                  std::int32_t count) const {
  return WithRecord(entity_, model_status::kAttributeFailed, [&](host::RecordHandle record) {
    // The host works on an array of our own, so nothing it does reaches the caller's values.
    std::vector<float> copy;
    if (values != nullptr && count > 0) copy.assign(values, values + count);
    return qel_set_float_vector_attribute(record, name.c_str(), copy.data(), count, 6);
  });
}

std::int16_t HRPrimitive::ReadLongVectorAttribute(const std::string& name, std::int32_t* count,
                                                  std::int32_t** hostValues) const {
  return WithRecord(entity_, model_status::kAttributeFailed, [&](host::RecordHandle record) {
    return qel_read_unknown_long_vector(record, name.c_str(), count, hostValues);
  });
}

std::int16_t HRPrimitive::ReadFloatVectorAttribute(const std::string& name, std::int32_t* count,
                                                   float** hostValues) const {
  return WithRecord(entity_, model_status::kAttributeFailed, [&](host::RecordHandle record) {
    return qel_read_unknown_float_vector(record, name.c_str(), count, hostValues);
  });
}

std::int16_t HRPrimitive::RemoveAttribute(const std::string& name) const {
  return WithRecord(entity_, model_status::kAttributeFailed, [&](host::RecordHandle record) {
    return qel_remove_attribute_from_record(record, name.c_str());
  });
}
