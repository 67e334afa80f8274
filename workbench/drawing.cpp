// Entity and drawing bookkeeping shared by the host calls and the drawing file store.
#include "workbench/drawing.h"

#include <algorithm>
#include <utility>

namespace wb {

const Attribute* Entity::FindAttribute(const char* attributeName) const {
  for (const Attribute& attribute : attributes) {
    if (attribute.name == attributeName) return &attribute;
  }
  return nullptr;
}

Attribute* Entity::FindAttribute(const char* attributeName) {
  return const_cast<Attribute*>(std::as_const(*this).FindAttribute(attributeName));
}

bool Entity::operator==(const Entity& other) const {
  return handle == other.handle && std::memcmp(header.bytes, other.header.bytes, sizeof header.bytes) == 0 &&
         record == other.record && name == other.name && members == other.members &&
         configPath == other.configPath && elementName == other.elementName && attributes == other.attributes;
}

Drawing::Drawing() {
  for (int i = 0; i < kLayerCount; ++i) layers[static_cast<std::size_t>(i)].name = "Layer " + std::to_string(i + 1);
}

Entity* Drawing::Find(host::EntityHandle handle) {
  return const_cast<Entity*>(std::as_const(*this).Find(handle));
}

const Entity* Drawing::Find(host::EntityHandle handle) const {
  if (handle < 1 || static_cast<std::size_t>(handle) > slots.size()) return nullptr;
  const Entity& entity = slots[static_cast<std::size_t>(handle) - 1];
  return entity.Alive() ? &entity : nullptr;
}

Entity& Drawing::Add(std::uint8_t type) {
  Entity& entity = slots.emplace_back();
  entity.handle = static_cast<host::EntityHandle>(slots.size());
  entity.header.bytes[host::kHeaderType] = type;
  return entity;
}

bool Drawing::Remove(host::EntityHandle handle) {
  Entity* entity = Find(handle);
  if (entity == nullptr) return false;
  *entity = Entity{};
  return true;
}

std::size_t Drawing::LiveCount() const {
  return static_cast<std::size_t>(std::count_if(slots.begin(), slots.end(), [](const Entity& e) { return e.Alive(); }));
}

}  // namespace wb
