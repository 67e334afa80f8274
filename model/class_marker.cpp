// Reading the class marker of an entity.
#include "model/class_marker.h"

#include "model/attribute_record.h"
#include "model/host_allocation.h"
#include "shell/host/qeldll.h"

bool HasClassMarker(host::DatabaseHandle database, host::EntityHandle entity, const std::string& className) {
  AttributeRecord record(database, entity);
  if (!record.IsOpen()) return false;
  char* hostText = nullptr;
  const host::Status result = qel_read_string_attribute(record.Get(), kClassAttribute, &hostText);
  const HostAllocation<char> text(hostText);
  return result == host::kOk && text != nullptr && className == text.get();
}
