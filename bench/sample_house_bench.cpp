// 2D generation of the sample house: one view, and the whole batch of its ticked views.
#include <benchmark/benchmark.h>

#include <filesystem>
#include <unistd.h>

#include "app/plugin_session.h"
#include "display/build_batch.h"
#include "display/save2d.h"
#include "samples/sample_drawing.h"
#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll_2d.h"
#include "views/hr_camera_mgr.h"
#include "views/view_collection.h"
#include "workbench/workbench.h"

namespace {

// The sample house open in the workbench with the plug-in loaded; output under a temp folder.
class HouseSession {
 public:
  HouseSession()
      : folder_(std::filesystem::temp_directory_path() / ("pandex-bench-" + std::to_string(::getpid()))),
        session_(samples::MakeSampleDrawing()) {
    std::filesystem::create_directories(folder_);
    wb::Workbench::Get().SetDrawingPath(db.handle, (folder_ / "house.pdx").string());
    SetDatabase(db.handle);
  }
  ~HouseSession() {
    std::error_code error;
    std::filesystem::remove_all(folder_, error);
  }
  const std::filesystem::path& Folder() const { return folder_; }

 private:
  std::filesystem::path folder_;
  app::PluginSession session_;
};

void SampleHouseOneView(benchmark::State& state) {
  const HouseSession session;
  HRCamera camera;
  LoadGeneralCamera(camera, 1);  // the axonometric view, hidden lines removed
  camera.Execute(nullptr);
  const std::string target = (session.Folder() / "one_view").string();
  for (auto _ : state) {
    std::int32_t word = -1;
    qel_put_long_name(target.c_str(), 10, &word);
    const bool saved = HRUtility::Save2D(target, 1, 1, 1, 1, 0, 0, 0, 0, 0);
    if (!saved) state.SkipWithError("the view was not saved");
  }
}
BENCHMARK(SampleHouseOneView)->Unit(benchmark::kMillisecond);

void SampleHouseWholeBatch(benchmark::State& state) {
  const HouseSession session;
  std::int32_t saved = 0;
  for (auto _ : state) {
    HRUtility::Build2DBatch batch(HRUtility::BuildMode::All, CollectSectionHandles(db.handle),
                                  CollectPlanHandles(db.handle));
    saved = batch.Run().Saved();
  }
  state.counters["views"] = saved;
  state.SetItemsProcessed(state.iterations() * saved);
}
BENCHMARK(SampleHouseWholeBatch)->Unit(benchmark::kMillisecond);

}  // namespace
