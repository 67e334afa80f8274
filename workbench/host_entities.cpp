// Host calls on single entities: headers, deletion, lines and texts.
#include <vector>

#include "shell/host/qeldll.h"
#include "workbench/host_call_support.h"

namespace wb::call {

void DeleteEntity(Drawing& drawing, host::EntityHandle entity) {
  for (Entity& owner : drawing.slots) {
    if (!owner.members.empty()) std::erase(owner.members, entity);
  }
  drawing.Remove(entity);
}

}  // namespace wb::call

using namespace wb;

Status qel_read_entity_header(DatabaseHandle database, EntityHandle entity, host::EntityHeader* header) {
  if (auto fault = call::Fault(__func__, entity)) return call::AsStatus(*fault);
  const Entity* found = call::FindEntity(database, entity);
  if (found == nullptr || header == nullptr) return 0;
  *header = found->header;
  return host::kOk;
}

Status qel_update_entity_header(DatabaseHandle database, EntityHandle entity, const host::EntityHeader* header) {
  if (auto fault = call::Fault(__func__, entity)) return call::AsStatus(*fault);
  Entity* found = call::FindEntity(database, entity);
  if (found == nullptr || header == nullptr) return 0;
  // The type says which record the entity holds; a header update must not turn a line into a
  // block, so the host keeps its own type byte.
  const std::uint8_t type = found->Type();
  found->header = *header;
  found->header.bytes[host::kHeaderType] = type;
  call::JournalHostCall(__func__, entity);
  return host::kOk;
}

Status qel_delete_entity(DatabaseHandle database, EntityHandle entity) {
  if (auto fault = call::Fault(__func__, entity)) return call::AsStatus(*fault);
  Drawing* drawing = Workbench::Get().Find(database);
  if (drawing == nullptr || drawing->Find(entity) == nullptr) return 0;
  call::DeleteEntity(*drawing, entity);
  call::JournalHostCall(__func__, entity);
  return host::kOk;
}

Status qel_read_line(DatabaseHandle database, EntityHandle entity, host::LineRecord* line) {
  return call::ReadTypedRecord(__func__, database, entity, host::kTypeLine, line);
}

Status qel_update_line(DatabaseHandle database, EntityHandle entity, const host::LineRecord* line) {
  return call::UpdateTypedRecord(__func__, database, entity, host::kTypeLine, line);
}

Status qel_add_line(DatabaseHandle database, EntityHandle* newEntity, const host::LineRecord* line) {
  if (auto fault = call::Fault(__func__)) return call::AsStatus(*fault);
  Drawing* drawing = Workbench::Get().Find(database);
  if (drawing == nullptr || newEntity == nullptr || line == nullptr) return 0;
  Entity& entity = drawing->Add(host::kTypeLine);
  WriteRecord(entity, *line);
  *newEntity = entity.handle;
  call::JournalHostCall(__func__, entity.handle);
  return host::kOk;
}

// The style and mode choose how the host draws the text; this host draws texts with its
// standing settings, so both are accepted and not kept.
Status qel_add_text(DatabaseHandle database, EntityHandle* newEntity, const host::LineRecord* line,
                    const char* /*style*/, const char* text, std::int16_t /*mode*/) {
  if (auto fault = call::Fault(__func__)) return call::AsStatus(*fault);
  Drawing* drawing = Workbench::Get().Find(database);
  if (drawing == nullptr || newEntity == nullptr || line == nullptr || text == nullptr) return 0;
  Entity& entity = drawing->Add(host::kTypeLine);
  WriteRecord(entity, *line);
  Attribute& content = entity.attributes.emplace_back();
  content.name = "t=";
  content.type = AttributeType::String;
  content.text = text;
  *newEntity = entity.handle;
  call::JournalHostCall(__func__, entity.handle);
  return host::kOk;
}
