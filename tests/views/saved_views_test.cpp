// Every kind of view kept through a saved drawing file: a camera with every value, a section and
// a plan with their own cameras, and a selection set that still applies in the reopened drawing.
#include <array>
#include <string>
#include <tuple>

#include "tests/views/views_fixture.h"
#include "views/hr_selection.h"

namespace {

class SavedViewsTest : public ViewsTest {};

TEST_F(SavedViewsTest, EveryKindOfViewComesBackFromASavedDrawingFile) {
  CameraSettings settings = DistinctSettings(3.0F);
  settings.scaleMode = ' ';
  settings.viewMode = HRCamera::k2DPerspective;
  HRCamera general = CameraWith(settings);
  general.SetName("South");
  general.SetFor2D(1);
  ASSERT_EQ(general.Create(), 0);
  HRSection section;
  SectionSettings cut{
      .start = {1.5F, -2, 0.5F}, .end = {9, 4.25F, 0.5F}, .symbolFile = "...sec_sym\\sec02", .comment = "not kept"};
  cut.lineColor = 300;  // the line keeps the low eight bits
  cut.lineType = 3;
  cut.cutType = HRSection::kCutOff;
  section.SetName("R-R");
  section.SetSettings(cut);
  section.SetFor2D(1);
  ASSERT_EQ(section.Create(), 0);
  section.SetCameraFor2D(section.AddCamera("Default"), 1);  // cleared, as the set does not list it
  section.AddCamera("Close");
  HRSection unlisted;
  StoreSection(unlisted);
  unlisted.SetCameraFor2D(unlisted.AddCamera("Ticked"), 1);
  HRPlane plan;
  plan.SetFor2D(1);
  StorePlan(plan, "Mezzanine");
  plan.AddCamera("Default");
  HRCamera planCamera;
  ASSERT_EQ(plan.LoadCamera(0, planCamera), 0);
  HRSelection selection;
  selection.AddSection(section.GetHandle(), {1});
  selection.AddSection(55555, {0});  // a section that no longer loads is skipped
  selection.AddPlan(plan.GetHandle(), {0});
  ASSERT_EQ(selection.Create(), 0);

  ReopenThroughFile();
  HRCamera camera;
  ASSERT_EQ(LoadGeneralCamera(camera, 0), 0);
  EXPECT_EQ(std::tuple(camera.GetName(), camera.IsFor2D()), std::tuple("South", 1));
  EXPECT_EQ(Values(SettingsOf(camera)), Values(settings));

  HRSection loadedSection;
  ASSERT_EQ(loadedSection.Load(section.GetHandle()), 0);
  SectionSettings read;
  loadedSection.GetSettings(read);
  EXPECT_EQ(Rounded({{read.start[0], read.start[1], read.start[2]}, {read.end[0], read.end[1], read.end[2]}}),
            "(1.5 -2 0.5)(9 4.25 0.5)");
  EXPECT_EQ(std::tuple(read.lineColor, read.lineType, read.cutType, read.symbolFile, read.comment),
            std::tuple(44, 3, 'o', cut.symbolFile, ""));
  EXPECT_EQ(std::tuple(loadedSection.GetName(), loadedSection.IsFor2D()), std::tuple("R-R", 1));
  EXPECT_EQ(loadedSection.Cameras(), section.Cameras());

  HRPlane loadedPlan;
  ASSERT_EQ(loadedPlan.Load(plan.GetHandle()), 0);
  EXPECT_EQ(std::tuple(loadedPlan.GetName(), loadedPlan.IsFor2D(), loadedPlan.GetCutType()),
            std::tuple("Mezzanine", 1, 'b'));
  EXPECT_EQ((std::array{loadedPlan.GetBase()[0], loadedPlan.GetBase()[1], loadedPlan.GetBase()[2],
                        loadedPlan.GetDir()[0], loadedPlan.GetDir()[1], loadedPlan.GetDir()[2]}),
            (std::array{1.0, 2.0, 0.0, 1.0, 2.0, 5.0}));
  ASSERT_EQ(loadedPlan.LoadCamera(0, camera), 0);
  EXPECT_EQ(Values(SettingsOf(camera)), Values(SettingsOf(planCamera)));

  // The selection set ticks exactly the listed cameras of the views it lists, in the reopened drawing.
  HRSelection loadedSelection;
  ASSERT_EQ(loadedSelection.Load(selection.GetHandle()), 0);
  loadedSelection.Apply();
  EXPECT_EQ(std::tuple(loadedSection.IsCameraFor2D(0), loadedSection.IsCameraFor2D(1), loadedPlan.IsCameraFor2D(0),
                       unlisted.IsCameraFor2D(0)),
            std::tuple(0, 1, 1, 1));
}

}  // namespace
