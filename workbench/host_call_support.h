// Steps every host call shares: the fault check, finding drawings, entities and the owners of
// open records, and journaling the calls that change a drawing.
#pragma once

#include <cstdint>
#include <optional>

#include "shell/host/host_types.h"
#include "workbench/drawing.h"
#include "workbench/workbench.h"

namespace wb::call {

constexpr host::EntityHandle kNoEntity = FaultRule::kAnyEntity;

// The result an armed fault forces on this call, if any. One branch when nothing is armed.
inline std::optional<std::int32_t> Fault(const char* function, host::EntityHandle entity = kNoEntity,
                                         const char* name = nullptr) {
  return Workbench::Get().GetFaults().Check(function, entity, name);
}

inline host::Status AsStatus(std::int32_t value) { return static_cast<host::Status>(value); }

inline Entity* FindEntity(host::DatabaseHandle database, host::EntityHandle entity) {
  Drawing* drawing = Workbench::Get().Find(database);
  return drawing == nullptr ? nullptr : drawing->Find(entity);
}

// The live entity when it has the given host type; reads and updates of typed records refuse
// any other.
inline Entity* FindEntityOfType(host::DatabaseHandle database, host::EntityHandle entity, std::uint8_t type) {
  Entity* found = FindEntity(database, entity);
  return found != nullptr && found->Type() == type ? found : nullptr;
}

// The entity an open record is bound to: null when the record is not open or its entity has
// been deleted meanwhile.
inline Entity* RecordOwner(host::RecordHandle record) {
  const OpenRecord* open = Workbench::Get().Records().Find(record);
  return open == nullptr ? nullptr : FindEntity(open->database, open->entity);
}

inline host::EntityHandle HandleOf(const Entity* entity) { return entity == nullptr ? kNoEntity : entity->handle; }

inline void AddToJournal(JournalEntry::Kind kind, const char* name, host::EntityHandle entity = 0,
                         std::int32_t code = 0) {
  Workbench::Get().GetJournal().Record(JournalEntry{kind, name, entity, code});
}

// State-changing calls other than commands and attribute writes are journaled by name.
inline void JournalHostCall(const char* function, host::EntityHandle entity = 0) {
  AddToJournal(JournalEntry::Kind::HostCall, function, entity);
}

// Reads a typed host record of an entity of the given type.
template <typename Record>
host::Status ReadTypedRecord(const char* function, host::DatabaseHandle database, host::EntityHandle entity,
                             std::uint8_t type, Record* out) {
  if (auto fault = Fault(function, entity)) return AsStatus(*fault);
  const Entity* found = FindEntityOfType(database, entity, type);
  if (found == nullptr || out == nullptr) return 0;
  *out = ReadRecord<Record>(*found);
  return host::kOk;
}

// Replaces the typed host record of an entity of the given type.
template <typename Record>
host::Status UpdateTypedRecord(const char* function, host::DatabaseHandle database, host::EntityHandle entity,
                               std::uint8_t type, const Record* in) {
  if (auto fault = Fault(function, entity)) return AsStatus(*fault);
  Entity* found = FindEntityOfType(database, entity, type);
  if (found == nullptr || in == nullptr) return 0;
  WriteRecord(*found, *in);
  JournalHostCall(function, entity);
  return host::kOk;
}

// Hands the entity's name out as host memory when the caller asked for it.
inline void HandOutName(const Entity& entity, char** hostName) {
  if (hostName != nullptr) *hostName = Workbench::Get().Memory().DuplicateText(entity.name);
}

// Deletes an entity for good: its handle leaves every block and group that listed it, and the
// members of a deleted block or group stay in the drawing as plain entities.
void DeleteEntity(Drawing& drawing, host::EntityHandle entity);

}  // namespace wb::call
