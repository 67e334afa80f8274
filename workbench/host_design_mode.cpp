// The host's design-mode library: whether an entity is a frame of the sheet layout.
#include "shell/host/dsgmode.h"
#include "workbench/host_call_support.h"

using namespace wb;

std::int16_t IsDsgFrameEntity(host::DatabaseHandle database, host::EntityHandle entity) {
  if (auto fault = call::Fault(__func__, entity)) return static_cast<std::int16_t>(*fault);
  const Entity* found = call::FindEntity(database, entity);
  return found != nullptr && found->FindAttribute("@dsgframe=") != nullptr ? 1 : 0;
}
