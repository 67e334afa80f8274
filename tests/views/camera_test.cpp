// Cameras as stored: the record's keys written in order, the read with its defaults and required
// keys, damaged records and refused host calls; and the camera manager, which lists the general
// cameras of a drawing and adds, removes and updates them by index.
#include <algorithm>
#include <string>
#include <tuple>
#include <vector>

#include "model/status_codes.h"
#include "tests/views/views_fixture.h"

namespace {

using Handles = std::vector<host::EntityHandle>;

class CameraRecordTest : public ViewsTest {};
class CameraManagerTest : public ViewsTest {};

TEST_F(CameraRecordTest, CreateWritesEveryKeyInOrderAndTheClassLast) {
  CameraSettings settings = DistinctSettings();
  settings.autoClip = 5;  // any "on" is written as 1
  HRCamera camera = CameraWith(settings);
  ASSERT_EQ(camera.Create(), 0);
  const host::EntityHandle entity = camera.GetHandle();
  StepList writes = WritesTo(entity);
  writes.erase(writes.begin(), std::find(writes.begin(), writes.end(), "@EYE="));  // the new group's own
  EXPECT_EQ(writes, (StepList{"@EYE=",     "@TARGET=",   "@CONE=",         "@VIEWMODE=", "@LYRCFG=",    "@CAMNAME=",
                              "@DSP=",     "@CONF=",     "@S2D=",          "@2DFILE=",   "@COMMENT=",   "@PATTERN=",
                              "@SHOWSEC=", "@AUTOCLIP=", "@S2DOVERWRITE=", "@CLINE=",    "@LINEMERGE=", "@SCALE=",
                              "@PRESDIM=", "@PRESLYR=",  "@PRESLYRN=",     "@PRESTXT=",  "@PRESWLS=",   "@Class="}));
  EXPECT_EQ(AttributeOf(entity, "@EYE=")->format, 6);
  EXPECT_EQ(AttributeOf(entity, "@CONF=")->text, "-12.125000 -7.500000 30.000000 19.875000");
  EXPECT_EQ(AttributeOf(entity, "@AUTOCLIP=")->shortValue, 1);
}

TEST_F(CameraRecordTest, RecordWithoutDefaultedKeysLoadsWithTheirDefaults) {
  const host::EntityHandle entity = StoreCamera("Old record");
  for (const char* key : {"@2DFILE=", "@COMMENT=", "@AUTOCLIP=", "@S2DOVERWRITE=", "@CLINE=", "@LINEMERGE=", "@SCALE=",
                          "@PRESDIM=", "@PRESTXT=", "@PRESLYR=", "@PRESLYRN=", "@PRESWLS="}) {
    DropAttribute(entity, key);
  }
  Put(entity, "@SHOWSEC=", wb::AttributeType::Short).shortValue = 5;  // any "on" is read as 1
  HRCamera loaded;
  loaded.Set2DFile("left over");
  ASSERT_EQ(loaded.Load(entity), 0);
  CameraSettings expected = DistinctSettings();
  expected.file2D = expected.comment = "";
  expected.showSections = expected.autoClip = expected.overwrite2D = expected.removeCoincident = expected.lineMerge = 1;
  expected.preserveDimensions = expected.preserveText = expected.preserveLayer = expected.preserveWalls = 0;
  expected.scaleMode = 'a';
  expected.preserveLayerIndex = 0;  // an old record counts from layer index 0, unlike a reset camera
  EXPECT_EQ(Values(SettingsOf(loaded)), Values(expected));
  EXPECT_EQ(loaded.GetName(), "Old record");
}

class CameraRequiredKeyTest : public ViewsTest, public ::testing::WithParamInterface<const char*> {};

TEST_P(CameraRequiredKeyTest, RecordWithoutItDoesNotLoad) {
  const host::EntityHandle entity = StoreCamera("Incomplete");
  DropAttribute(entity, GetParam());
  HRCamera loaded;
  EXPECT_EQ(loaded.Load(entity), model_status::kAttributeFailed);
}

INSTANTIATE_TEST_SUITE_P(EveryRequiredKey, CameraRequiredKeyTest,
                         ::testing::Values("@EYE=", "@TARGET=", "@CONE=", "@VIEWMODE=", "@LYRCFG=", "@CAMNAME=",
                                           "@Class=", "@CONF=", "@DSP=", "@S2D=", "@PATTERN=", "@SHOWSEC="));

TEST_F(CameraRecordTest, DamagedRecordsAreRefusedWithoutReadingPastThem) {
  HRCamera camera;
  const host::EntityHandle entity = StoreCamera("Damaged");
  FailOn("qel_read_short_attribute", "@AUTOCLIP=");  // present but unreadable is a failure, not a default
  EXPECT_EQ(camera.Load(entity), model_status::kAttributeFailed);
  Bench().GetFaults().Clear();
  FailNext("qel_open_attribute_record");
  EXPECT_EQ(camera.Load(entity), model_status::kRecordNotOpened);
  Find(entity)->FindAttribute("@LYRCFG=")->shorts.resize(10);  // a layer table cut short
  EXPECT_EQ(camera.Load(entity), model_status::kAttributeFailed);
}

TEST_F(CameraRecordTest, RefusedHostCallsFailWithTheirStatusAndSaveStopsAtTheFirst) {
  HRCamera camera;
  FailNext("qel_create_group");
  EXPECT_EQ(camera.Create(), model_status::kRecordNotOpened);
  FailOn("qel_set_string_attribute", "@Class=");
  EXPECT_EQ(camera.Create(), model_status::kStringNotWritten);
  const host::EntityHandle entity = camera.GetHandle();
  Bench().GetFaults().Clear();
  // A save stops at the first refused write and leaves the missing class alone.
  camera.SetName("Renamed");
  ClearJournal();
  FailOn("qel_set_short_attribute", "@DSP=");
  EXPECT_EQ(camera.Save(), model_status::kStringNotWritten);
  EXPECT_EQ(WritesTo(entity), (StepList{"@EYE=", "@TARGET=", "@CONE=", "@VIEWMODE=", "@LYRCFG=", "@CAMNAME="}));
  EXPECT_EQ(AttributeOf(entity, "@Class="), nullptr);
  EXPECT_EQ(AttributeOf(entity, "@CAMNAME=")->text, "Renamed");
  FailNext("qel_delete_group");
  EXPECT_EQ(camera.Delete(), model_status::kNotDeleted);
  EXPECT_EQ(camera.Delete(), 0);
  EXPECT_EQ(Find(entity), nullptr);
}

TEST_F(CameraManagerTest, ListsGeneralCamerasOnlyHiddenOnesIncluded) {
  const host::EntityHandle first = StoreCamera("First");
  StoreCamera("Section camera", "hrSecCam");
  StoreCamera("Plan camera", "hrPlnCam");
  StoreCamera("Lower case", "hrcamera");
  Drawing().Add(host::kTypeGroup);  // a plain group without a record
  const host::EntityHandle hidden = StoreCamera("Hidden");
  Flags(hidden) |= host::kFlagHidden;
  // Every camera key on an entity that is no group does not make it a camera.
  const host::EntityHandle line = Drawing().Add(host::kTypeLine).handle;
  Find(line)->attributes = Find(hidden)->attributes;
  FailNext("loop_on_database_blank_h");
  EXPECT_EQ(SetDatabase(Bench().Current()), 0);
  EXPECT_EQ(GetGeneralCameraCount(), 0);  // a refused walk lists nothing
  ASSERT_EQ(SetDatabase(Bench().Current()), 0);
  EXPECT_EQ(CameraManager().Handles(), (Handles{first, hidden}));
}

TEST_F(CameraManagerTest, RemoveUpdateAndCopyGoByIndexAndRefusalsChangeNothing) {
  const host::EntityHandle first = StoreCamera("A");
  const host::EntityHandle second = StoreCamera("B");
  const host::EntityHandle third = StoreCamera("C");
  SetDatabase(Bench().Current());
  EXPECT_EQ(RemoveGeneralCamera(0), 0);
  EXPECT_EQ(Find(first), nullptr);
  HRCamera camera;
  ASSERT_EQ(LoadGeneralCamera(camera, 0), 0);
  camera.SetComment("checked");
  camera.SetHandle(third);  // the index decides where it goes, not the handle it holds
  EXPECT_EQ(UpdateGeneralCamera(camera, 0), 0);
  EXPECT_EQ(AttributeOf(second, "@COMMENT=")->text, "checked");
  const HRCamera copy = CameraManager().GetCopy(1);  // the view only, under no name
  EXPECT_EQ(std::tuple(copy.GetHandle(), copy.GetName(), copy.IsFor2D()), std::tuple(third, "", 0));
  FailNext("qel_delete_group");
  EXPECT_EQ(RemoveGeneralCamera(0), model_status::kNotDeleted);
  EXPECT_EQ(CameraManager().Handles(), (Handles{second, third}));
}

TEST_F(CameraManagerTest, AddingGoesToTheCurrentDrawingWithAChangeRecordEvenWhenRefused) {
  Drawing().Add(host::kTypeLine);  // so that no handle of the first drawing is one of the second
  const host::EntityHandle inFirst = StoreCamera("In the first");
  const host::DatabaseHandle first = Bench().Current();
  const host::DatabaseHandle second = Bench().Open(wb::Drawing{});
  ASSERT_EQ(SetDatabase(second), 0);
  HRCamera camera, refused;
  ClearJournal();
  EXPECT_EQ(AddGeneralCamera(camera), 0);
  EXPECT_NE(Bench().Find(second)->Find(camera.GetHandle()), nullptr);
  FailNext("qel_create_group");
  EXPECT_EQ(AddGeneralCamera(refused), model_status::kRecordNotOpened);
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{camera.GetHandle(), 1}, {-1, -1}, {0, 1}, {-1, -1}}));
  EXPECT_EQ(CameraManager().AddCurrentView(), 0);
  EXPECT_EQ(ChangeRecords().size(), 4U);  // the current view comes without one
  EXPECT_EQ(GetGeneralCameraCount(), 2);
  ASSERT_EQ(SetDatabase(first), 0);
  EXPECT_EQ(CameraManager().Handles(), Handles{inFirst});
}

}  // namespace
