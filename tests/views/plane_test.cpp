// Plans: the record on the group entity, loading, the plan's cameras, deletion, the class test
// and plans kept through a saved drawing file.
#include <string>
#include <vector>

#include "display/display_mode.h"
#include "model/status_codes.h"
#include "tests/views/views_fixture.h"
#include "views/hr_plane.h"
#include "views/section_symbols.h"

namespace {

class PlaneTest : public ViewsTest {
 protected:
  static host::EntityHandle MakePlane(const std::string& name, HRPlane* keep = nullptr) {
    HRPlane local;
    HRPlane& plane = keep != nullptr ? *keep : local;
    const float base[3] = {1, 2, 0};
    const float dir[3] = {1, 2, 5};
    plane.DefineFromPoints(name, base, dir);
    EXPECT_EQ(plane.Create(), 0);
    return plane.GetHandle();
  }
};

TEST_F(PlaneTest, CreateWritesBaseDirNameAndFlag) {
  HRPlane plane;
  const float base[3] = {1, 2, 0};
  const float dir[3] = {1, 2, 5};
  plane.DefineFromPoints("Level 1", base, dir);
  plane.SetFor2D(1);
  ClearJournal();
  ASSERT_EQ(plane.Create(), 0);
  const host::EntityHandle entity = plane.GetHandle();
  EXPECT_EQ(Find(entity)->Type(), host::kTypeGroup);
  EXPECT_EQ(WritesTo(entity), (std::vector<std::string>{"@Class=", "@base=", "@dir=", "@name=", "@S2D="}));
  EXPECT_EQ(AttributeOf(entity, "@Class=")->text, "HRPlane");
  EXPECT_EQ(AttributeOf(entity, "@base=")->floats, (std::vector<float>{1, 2, 0}));
  EXPECT_EQ(AttributeOf(entity, "@dir=")->floats, (std::vector<float>{1, 2, 5}));
  EXPECT_EQ(AttributeOf(entity, "@base=")->format, 6);
  EXPECT_EQ(AttributeOf(entity, "@name=")->text, "Level 1");
  EXPECT_EQ(AttributeOf(entity, "@S2D=")->shortValue, 1);
  EXPECT_EQ(AttributeOf(entity, "@pln_cams="), nullptr);
  EXPECT_TRUE(IsPlaneEntity(Bench().Current(), entity));
}

TEST_F(PlaneTest, LoadedPlaneHasItsValues) {
  HRPlane plane;
  const double base[3] = {-3.5, 8.25, 12};
  const double dir[3] = {4, 4, 4};
  plane.Define("Roof", base, dir);
  plane.SetFor2D(1);
  ASSERT_EQ(plane.Create(), 0);

  HRPlane loaded;
  ASSERT_EQ(loaded.Load(plane.GetHandle()), 0);
  EXPECT_EQ(loaded.GetName(), "Roof");
  EXPECT_EQ(loaded.IsFor2D(), 1);
  for (int i = 0; i < 3; ++i) {
    EXPECT_DOUBLE_EQ(loaded.GetBase()[i], base[i]);
    EXPECT_DOUBLE_EQ(loaded.GetDir()[i], dir[i]);
  }
  EXPECT_EQ(loaded.GetCutType(), 'b');
  EXPECT_EQ(loaded.GetCameraCount(), 0);
}

TEST_F(PlaneTest, RecordMissingWhatCreateAlwaysWritesIsNoPlane) {
  for (const char* key : {"@base=", "@dir=", "@name="}) {
    const host::EntityHandle entity = MakePlane("Broken");
    DropAttribute(entity, key);
    HRPlane loaded;
    EXPECT_EQ(loaded.Load(entity), model_status::kAttributeFailed) << key;
  }
  const host::EntityHandle shortBase = MakePlane("Short base");
  Find(shortBase)->FindAttribute("@base=")->floats.resize(2);
  HRPlane loaded;
  EXPECT_EQ(loaded.Load(shortBase), model_status::kAttributeFailed);
  EXPECT_EQ(loaded.Load(4242), model_status::kHeaderNotRead);
  EXPECT_EQ(loaded.Load(Drawing().Add(host::kTypeLine).handle), model_status::kWrongEntity);
}

TEST_F(PlaneTest, SaveRewritesTheRecordAndDropsAnEmptyCameraList) {
  HRPlane plane;
  const host::EntityHandle entity = MakePlane("Ground", &plane);
  plane.AddCamera("Default");
  plane.SetName("Ground floor");
  ASSERT_EQ(plane.Save(), 0);
  EXPECT_EQ(AttributeOf(entity, "@name=")->text, "Ground floor");
  EXPECT_EQ(AttributeOf(entity, "@pln_cams=")->longs, plane.Cameras());

  EXPECT_EQ(plane.RemoveCamera(0), 0);
  ClearJournal();
  ASSERT_EQ(plane.Save(), 0);
  EXPECT_EQ(WritesTo(entity), (std::vector<std::string>{"@base=", "@dir=", "@name=", "@S2D="}));
  EXPECT_EQ(AttributeOf(entity, "@pln_cams="), nullptr);
  HRPlane loaded;
  ASSERT_EQ(loaded.Load(entity), 0);
  EXPECT_EQ(loaded.GetCameraCount(), 0);
}

TEST_F(PlaneTest, CamerasAreOwnedListedAndShiftedOnRemoval) {
  HRPlane plane;
  const host::EntityHandle entity = MakePlane("First floor", &plane);
  EXPECT_EQ(plane.AddCamera("Default"), 0);
  EXPECT_EQ(plane.AddCamera("Corner"), 1);
  const std::vector<host::EntityHandle> cameras = plane.Cameras();
  EXPECT_EQ(AttributeOf(entity, "@pln_cams=")->longs, cameras);
  EXPECT_EQ(AttributeOf(cameras[1], "@Class=")->text, "hrPlnCam");
  SetDatabase(Bench().Current());
  EXPECT_EQ(GetGeneralCameraCount(), 0);

  plane.SetCameraFor2D(1, 1);
  plane.RenameCamera("Far corner", 1);
  EXPECT_EQ(plane.IsCameraFor2D(1), 1);
  EXPECT_EQ(plane.IsCameraFor2D(0), 0);

  EXPECT_EQ(plane.RemoveCamera(0), 0);
  EXPECT_EQ(Find(cameras[0]), nullptr);
  EXPECT_EQ(plane.GetCameraCount(), 1);
  EXPECT_EQ(plane.GetCameraName(0), "Far corner");
  EXPECT_EQ(AttributeOf(entity, "@pln_cams=")->longs, (std::vector<std::int32_t>{cameras[1]}));
}

TEST_F(PlaneTest, CameraDeletedElsewhereHasNoNameAndIsOnlyUnlisted) {
  HRPlane plane;
  const host::EntityHandle entity = MakePlane("Basement", &plane);
  plane.AddCamera("One");
  plane.AddCamera("Two");
  const std::vector<host::EntityHandle> cameras = plane.Cameras();
  Drawing().Remove(cameras[1]);
  EXPECT_EQ(plane.GetCameraName(1), "");
  EXPECT_EQ(plane.IsCameraFor2D(1), 0);
  EXPECT_EQ(plane.RemoveCamera(1), model_status::kHeaderNotRead);
  EXPECT_EQ(AttributeOf(entity, "@pln_cams=")->longs, (std::vector<std::int32_t>{cameras[0]}));
}

TEST_F(PlaneTest, DamagedCameraListsLoadWithoutReadingPastThem) {
  const host::EntityHandle entity = MakePlane("Attic");
  PutLongs(entity, "@pln_cams=", {});
  HRPlane empty;
  ASSERT_EQ(empty.Load(entity), 0);
  EXPECT_EQ(empty.GetCameraCount(), 0);

  PutString(entity, "@pln_cams=", "1 2 3");
  HRPlane wrongKind;
  ASSERT_EQ(wrongKind.Load(entity), 0);
  EXPECT_EQ(wrongKind.GetCameraCount(), 0);

  PutLongs(entity, "@pln_cams=", {entity, -1});
  HRPlane strangers;
  ASSERT_EQ(strangers.Load(entity), 0);
  ASSERT_EQ(strangers.GetCameraCount(), 2);
  EXPECT_EQ(strangers.GetCameraName(0), "");
  EXPECT_EQ(strangers.GetCameraName(1), "");
}

TEST_F(PlaneTest, DeleteRemovesThePlaneAndEveryCamera) {
  HRPlane plane;
  const host::EntityHandle kept = Drawing().Add(host::kTypeLine).handle;
  const host::EntityHandle entity = MakePlane("Gone", &plane);
  plane.AddCamera("One");
  plane.AddCamera("Two");
  HRPlane loaded;
  ASSERT_EQ(loaded.Load(entity), 0);
  EXPECT_EQ(loaded.Delete(), 0);
  EXPECT_EQ(loaded.GetCameraCount(), 0);
  EXPECT_EQ(Drawing().LiveCount(), 1U);
  EXPECT_NE(Find(kept), nullptr);
}

TEST_F(PlaneTest, ClassTestIsExact) {
  const host::EntityHandle entity = MakePlane("Exact");
  const host::DatabaseHandle database = Bench().Current();
  EXPECT_TRUE(IsPlaneEntity(database, entity));
  for (const char* near : {"hrplane", "HRPlane ", "HRPlan", "HRSection", ""}) {
    PutString(entity, "@Class=", near);
    EXPECT_FALSE(IsPlaneEntity(database, entity)) << '"' << near << '"';
  }
  DropAttribute(entity, "@Class=");
  EXPECT_FALSE(IsPlaneEntity(database, entity));
  EXPECT_FALSE(IsPlaneEntity(database, 777));
}

TEST_F(PlaneTest, PlanViewHandsTheHostBaseAxesAndSecondPoint) {
  HRPlane plane;
  MakePlane("Level 0", &plane);
  plane.SetCutType('w');
  SectionsShown = 0;
  globr[103] = 0.0F;
  ClearJournal();
  EXPECT_EQ(plane.ShowView(-1), 0);
  const std::vector<host::Point3f> expected = {{1, 2, 0}, {101, 2, 0}, {1, 102, 0}, {1, 2, 5}};
  for (std::size_t i = 0; i < expected.size(); ++i) {
    EXPECT_EQ(globp[i].x, expected[i].x) << i;
    EXPECT_EQ(globp[i].y, expected[i].y) << i;
    EXPECT_EQ(globp[i].z, expected[i].z) << i;
  }
  EXPECT_EQ(Steps(), (std::vector<std::string>{"inq_render_mode", "set_background_color", "wire_frame_all",
                                               "set_dspmode_info", "draw_text_on_off", "new_solid", "redraw_all",
                                               "set_dspmode_info", "planv", "inq_render_mode", "hidden_lines"}));
  const wb::PlanView& view = Bench().View().plan;
  EXPECT_TRUE(view.active);
  EXPECT_EQ(view.cutType, 'w');
  EXPECT_EQ(view.xPoint.x, 101.0F);
  EXPECT_EQ(view.dir.z, 5.0F);
  EXPECT_FALSE(Bench().Display().textShown);
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kHiddenline);

  SectionsShown = 1;
  EXPECT_EQ(plane.ShowView(-1), 0);
  EXPECT_TRUE(Bench().Display().textShown);
}

TEST_F(PlaneTest, CameraViewEndsInTheCamerasModeOrHiddenLines) {
  HRPlane plane;
  MakePlane("Level 2", &plane);
  plane.AddCamera("Plain");
  plane.AddCamera("Wire");
  HRCamera camera;
  ASSERT_EQ(plane.LoadCamera(1, camera), 0);
  CameraSettings settings = SettingsOf(camera);
  settings.displayMode = HRUtility::kWireframe;
  camera.SetSettings(settings);
  ASSERT_EQ(plane.SaveCamera(1, camera), 0);

  ClearJournal();
  EXPECT_EQ(plane.ShowView(0), 0);
  EXPECT_FALSE(Journaled(Kind::Command, "planv"));
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kHiddenline);
  EXPECT_EQ(plane.ShowView(1), 0);
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kWireframe);
  EXPECT_EQ(Bench().View().waitCursor, 0);
}

TEST_F(PlaneTest, PlanViewIsRefusedWhileRendering) {
  HRPlane plane;
  MakePlane("Level 3", &plane);
  plane.AddCamera("Default");
  HRUtility::SetDisplayMode(HRUtility::kRender);
  ClearJournal();
  EXPECT_EQ(plane.ShowView(-1), -28);
  EXPECT_EQ(Steps(), std::vector<std::string>{"inq_render_mode"});
  FailOn("execute_internal_command", "render_on");
  EXPECT_EQ(plane.ShowView(0), -28);
  EXPECT_FALSE(Bench().View().plan.active);
  EXPECT_EQ(Bench().View().waitCursor, 0);
  EXPECT_EQ(Bench().View().waitCursorUnderflows, 0);
}

TEST_F(PlaneTest, CameraThatDoesNotLoadLeavesTheViewAlone) {
  HRPlane plane;
  MakePlane("Level 4", &plane);
  plane.AddCamera("Default");
  Drawing().Remove(plane.Cameras()[0]);
  ClearJournal();
  EXPECT_EQ(plane.ShowView(0), model_status::kHeaderNotRead);
  EXPECT_TRUE(Steps().empty());
  EXPECT_EQ(Bench().View().waitCursor, 0);
}

TEST_F(PlaneTest, PlansAndTheirCamerasComeBackFromASavedDrawingFile) {
  HRPlane plane;
  const double base[3] = {0.5, -1.25, 3};
  const double dir[3] = {0.5, -1.25, 9};
  plane.Define("Mezzanine", base, dir);
  plane.SetFor2D(1);
  ASSERT_EQ(plane.Create(), 0);
  plane.AddCamera("Default");
  plane.AddCamera("Detail");
  plane.SetCameraFor2D(0, 1);
  HRCamera detail;
  ASSERT_EQ(plane.LoadCamera(1, detail), 0);
  const CameraSettings detailSettings = SettingsOf(detail);

  ReopenThroughFile();
  HRPlane loaded;
  ASSERT_EQ(loaded.Load(plane.GetHandle()), 0);
  EXPECT_EQ(loaded.GetName(), "Mezzanine");
  EXPECT_EQ(loaded.IsFor2D(), 1);
  for (int i = 0; i < 3; ++i) {
    EXPECT_DOUBLE_EQ(loaded.GetBase()[i], base[i]);
    EXPECT_DOUBLE_EQ(loaded.GetDir()[i], dir[i]);
  }
  EXPECT_EQ(loaded.Cameras(), plane.Cameras());
  EXPECT_EQ(loaded.GetCameraName(1), "Detail");
  EXPECT_EQ(loaded.IsCameraFor2D(0), 1);
  HRCamera camera;
  ASSERT_EQ(loaded.LoadCamera(1, camera), 0);
  ExpectSameSettings(SettingsOf(camera), detailSettings);
}

}  // namespace
