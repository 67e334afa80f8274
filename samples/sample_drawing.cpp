// Builds the sample drawing in code, so that it never goes stale against the file format.
#include "samples/sample_drawing.h"

#include "samples/sample_house.h"
#include "shell/plugin_exports.h"
#include "workbench/workbench.h"

namespace samples {

wb::Drawing MakeSampleDrawing() {
  wb::Workbench& bench = wb::Workbench::Get();
  bench.Reset();
  bench.LoadPlugin({pandex::kExports.attach, pandex::kExports.detach, pandex::kExports.entry});
  BuildSampleHouse();
  wb::Drawing drawing = bench.CurrentDrawing();
  drawing.title = "sample";
  bench.Reset();
  return drawing;
}

}  // namespace samples
