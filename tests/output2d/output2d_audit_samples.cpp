// Writes the 2D files of the sample house for the independent audit: every ticked view through
// the batch and the host's 2D commands, plus a view that carries texts and dimensions over, one
// merged into its earlier version, and one with an awkward name. Beside them, "expected.txt"
// lists per file the LINE and TEXT counts and the layer names the audit must find.
#include <exception>
#include <filesystem>
#include <fstream>
#include <iostream>

#include "display/build_batch.h"
#include "model/current_database.h"
#include "samples/sample_house.h"
#include "shell/plugin_exports.h"
#include "views/hr_camera.h"
#include "views/hr_camera_mgr.h"
#include "views/view_collection.h"
#include "workbench/draft/dxf_reader.h"
#include "workbench/draft/dxf_writer.h"
#include "workbench/workbench.h"

namespace {

// Straight down onto the house, replacing the earlier file unless told otherwise.
void AddTopView(const std::string& name, std::int16_t displayMode, std::uint8_t overwrite, std::uint8_t preserve) {
  CameraSettings settings;
  settings.eye[0] = settings.target[0] = 5.0F;
  settings.eye[1] = settings.target[1] = 4.0F;
  settings.eye[2] = 30.0F;
  settings.cone = 45.0F;
  const double window[4] = {-8.0, -6.0, 8.0, 6.0};
  std::copy(window, window + 4, settings.viewWindow);
  settings.viewMode = HRCamera::k3DParallel;
  settings.displayMode = displayMode;
  settings.layers.fill(1);
  settings.overwrite2D = overwrite;
  settings.removeCoincident = settings.lineMerge = 1;
  settings.preserveText = settings.preserveDimensions = preserve;
  HRCamera camera;
  camera.SetSettings(settings);
  camera.SetName(name);
  camera.SetFor2D(1);
  if (AddGeneralCamera(camera) < 0) throw std::runtime_error("cannot add the camera " + name);
}

void RunBatch(const std::filesystem::path& drawing) {
  const host::DatabaseHandle database = wb::Workbench::Get().Current();
  wb::Workbench::Get().SetDrawingPath(database, drawing.string());
  const HRUtility::BuildResult result =
      HRUtility::Build2DBatch(HRUtility::BuildMode::All, CollectSectionHandles(database), CollectPlanHandles(database))
          .Run();
  if (!result.AllSaved()) throw std::runtime_error("the batch saved " + std::to_string(result.Saved()) + " views");
}

// The audit looks at one folder: the files move up out of the 2D folder.
void ListOutput(const std::filesystem::path& outputFolder, const std::filesystem::path& folder) {
  std::ofstream expected(folder / "expected.txt");
  for (const auto& entry : std::filesystem::directory_iterator(outputFolder)) {
    const std::filesystem::path moved = folder / entry.path().filename();
    std::filesystem::rename(entry.path(), moved);
    if (moved.extension() != ".dxf") continue;
    const wb::draft::Sheet sheet = wb::draft::ReadDxfSheet(moved);
    expected << moved.filename().string() << '\t' << sheet.strokes.size() << '\t' << sheet.labels.size();
    for (const std::string& layer : wb::draft::DxfLayerNames(sheet)) {
      if (!layer.empty()) expected << '\t' << layer;
    }
    expected << '\n';
  }
  if (!expected.flush()) throw std::runtime_error("cannot write expected.txt");
}

}  // namespace

int main(int argc, char** argv) {
  if (argc != 2) {
    std::cerr << "usage: output2d_audit_samples FOLDER\n";
    return 2;
  }
  try {
    const std::filesystem::path folder = argv[1];
    wb::Workbench& bench = wb::Workbench::Get();
    bench.Reset();
    bench.Output2D().specialFolder = folder / "host";
    bench.LoadPlugin({pandex::kExports.attach, pandex::kExports.detach, pandex::kExports.entry});
    SetDatabase(bench.Current());
    samples::BuildSampleHouse();
    AddTopView("Kept texts", 0, 1, 1);
    AddTopView("Merged", 2, 0, 0);  // hidden lines, merged into the first run's drawing
    AddTopView("../odd: name*?\t", 0, 1, 0);
    // The second run replaces every file but the merged one, which holds both runs.
    RunBatch(folder / "house.pdx");
    RunBatch(folder / "house.pdx");
    bench.UnloadPlugin();
    ListOutput(folder / "2D_", folder);
    std::filesystem::remove_all(folder / "2D_");
    std::filesystem::remove_all(folder / "host");
  } catch (const std::exception& error) {
    std::cerr << "output2d_audit_samples: " << error.what() << '\n';
    return 1;
  }
  return 0;
}
