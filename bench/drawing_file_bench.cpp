// Saving and opening a drawing of a million entities through the drawing file store, sync to
// disk included: items are entities, so items_per_second is entities per second.
#include <benchmark/benchmark.h>

#include <cstdint>
#include <filesystem>

#include "tests/drawing_file/sample_drawings.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/drawing_file.h"

namespace {

constexpr std::int64_t kEntities = 1'000'000;

const wb::Drawing& LargeDrawing() {
  static const wb::Drawing drawing = drawing_file_samples::MakeBulkDrawing(kEntities, 1);
  return drawing;
}

void ReportSize(benchmark::State& state, const std::filesystem::path& file) {
  state.SetItemsProcessed(state.iterations() * kEntities);
  state.counters["file_MB"] = static_cast<double>(std::filesystem::file_size(file)) / 1e6;
}

// Each save replaces the previous file, as saving an open drawing again does.
void BM_SaveDrawingFile(benchmark::State& state) {
  const wb::Drawing& drawing = LargeDrawing();
  const drawing_file_samples::ScratchFolder folder;
  for (auto _ : state) wb::SaveDrawingFile(drawing, folder / "large.pdx");
  ReportSize(state, folder / "large.pdx");
}
BENCHMARK(BM_SaveDrawingFile)->Unit(benchmark::kMillisecond)->UseRealTime();

void BM_OpenDrawingFile(benchmark::State& state) {
  const drawing_file_samples::ScratchFolder folder;
  wb::SaveDrawingFile(LargeDrawing(), folder / "large.pdx");
  for (auto _ : state) {
    wb::Drawing opened = wb::OpenDrawingFile(folder / "large.pdx");
    benchmark::DoNotOptimize(opened);
    // Freeing the drawing is not part of opening it.
    state.PauseTiming();
    opened = wb::Drawing();
    state.ResumeTiming();
  }
  ReportSize(state, folder / "large.pdx");
}
BENCHMARK(BM_OpenDrawingFile)->Unit(benchmark::kMillisecond)->UseRealTime();

}  // namespace
