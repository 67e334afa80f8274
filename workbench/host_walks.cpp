// Host walks over a drawing in handle order; the cursor is the slot index to look at next.
#include "shell/host/qeldll.h"
#include "workbench/host_call_support.h"

using namespace wb;

namespace {

// Which entities a walk delivers, and whether it hands over each one's header too.
enum class Reach : std::uint8_t { VisibleOnly, HiddenToo, HiddenWithHeader };

// Delivers the next live entity at or after the cursor; answers 0 at the end, with the entity
// 0 and the cursor past the last slot, so asking again keeps answering 0.
Status Walk(const char* function, DatabaseHandle database, EntityHandle* entity, std::int32_t* cursor, Reach reach,
            host::EntityHeader* header) {
  if (auto fault = call::Fault(function)) return call::AsStatus(*fault);
  const Drawing* drawing = Workbench::Get().Find(database);
  if (drawing == nullptr || entity == nullptr || cursor == nullptr || *cursor < 0) return 0;
  if (reach == Reach::HiddenWithHeader && header == nullptr) return 0;
  const std::vector<Entity>& slots = drawing->slots;
  for (std::size_t slot = static_cast<std::size_t>(*cursor); slot < slots.size(); ++slot) {
    const Entity& candidate = slots[slot];
    if (!candidate.Alive() || (reach == Reach::VisibleOnly && candidate.Hidden())) continue;
    *entity = candidate.handle;
    *cursor = static_cast<std::int32_t>(slot + 1);
    if (header != nullptr) *header = candidate.header;
    return host::kOk;
  }
  *entity = 0;
  if (static_cast<std::size_t>(*cursor) < slots.size()) *cursor = static_cast<std::int32_t>(slots.size());
  return 0;
}

}  // namespace

Status loop_on_database(DatabaseHandle database, EntityHandle* entity, std::int32_t* cursor) {
  return Walk(__func__, database, entity, cursor, Reach::VisibleOnly, nullptr);
}

Status loop_on_database_blank(DatabaseHandle database, EntityHandle* entity, std::int32_t* cursor) {
  return Walk(__func__, database, entity, cursor, Reach::HiddenToo, nullptr);
}

Status loop_on_database_blank_h(DatabaseHandle database, EntityHandle* entity, std::int32_t* cursor,
                                host::EntityHeader* header) {
  return Walk(__func__, database, entity, cursor, Reach::HiddenWithHeader, header);
}
