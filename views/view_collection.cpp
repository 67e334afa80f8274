// Whole-database walks that keep the entities of one view class. Every entity is examined,
// the first one included.
#include "views/view_collection.h"

#include "model/current_database.h"
#include "shell/host/qeldll.h"
#include "views/hr_plane.h"
#include "views/hr_selection.h"
#include "views/section_symbols.h"

namespace {

template <typename Keep>
std::vector<host::EntityHandle> Collect(host::DatabaseHandle database, Keep keep) {
  std::vector<host::EntityHandle> handles;
  host::EntityHandle entity = 0;
  std::int32_t cursor = 0;
  while (loop_on_database_blank(database, &entity, &cursor) == host::kOk) {
    if (keep(entity)) handles.push_back(entity);
  }
  return handles;
}

}  // namespace

std::vector<host::EntityHandle> CollectSectionHandles(host::DatabaseHandle database) {
  return Collect(database, [database](host::EntityHandle entity) { return IsSection(database, entity); });
}

std::vector<host::EntityHandle> CollectPlanHandles(host::DatabaseHandle database) {
  return Collect(database, [database](host::EntityHandle entity) { return IsPlaneEntity(database, entity); });
}

std::vector<host::EntityHandle> CollectSelectionHandles() {
  return Collect(GetCurrentDatabase(), [](host::EntityHandle entity) { return IsSelection(entity) == 1; });
}
