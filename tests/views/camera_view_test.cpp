// Cameras and the host view: applying a camera whole (Execute) or in two phases (ApplyView), the
// host calls each makes in order, and updating a camera from the host.
#include <algorithm>
#include <string>
#include <vector>

#include "display/display_mode.h"
#include "tests/views/views_fixture.h"
#include "views/section_symbols.h"

namespace {

class CameraViewTest : public ViewsTest {
 protected:
  static std::vector<std::int32_t> SwitchedLayers(const char* call) {
    std::vector<std::int32_t> layers;
    for (const wb::JournalEntry& entry : Log().Entries()) {
      if (entry.kind == wb::JournalEntry::Kind::HostCall && entry.name == call) layers.push_back(entry.code);
    }
    return layers;
  }

  static CameraSettings Applicable(std::int16_t displayMode, std::uint8_t patterns = 0) {
    CameraSettings settings = DistinctSettings();
    settings.displayMode = displayMode;
    settings.patterns = patterns;
    return settings;
  }
};

TEST_F(CameraViewTest, ExecuteRunsTheHostCommandsInOrderAndUpdateTakesOnlyTheView) {
  const StepList view = {"inq_render_mode", "set_perspective",   "start_redraw_off", "eye",
                         "target",          "set_viewing_conus", "set_scale_mode",   "start_redraw_on"};
  const StepList drawn = {"overlay refh", "redraw_all", "inq_render_mode", "redraw_all"};
  const StepList solid = {"inq_render_mode", "overlay hidlin2d", "set_background_color",
                          "wireframe_all",   "set_dspmode_info", "draw_text_on_off",
                          "new_solid",       "redraw_all",       "overlay toolbar",
                          "hidden_lines",    "redraw_all"};
  struct Case {
    std::int16_t displayMode;
    std::uint8_t patterns;
    bool showable;
    char patternLetter;
    StepList end;
  };
  const Case cases[] = {
      {HRUtility::kGeometric, 1, true, 'h', {"overlay refh", "regen", "inq_render_mode", "redraw_all"}},
      {HRUtility::kGeometric, 1, false, ' ', drawn},  // the host dropped the patterns
      {HRUtility::kGeometric, 0, true, ' ', drawn},
      {HRUtility::kHiddenline, 1, true, 'x', solid},  // a solid mode leaves the patterns alone
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(::testing::Message() << "mode " << c.displayMode << " patterns " << +c.patterns);
    HRUtility::SetDisplayMode(HRUtility::kGeometric);
    Bench().Display().patternsShowable = c.showable;
    globc[66] = 'x';
    ClearJournal();
    EXPECT_EQ(CameraWith(Applicable(c.displayMode, c.patterns)).Execute(nullptr), 0);
    StepList expected = view;
    expected.insert(expected.end(), c.end.begin(), c.end.end());
    EXPECT_EQ(Steps(), expected);
    EXPECT_EQ(globc[66], c.patternLetter);
    if (c.patternLetter != 'x') {
      EXPECT_EQ(globc[0], 'x');  // handed over before refh
    }
    EXPECT_EQ(HRUtility::GetDisplayMode(), c.displayMode);
  }
  EXPECT_EQ(Bench().View().waitCursor, 0);
  EXPECT_EQ(Bench().View().waitCursorUnderflows, 0);

  // Updating a camera from the host takes only the eye, the target and the window.
  HRCamera updated = CameraWith(DistinctSettings(2.0F));
  updated.UpdateView();
  CameraSettings expected = DistinctSettings(2.0F);
  std::copy_n(DistinctSettings().eye, 3, expected.eye);
  std::copy_n(DistinctSettings().target, 3, expected.target);
  std::copy_n(DistinctSettings().viewWindow, 4, expected.viewWindow);
  EXPECT_EQ(Values(SettingsOf(updated)), Values(expected));
}

TEST_F(CameraViewTest, ExecuteSwitchesOnlyTheLayersThatDifferAndStopsAtARefusal) {
  for (std::size_t i = 0; i < 256; ++i) Drawing().layers[i].on = i == 1 || i == 2;
  CameraSettings settings = Applicable(HRUtility::kGeometric);
  settings.layers = {};
  settings.layers[0] = settings.layers[1] = settings.layers[255] = 1;
  settings.layers[3] = 2;  // no meaning: nothing happens
  EXPECT_EQ(CameraWith(settings).Execute(nullptr), 0);
  EXPECT_EQ(SwitchedLayers("HDL_Set_Layer_On"), (std::vector<std::int32_t>{0, 255}));
  EXPECT_EQ(SwitchedLayers("HDL_Set_Layer_Off"), (std::vector<std::int32_t>{2}));
  settings.layers.fill(0);
  FailOn("HDL_Set_Layer_Off", "", 1);
  ClearJournal();
  EXPECT_EQ(CameraWith(settings).Execute(nullptr), -12);
  EXPECT_EQ(SwitchedLayers("HDL_Set_Layer_Off"), std::vector<std::int32_t>{0});  // 1 refused, 255 never reached
  EXPECT_EQ(Steps(), StepList{"inq_render_mode"});                               // nothing of the view was applied
  EXPECT_EQ(Bench().View().waitCursor, 0);
}

TEST_F(CameraViewTest, ApplyViewSetsTheViewBeforeTheProjectionAndNeverShowsTheSymbols) {
  const host::EntityHandle instance = StoreSection();
  CameraSettings settings = Applicable(HRUtility::kGeometric);
  EXPECT_EQ(CameraWith(settings).Execute(nullptr), 0);
  EXPECT_TRUE(Find(instance)->Hidden());
  EXPECT_EQ(SectionsShown, 0);
  settings.showSections = 1;
  settings.viewMode = HRCamera::k2DParallel;
  HRCamera camera = CameraWith(settings);
  ClearJournal();
  camera.ApplyView(0);
  EXPECT_EQ(Steps(), (StepList{"inq_render_mode", "eye", "target", "set_viewing_conus", "set_parallel",
                               "start_redraw_off", "set_scale_mode", "start_redraw_on", "overlay refh", "redraw_all"}));
  EXPECT_EQ(Bench().View().waitCursor, 1);
  camera.ApplyView(1);
  EXPECT_EQ(Bench().View().waitCursor, 0);
  EXPECT_EQ(SectionsShown, 1);
  EXPECT_TRUE(Find(instance)->Hidden());
  // A camera taken in plain geometry is finished in hidden lines.
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kHiddenline);
  ClearJournal();
  camera.ApplyView(2);
  camera.ApplyView(-1);
  EXPECT_TRUE(Log().Entries().empty());
}

}  // namespace
