// Selection sets: the record written on create, loading damaged records, and applying the ticks
// to the general cameras.
#include <string>
#include <tuple>
#include <vector>

#include "model/status_codes.h"
#include "tests/views/views_fixture.h"
#include "views/hr_selection.h"

namespace {

using Indices = std::vector<std::int32_t>;
using Ticks = std::vector<std::uint16_t>;

class SelectionTest : public ViewsTest {};

TEST_F(SelectionTest, CreateWritesEveryListInOrderAndLoadGivesItBack) {
  HRSelection selection;
  selection.SetName("Facades");
  selection.AddCamera(3);
  StepList keys = {"@SNAME=", "@SCL=", "@SSC="};
  for (std::int32_t i = 0; i < 12; ++i) {
    selection.AddSection(100 + i, {i, 2});
    keys.push_back("@SSL" + std::to_string(i) + "=");
  }
  selection.AddPlan(51, {});
  keys.insert(keys.end(), {"@SPC=", "@SPL0=", "@Class="});
  ClearJournal();
  ASSERT_EQ(selection.Create(), 0);
  const host::EntityHandle entity = selection.GetHandle();
  const StepList writes = WritesTo(entity);
  EXPECT_EQ(StepList(writes.begin() + 1, writes.end()), keys);  // after the marker the new group carries
  EXPECT_EQ(AttributeOf(entity, "@SCL=")->longs, Indices{3});
  EXPECT_EQ(AttributeOf(entity, "@SSL10=")->longs, (Indices{110, 10, 2}));

  HRSelection loaded;
  ASSERT_EQ(loaded.Load(entity), 0);
  ASSERT_EQ(loaded.GetSectionCount(), 12);
  Indices cameras;
  loaded.GetSectionCameras(11, cameras);
  EXPECT_EQ(std::tuple(loaded.GetSectionHandle(11), cameras), std::tuple(111, Indices{11, 2}));
}

TEST_F(SelectionTest, RefusedWritesAndDamagedRecordsFailWithoutLooping) {
  HRSelection selection;
  selection.AddSection(5, {0});
  selection.AddSection(6, {1});
  selection.AddPlan(7, {0});
  FailOn("qel_set_long_vector_attribute", "@SSL1=");
  EXPECT_EQ(selection.Create(), model_status::kAttributeFailed);
  const host::EntityHandle refused = selection.GetHandle();
  EXPECT_EQ(AttributeOf(refused, "@SCL="), nullptr);  // no ticked camera, no key
  EXPECT_NE(AttributeOf(refused, "@SSL0="), nullptr);
  EXPECT_EQ(AttributeOf(refused, "@SPC="), nullptr);
  EXPECT_EQ(IsSelection(refused), 0);
  FailNext("qel_delete_group");
  EXPECT_EQ(DeleteSelection(refused), model_status::kNotDeleted);
  EXPECT_EQ(DeleteSelection(refused), 0);

  Bench().GetFaults().Clear();
  ASSERT_EQ(selection.Create(), 0);
  const host::EntityHandle entity = selection.GetHandle();
  const auto loaded = [entity](std::int16_t status) {
    HRSelection fresh;
    EXPECT_EQ(fresh.Load(entity), status);
    return fresh.GetSectionCount();
  };
  Put(entity, "@SSC=", wb::AttributeType::Short).shortValue = 32767;
  loaded(model_status::kAttributeFailed);
  Put(entity, "@SSC=", wb::AttributeType::Short).shortValue = -4;
  EXPECT_EQ(loaded(0), 0);
  Put(entity, "@SSC=", wb::AttributeType::Short).shortValue = 2;
  PutString(entity, "@SSL1=", "6 1");
  loaded(model_status::kAttributeFailed);
  Put(entity, "@SSL1=", wb::AttributeType::LongVector).longs = {6, 1};
  EXPECT_EQ(loaded(0), 2);
  DropAttribute(entity, "@SPL0=");
  loaded(model_status::kAttributeFailed);
}

TEST_F(SelectionTest, ApplyTicksTheListedGeneralCamerasInStepWithTheList) {
  struct Case {
    int stored;
    std::int16_t ticked;
    Indices listed;
    Ticks expected;
  };
  for (const Case& c :
       {Case{4, 1, {0, 2}, {1, 0, 1, 0}}, Case{4, 1, {2, 0}, {0, 0, 1, 0}}, Case{2, 0, {1, 7}, {0, 1}}}) {
    TearDown();
    SetUp();
    HRCamera camera;
    camera.SetFor2D(c.ticked);
    for (int i = 0; i < c.stored; ++i) EXPECT_EQ(AddGeneralCamera(camera), i);
    HRSelection selection;
    for (const std::int32_t index : c.listed) selection.AddCamera(index);
    selection.Apply();
    Ticks ticks;
    for (std::int32_t i = 0; i < c.stored; ++i) {
      EXPECT_EQ(LoadGeneralCamera(camera, i), 0);
      ticks.push_back(camera.IsFor2D());
    }
    EXPECT_EQ(ticks, c.expected);
  }
}

}  // namespace
