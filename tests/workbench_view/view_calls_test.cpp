// The view and layer calls: view window, fitting the window to the drawing, the wait cursor's
// balance, scale keeping, and the layer table of the current drawing.
#include <array>
#include <limits>

#include "tests/workbench/host_fixture.h"

namespace {

class ViewCallsTest : public HostTest {
 protected:
  using Rect = std::array<double, 4>;

  static Rect Window() {
    Rect rect{};
    wn3_inq_view_rect(rect.data());
    return rect;
  }
  static wb::Entity& AddLineOn(host::Point3f start, host::Point3f end, std::uint8_t layer = 0) {
    wb::Entity& entity = Current().Add(host::kTypeLine);
    entity.header.bytes[host::kHeaderLayer] = layer;
    wb::WriteRecord(entity, MakeLine(start, end));
    return entity;
  }
};

TEST_F(ViewCallsTest, WindowIsSetInCornerOrderAndFittedToTheShownLinesOnly) {
  wn3_set_view_rect(Rect{10.0, 8.0, -2.0, 1.0}.data());
  wn3_set_view_rect(Rect{0.0, std::numeric_limits<double>::quiet_NaN(), 1.0, 1.0}.data());
  wn3_auto_window(4);
  EXPECT_EQ(Window(), (Rect{-2.0, 1.0, 10.0, 8.0})) << "an empty drawing keeps the window";

  AddLineOn({2, 5, 0}, {2, 5, 9});
  wn3_auto_window(4);
  EXPECT_EQ(Window(), (Rect{1.5, 4.5, 2.5, 5.5})) << "a point gets a window with area";
  AddLineOn({-4, 1, 0}, {6, 3, 2});
  AddLineOn({100, 100, 0}, {200, 200, 0}, 7);
  Current().layers[7].on = false;
  AddLineOn({-50, -50, 0}, {-40, -40, 0}).header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
  wn3_auto_window(3);
  EXPECT_EQ(Window(), (Rect{1.5, 4.5, 2.5, 5.5})) << "only mode 4 fits";
  wn3_auto_window(4);
  EXPECT_EQ(Window(), (Rect{-4.0, 1.0, 6.0, 5.0}));
}

TEST_F(ViewCallsTest, WaitCursorBalancesAndNeverGoesNegative) {
  add_wait_cur();
  remove_wait_cur();
  remove_wait_cur();
  EXPECT_EQ(View().waitCursor, 0);
  EXPECT_EQ(View().waitCursorUnderflows, 1);
  EXPECT_EQ(Log().Names(Kind::HostCall), (std::vector<std::string>{"add_wait_cur", "remove_wait_cur"}));
}

TEST_F(ViewCallsTest, FixedScalingKeepsTheScaleOfThePresentWindow) {
  const std::pair<char, std::pair<int, int>> switches[] = {{'a', {0, 1}}, {'o', {0, 0}}, {'f', {1, 0}}};
  for (const auto& [mode, fixedAndAuto] : switches) {
    globc[22] = mode;
    Run("set_scale_mode");
    EXPECT_EQ(std::pair(wnp_fixed_scaling(), wnp_auto_scaling()), fixedAndAuto) << mode;
  }
  for (float unusable : {0.0F, -2.0F, std::numeric_limits<float>::infinity()}) dBox_window_set_keep_scale(unusable);
  EXPECT_EQ(dBox_window_keep_scale(), 0);
  View().boxWidth = 0.5;
  wn3_set_view_rect(Rect{0.0, 0.0, 20.0, 10.0}.data());
  EXPECT_EQ(dBox_calc_scale(), 40.0);
  dBox_window_set_keep_scale(40.0F);
  EXPECT_EQ(dBox_window_keep_scale(), 1);
  EXPECT_EQ(View().keptScale, 40.0F);
  globc[22] = 'a';
  Run("set_scale_mode");
  EXPECT_FALSE(View().keepingScale) << "auto scaling lets the scale go";
}

TEST_F(ViewCallsTest, LayerTableBelongsToItsDrawingAndRefusesWhatItDoesNotHold) {
  const host::LayerTableHandle table = HDL_Main();
  const std::pair<host::LayerTableHandle, int> refused[] = {{table, -1}, {table, 256}, {db.handle, 4}, {0, 4}};
  for (const auto& [handle, index] : refused) EXPECT_EQ(HDL_Set_Layer_Off(handle, index), 0) << handle << " " << index;
  EXPECT_EQ(HDL_Get_LayerName(db.handle, 0), nullptr) << "a database handle is no table handle";
  EXPECT_EQ(HDL_Set_Layer_Off(table, 255), 1);
  EXPECT_EQ(GetLayersInCurrentHDL()[255].state, host::kLayerOffState);
  EXPECT_EQ(Log().Entries(), (std::vector<wb::JournalEntry>{{Kind::HostCall, "HDL_Set_Layer_Off", 0, 255}}));

  wb::Drawing other;
  other.layers[9] = {"Roof", false};
  Session().SetCurrent(Session().Open(std::move(other)));
  EXPECT_EQ(GetLayersInCurrentHDL()[9].state, host::kLayerOffState);
  EXPECT_STREQ(HDL_Get_LayerName(HDL_Main(), 9), "Roof");
  EXPECT_EQ(HDL_Set_Layer_Off(table, 5), 1);
  EXPECT_EQ(GetLayersInCurrentHDL()[5].state, 0) << "the first drawing's table reaches the first drawing only";
  EXPECT_FALSE(Session().Find(1)->layers[5].on);
  Session().Close(db.handle);
  EXPECT_EQ(GetLayersInCurrentHDL(), nullptr);
  EXPECT_EQ(HDL_Main(), 0);
}

}  // namespace
