// The layer calls: the table reflects the current drawing, switches through the table handle
// change that drawing's layers, and bad handles and indices are refused.
#include <limits>

#include "tests/workbench_view/view_host_fixture.h"

namespace {

class LayerCallsTest : public ViewHostTest {
 protected:
  static std::int32_t StateOf(int layer) { return GetLayersInCurrentHDL()[layer].state; }
};

TEST_F(LayerCallsTest, TableShowsOnLayersAsZeroAndOffLayersAs255) {
  wb::Drawing& drawing = Session().CurrentDrawing();
  drawing.layers[3].on = false;
  drawing.layers[255].on = false;

  const host::LayerEntry* table = GetLayersInCurrentHDL();
  ASSERT_NE(table, nullptr);
  for (int i = 0; i < host::kHostLayerCount; ++i) {
    const bool off = i == 3 || i == 255;
    EXPECT_EQ(table[i].state, off ? host::kLayerOffState : 0) << i;
  }
}

TEST_F(LayerCallsTest, SwitchesChangeTheDrawingAndReadBackThroughTheTable) {
  const host::LayerTableHandle table = HDL_Main();
  EXPECT_EQ(HDL_Set_Layer_Off(table, 0), 1);
  EXPECT_EQ(HDL_Set_Layer_Off(table, 200), 1);
  EXPECT_FALSE(Session().CurrentDrawing().layers[200].on);
  EXPECT_EQ(StateOf(0), host::kLayerOffState);
  EXPECT_EQ(StateOf(200), host::kLayerOffState);
  EXPECT_EQ(StateOf(1), 0);

  EXPECT_EQ(HDL_Set_Layer_On(table, 200), 1);
  EXPECT_EQ(StateOf(200), 0);
  EXPECT_TRUE(Session().CurrentDrawing().layers[200].on);

  const std::vector<wb::JournalEntry>& entries = Session().GetJournal().Entries();
  ASSERT_EQ(entries.size(), 3U);
  EXPECT_EQ(entries[1].name, "HDL_Set_Layer_Off");
  EXPECT_EQ(entries[1].code, 200);
  EXPECT_EQ(entries[2].name, "HDL_Set_Layer_On");
  EXPECT_EQ(entries[2].code, 200);
}

TEST_F(LayerCallsTest, BadIndexOrTableHandleIsRefused) {
  const host::LayerTableHandle table = HDL_Main();
  EXPECT_EQ(HDL_Set_Layer_Off(table, -1), 0);
  EXPECT_EQ(HDL_Set_Layer_Off(table, 256), 0);
  EXPECT_EQ(HDL_Set_Layer_Off(db.handle, 4), 0) << "a database handle is no table handle";
  EXPECT_EQ(HDL_Set_Layer_On(0, 4), 0);
  EXPECT_EQ(HDL_Set_Layer_On(std::numeric_limits<std::int32_t>::min(), 4), 0);
  EXPECT_EQ(HDL_Get_LayerName(table, 256), nullptr);
  EXPECT_EQ(HDL_Get_LayerName(db.handle, 0), nullptr);
  for (int i = 0; i < host::kHostLayerCount; ++i) EXPECT_TRUE(Session().CurrentDrawing().layers[i].on);
  EXPECT_TRUE(Session().GetJournal().Entries().empty());
}

TEST_F(LayerCallsTest, TableFollowsTheCurrentDrawing) {
  const host::DatabaseHandle first = db.handle;
  const host::LayerTableHandle firstTable = HDL_Main();
  wb::Drawing other;
  other.layers[9].on = false;
  other.layers[9].name = "Roof";
  const host::DatabaseHandle second = Session().Open(std::move(other));
  Session().SetCurrent(second);

  EXPECT_NE(HDL_Main(), firstTable);
  EXPECT_EQ(StateOf(9), host::kLayerOffState);
  EXPECT_STREQ(HDL_Get_LayerName(HDL_Main(), 9), "Roof");

  // The first drawing's table still reaches the first drawing only.
  EXPECT_EQ(HDL_Set_Layer_Off(firstTable, 5), 1);
  EXPECT_FALSE(Session().Find(first)->layers[5].on);
  EXPECT_EQ(StateOf(5), 0);
}

TEST_F(LayerCallsTest, NoCurrentDrawingGivesNoTable) {
  Session().Close(db.handle);
  EXPECT_EQ(GetLayersInCurrentHDL(), nullptr);
  EXPECT_EQ(HDL_Main(), 0);
}

TEST_F(LayerCallsTest, FaultsCanRefuseOneLayer) {
  wb::FaultRule refuseLayerTwelve;
  refuseLayerTwelve.call = "HDL_Set_Layer_Off";
  refuseLayerTwelve.entity = 12;
  refuseLayerTwelve.times = -1;
  Session().GetFaults().Add(refuseLayerTwelve);
  const host::LayerTableHandle table = HDL_Main();
  EXPECT_EQ(HDL_Set_Layer_Off(table, 11), 1);
  EXPECT_EQ(HDL_Set_Layer_Off(table, 12), 0);
  EXPECT_EQ(HDL_Set_Layer_Off(table, 12), 0);
  EXPECT_TRUE(Session().CurrentDrawing().layers[12].on);

  Session().GetFaults().FailNext("GetLayersInCurrentHDL");
  EXPECT_EQ(GetLayersInCurrentHDL(), nullptr);
  EXPECT_NE(GetLayersInCurrentHDL(), nullptr);

  Session().GetFaults().FailNext("HDL_Main", -4);
  EXPECT_EQ(HDL_Main(), -4);
}

}  // namespace
