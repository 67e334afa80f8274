// Hidden-line removal on a city of boxes in an isometric view: how the 2D pipeline scales with
// the number of solids.
#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdint>
#include <random>

#include "workbench/draft/generate_sheet.h"
#include "workbench/draft/solid_mesh.h"

namespace {

constexpr float kFootprint = 7.0F;
constexpr float kSpacing = 10.0F;
constexpr std::uint32_t kSeed = 20240611;

// A square grid of n boxes (n a square), 7 x 7 on a spacing of 10, heights uniform in [2, 20].
wb::Drawing City(int n) {
  const int side = static_cast<int>(std::lround(std::sqrt(n)));
  std::mt19937 random(kSeed);
  std::uniform_real_distribution<float> height(2.0F, 20.0F);
  wb::Drawing drawing;
  for (int row = 0; row < side; ++row) {
    for (int column = 0; column < side; ++column) {
      wb::Entity& box = drawing.Add(host::kTypeSolid);
      box.header.bytes[host::kHeaderColor] = 1;
      const host::Point3f corner{static_cast<float>(column) * kSpacing, static_cast<float>(row) * kSpacing, 0.0F};
      wb::draft::WriteSolidMesh(box, wb::draft::MakeBox(corner, {kFootprint, kFootprint, height(random)}));
    }
  }
  return drawing;
}

void BM_CityHiddenLines(benchmark::State& state) {
  const int n = static_cast<int>(state.range(0));
  const wb::Drawing drawing = City(n);
  const float middle = static_cast<float>(std::sqrt(n)) * kSpacing / 2.0F;
  wb::draft::GenerateOptions options;
  options.view = {{middle - 1000.0F, middle - 1000.0F, 1000.0F}, {middle, middle, 0.0F}, false};
  options.hideHiddenLines = true;
  std::size_t strokes = 0;
  for (auto _ : state) {
    const wb::draft::Sheet sheet = wb::draft::GenerateSheet(drawing, options);
    strokes = sheet.strokes.size();
    benchmark::DoNotOptimize(sheet.strokes.data());
  }
  state.SetItemsProcessed(state.iterations() * 12 * n);  // triangles
  state.counters["strokes"] = static_cast<double>(strokes);
}
BENCHMARK(BM_CityHiddenLines)->Arg(400)->Arg(1600)->Arg(3600)->Arg(10000)->Unit(benchmark::kMillisecond);

}  // namespace
