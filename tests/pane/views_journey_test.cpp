// A user's journeys through the pane: cameras, sections and plans added, ticked, renamed,
// updated, executed and removed, each checked in the drawing's records and in the tree.
#include <algorithm>
#include <filesystem>

#include "display/display_mode.h"
#include "shell/host/argument_blocks.h"
#include "tests/pane/pane_fixture.h"
#include "views/hr_section.h"
#include "workbench/drawing_file.h"

namespace {

std::vector<float> Eye(const wb::ViewState& view) { return {view.eye.x, view.eye.y, view.eye.z}; }
std::vector<float> Target(const wb::ViewState& view) { return {view.target.x, view.target.y, view.target.z}; }

TEST_F(PaneTest, CamerasAreAddedPastTakenNamesTickedUpdatedExecutedAndRemoved) {
  Run(R"(rename "Street perspective" "Camera 3"
rename Axonometric "Camera 4"
rename "Site plan" "Camera 3"
rename "Site plan" ""
view eye 1,-20,5 target 1,0,1
click add
tick "Camera 5"
untick "Camera 3")");
  // Three cameras: "Camera 3" and "Camera 4" are taken, so the new one is "Camera 5". The
  // renames to a name in use and to nothing were refused.
  EXPECT_EQ(Tree(), "Cameras:\n  [ ] Camera 3\n  [x] Camera 4\n  [x] Site plan\n  [x] Camera 5\n");
  const wb::Entity& added = CameraNamed("Camera 5");
  EXPECT_EQ(Floats(added, "@EYE="), (std::vector<float>{1, -20, 5}));
  EXPECT_EQ(Floats(added, "@TARGET="), (std::vector<float>{1, 0, 1}));
  for (const char* option : {"@SHOWSEC=", "@AUTOCLIP=", "@S2DOVERWRITE=", "@CLINE=", "@LINEMERGE="}) {
    EXPECT_EQ(Short(added, option), 0) << option;
  }
  EXPECT_EQ(Short(added, "@S2D="), 1);
  EXPECT_EQ(Short(CameraNamed("Camera 3"), "@S2D="), 0);
  EXPECT_EQ(OfClass("HRCamera").size(), 4U);

  // Update stores the host view into the selected camera; Execute puts a camera on screen.
  const std::vector<float> siteEye = Floats(CameraNamed("Site plan"), "@EYE=");
  Run(R"(view eye 7,8,9 target 0,0,2
select "Camera 4"
click update
select "Site plan"
click execute)");
  EXPECT_EQ(Floats(CameraNamed("Camera 4"), "@EYE="), (std::vector<float>{7, 8, 9}));
  EXPECT_EQ(Floats(CameraNamed("Camera 4"), "@TARGET="), (std::vector<float>{0, 0, 2}));
  EXPECT_EQ(Eye(Bench().View()), siteEye);
  EXPECT_EQ(Target(Bench().View()), Floats(CameraNamed("Site plan"), "@TARGET="));

  // Removing a camera moves the later ones up; the refilled tree still reaches the right ones.
  Run(R"(select "Camera 4"
click remove
untick "Site plan")");
  EXPECT_EQ(Tree(), "Cameras:\n  [ ] Camera 3\n  [ ] Site plan\n  [x] Camera 5\n");
  EXPECT_EQ(OfClass("HRCamera").size(), 3U);
  EXPECT_EQ(Short(CameraNamed("Site plan"), "@S2D="), 0);
  EXPECT_EQ(Short(CameraNamed("Camera 5"), "@S2D="), 1);
}

TEST_F(PaneTest, ASectionIsPickedGetsCamerasTicksRenamesAndLeavesTheDrawingWithThem) {
  HRUtility::SetDisplayMode(HRUtility::kHiddenline);
  Bench().GetJournal().Clear();
  Run(R"(tab sections
click add
pick 2,-1 2,9)");
  // "Add new" first brought the display back to plain geometry, then asked for the points.
  const std::vector<wb::JournalEntry>& log = Bench().GetJournal().Entries();
  const auto named = [&log](wb::JournalEntry::Kind kind, const std::string& name) {
    return std::find_if(log.begin(), log.end(), [&](const wb::JournalEntry& e) { return e.kind == kind && e.name == name; });
  };
  EXPECT_LT(named(wb::JournalEntry::Kind::Overlay, "hidlin2d"), named(wb::JournalEntry::Kind::CommandMessage, "/3secadd"));
  EXPECT_EQ(Bench().CommandLines(), std::vector<std::string>{"/3secadd"});
  EXPECT_EQ(Tree(), "Sections:\n  [ ] A\n    [x] Default\n  [ ] B\n    [x] Default\n  [ ] Section 2\n    [ ] Default\n");
  const std::vector<const wb::Entity*> sections = OfClass("HRSection");
  ASSERT_EQ(sections.size(), 3U);
  const host::EntityHandle added = sections.back()->handle;
  HRSection section;
  ASSERT_EQ(section.Load(added), 0);
  SectionSettings settings;
  section.GetSettings(settings);
  EXPECT_EQ(std::vector<float>(settings.start, settings.start + 3), (std::vector<float>{2, -1, 0}));
  EXPECT_EQ(std::vector<float>(settings.end, settings.end + 3), (std::vector<float>{2, 9, 0}));
  EXPECT_EQ(settings.symbolFile, "...sec_sym\\sec01");
  EXPECT_EQ(settings.cutType, 'b');
  EXPECT_TRUE(Bench().View().section.active) << "the new section's cut is shown";
  const std::vector<std::int32_t> cameras = Longs(*sections.back(), "@CamLst=");
  ASSERT_EQ(cameras.size(), 1U);
  EXPECT_EQ(Text(*Drawing().Find(cameras[0]), "@CAMNAME="), "Default");
  EXPECT_EQ(Text(*Drawing().Find(cameras[0]), "@Class="), "hrSecCam");

  Run(R"(select "Section 2"
click add-view
tick "Section 2"
untick "Section 2/Camera 1"
rename "Section 2/Camera 1" Default
rename "Section 2/Camera 1" Front
rename "Section 2" A)");
  EXPECT_EQ(Tree(), "Sections:\n  [ ] A\n    [x] Default\n  [ ] B\n    [x] Default\n  [x] Section 2\n    [x] Default\n"
                    "    [ ] Front\n");
  EXPECT_EQ(Short(*Drawing().Find(added), "@S2D="), 1);
  EXPECT_EQ(Short(*Drawing().Find(cameras[0]), "@S2D="), 1);
  const wb::Entity& front = CameraNamed("Front", "hrSecCam");
  EXPECT_EQ(Short(front, "@S2D="), 0);
  EXPECT_EQ(Longs(*Drawing().Find(added), "@CamLst="), (std::vector<std::int32_t>{cameras[0], front.handle}));

  Run(R"(view eye 3,3,3 target 0,0,1
select "Section 2/Front"
click update
view eye 9,9,9 target 1,1,1
click execute)");
  EXPECT_EQ(Floats(CameraNamed("Front", "hrSecCam"), "@EYE="), (std::vector<float>{3, 3, 3}));
  EXPECT_EQ(Eye(Bench().View()), (std::vector<float>{3, 3, 3}));
  EXPECT_EQ(Target(Bench().View()), (std::vector<float>{0, 0, 1}));

  const host::EntityHandle frontHandle = CameraNamed("Front", "hrSecCam").handle;
  Run(R"(select "Section 2/Front"
click remove)");
  EXPECT_EQ(Drawing().Find(frontHandle), nullptr);
  EXPECT_EQ(Longs(*Drawing().Find(added), "@CamLst="), (std::vector<std::int32_t>{cameras[0]}));
  const std::size_t entitiesWithSection = Drawing().LiveCount();
  Run(R"(select "Section 2"
click remove)");
  EXPECT_EQ(Tree(), "Sections:\n  [ ] A\n    [x] Default\n  [ ] B\n    [x] Default\n");
  EXPECT_EQ(Drawing().Find(added), nullptr);
  EXPECT_EQ(Drawing().Find(cameras[0]), nullptr) << "the section's camera left with it";
  // The instance, its block, the line, two marks, two labels and the camera.
  EXPECT_EQ(Drawing().LiveCount(), entitiesWithSection - 8);

  // A pick the user cancels makes the host call nothing.
  Run("click add\npick cancel");
  EXPECT_EQ(OfClass("HRSection").size(), 2U);
  EXPECT_EQ(Bench().CommandLines().size(), 2U);
}

// The first plan of an empty drawing is its first entity: the pane must still find it.
TEST_F(PaneTest, PlansOfAnEmptyDrawingAreNamedWithTheirTwoSpacesAndListedFromTheFirstEntity) {
  Open(Start::kEmptyDrawing);
  Run(R"(tab plans
click add
pick 1,2 1,2,5
click add
pick 4,4 4,4,3
run 4 5,5 5,5,3
select "Hsection  0"
click add-view)");
  EXPECT_EQ(Tree(), "Plans:\n  [ ] Hsection  0\n    [ ] Default\n    [ ] Camera 1\n  [ ] Hsection  1\n    [ ] Default\n"
                    "  [ ] Hsection  2\n    [ ] Default\n");
  const std::vector<const wb::Entity*> plans = OfClass("HRPlane");
  ASSERT_EQ(plans.size(), 3U);
  EXPECT_EQ(plans[0]->handle, 1);
  EXPECT_EQ(Text(*plans[0], "@name="), "Hsection  0");
  EXPECT_EQ(Floats(*plans[0], "@base="), (std::vector<float>{1, 2, 0}));
  EXPECT_EQ(Floats(*plans[0], "@dir="), (std::vector<float>{1, 2, 5}));
  EXPECT_EQ(Longs(*plans[0], "@pln_cams=").size(), 2U);
  EXPECT_EQ(Text(*Drawing().Find(Longs(*plans[2], "@pln_cams=").at(0)), "@Class="), "hrPlnCam");
  EXPECT_TRUE(Bench().View().plan.active);
}

// Everything a journey leaves is in the drawing: saved and opened again, the pane shows the
// same trees.
TEST_F(PaneTest, AJourneySavedAndOpenedAgainShowsTheSameTrees) {
  const std::filesystem::path file =
      std::filesystem::path(::testing::TempDir()) / ("pane_journey_" + std::to_string(::getpid()) + ".pdx");
  Run(R"(click add
untick Axonometric
tab sections
click add
pick 0,0 10,0
tick "Section 2"
tab plans
click add
pick 3,3 3,3,2
rename "Hsection  1" Upstairs)");
  const std::string each = "tab cameras\nprint\ntab sections\nprint\ntab plans\nprint";
  const std::string before = Run(each);
  Run("save \"" + file.string() + "\"");
  Close();
  Open(wb::OpenDrawingFile(file));
  EXPECT_EQ(Run(each), before);
  EXPECT_NE(before.find("[ ] Camera 3"), std::string::npos);
  EXPECT_NE(before.find("[x] Section 2\n    [x] Default"), std::string::npos);
  EXPECT_NE(before.find("[ ] Upstairs"), std::string::npos);
  std::filesystem::remove(file);
}

}  // namespace
