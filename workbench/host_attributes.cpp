// Host calls on attribute records: open and close, typed set, read and remove by exact name.
#include <algorithm>
#include <vector>

#include "shell/host/qeldll.h"
#include "workbench/host_call_support.h"

using namespace wb;

namespace {

bool UsableName(const char* name) { return name != nullptr && name[0] != '\0'; }

// The attribute a set_* call writes: the existing one of that name, emptied and retyped in
// place (an attribute keeps its position in the record), or a new one at the end. Names are
// taken exactly as given; the host does not add or strip "=".
Attribute& Writable(Entity& owner, const char* name, AttributeType type) {
  Attribute* attribute = owner.FindAttribute(name);
  if (attribute == nullptr) {
    attribute = &owner.attributes.emplace_back();
  } else {
    *attribute = Attribute{};
  }
  attribute->name = name;
  attribute->type = type;
  call::AddToJournal(JournalEntry::Kind::AttributeWrite, name, owner.handle);
  return *attribute;
}

// The attribute a read asks for, or null with `status` set to what the read answers:
// kAttributeAbsent when the record holds no such name, 0 for any other refusal.
const Attribute* Readable(const Entity* owner, const char* name, AttributeType type, Status& status) {
  status = 0;
  if (owner == nullptr || !UsableName(name)) return nullptr;
  const Attribute* attribute = owner->FindAttribute(name);
  if (attribute == nullptr) {
    status = host::kAttributeAbsent;
    return nullptr;
  }
  return attribute->type == type ? attribute : nullptr;
}

// Shared shape of the set_* calls: owner lookup, fault check, argument check, write.
template <typename Write>
Status SetAttribute(const char* function, RecordHandle record, const char* name, AttributeType type,
                    bool argumentsValid, Write write) {
  Entity* owner = call::RecordOwner(record);
  if (auto fault = call::Fault(function, call::HandleOf(owner), name)) return call::AsStatus(*fault);
  if (owner == nullptr || !UsableName(name) || !argumentsValid) return 0;
  write(Writable(*owner, name, type));
  return host::kOk;
}

// Shared shape of the read calls: owner lookup, fault check, typed lookup, copy out.
template <typename Copy>
Status ReadAttribute(const char* function, RecordHandle record, const char* name, AttributeType type,
                     bool argumentsValid, Copy copy) {
  const Entity* owner = call::RecordOwner(record);
  if (auto fault = call::Fault(function, call::HandleOf(owner), name)) return call::AsStatus(*fault);
  Status status = 0;
  const Attribute* attribute = Readable(owner, name, type, status);
  if (attribute == nullptr) return status;
  if (!argumentsValid) return 0;
  return copy(*attribute) ? host::kOk : Status{0};
}

bool CountValid(std::int32_t count, const void* values) { return count >= 0 && (count == 0 || values != nullptr); }

template <typename Value>
Value* HostList(const std::vector<Value>& values) {
  if (values.empty()) return nullptr;
  auto* list = static_cast<Value*>(Workbench::Get().Memory().Allocate(values.size() * sizeof(Value)));
  std::copy(values.begin(), values.end(), list);
  return list;
}

// Fixed-length reads take the first `count` values; a shorter stored vector is refused.
template <typename Value>
bool CopyFixed(const std::vector<Value>& stored, Value* values, std::int32_t count) {
  if (stored.size() < static_cast<std::size_t>(count)) return false;
  std::copy_n(stored.begin(), count, values);
  return true;
}

template <typename Value>
bool HandOutVector(const std::vector<Value>& stored, std::int32_t* count, Value** hostValues) {
  *count = static_cast<std::int32_t>(stored.size());
  *hostValues = HostList(stored);
  return true;
}

}  // namespace

RecordHandle qel_open_attribute_record(DatabaseHandle database, EntityHandle entity, std::int16_t* status) {
  if (auto fault = call::Fault(__func__, entity)) {
    if (status != nullptr) *status = call::AsStatus(*fault);
    return 0;
  }
  const bool open = call::FindEntity(database, entity) != nullptr;
  if (status != nullptr) *status = open ? host::kOk : Status{0};
  return open ? Workbench::Get().Records().Open(database, entity) : 0;
}

Status qel_close_attribute_record(DatabaseHandle database, RecordHandle record) {
  const OpenRecord* open = Workbench::Get().Records().Find(record);
  if (auto fault = call::Fault(__func__, open == nullptr ? call::kNoEntity : open->entity)) {
    return call::AsStatus(*fault);
  }
  return Workbench::Get().Records().Close(database, record) ? host::kOk : Status{0};
}

Status qel_set_string_attribute(RecordHandle record, const char* name, const char* text) {
  return SetAttribute(__func__, record, name, AttributeType::String, text != nullptr,
                      [&](Attribute& attribute) { attribute.text = text; });
}

Status qel_read_string_attribute(RecordHandle record, const char* name, char** hostText) {
  return ReadAttribute(__func__, record, name, AttributeType::String, hostText != nullptr, [&](const Attribute& a) {
    *hostText = Workbench::Get().Memory().DuplicateText(a.text);
    return true;
  });
}

Status qel_set_short_attribute(RecordHandle record, const char* name, std::int16_t value) {
  return SetAttribute(__func__, record, name, AttributeType::Short, true,
                      [&](Attribute& attribute) { attribute.shortValue = value; });
}

Status qel_read_short_attribute(RecordHandle record, const char* name, std::int16_t* value) {
  return ReadAttribute(__func__, record, name, AttributeType::Short, value != nullptr, [&](const Attribute& a) {
    *value = a.shortValue;
    return true;
  });
}

Status qel_set_float_attribute(RecordHandle record, const char* name, float value, std::int16_t format) {
  return SetAttribute(__func__, record, name, AttributeType::Float, true, [&](Attribute& attribute) {
    attribute.floatValue = value;
    attribute.format = format;
  });
}

Status qel_read_float_attribute(RecordHandle record, const char* name, float* value) {
  return ReadAttribute(__func__, record, name, AttributeType::Float, value != nullptr, [&](const Attribute& a) {
    *value = a.floatValue;
    return true;
  });
}

Status qel_set_float_vector_attribute(RecordHandle record, const char* name, const float* values, std::int32_t count,
                                      std::int16_t format) {
  return SetAttribute(__func__, record, name, AttributeType::FloatVector, CountValid(count, values),
                      [&](Attribute& attribute) {
                        attribute.floats.assign(values, values + count);
                        attribute.format = format;
                      });
}

Status qel_read_fixed_float_vector(RecordHandle record, const char* name, float* values, std::int32_t count) {
  return ReadAttribute(__func__, record, name, AttributeType::FloatVector, CountValid(count, values),
                       [&](const Attribute& a) { return CopyFixed(a.floats, values, count); });
}

Status qel_read_fixed_short_vector(RecordHandle record, const char* name, std::int16_t* values, std::int32_t count) {
  return ReadAttribute(__func__, record, name, AttributeType::ShortVector, CountValid(count, values),
                       [&](const Attribute& a) { return CopyFixed(a.shorts, values, count); });
}

Status qel_set_short_vector_attribute(RecordHandle record, const char* name, const std::int16_t* values,
                                      std::int32_t count) {
  return SetAttribute(__func__, record, name, AttributeType::ShortVector, CountValid(count, values),
                      [&](Attribute& attribute) { attribute.shorts.assign(values, values + count); });
}

Status qel_read_unknown_short_vector(RecordHandle record, const char* name, std::int32_t* count,
                                     std::int16_t** hostValues) {
  return ReadAttribute(__func__, record, name, AttributeType::ShortVector, count != nullptr && hostValues != nullptr,
                       [&](const Attribute& a) { return HandOutVector(a.shorts, count, hostValues); });
}

Status qel_set_long_vector_attribute(RecordHandle record, const char* name, std::int32_t count,
                                     const std::int32_t* values) {
  return SetAttribute(__func__, record, name, AttributeType::LongVector, CountValid(count, values),
                      [&](Attribute& attribute) { attribute.longs.assign(values, values + count); });
}

Status qel_read_unknown_long_vector(RecordHandle record, const char* name, std::int32_t* count,
                                    std::int32_t** hostValues) {
  return ReadAttribute(__func__, record, name, AttributeType::LongVector, count != nullptr && hostValues != nullptr,
                       [&](const Attribute& a) { return HandOutVector(a.longs, count, hostValues); });
}

Status qel_read_unknown_float_vector(RecordHandle record, const char* name, std::int32_t* count, float** hostValues) {
  return ReadAttribute(__func__, record, name, AttributeType::FloatVector, count != nullptr && hostValues != nullptr,
                       [&](const Attribute& a) { return HandOutVector(a.floats, count, hostValues); });
}

// Removing a name the record does not hold answers kAttributeAbsent, as a read of it would.
Status qel_remove_attribute_from_record(RecordHandle record, const char* name) {
  Entity* owner = call::RecordOwner(record);
  if (auto fault = call::Fault(__func__, call::HandleOf(owner), name)) return call::AsStatus(*fault);
  if (owner == nullptr || !UsableName(name)) return 0;
  const auto removed = std::erase_if(owner->attributes, [name](const Attribute& a) { return a.name == name; });
  if (removed == 0) return host::kAttributeAbsent;
  call::AddToJournal(JournalEntry::Kind::AttributeRemove, name, owner->handle);
  return host::kOk;
}

std::int16_t is_attribute_exist(DatabaseHandle database, EntityHandle entity, const char* name) {
  if (auto fault = call::Fault(__func__, entity, name)) return call::AsStatus(*fault);
  const Entity* found = call::FindEntity(database, entity);
  return found != nullptr && UsableName(name) && found->FindAttribute(name) != nullptr ? 1 : 0;
}
