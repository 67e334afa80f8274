// Walking a large drawing through the host calls: the blank walk that reads each entity's
// class marker, the way the plug-in finds its sections, plans, cameras and selections.
#include <benchmark/benchmark.h>

#include <cstdint>
#include <string>

#include "shell/host/qeldll.h"
#include "workbench/workbench.h"

namespace {

constexpr std::int64_t kEntities = 1'000'000;

// A drawing of lines and camera groups, every one marked with its class, every tenth hidden.
wb::Drawing BuildDrawing() {
  wb::Drawing drawing;
  drawing.slots.reserve(kEntities);
  for (std::int64_t i = 0; i < kEntities; ++i) {
    const bool isGroup = i % 4 == 0;
    wb::Entity& entity = drawing.Add(isGroup ? host::kTypeGroup : host::kTypeLine);
    if (isGroup) {
      wb::WriteRecord(entity, host::GroupRecord{});
      entity.name = "grp";
    } else {
      host::LineRecord line{};
      line.end = {static_cast<float>(i), 1.0F, 0.0F};
      wb::WriteRecord(entity, line);
    }
    if (i % 10 == 0) entity.header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
    wb::Attribute& marker = entity.attributes.emplace_back();
    marker.name = "@Class=";
    marker.text = isGroup ? "HRCamera" : "HRLine";
  }
  return drawing;
}

// The session holds the drawing from the first benchmark on; building it is not timed.
DatabaseHandle LargeDrawing() {
  static const DatabaseHandle database = [] {
    wb::Workbench::Get().Reset();
    return wb::Workbench::Get().Open(BuildDrawing());
  }();
  return database;
}

void BM_BlankWalkReadingClassMarkers(benchmark::State& state) {
  const DatabaseHandle database = LargeDrawing();
  for (auto _ : state) {
    EntityHandle entity = 0;
    std::int32_t cursor = 0;
    std::int64_t seen = 0;
    std::int64_t cameras = 0;
    while (loop_on_database_blank(database, &entity, &cursor) == 1) {
      std::int16_t status = 0;
      const RecordHandle record = qel_open_attribute_record(database, entity, &status);
      char* hostText = nullptr;
      if (status == 1 && qel_read_string_attribute(record, "@Class=", &hostText) == 1) {
        const std::string marker(hostText);
        cameras += marker == "HRCamera" ? 1 : 0;
      }
      log_free(hostText);
      qel_close_attribute_record(database, record);
      ++seen;
    }
    benchmark::DoNotOptimize(cameras);
    if (seen != kEntities || cameras != kEntities / 4) state.SkipWithError("the walk missed entities");
  }
  state.SetItemsProcessed(state.iterations() * kEntities);
  if (wb::Workbench::Get().Memory().Outstanding() != 0) state.SkipWithError("host memory left outstanding");
}
BENCHMARK(BM_BlankWalkReadingClassMarkers)->Unit(benchmark::kMillisecond);

void BM_BlankWalkAlone(benchmark::State& state) {
  const DatabaseHandle database = LargeDrawing();
  for (auto _ : state) {
    EntityHandle entity = 0;
    std::int32_t cursor = 0;
    std::int64_t seen = 0;
    while (loop_on_database_blank(database, &entity, &cursor) == 1) ++seen;
    benchmark::DoNotOptimize(seen);
  }
  state.SetItemsProcessed(state.iterations() * kEntities);
}
BENCHMARK(BM_BlankWalkAlone)->Unit(benchmark::kMillisecond);

}  // namespace
