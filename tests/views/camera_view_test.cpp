// Cameras and the host view: capturing it, applying a camera whole (Execute) or in two phases
// (ApplyView), the host calls each makes in order, and captures that give the camera back.
#include <algorithm>
#include <string>
#include <vector>

#include "display/display_mode.h"
#include "shell/host/qeldll.h"
#include "shell/host/qeldll_view.h"
#include "tests/views/views_fixture.h"
#include "views/section_symbols.h"

namespace {

using StepList = std::vector<std::string>;

class CameraViewTest : public ViewsTest {
 protected:
  // Puts the host's view where a user would have left it, through the host's own commands.
  static void SetHostView(host::Point3f eye, host::Point3f target, float cone, bool perspective, bool threeD,
                          const double window[4], char scaleMode) {
    globp[48] = eye;
    execute_internal_command("eye");
    globp[47] = target;
    execute_internal_command("target");
    globr[64] = cone;
    execute_internal_command("set_viewing_conus");
    execute_internal_command(perspective ? "set_perspective" : "set_parallel");
    if (threeD) {
      execute_3d();
    } else {
      execute_2d();
    }
    wn3_set_view_rect(window);
    globc[22] = scaleMode;
    execute_internal_command("set_scale_mode");
  }

  static void SetHostLayers(const HRCamera::LayerTable& on) {
    for (std::size_t i = 0; i < on.size(); ++i) Drawing().layers[i].on = on[i] == 1;
  }

  static HRCamera::LayerTable HostLayers() {
    HRCamera::LayerTable table{};
    for (std::size_t i = 0; i < table.size(); ++i) table[i] = Drawing().layers[i].on ? 1 : 0;
    return table;
  }

  static std::vector<std::int32_t> SwitchedLayers(const char* call) {
    std::vector<std::int32_t> layers;
    for (const wb::JournalEntry& entry : Log().Entries()) {
      if (entry.kind == Kind::HostCall && entry.name == call) layers.push_back(entry.code);
    }
    return layers;
  }

  static HRCamera CameraWith(const CameraSettings& settings) {
    HRCamera camera;
    camera.SetSettings(settings);
    return camera;
  }

  // A camera the host can take exactly: a window with its corners in order.
  static CameraSettings ApplicableSettings(std::int16_t displayMode, std::int16_t viewMode) {
    CameraSettings settings = DistinctSettings();
    settings.displayMode = displayMode;
    settings.viewMode = viewMode;
    settings.patterns = 0;
    return settings;
  }

  static int WaitCursor() { return Bench().View().waitCursor; }
};

TEST_F(CameraViewTest, CaptureTakesEveryValueOfTheHostView) {
  const double window[4] = {-4.5, -3.0, 16.0, 9.5};
  SetHostView({1, 2, 3}, {4, 5, 6}, 28.0F, true, true, window, 'f');
  HRCamera::LayerTable layers{};
  for (std::size_t i = 0; i < layers.size(); i += 7) layers[i] = 1;
  SetHostLayers(layers);
  HRUtility::SetDisplayMode(HRUtility::kShaded);
  globc[66] = 'h';

  HRCamera camera;
  EXPECT_EQ(camera.CaptureView(), 0);
  const CameraSettings captured = SettingsOf(camera);
  EXPECT_EQ(captured.eye[0], 1.0F);
  EXPECT_EQ(captured.eye[2], 3.0F);
  EXPECT_EQ(captured.target[1], 5.0F);
  EXPECT_EQ(captured.cone, 28.0F);
  EXPECT_EQ(captured.viewMode, HRCamera::k3DPerspective);
  EXPECT_EQ(captured.displayMode, HRUtility::kShaded);
  EXPECT_EQ(captured.scaleMode, 'f');
  EXPECT_EQ(captured.layers, layers);
  EXPECT_EQ(captured.patterns, 1);
  for (int i = 0; i < 4; ++i) EXPECT_DOUBLE_EQ(captured.viewWindow[i], window[i]);
}

TEST_F(CameraViewTest, CaptureTellsTheFourViewModesApart) {
  const double window[4] = {0, 0, 10, 10};
  struct Case {
    bool perspective, threeD;
    std::int16_t viewMode;
  };
  for (const Case c : {Case{false, false, 0}, Case{true, false, 1}, Case{false, true, 2}, Case{true, true, 3}}) {
    SetHostView({1, 1, 1}, {0, 0, 0}, 45.0F, c.perspective, c.threeD, window, 'a');
    HRCamera camera;
    camera.CaptureView();
    EXPECT_EQ(camera.GetViewMode(), c.viewMode) << "perspective " << c.perspective << " 3D " << c.threeD;
  }
}

TEST_F(CameraViewTest, CaptureKeepsPatternsUnlessTheHostShowsThem) {
  CameraSettings settings = DistinctSettings();
  settings.patterns = 1;
  HRCamera camera = CameraWith(settings);
  globc[66] = ' ';
  camera.CaptureView();
  EXPECT_TRUE(camera.HasPatterns());
  HRCamera fresh;
  fresh.CaptureView();
  EXPECT_FALSE(fresh.HasPatterns());
}

TEST_F(CameraViewTest, UpdateViewTakesOnlyEyeTargetAndWindow) {
  const double window[4] = {1, 2, 3, 4};
  SetHostView({7, 8, 9}, {1, 1, 1}, 60.0F, false, false, window, 'o');
  HRCamera camera = CameraWith(DistinctSettings());
  camera.UpdateView();
  CameraSettings expected = DistinctSettings();
  expected.eye[0] = 7;
  expected.eye[1] = 8;
  expected.eye[2] = 9;
  expected.target[0] = expected.target[1] = expected.target[2] = 1;
  for (int i = 0; i < 4; ++i) expected.viewWindow[i] = window[i];
  ExpectSameSettings(SettingsOf(camera), expected);
}

TEST_F(CameraViewTest, ExecuteRunsTheHostCommandsInOrder) {
  CameraSettings settings = ApplicableSettings(HRUtility::kGeometric, HRCamera::k3DPerspective);
  settings.patterns = 1;
  HRCamera camera = CameraWith(settings);
  globc[66] = 'x';
  ClearJournal();
  EXPECT_EQ(camera.Execute(nullptr), 0);
  EXPECT_EQ(Steps(), (StepList{"inq_render_mode", "set_perspective", "start_redraw_off", "eye", "target",
                             "set_viewing_conus", "set_scale_mode", "start_redraw_on", "overlay refh", "regen",
                             "inq_render_mode", "redraw_all"}));
  EXPECT_EQ(globc[0], 'x');  // the pattern letter before refh is handed over in globc[0]
  EXPECT_EQ(globc[66], 'h');
  EXPECT_EQ(WaitCursor(), 0);
  EXPECT_EQ(Bench().View().waitCursorUnderflows, 0);
  const std::vector<std::string> calls = Log().Names(Kind::HostCall);
  EXPECT_EQ(calls.front(), "add_wait_cur");
  EXPECT_EQ(calls.back(), "remove_wait_cur");
}

TEST_F(CameraViewTest, ExecuteRedrawsInsteadWhenTheHostDropsThePatterns) {
  CameraSettings settings = ApplicableSettings(HRUtility::kGeometric, HRCamera::k2DParallel);
  settings.patterns = 1;
  Bench().Display().patternsShowable = false;
  HRCamera camera = CameraWith(settings);
  ClearJournal();
  EXPECT_EQ(camera.Execute(nullptr), 0);
  const StepList steps = Steps();
  const auto refh = std::find(steps.begin(), steps.end(), "overlay refh");
  ASSERT_NE(refh, steps.end());
  EXPECT_EQ(*(refh + 1), "redraw_all");
  EXPECT_EQ(std::count(steps.begin(), steps.end(), "regen"), 0);

  settings.patterns = 0;
  Bench().Display().patternsShowable = true;
  ClearJournal();
  EXPECT_EQ(CameraWith(settings).Execute(nullptr), 0);
  EXPECT_EQ(globc[66], ' ');
  const StepList plain = Steps();
  EXPECT_EQ(std::count(plain.begin(), plain.end(), "regen"), 0);
}

TEST_F(CameraViewTest, ExecuteInASolidModeLeavesThePatternsAlone) {
  HRCamera camera = CameraWith(ApplicableSettings(HRUtility::kHiddenline, HRCamera::k3DParallel));
  ClearJournal();
  EXPECT_EQ(camera.Execute(nullptr), 0);
  const StepList steps = Steps();
  EXPECT_EQ(std::count(steps.begin(), steps.end(), "overlay refh"), 0);
  EXPECT_EQ(steps.back(), "redraw_all");
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kHiddenline);
}

TEST_F(CameraViewTest, ExecuteSwitchesOnlyTheLayersThatDiffer) {
  HRCamera::LayerTable host{};
  host[1] = host[2] = 1;
  SetHostLayers(host);
  CameraSettings settings = ApplicableSettings(HRUtility::kGeometric, HRCamera::k3DParallel);
  settings.layers = {};
  settings.layers[0] = 1;    // off in the host: switched on
  settings.layers[1] = 1;    // on already
  settings.layers[2] = 0;    // on in the host: switched off
  settings.layers[3] = 2;    // no meaning: nothing happens
  settings.layers[255] = 1;  // the last layer too
  ClearJournal();
  EXPECT_EQ(CameraWith(settings).Execute(nullptr), 0);
  EXPECT_EQ(SwitchedLayers("HDL_Set_Layer_On"), (std::vector<std::int32_t>{0, 255}));
  EXPECT_EQ(SwitchedLayers("HDL_Set_Layer_Off"), (std::vector<std::int32_t>{2}));
  HRCamera::LayerTable expected{};
  expected[0] = expected[1] = expected[255] = 1;
  EXPECT_EQ(HostLayers(), expected);
}

TEST_F(CameraViewTest, RefusedLayerSwitchStopsExecuteWithTheCursorRemoved) {
  HRCamera::LayerTable host{};
  host.fill(1);
  SetHostLayers(host);
  CameraSettings settings = ApplicableSettings(HRUtility::kGeometric, HRCamera::k3DParallel);
  settings.layers.fill(0);
  FailForEntity("HDL_Set_Layer_Off", 7);
  ClearJournal();
  EXPECT_EQ(CameraWith(settings).Execute(nullptr), -12);
  EXPECT_EQ(SwitchedLayers("HDL_Set_Layer_Off").size(), 7U);
  EXPECT_EQ(Steps(), StepList{"inq_render_mode"});  // nothing of the view was applied
  EXPECT_EQ(WaitCursor(), 0);
  EXPECT_EQ(Bench().View().waitCursorUnderflows, 0);
}

TEST_F(CameraViewTest, ExecuteShowsOrHidesEverySectionSymbol) {
  const host::EntityHandle instance = StoreSection();

  CameraSettings settings = ApplicableSettings(HRUtility::kGeometric, HRCamera::k3DParallel);
  settings.showSections = 0;
  EXPECT_EQ(CameraWith(settings).Execute(nullptr), 0);
  EXPECT_TRUE(Find(instance)->Hidden());
  EXPECT_EQ(SectionsShown, 0);

  settings.showSections = 1;
  EXPECT_EQ(CameraWith(settings).Execute(nullptr), 0);
  EXPECT_FALSE(Find(instance)->Hidden());
  EXPECT_EQ(SectionsShown, 1);
}

TEST_F(CameraViewTest, ApplyViewSetsTheViewBeforeTheProjectionAndFinishesInPhaseOne) {
  CameraSettings settings = ApplicableSettings(HRUtility::kGeometric, HRCamera::k2DParallel);
  HRCamera camera = CameraWith(settings);
  ClearJournal();
  camera.ApplyView(0);
  EXPECT_EQ(Steps(), (StepList{"inq_render_mode", "eye", "target", "set_viewing_conus", "set_parallel",
                             "start_redraw_off", "set_scale_mode", "start_redraw_on", "overlay refh",
                             "redraw_all"}));
  EXPECT_EQ(WaitCursor(), 1);
  ClearJournal();
  camera.ApplyView(1);
  EXPECT_EQ(WaitCursor(), 0);
  // A camera taken in plain geometry is finished in hidden lines.
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kHiddenline);

  ClearJournal();
  camera.ApplyView(2);
  camera.ApplyView(-1);
  EXPECT_TRUE(Log().Entries().empty());
}

TEST_F(CameraViewTest, ApplyViewFinishesInTheCamerasOwnMode) {
  HRCamera camera = CameraWith(ApplicableSettings(HRUtility::kShadowModel, HRCamera::k3DPerspective));
  camera.ApplyView(0);
  camera.ApplyView(1);
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kShadowModel);
  EXPECT_EQ(WaitCursor(), 0);
}

TEST_F(CameraViewTest, ApplyViewNeverShowsSymbolsItself) {
  const host::EntityHandle instance = StoreSection();
  Find(instance)->header.bytes[host::kHeaderFlags] |= host::kFlagHidden;

  CameraSettings settings = ApplicableSettings(HRUtility::kGeometric, HRCamera::k3DParallel);
  settings.showSections = 1;
  HRCamera showing = CameraWith(settings);
  showing.ApplyView(0);
  showing.ApplyView(1);
  EXPECT_EQ(SectionsShown, 1);
  EXPECT_TRUE(Find(instance)->Hidden());

  Find(instance)->header.bytes[host::kHeaderFlags] &= static_cast<std::uint8_t>(~host::kFlagHidden);
  settings.showSections = 0;
  HRCamera hiding = CameraWith(settings);
  hiding.ApplyView(0);
  hiding.ApplyView(1);
  EXPECT_EQ(SectionsShown, 1);  // phase 0 hides without changing the flag
  EXPECT_TRUE(Find(instance)->Hidden());
}

class CameraRoundTripTest : public CameraViewTest, public ::testing::WithParamInterface<std::int16_t> {};

// Applying a camera and capturing the view right after gives the camera back.
TEST_P(CameraRoundTripTest, ExecuteThenCaptureGivesTheCameraBack) {
  const std::int16_t displayMode = GetParam();
  for (const std::int16_t viewMode : {HRCamera::k2DParallel, HRCamera::k2DPerspective, HRCamera::k3DParallel,
                                      HRCamera::k3DPerspective}) {
    // Rendering always shows the model in 3D.
    if (displayMode == HRUtility::kRender && viewMode < HRCamera::k3DParallel) continue;
    for (const char scaleMode : {'a', 'f', 'o', ' '}) {
      CameraSettings settings = ApplicableSettings(displayMode, viewMode);
      settings.scaleMode = scaleMode;
      ASSERT_EQ(CameraWith(settings).Execute(nullptr), 0);
      HRCamera captured;
      ASSERT_EQ(captured.CaptureView(), 0);
      const CameraSettings back = SettingsOf(captured);
      SCOPED_TRACE("view mode " + std::to_string(viewMode) + ", scale '" + std::string(1, scaleMode) + "'");
      for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(back.eye[i], settings.eye[i]);
        EXPECT_EQ(back.target[i], settings.target[i]);
      }
      EXPECT_EQ(back.cone, settings.cone);
      for (int i = 0; i < 4; ++i) EXPECT_DOUBLE_EQ(back.viewWindow[i], settings.viewWindow[i]);
      EXPECT_EQ(back.viewMode, viewMode);
      EXPECT_EQ(back.displayMode, displayMode);
      EXPECT_EQ(back.layers, settings.layers);
      EXPECT_EQ(back.scaleMode, scaleMode);
      EXPECT_EQ(WaitCursor(), 0);
    }
  }
}

INSTANTIATE_TEST_SUITE_P(EverySwitchableMode, CameraRoundTripTest, ::testing::Range<std::int16_t>(0, 11));

}  // namespace
