// The camera manager: which entities of a drawing it lists, adding, removing and updating by
// index, and the database switch.
#include <string>
#include <vector>

#include "model/status_codes.h"
#include "shell/host/qeldll.h"
#include "tests/views/views_fixture.h"

namespace {

class CameraManagerTest : public ViewsTest {
 protected:
  static std::vector<std::string> ListedNames() {
    std::vector<std::string> names;
    for (std::int32_t i = 0; i < GetGeneralCameraCount(); ++i) {
      HRCamera camera;
      EXPECT_EQ(LoadGeneralCamera(camera, i), 0);
      names.push_back(camera.GetName());
    }
    return names;
  }
};

TEST_F(CameraManagerTest, EmptyDrawingOrRefusedWalkListsNothing) {
  EXPECT_EQ(GetGeneralCameraCount(), 0);
  StoreCamera("Somewhere");
  FailNext("loop_on_database_blank_h");
  EXPECT_EQ(SetDatabase(Bench().Current()), 0);
  EXPECT_EQ(GetGeneralCameraCount(), 0);
  EXPECT_EQ(SetDatabase(Bench().Current()), 0);
  EXPECT_EQ(GetGeneralCameraCount(), 1);
}

TEST_F(CameraManagerTest, ListsGeneralCamerasOnlyHiddenOnesIncluded) {
  StoreCamera("First");
  StoreCamera("Section camera", "hrSecCam");
  const host::EntityHandle hidden = StoreCamera("Hidden");
  StoreCamera("Plan camera", "hrPlnCam");
  StoreCamera("Lower case", "hrcamera");
  Drawing().Add(host::kTypeGroup);  // a plain group without a record
  const host::EntityHandle line = Drawing().Add(host::kTypeLine).handle;
  // Every camera key on an entity that is no group does not make it a camera.
  const host::EntityHandle source = StoreCamera("Copied keys");
  Find(line)->attributes = Find(source)->attributes;
  PutString(source, "@CAMNAME=", "Last");
  Find(hidden)->header.bytes[host::kHeaderFlags] |= host::kFlagHidden;

  ASSERT_EQ(SetDatabase(Bench().Current()), 0);
  EXPECT_EQ(ListedNames(), (std::vector<std::string>{"First", "Hidden", "Last"}));
}

TEST_F(CameraManagerTest, AddAppendsAndReportsTheNewEntity) {
  HRCamera camera;
  camera.SetSettings(DistinctSettings());
  ClearJournal();
  EXPECT_EQ(AddGeneralCamera(camera), 0);
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{camera.GetHandle(), 1}, {-1, -1}}));

  for (int n = 1; n < 4; ++n) {
    HRCamera next;
    next.SetName("Camera " + std::to_string(n));
    EXPECT_EQ(AddGeneralCamera(next), n);
  }
  EXPECT_EQ(GetGeneralCameraCount(), 4);
  EXPECT_EQ(CameraManager().Handles()[0], camera.GetHandle());
}

TEST_F(CameraManagerTest, AddCurrentViewStoresTheHostViewWithoutAChangeRecord) {
  globp[48] = {3.0F, -4.0F, 12.0F};
  execute_internal_command("eye");
  ClearJournal();
  EXPECT_EQ(CameraManager().AddCurrentView(), 0);
  ASSERT_EQ(GetGeneralCameraCount(), 1);
  EXPECT_TRUE(ChangeRecords().empty());
  HRCamera camera;
  ASSERT_EQ(LoadGeneralCamera(camera, 0), 0);
  EXPECT_EQ(SettingsOf(camera).eye[2], 12.0F);
  EXPECT_EQ(camera.GetName(), "Camera");

  FailNext("qel_create_group");
  EXPECT_NE(CameraManager().AddCurrentView(), 0);
  EXPECT_EQ(GetGeneralCameraCount(), 1);
}

TEST_F(CameraManagerTest, FailedAddKeepsTheListAndStillWritesTheChangeRecord) {
  StoreCamera("Existing");
  SetDatabase(Bench().Current());
  FailNext("qel_create_group");
  ClearJournal();
  HRCamera camera;
  EXPECT_EQ(AddGeneralCamera(camera), model_status::kRecordNotOpened);
  EXPECT_EQ(GetGeneralCameraCount(), 1);
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{0, 1}, {-1, -1}}));
}

TEST_F(CameraManagerTest, RemovingAnIndexShiftsTheLaterCamerasDown) {
  const host::EntityHandle first = StoreCamera("A");
  const host::EntityHandle second = StoreCamera("B");
  const host::EntityHandle third = StoreCamera("C");
  SetDatabase(Bench().Current());

  EXPECT_EQ(RemoveGeneralCamera(0), 0);
  EXPECT_EQ(Find(first), nullptr);
  EXPECT_EQ(CameraManager().Handles(), (std::vector<host::EntityHandle>{second, third}));
  EXPECT_EQ(ListedNames(), (std::vector<std::string>{"B", "C"}));
}

TEST_F(CameraManagerTest, RefusedRemovalKeepsTheHandle) {
  const host::EntityHandle entity = StoreCamera("Kept");
  SetDatabase(Bench().Current());
  FailNext("qel_delete_group");
  EXPECT_EQ(RemoveGeneralCamera(0), model_status::kNotDeleted);
  EXPECT_EQ(GetGeneralCameraCount(), 1);
  EXPECT_NE(Find(entity), nullptr);
}

TEST_F(CameraManagerTest, IndicesOutsideTheListChangeNothing) {
  StoreCamera("Only");
  SetDatabase(Bench().Current());
  HRCamera camera;
  EXPECT_NE(LoadGeneralCamera(camera, 1), 0);
  EXPECT_NE(LoadGeneralCamera(camera, -1), 0);
  EXPECT_NE(RemoveGeneralCamera(5), 0);
  EXPECT_NE(UpdateGeneralCamera(camera, 1), 0);
  EXPECT_EQ(GetGeneralCameraCount(), 1);
  EXPECT_EQ(Drawing().LiveCount(), 1U);
}

TEST_F(CameraManagerTest, UpdateWritesTheCameraAtTheIndex) {
  StoreCamera("A");
  const host::EntityHandle second = StoreCamera("B");
  SetDatabase(Bench().Current());

  HRCamera camera;
  ASSERT_EQ(LoadGeneralCamera(camera, 1), 0);
  camera.SetComment("checked");
  camera.SetHandle(0);  // the index decides where it goes, not the handle it holds
  EXPECT_EQ(UpdateGeneralCamera(camera, 1), 0);
  EXPECT_EQ(AttributeOf(second, "@COMMENT=")->text, "checked");
  EXPECT_EQ(camera.GetHandle(), second);
}

TEST_F(CameraManagerTest, CopyAtAnIndexCarriesTheViewButNoName) {
  const host::EntityHandle entity = StoreCamera("Named");
  SetDatabase(Bench().Current());
  const HRCamera copy = CameraManager().GetCopy(0);
  EXPECT_EQ(copy.GetName(), "");
  EXPECT_EQ(copy.GetHandle(), entity);
  EXPECT_EQ(SettingsOf(copy).cone, DistinctSettings().cone);
}

TEST_F(CameraManagerTest, SetDatabaseSwitchesTheDrawingItWorksOn) {
  StoreCamera("In the first");
  const host::DatabaseHandle first = Bench().Current();
  const host::DatabaseHandle second = Bench().Open(wb::Drawing{});
  ASSERT_EQ(SetDatabase(second), 0);
  EXPECT_EQ(GetCurrentDatabase(), second);
  EXPECT_EQ(GetGeneralCameraCount(), 0);

  HRCamera camera;
  camera.SetName("In the second");
  EXPECT_EQ(AddGeneralCamera(camera), 0);
  EXPECT_NE(Bench().Find(second)->Find(camera.GetHandle()), nullptr);

  ASSERT_EQ(SetDatabase(first), 0);
  EXPECT_EQ(ListedNames(), (std::vector<std::string>{"In the first"}));
}

}  // namespace
