// Finding the views of a large drawing: the camera manager's reload and the section and plan
// collection walks over 1,000,000 entities holding 10,000 cameras, 1,000 sections and 1,000
// plans.
#include <benchmark/benchmark.h>

#include <string>

#include "model/current_database.h"
#include "shell/plugin_exports.h"
#include "views/hr_camera_mgr.h"
#include "views/hr_plane.h"
#include "views/hr_section.h"
#include "views/view_collection.h"
#include "workbench/workbench.h"

namespace {

constexpr int kEntities = 1'000'000;
constexpr int kCameras = 10'000;
constexpr int kSections = 1'000;
constexpr int kPlans = 1'000;

// Builds the drawing once: views through the plug-in, the rest as plain lines.
class LargeDrawing {
 public:
  LargeDrawing() {
    wb::Workbench& bench = wb::Workbench::Get();
    bench.Reset();
    bench.LoadPlugin({pandex::kExports.attach, pandex::kExports.detach, pandex::kExports.entry});
    SetCurrentDatabase(bench.Current());
    const int fillerEvery = kEntities / (kCameras + kSections + kPlans);
    for (int i = 0; i < kCameras; ++i) {
      AddFiller(fillerEvery);
      HRCamera camera;
      camera.SetName("Camera " + std::to_string(i));
      camera.Create();
    }
    const double start[3] = {0.0, 0.0, 0.0};
    const double end[3] = {10.0, 0.0, 0.0};
    for (int i = 0; i < kSections; ++i) {
      AddFiller(fillerEvery);
      HRSection section;
      section.SetName("S" + std::to_string(i));
      section.Build("S" + std::to_string(i), "lib\\sec01", start, end);
      section.Create();
    }
    for (int i = 0; i < kPlans; ++i) {
      AddFiller(fillerEvery);
      HRPlane plan;
      plan.Define("P" + std::to_string(i), start, end);
      plan.Create();
    }
    wb::Drawing& drawing = bench.CurrentDrawing();
    while (drawing.slots.size() < static_cast<std::size_t>(kEntities)) drawing.Add(host::kTypeLine);
    bench.GetJournal().Clear();
  }

 private:
  static void AddFiller(int count) {
    wb::Drawing& drawing = wb::Workbench::Get().CurrentDrawing();
    for (int i = 0; i < count; ++i) drawing.Add(host::kTypeLine);
  }
};

LargeDrawing& Drawing() {
  static LargeDrawing drawing;
  return drawing;
}

void CameraManagerReload(benchmark::State& state) {
  Drawing();
  const host::DatabaseHandle database = wb::Workbench::Get().Current();
  for (auto _ : state) {
    SetDatabase(database);
    benchmark::DoNotOptimize(GetGeneralCameraCount());
  }
  if (GetGeneralCameraCount() != kCameras) state.SkipWithError("wrong camera count");
  state.SetItemsProcessed(state.iterations() * kEntities);
}
BENCHMARK(CameraManagerReload)->Unit(benchmark::kMillisecond);

void SectionAndPlanCollection(benchmark::State& state) {
  Drawing();
  const host::DatabaseHandle database = wb::Workbench::Get().Current();
  std::size_t found = 0;
  for (auto _ : state) {
    found = CollectSectionHandles(database).size() + CollectPlanHandles(database).size();
    benchmark::DoNotOptimize(found);
  }
  if (found != static_cast<std::size_t>(kSections + kPlans)) state.SkipWithError("wrong section or plan count");
  // Two full walks per iteration.
  state.SetItemsProcessed(state.iterations() * 2 * kEntities);
}
BENCHMARK(SectionAndPlanCollection)->Unit(benchmark::kMillisecond);

}  // namespace
