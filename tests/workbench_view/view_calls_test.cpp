// The view calls: view window, fitting the window to the drawing, redraw calls, 2D and 3D,
// the wait cursor's balance and scale keeping, each honouring faults.
#include <array>
#include <limits>

#include "tests/workbench_view/view_host_fixture.h"

namespace {

class ViewCallsTest : public ViewHostTest {
 protected:
  using Rect = std::array<double, 4>;

  static Rect Window() {
    Rect rect{};
    wn3_inq_view_rect(rect.data());
    return rect;
  }

  static wb::Entity& AddLine(host::Point3f start, host::Point3f end, std::uint8_t layer = 0) {
    wb::Entity& entity = Session().CurrentDrawing().Add(host::kTypeLine);
    entity.header.bytes[host::kHeaderLayer] = layer;
    host::LineRecord line{};
    line.start = start;
    line.end = end;
    wb::WriteRecord(entity, line);
    return entity;
  }
};

TEST_F(ViewCallsTest, ViewWindowReadsBackAsSetWithItsCornersInOrder) {
  const Rect set{-3.5, 2.0, 40.25, 18.0};
  wn3_set_view_rect(set.data());
  EXPECT_EQ(Window(), set);

  const Rect swapped{10.0, 8.0, -2.0, 1.0};
  wn3_set_view_rect(swapped.data());
  EXPECT_EQ(Window(), (Rect{-2.0, 1.0, 10.0, 8.0}));
}

TEST_F(ViewCallsTest, ViewWindowThatCannotBeDrawnIsRefused) {
  const Rect before = Window();
  const Rect broken{0.0, std::numeric_limits<double>::quiet_NaN(), 1.0, 1.0};
  wn3_set_view_rect(broken.data());
  wn3_set_view_rect(nullptr);
  EXPECT_EQ(Window(), before);
  EXPECT_TRUE(HostCalls().empty());
}

TEST_F(ViewCallsTest, FittingTheWindowTakesTheShownLinesOnly) {
  AddLine({-4, 1, 0}, {6, 3, 2});
  AddLine({100, 100, 0}, {200, 200, 0}, 7);  // on a layer that is off
  wb::Entity& hidden = AddLine({-50, -50, 0}, {-40, -40, 0});
  hidden.header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
  Session().CurrentDrawing().layers[7].on = false;

  wn3_auto_window(4);
  EXPECT_EQ(Window(), (Rect{-4.0, 1.0, 6.0, 3.0}));
  EXPECT_EQ(View().autoWindowFits, 1);
}

TEST_F(ViewCallsTest, FittingAPointGivesAWindowWithArea) {
  AddLine({2, 5, 0}, {2, 5, 9});
  wn3_auto_window(4);
  EXPECT_EQ(Window(), (Rect{1.5, 4.5, 2.5, 5.5}));
}

TEST_F(ViewCallsTest, FittingAnEmptyDrawingOrAnUnknownModeKeepsTheWindow) {
  const Rect before = Window();
  wn3_auto_window(4);
  EXPECT_EQ(Window(), before);
  AddLine({0, 0, 0}, {1, 1, 0});
  wn3_auto_window(3);
  EXPECT_EQ(Window(), before);
  EXPECT_EQ(View().autoWindowFits, 1);
}

TEST_F(ViewCallsTest, DisplayListRedrawIsHeldWhileRedrawingIsOff) {
  wn3_dl_redraw(2);
  init_hdl_redraw_draw_params();
  EXPECT_EQ(View().redraws.displayList, 1);
  EXPECT_EQ(View().redraws.lastDisplayListMode, 2);
  EXPECT_EQ(View().redraws.drawParameterResets, 1);

  execute_internal_command("start_redraw_off");
  wn3_dl_redraw(5);
  EXPECT_EQ(View().redraws.displayList, 1);
  EXPECT_EQ(View().redraws.lastDisplayListMode, 5);
  execute_internal_command("start_redraw_on");
  EXPECT_EQ(View().redraws.full, 1);
}

TEST_F(ViewCallsTest, WaitCursorBalancesAndNeverGoesNegative) {
  add_wait_cur();
  add_wait_cur();
  remove_wait_cur();
  EXPECT_EQ(View().waitCursor, 1);
  remove_wait_cur();
  remove_wait_cur();
  EXPECT_EQ(View().waitCursor, 0);
  EXPECT_EQ(View().waitCursorUnderflows, 1);
  EXPECT_EQ(HostCalls(),
            (std::vector<std::string>{"add_wait_cur", "add_wait_cur", "remove_wait_cur", "remove_wait_cur"}));
}

TEST_F(ViewCallsTest, ScalingSwitchesFollowTheScaleMode) {
  const std::pair<char, std::pair<int, int>> cases[] = {{'a', {0, 1}}, {'f', {1, 0}}, {'o', {0, 0}}, {' ', {0, 0}}};
  for (const auto& [mode, switches] : cases) {
    globc[22] = mode;
    execute_internal_command("set_scale_mode");
    EXPECT_EQ(wnp_fixed_scaling(), switches.first) << mode;
    EXPECT_EQ(wnp_auto_scaling(), switches.second) << mode;
  }
}

TEST_F(ViewCallsTest, FixedScalingKeepsTheScaleOfThePresentWindow) {
  View().boxWidth = 0.5;
  const Rect window{0.0, 0.0, 20.0, 10.0};
  wn3_set_view_rect(window.data());
  globc[22] = 'f';
  execute_internal_command("set_scale_mode");

  ASSERT_NE(wnp_fixed_scaling(), 0);
  const double scale = dBox_calc_scale();
  EXPECT_EQ(scale, 40.0);
  dBox_window_set_keep_scale(static_cast<float>(scale));
  EXPECT_EQ(dBox_window_keep_scale(), 1);
  EXPECT_EQ(View().keptScale, 40.0F);
  EXPECT_TRUE(View().keepingScale);

  globc[22] = 'a';
  execute_internal_command("set_scale_mode");
  EXPECT_FALSE(View().keepingScale);
  EXPECT_EQ(View().keptScale, 40.0F);
}

TEST_F(ViewCallsTest, ScaleThatCannotBeDrawnAtIsNotKept) {
  dBox_window_set_keep_scale(0.0F);
  dBox_window_set_keep_scale(-2.0F);
  dBox_window_set_keep_scale(std::numeric_limits<float>::infinity());
  EXPECT_EQ(View().keptScale, 0.0F);
  EXPECT_EQ(dBox_window_keep_scale(), 0);
  EXPECT_FALSE(View().keepingScale);
}

}  // namespace
