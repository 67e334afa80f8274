// The workbench's in-memory drawing: entities by handle with their headers, typed records,
// attribute records and block members, plus the layer table. Host calls read and change it;
// the drawing file store saves and opens it whole.
#pragma once

#include <array>
#include <cstdint>
#include <cstring>
#include <string>
#include <vector>

#include "shell/host/host_types.h"

namespace wb {

enum class AttributeType : std::uint8_t {
  String = 1,
  Short = 2,
  Float = 3,
  FloatVector = 4,
  ShortVector = 5,
  LongVector = 6,
};

// One named value of an entity's attribute record. Only the member matching `type` is used.
struct Attribute {
  std::string name;  // as written, normally ending in "="
  AttributeType type = AttributeType::String;
  std::int16_t format = 0;  // the format code float writers hand over
  std::string text;
  std::int16_t shortValue = 0;
  float floatValue = 0.0F;
  std::vector<float> floats;
  std::vector<std::int16_t> shorts;
  std::vector<std::int32_t> longs;

  bool operator==(const Attribute&) const = default;
};

struct Entity {
  host::EntityHandle handle = 0;  // 0 marks a deleted slot
  host::EntityHeader header{};
  // The typed host record of this entity's type (line, point, block, group, placed block,
  // element), kept whole as the host struct's bytes.
  std::vector<std::uint8_t> record;
  std::string name;                           // block, group and placed-block name
  std::vector<host::EntityHandle> members;    // block and group members, in order
  std::string configPath;                     // elements: library folder
  std::string elementName;                    // elements: library element name
  std::vector<Attribute> attributes;          // in the order first written

  std::uint8_t Type() const { return header.bytes[host::kHeaderType]; }
  bool Hidden() const { return (header.bytes[host::kHeaderFlags] & host::kFlagHidden) != 0; }
  bool Alive() const { return handle != 0; }

  const Attribute* FindAttribute(const char* attributeName) const;
  Attribute* FindAttribute(const char* attributeName);

  bool operator==(const Entity& other) const;
};

struct Layer {
  std::string name;
  bool on = true;
  bool operator==(const Layer&) const = default;
};

constexpr int kLayerCount = 256;

struct Drawing {
  // Slot i holds handle i + 1; handles are never reused, so deleted slots stay as
  // tombstones (handle 0).
  std::vector<Entity> slots;
  std::array<Layer, kLayerCount> layers{};
  std::string title;  // drawing title, e.g. the file name without folder and extension

  Drawing();

  host::EntityHandle NextHandle() const { return static_cast<host::EntityHandle>(slots.size()) + 1; }
  // The live entity with this handle, or null.
  Entity* Find(host::EntityHandle handle);
  const Entity* Find(host::EntityHandle handle) const;
  // Appends a new entity of the given type and answers it (its handle is set).
  Entity& Add(std::uint8_t type);
  // Turns the slot into a tombstone; answers false when there was no such entity.
  bool Remove(host::EntityHandle handle);
  std::size_t LiveCount() const;

  bool operator==(const Drawing&) const = default;
};

// Typed views of an entity's record bytes; the record is resized to fit when written.
template <typename Record>
Record ReadRecord(const Entity& entity) {
  Record value{};
  if (entity.record.size() >= sizeof(Record)) {
    std::memcpy(&value, entity.record.data(), sizeof(Record));
  }
  return value;
}

template <typename Record>
void WriteRecord(Entity& entity, const Record& value) {
  entity.record.resize(sizeof(Record));
  std::memcpy(entity.record.data(), &value, sizeof(Record));
}

}  // namespace wb
