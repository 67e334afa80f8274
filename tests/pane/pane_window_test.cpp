// The pane as a window of the host: docked, shown, hidden and closed, undocked, resized, its
// tips, its tree following the drawing, and its end with the main frame.
#include <algorithm>

#include "framework/input.h"
#include "framework/scripted_user.h"
#include "framework/window_system.h"
#include "shell/pane_instance.h"
#include "tests/pane/pane_fixture.h"
#include "views/hr_camera.h"
#include "workbench/host_ui/screen_render.h"

namespace {

using Calls = std::vector<std::string>;

bool Has(const std::string& text, const std::string& part) { return text.find(part) != std::string::npos; }

// The texts of the tips on screen.
std::vector<std::string> ShownTips(HWND frame) {
  std::vector<std::string> tips;
  for (const HWND window : framework::TopLevelWindows()) {
    if (window != frame && ::IsWindowVisible(window)) tips.push_back(::GetWindowText(window));
  }
  return tips;
}

TEST_F(PaneTest, ThePaneDocksOnTheLeftAndTheHostFollowsItsShowHideAndClose) {
  EXPECT_EQ(PaneCalls(), (Calls{"CPaneManager::AddPane 62000", "CPaneManager::ReattachPane 62000", "SetCameraManagerOn"}));
  CRect client;
  Frame().GetClientRect(&client);
  const CRect docked(0, wb::ui::MainFrame::kCaptionHeight, 280, client.bottom - wb::ui::MainFrame::kStatusHeight);
  EXPECT_EQ(Frame().DockedPlace(62000), docked);
  const std::string screen = wb::ui::RenderScreen();
  EXPECT_TRUE(Has(screen, R"(data-part="dock-caption" data-pane="62000" data-side="left" data-text="Cameras and sections manager")"));
  EXPECT_TRUE(Has(screen, R"(data-camera-manager="on")"));
  // The tree was stretched to the docked pane.
  CRect pane;
  ::GetClientRect(PaneWindow(), &pane);
  EXPECT_EQ(Placed(5016), CRect(3, 63, pane.right - 3, pane.bottom - 5));

  Bench().GetJournal().Clear();
  Run("run 5");
  EXPECT_FALSE(::IsWindowVisible(PaneWindow()));
  EXPECT_FALSE(Frame().DockedPlace(62000));
  EXPECT_FALSE(Has(wb::ui::RenderScreen(), "dock-caption"));
  EXPECT_TRUE(Has(wb::ui::RenderScreen(), R"(data-camera-manager="off")"));
  Run("run 1");
  EXPECT_EQ(Frame().DockedPlace(62000), docked);
  EXPECT_EQ(PaneCalls(), (Calls{"CPaneManager::RemovePane 62000", "SetCameraManagerOff",
                                "CPaneManager::ReattachPane 62000", "SetCameraManagerOn"}));

  // The caption's close box closes the pane; Enter hides it too; Escape leaves it docked.
  framework::ScriptedUser user;
  Bench().GetJournal().Clear();
  user.Click(Frame().m_hWnd, {docked.right - 10, 10});
  EXPECT_FALSE(::IsWindowVisible(PaneWindow()));
  EXPECT_EQ(PaneCalls(), (Calls{"SetCameraManagerOff", "CPaneManager::RemovePane 62000", "SetCameraManagerOff"}));
  Run("run 1\nselect Axonometric");
  user.Press(VK_ESCAPE);
  EXPECT_TRUE(::IsWindowVisible(PaneWindow()));
  user.Press(VK_RETURN);
  EXPECT_FALSE(::IsWindowVisible(PaneWindow()));
  EXPECT_FALSE(Bench().CameraManagerOn());
}

TEST_F(PaneTest, AHostThatDoesNotAnswerLeavesThePaneUndockedInItsFrame) {
  Open(Start::kSampleHouse, /*docking=*/false);
  EXPECT_EQ(PaneCalls(), Calls{"SetCameraManagerOn"});
  EXPECT_FALSE(Frame().DockedPlace(62000));
  EXPECT_EQ(::GetParent(PaneWindow()), Frame().m_hWnd);
  CRect place;
  ::GetWindowRect(PaneWindow(), &place);
  EXPECT_EQ(place.Size(), CSize(254, 400));  // the template's size, not the dock's
  Run("run 5\nrun 1\ntab plans");
  EXPECT_EQ(PaneCalls(), (Calls{"SetCameraManagerOn", "SetCameraManagerOff", "SetCameraManagerOn"}));
  EXPECT_EQ(Tree(), "Plans:\n  [ ] Ground floor\n    [x] Default\n");
  EXPECT_FALSE(Has(wb::ui::RenderScreen(), "dock-caption"));
}

TEST_F(PaneTest, ResizedBelowItsSmallestSizeThePaneLaysOutAsForTheSmallestSize) {
  Run("resize 240 150");
  const std::vector<CRect> smallest = {Placed(5011), Placed(5016), Placed(5019), Placed(IDOK)};
  Run("resize 100 100");
  EXPECT_EQ((std::vector<CRect>{Placed(5011), Placed(5016), Placed(5019), Placed(IDOK)}), smallest);
  EXPECT_EQ(smallest[1], CRect(3, 63, 237, 145));  // the tree, stretched from the template's 254 x 400
  EXPECT_EQ(Placed(5007), CRect(5, 33, 29, 56));  // not anchored
}

TEST_F(PaneTest, TheHostsMouseMovesBringUpTheTipOfTheButtonOrTabUnderTheMouse) {
  Run("hover add");
  EXPECT_EQ(ShownTips(Frame().m_hWnd), std::vector<std::string>{"Add new"});
  Run("hover tab sections");
  EXPECT_EQ(ShownTips(Frame().m_hWnd), std::vector<std::string>{"Vertical Section"});
  Run("wait 6000");  // a tip stays five seconds at most
  EXPECT_TRUE(ShownTips(Frame().m_hWnd).empty());
}

TEST_F(PaneTest, TheTreeFollowsTheDrawingWhenThePaneIsHiddenShownOrRefreshed) {
  const std::string sample = "Cameras:\n  [x] Street perspective\n  [x] Axonometric\n  [x] Site plan\n";
  HRCamera behind;
  behind.SetName("Behind");
  ASSERT_EQ(behind.Create(), 0);
  EXPECT_EQ(Tree(), sample);
  Run("run 5");  // hiding reads the drawing again too
  EXPECT_EQ(Tree(), sample + "  [ ] Behind\n");
  Drawing().Remove(CameraNamed("Axonometric").handle);
  Run("run 1");
  EXPECT_EQ(Tree(), "Cameras:\n  [x] Street perspective\n  [x] Site plan\n  [ ] Behind\n");
  Drawing().Remove(CameraNamed("Behind").handle);
  Run("click refresh");
  EXPECT_EQ(Tree(), "Cameras:\n  [x] Street perspective\n  [x] Site plan\n");
  Drawing().Remove(CameraNamed("Site plan").handle);
  Run("run 8");
  EXPECT_EQ(Tree(), "Cameras:\n  [x] Street perspective\n");
}

// Selecting a tab from the host tells nobody: the tree keeps the last tab's objects until the
// next refill.
TEST_F(PaneTest, ATabSelectedByTheHostKeepsTheTreeUntilTheNextRefill) {
  Run("run 7 2");
  EXPECT_EQ(Tree(), "Sections:\n  [x] Street perspective\n  [x] Axonometric\n  [x] Site plan\n");
  Run("run 8");
  EXPECT_EQ(Tree(), "Sections:\n  [ ] A\n    [x] Default\n  [ ] B\n    [x] Default\n");
  Run("run 7 3.4\nrun 8");
  EXPECT_EQ(Tree(), "Plans:\n  [ ] Ground floor\n    [x] Default\n");
}

TEST_F(PaneTest, ThePaneGoesWithItsFrameAndTheNextShowMakesANewOne) {
  const HWND frame = Frame().m_hWnd;
  CRect outer;
  ::GetWindowRect(frame, &outer);
  const RECT insets = framework::NonClientInsets(::GetWindowStyle(frame), ::GetWindowExStyle(frame));
  const POINT closeBox{outer.Width() - insets.right - 11, (insets.left + insets.top) / 2};
  Bench().GetJournal().Clear();
  framework::input::MouseDown(frame, closeBox);
  framework::input::MouseUp(frame, closeBox);
  EXPECT_FALSE(::IsWindow(frame));
  EXPECT_EQ(pandex::GetPane(), nullptr);
  EXPECT_EQ(PaneCalls(), (Calls{"CPaneManager::RemovePane 62000", "SetCameraManagerOff"}));

  ASSERT_TRUE(Frame().Create("Workbench - again"));
  Frame().RunSubCommand(1);
  ASSERT_NE(pandex::GetPane(), nullptr);
  EXPECT_TRUE(Frame().DockedPlace(62000));
  EXPECT_EQ(Tree(), "Cameras:\n  [x] Street perspective\n  [x] Axonometric\n  [x] Site plan\n");
}

}  // namespace
