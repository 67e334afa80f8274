// Applying a camera and capturing the view right after gives the camera back: every value a
// camera applies through this host's commands and calls reads back through its queries.
#include <algorithm>
#include <array>
#include <cstdint>

#include "display/display_mode.h"
#include "tests/shell/plugin_fixture.h"
#include "views/hr_camera.h"
#include "workbench/workbench.h"

namespace {

struct Shot {
  std::int16_t viewMode;
  std::int16_t displayMode;
  char scaleMode;
};

CameraSettings SettingsFor(const Shot& shot) {
  CameraSettings settings;
  settings.eye[0] = 3.5F;
  settings.eye[1] = -40.0F;
  settings.eye[2] = 12.25F;
  settings.target[0] = 1.0F;
  settings.target[1] = 2.0F;
  settings.target[2] = 0.5F;
  settings.cone = 30.0F;
  settings.viewWindow[0] = -5.0;
  settings.viewWindow[1] = -2.5;
  settings.viewWindow[2] = 15.0;
  settings.viewWindow[3] = 9.75;
  settings.viewMode = shot.viewMode;
  settings.displayMode = shot.displayMode;
  settings.scaleMode = shot.scaleMode;
  for (std::size_t i = 0; i < settings.layers.size(); ++i) settings.layers[i] = i % 3 == 0 ? 0 : 1;
  return settings;
}

class CameraRoundTripTest : public LoadedPluginTest {
 protected:
  static long Regenerations() {
    const std::vector<std::string> commands = wb::Workbench::Get().GetJournal().Names(wb::JournalEntry::Kind::Command);
    return std::count(commands.begin(), commands.end(), "regen");
  }
};

TEST_F(CameraRoundTripTest, CaptureAfterExecuteGivesTheCameraBack) {
  // Rendering is 3D only, so the 2D view modes are paired with the other modes.
  const Shot shots[] = {
      {HRCamera::k2DParallel, HRUtility::kGeometric, 'a'},
      {HRCamera::k2DPerspective, HRUtility::kHiddenline, 'f'},
      {HRCamera::k3DParallel, HRUtility::kMonoShadowModel, 'o'},
      {HRCamera::k3DPerspective, HRUtility::kRender, ' '},
      {HRCamera::k3DParallel, HRUtility::kShaded, 'f'},
  };
  for (const Shot& shot : shots) {
    const CameraSettings wanted = SettingsFor(shot);
    HRCamera camera;
    camera.SetSettings(wanted);
    ASSERT_EQ(camera.Execute(nullptr), 0);

    HRCamera captured;
    ASSERT_EQ(captured.CaptureView(), 0);
    CameraSettings got;
    captured.GetSettings(got);
    SCOPED_TRACE(testing::Message() << "view mode " << shot.viewMode << ", display mode " << shot.displayMode);
    EXPECT_EQ(std::to_array(got.eye), std::to_array(wanted.eye));
    EXPECT_EQ(std::to_array(got.target), std::to_array(wanted.target));
    EXPECT_EQ(got.cone, wanted.cone);
    EXPECT_EQ(std::to_array(got.viewWindow), std::to_array(wanted.viewWindow));
    EXPECT_EQ(got.viewMode, wanted.viewMode);
    EXPECT_EQ(got.displayMode, wanted.displayMode);
    EXPECT_EQ(got.scaleMode, wanted.scaleMode);
    EXPECT_EQ(got.layers, wanted.layers);
    EXPECT_EQ(wb::Workbench::Get().View().waitCursor, 0);
  }
  EXPECT_EQ(wb::Workbench::Get().View().waitCursorUnderflows, 0);
}

TEST_F(CameraRoundTripTest, RefusedLayerSwitchEndsExecuteWithTheWaitCursorRemoved) {
  wb::FaultRule refuseLayerSix;
  refuseLayerSix.call = "HDL_Set_Layer_Off";
  refuseLayerSix.entity = 6;
  wb::Workbench::Get().GetFaults().Add(refuseLayerSix);
  HRCamera camera;
  camera.SetSettings(SettingsFor({HRCamera::k3DParallel, HRUtility::kGeometric, 'a'}));
  EXPECT_EQ(camera.Execute(nullptr), -12);
  wb::Workbench& host = wb::Workbench::Get();
  EXPECT_EQ(host.View().waitCursor, 0);
  EXPECT_FALSE(host.CurrentDrawing().layers[3].on);
  EXPECT_TRUE(host.CurrentDrawing().layers[6].on);
  EXPECT_TRUE(host.CurrentDrawing().layers[9].on) << "layers after the refused one stay as they were";
}

TEST_F(CameraRoundTripTest, PatternsAreKeptOnlyWhereTheHostCanShowThem) {
  CameraSettings settings = SettingsFor({HRCamera::k3DParallel, HRUtility::kGeometric, 'a'});
  settings.patterns = 1;
  HRCamera camera;
  camera.SetSettings(settings);
  wb::Workbench::Get().Display().patternsShowable = false;
  camera.Execute(nullptr);
  EXPECT_EQ(Regenerations(), 0) << "the host dropped the patterns, so the camera only redraws";
  EXPECT_FALSE(wb::Workbench::Get().Display().hatchPatterns);

  wb::Workbench::Get().Display().patternsShowable = true;
  camera.Execute(nullptr);
  EXPECT_EQ(Regenerations(), 1);
  EXPECT_TRUE(wb::Workbench::Get().Display().hatchPatterns);
  HRCamera captured;
  captured.CaptureView();
  EXPECT_TRUE(captured.HasPatterns());
}

}  // namespace
