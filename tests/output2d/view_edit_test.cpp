// Preparing a drawing for the batch from the command line: ticking views by name and adding
// cameras, checked by what the batch then counts.
#include <limits>
#include <stdexcept>

#include "app/view_edit.h"
#include "display/build_batch.h"
#include "tests/output2d/output2d_fixture.h"
#include "views/hr_camera_mgr.h"
#include "views/hr_section.h"
#include "views/view_collection.h"

namespace output2d_test {
namespace {

const View kFront{{0.5F, -10.0F, 2.0F}, {0.5F, 0.5F, 0.5F}};

class ViewEditTest : public Output2DTest {
 protected:
  static std::int32_t Ticked(HRUtility::BuildMode mode) {
    const host::DatabaseHandle database = Bench().Current();
    return HRUtility::Build2DBatch(mode, CollectSectionHandles(database), CollectPlanHandles(database)).Count();
  }
  static bool CameraTicked(std::int32_t index) {
    HRCamera camera;
    EXPECT_EQ(LoadGeneralCamera(camera, index), 0);
    return camera.IsFor2D() == 1;
  }
  // A section named `name` with one camera, "Default", unticked.
  static void AddSection(const std::string& name) {
    HRSection section;
    SectionSettings settings;
    settings.end[0] = 5.0F;
    settings.symbolFile = "...sec_sym\\sec01";
    section.SetName(name);
    section.SetSettings(settings);
    ASSERT_EQ(section.Create(), 0);
    section.AddCamera("Default");
    section.SetCameraFor2D(0, 0);
  }
};

TEST_F(ViewEditTest, ViewsAreFoundByCameraNameOrOwnerAndCameraEvenWithSlashesInNames) {
  const std::int32_t plain = AddCamera("Front", kFront, false);
  const std::int32_t slashed = AddCamera("North/East", kFront, false);
  AddSection("A");
  AddSection("B/C");

  app::SetTicks({"Front", "North/East"}, true);
  EXPECT_TRUE(CameraTicked(plain));
  EXPECT_TRUE(CameraTicked(slashed));
  EXPECT_EQ(Ticked(HRUtility::BuildMode::Sections), 0);

  app::SetTicks({"A/Default", "B/C/Default"}, true);
  EXPECT_EQ(Ticked(HRUtility::BuildMode::Sections), 2);

  app::SetTicks({"North/East", "B/C/Default"}, false);
  EXPECT_FALSE(CameraTicked(slashed));
  EXPECT_TRUE(CameraTicked(plain));
  EXPECT_EQ(Ticked(HRUtility::BuildMode::All), 2);
}

TEST_F(ViewEditTest, UnknownViewChangesNothing) {
  const std::int32_t front = AddCamera("Front", kFront, false);
  AddSection("A");
  EXPECT_THROW(app::SetTicks({"Front", "A/Default", "A/Missing"}, true), std::runtime_error);
  EXPECT_THROW(app::SetTicks({"Missing"}, true), std::runtime_error);
  EXPECT_FALSE(CameraTicked(front));
  EXPECT_EQ(Ticked(HRUtility::BuildMode::All), 0);
}

TEST_F(ViewEditTest, NewCameraIsStoredTickedWithItsView) {
  app::NewCamera camera;
  camera.name = "North";
  camera.eye = {5.0F, 30.0F, 5.0F};
  camera.target = {5.0F, 4.0F, 2.0F};
  camera.perspective = true;
  camera.displayMode = 2;
  const std::int32_t index = app::AddCamera(camera);
  HRCamera stored;
  ASSERT_EQ(LoadGeneralCamera(stored, index), 0);
  CameraSettings settings;
  stored.GetSettings(settings);
  EXPECT_EQ(stored.GetName(), "North");
  EXPECT_EQ(stored.IsFor2D(), 1);
  EXPECT_EQ(settings.eye[1], 30.0F);
  EXPECT_EQ(settings.target[2], 2.0F);
  EXPECT_EQ(settings.viewMode, HRCamera::k3DPerspective);
  EXPECT_EQ(settings.displayMode, 2);

  camera.tick = false;
  camera.flat = true;
  camera.perspective = false;
  camera.name = "Plan";
  ASSERT_EQ(LoadGeneralCamera(stored, app::AddCamera(camera)), 0);
  EXPECT_EQ(stored.IsFor2D(), 0);
  EXPECT_EQ(stored.GetViewMode(), HRCamera::k2DParallel);
}

TEST_F(ViewEditTest, CameraWithoutNameOrDirectionIsRefused) {
  app::NewCamera camera;
  camera.name = "Flat";
  camera.eye = camera.target = {1.0F, 2.0F, 3.0F};
  EXPECT_THROW(app::AddCamera(camera), std::runtime_error);
  camera.eye = {1.0F, std::numeric_limits<float>::quiet_NaN(), 3.0F};
  EXPECT_THROW(app::AddCamera(camera), std::runtime_error);
  camera.eye = {1.0F, std::numeric_limits<float>::infinity(), 3.0F};
  EXPECT_THROW(app::AddCamera(camera), std::runtime_error);
  camera.eye = {0.0F, 0.0F, 0.0F};
  camera.name.clear();
  EXPECT_THROW(app::AddCamera(camera), std::runtime_error);
  EXPECT_EQ(GetGeneralCameraCount(), 0);
}

}  // namespace
}  // namespace output2d_test
