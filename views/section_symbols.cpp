// Section symbol visibility: whole-drawing walks that hide or show every section's instance.
#include "views/section_symbols.h"

#include "model/class_marker.h"
#include "model/current_database.h"
#include "model/status_codes.h"
#include "model/hr_placed_block.h"
#include "shell/host/qeldll.h"

std::uint8_t SectionsShown = 0;

namespace {

constexpr const char* kSectionClass = "HRSection";

using Walk = host::Status (*)(host::DatabaseHandle, host::EntityHandle*, std::int32_t*);

template <typename Change>
void ForEachSection(Walk walk, Change change) {
  const host::DatabaseHandle database = GetCurrentDatabase();
  host::EntityHandle entity = 0;
  std::int32_t cursor = 0;
  while (walk(database, &entity, &cursor) == host::kOk) {
    if (!IsSection(database, entity)) continue;
    HRPlacedBlock instance;
    // Changing the flag of a header that could not be read would write a blank header back.
    if (instance.Read(database, entity) == model_status::kHeaderNotRead) continue;
    change(instance);
  }
}

}  // namespace

bool IsSection(host::DatabaseHandle database, host::EntityHandle entity) {
  return HasClassMarker(database, entity, kSectionClass);
}

void HideSectionSymbols() {
  ForEachSection(&loop_on_database, [](HRPlacedBlock& instance) { instance.Hide(); });
}

void ShowSectionSymbols() {
  ForEachSection(&loop_on_database_blank, [](HRPlacedBlock& instance) { instance.Show(); });
}
