// A fresh host with the library loaded over an empty drawing that lives in a scratch folder, and
// what the 2D tests compare against: the host calls in order and the views put on screen.
#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <string>
#include <vector>

#include "display/save2d.h"
#include "model/current_database.h"
#include "shell/host/qeldll_2d.h"
#include "shell/plugin_exports.h"
#include "tests/draft/draft_fixture.h"
#include "tests/drawing_file/scratch_folder.h"
#include "views/hr_camera.h"
#include "views/hr_camera_mgr.h"
#include "workbench/workbench.h"

namespace output2d_test {

// A camera's 2D options, in the order Save2D takes them.
struct SaveOptions {
  std::uint8_t autoClip = 0, overwrite = 1, removeCoincident = 0, lineMerge = 0, dimensions = 0, texts = 0, walls = 0;
  std::uint8_t layer = 0;
  std::int16_t layerIndex = 0;
};

// A view as a camera holds it.
struct View {
  std::array<float, 3> eye{}, target{};
  bool perspective = false;
  std::int16_t displayMode = 0;
  std::array<double, 4> window{-100.0, -100.0, 100.0, 100.0};
};

class Output2DTest : public ::testing::Test {
 protected:
  void SetUp() override {
    Bench().Reset();
    // The host's own work files go with the test's, not into a folder that outlives it.
    HostState().specialFolder = scratch_ / "host";
    Bench().LoadPlugin({pandex::kExports.attach, pandex::kExports.detach, pandex::kExports.entry});
    SetDatabase(Bench().Current());
    Bench().SetDrawingPath(Bench().Current(), (scratch_ / "house.pdx").string());
  }
  void TearDown() override {
    EXPECT_EQ(Bench().Records().OpenCount(), 0U) << "an attribute record was left open";
    Bench().GetFaults().Clear();
    Bench().UnloadPlugin();
    EXPECT_EQ(Bench().Memory().Outstanding(), 0) << "host memory was not released";
    EXPECT_EQ(Bench().Memory().BadReleases(), 0);
    Bench().Reset();
  }

  static wb::Workbench& Bench() { return wb::Workbench::Get(); }
  static wb::Drawing& Drawing() { return Bench().CurrentDrawing(); }
  static wb::Output2DState& HostState() { return Bench().Output2D(); }
  const std::filesystem::path& Folder() const { return scratch_.Path(); }
  std::filesystem::path Target() const { return scratch_ / "view"; }

  // Commands, overlays, change records and the 2D host calls that change the host, in the order
  // the host saw them.
  static std::vector<std::string> Steps() {
    using Kind = wb::JournalEntry::Kind;
    std::vector<std::string> steps;
    for (const wb::JournalEntry& e : Bench().GetJournal().Entries()) {
      const bool hostCall = e.kind == Kind::HostCall;
      if (e.kind == Kind::Command || (hostCall && e.name == "SetSymbolString")) steps.push_back(e.name);
      if (e.kind == Kind::Overlay) steps.push_back("overlay " + e.name);
      const std::string entity = std::to_string(e.entity);
      if (e.kind == Kind::ChangeRecord) steps.push_back("write_to_record " + entity + " " + std::to_string(e.code));
      if (hostCall && (e.name == "qel_put_long_name" || e.name == "select_app_entity")) {
        steps.push_back(e.name + " " + entity);
      }
    }
    return steps;
  }
  static long Count(const std::string& step) { return std::ranges::count(Steps(), step); }

  // Registers the target under kind 10, as the batch does, and runs Save2D on it.
  static bool Save(const std::filesystem::path& target, const SaveOptions& o = {}) {
    std::int32_t word = -1;
    qel_put_long_name(target.c_str(), 10, &word);
    return HRUtility::Save2D(target.string(), o.autoClip, o.overwrite, o.removeCoincident, o.lineMerge, o.dimensions,
                             o.texts, o.walls, o.layer, o.layerIndex);
  }

  static CameraSettings SettingsFor(const View& view) {
    CameraSettings settings;
    std::copy(view.eye.begin(), view.eye.end(), settings.eye);
    std::copy(view.target.begin(), view.target.end(), settings.target);
    settings.cone = 45.0F;
    std::copy(view.window.begin(), view.window.end(), settings.viewWindow);
    settings.displayMode = view.displayMode;
    settings.viewMode = view.perspective ? HRCamera::k3DPerspective : HRCamera::k3DParallel;
    settings.layers.fill(1);
    return settings;
  }
  // Puts the view on the host screen the way the batch does, through a camera's Execute.
  static void Show(const View& view) {
    HRCamera camera;
    camera.SetSettings(SettingsFor(view));
    ASSERT_EQ(camera.Execute(nullptr), 0);
  }
  // A stored general camera, ticked for 2D or not.
  static void AddCamera(const std::string& name, const View& view, bool ticked = true, const std::string& file = "") {
    CameraSettings settings = SettingsFor(view);
    settings.file2D = file;
    HRCamera camera;
    camera.SetSettings(settings);
    camera.SetName(name);
    camera.SetFor2D(ticked ? 1 : 0);
    EXPECT_GE(AddGeneralCamera(camera), 0) << name;
  }
  static void AddCube() { draft_test::AddBox(Drawing(), {0.0F, 0.0F, 0.0F}, {1.0F, 1.0F, 1.0F}); }

 private:
  drawing_file_samples::ScratchFolder scratch_;
};

}  // namespace output2d_test
