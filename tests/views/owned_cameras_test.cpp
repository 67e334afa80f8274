// The cameras a section or a plan owns, which behave alike for both: the list on the owner's
// record, cameras not made or gone, deletion with the owner, and the view through a camera.
#include <string>
#include <type_traits>
#include <vector>

#include "display/display_mode.h"
#include "model/status_codes.h"
#include "tests/views/views_fixture.h"

namespace {

class OwnedCamerasTest : public ViewsTest {
 protected:
  // Runs a check on a section and then, in a fresh host, on a plan.
  template <typename Check>
  void ForBoth(Check check) {
    {
      SCOPED_TRACE("section");
      HRSection section;
      check(section);
    }
    TearDown();
    SetUp();
    SCOPED_TRACE("plan");
    HRPlane plan;
    check(plan);
  }

  static const char* ListKey(const HRSection&) { return "@CamLst="; }
  static const char* ListKey(const HRPlane&) { return "@pln_cams="; }
  static const char* CameraClass(const HRSection&) { return "hrSecCam"; }
  static const char* CameraClass(const HRPlane&) { return "hrPlnCam"; }
};

TEST_F(OwnedCamerasTest, CamerasAreListedOnTheOwnersRecordAtOnceAndDeletedWithIt) {
  ForBoth([](auto& view) {
    const host::EntityHandle unrelated = Drawing().Add(host::kTypeLine).handle;
    const host::EntityHandle owner = StoreView(view);
    FailNext("qel_create_group");
    EXPECT_EQ(view.AddCamera("Lost"), 0);
    EXPECT_EQ(AttributeOf(owner, ListKey(view)), nullptr);  // a camera not made is not listed
    EXPECT_EQ(view.AddCamera("Default"), 0);
    EXPECT_EQ(view.AddCamera("Second"), 1);
    EXPECT_EQ(view.AddCamera("Third"), 2);
    const std::vector<host::EntityHandle> cameras = view.Cameras();
    EXPECT_EQ(AttributeOf(owner, ListKey(view))->longs, cameras);
    EXPECT_EQ(AttributeOf(cameras[0], "@Class=")->text, CameraClass(view));
    view.SetCameraFor2D(1, 1);
    std::remove_reference_t<decltype(view)> reloaded;
    ASSERT_EQ(reloaded.Load(owner), 0);
    EXPECT_EQ(reloaded.IsCameraFor2D(1), 1);
    EXPECT_EQ(reloaded.RemoveCamera(0), 0);
    EXPECT_EQ(Find(cameras[0]), nullptr);
    EXPECT_EQ(reloaded.GetCameraName(0), "Second");
    Drawing().Remove(cameras[1]);  // a camera deleted elsewhere is only unlisted
    EXPECT_EQ(reloaded.RemoveCamera(0), model_status::kHeaderNotRead);
    EXPECT_EQ(reloaded.RemoveCamera(0), 0);
    EXPECT_EQ(AttributeOf(owner, ListKey(view)), nullptr);  // no empty list is left behind

    reloaded.AddCamera("Last");
    ClearJournal();
    EXPECT_EQ(reloaded.Delete(), 0);
    EXPECT_EQ(Drawing().LiveCount(), 1U);
    EXPECT_NE(Find(unrelated), nullptr);
    if constexpr (std::is_same_v<std::remove_reference_t<decltype(view)>, HRSection>) {
      EXPECT_EQ(ChangeRecords().at(0), (ChangeRecord{owner, 2}));  // the placed block's deletion is recorded
    }
  });
}

TEST_F(OwnedCamerasTest, ViewThroughACameraEndsInItsModeOrInHiddenLinesUnlessRefused) {
  ForBoth([](auto& view) {
    StoreView(view);
    view.AddCamera("Plain");
    view.AddCamera("Shaded");
    view.AddCamera("Gone");
    HRCamera camera;
    ASSERT_EQ(view.LoadCamera(0, camera), 0);
    CameraSettings settings = SettingsOf(camera);
    settings.displayMode = HRUtility::kShaded;
    settings.eye[0] = 41.0F;
    camera.SetSettings(settings);
    ASSERT_EQ(view.SaveCamera(1, camera), 0);
    EXPECT_EQ(view.GetCameraName(1), "Plain");  // saved onto the handle at the index
    ClearJournal();
    EXPECT_EQ(view.ShowView(0), 0);
    EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kHiddenline);
    EXPECT_EQ(view.ShowView(1), 0);
    EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kShaded);
    EXPECT_EQ(Bench().View().eye.x, 41.0F);

    Drawing().Remove(view.Cameras()[2]);
    ClearJournal();
    EXPECT_EQ(view.ShowView(2), model_status::kHeaderNotRead);
    EXPECT_TRUE(Steps().empty());  // a camera that does not load leaves the view as it is

    HRUtility::SetDisplayMode(HRUtility::kRender);
    FailOn("execute_internal_command", "render_on");
    ClearJournal();
    EXPECT_EQ(view.ShowView(-1), -28);
    EXPECT_EQ(view.ShowView(0), -28);
    // A camera's first phase turns the wait cursor on; the refusal turns it off again.
    EXPECT_EQ(Bench().View().waitCursor, 0);
  });
}

}  // namespace
