// The plug-in's own camera and display-mode code against this host: a camera applied and
// captured right after comes back whole, and the way back from a solid mode to plain geometry
// re-enters the plug-in through the host, which shows the section symbols again.
#include <algorithm>
#include <array>
#include <memory>

#include "display/display_mode.h"
#include "shell/host/argument_blocks.h"
#include "shell/pane_instance.h"
#include "tests/shell/plugin_fixture.h"
#include "ui/pandex_dlg.h"
#include "views/hr_camera.h"

namespace {

// Stands in for the docked pane: sub-command 3 needs a pane to exist, nothing more.
class QuietPane : public CPandexDlg {
 public:
  bool Create(int, CWnd*) override { return true; }
  void ShowPane(bool) override {}
};

using PluginRoundTripTest = LoadedPluginTest;

// Everything a camera applies and a capture reads back.
auto Values(const CameraSettings& s) {
  return std::tuple(std::to_array(s.eye), std::to_array(s.target), std::to_array(s.viewWindow), s.cone, s.viewMode,
                    s.displayMode, s.scaleMode, s.layers);
}

TEST_F(PluginRoundTripTest, CaptureAfterExecuteGivesTheCameraBack) {
  // Rendering is 3D only, so the 2D view modes are paired with the other modes.
  const std::tuple<std::int16_t, std::int16_t, char> shots[] = {
      {HRCamera::k2DParallel, HRUtility::kGeometric, 'a'},     {HRCamera::k2DPerspective, HRUtility::kHiddenline, 'f'},
      {HRCamera::k3DParallel, HRUtility::kMonoShadowModel, 'o'}, {HRCamera::k3DPerspective, HRUtility::kRender, ' '},
      {HRCamera::k3DParallel, HRUtility::kShaded, 'f'},
  };
  for (const auto& [viewMode, displayMode, scaleMode] : shots) {
    SCOPED_TRACE(testing::Message() << "view mode " << viewMode << ", display mode " << displayMode);
    CameraSettings wanted;
    std::ranges::copy(std::array{3.5F, -40.0F, 12.25F}, wanted.eye);
    std::ranges::copy(std::array{1.0F, 2.0F, 0.5F}, wanted.target);
    std::ranges::copy(std::array{-5.0, -2.5, 15.0, 9.75}, wanted.viewWindow);
    wanted.cone = 30.0F;
    wanted.viewMode = viewMode;
    wanted.displayMode = displayMode;
    wanted.scaleMode = scaleMode;
    for (std::size_t i = 0; i < wanted.layers.size(); ++i) wanted.layers[i] = i % 3 == 0 ? 0 : 1;
    HRCamera camera;
    camera.SetSettings(wanted);
    ASSERT_EQ(camera.Execute(nullptr), 0);

    HRCamera captured;
    ASSERT_EQ(captured.CaptureView(), 0);
    CameraSettings got;
    captured.GetSettings(got);
    EXPECT_EQ(Values(got), Values(wanted));
    EXPECT_EQ(wb::Workbench::Get().View().waitCursor, 0);
  }
}

TEST_F(PluginRoundTripTest, LeavingASolidModeReEntersThePlugInToShowTheSections) {
  pandex::SetPaneFactory([] { return std::make_unique<QuietPane>(); });
  ASSERT_NE(pandex::EnsurePane(), nullptr);
  HRUtility::SetDisplayMode(HRUtility::kSurfaces);
  wb::Drawing& drawing = wb::Workbench::Get().CurrentDrawing();
  const host::EntityHandle section = drawing.Add(host::kTypePlacedBlock).handle;
  wb::WriteRecord(*drawing.Find(section), host::PlacedBlockRecord{});
  drawing.Find(section)->attributes.emplace_back().name = "@Class=";
  drawing.Find(section)->attributes.back().text = "HRSection";
  drawing.Find(section)->header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
  wb::Workbench::Get().GetJournal().Clear();

  HRUtility::SetDisplayMode(HRUtility::kGeometric);
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kGeometric);
  EXPECT_EQ(globi[0], 3);
  EXPECT_FALSE(wb::Workbench::Get().CurrentDrawing().Find(section)->Hidden());
  EXPECT_EQ(wb::Workbench::Get().GetJournal().Names(wb::JournalEntry::Kind::Overlay),
            (std::vector<std::string>{"hidlin2d", "toolbar", "Pandex"}));
  EXPECT_EQ(wb::Workbench::Get().Display().solidBuilds, 1) << "the solid state was built once";
}

}  // namespace
