// What the pane does where doing as first described would hang, lose data or claim a success:
// a display that never gets back to geometry, a camera view that could not be made, cameras
// that no longer load, a tree that shows another tab's objects, adds from the host while
// another tab is shown, and check-box changes for items that are gone.
#include "framework/message_box.h"
#include "framework/message_queue.h"
#include "shell/host/argument_blocks.h"
#include "tests/pane/pane_fixture.h"

namespace {

using Attributes = std::vector<wb::Attribute>;

constexpr const char* kModeRefused = "This operation can be performed only in Geometric , Render and Solid mode";

TEST_F(PaneTest, AddNewGivesUpWithAMessageWhenTheDisplayStaysOutOfPlainGeometry) {
  globc[32] = 'a';  // a geometric variant the switch to Geometric leaves as it is
  Run("tab sections\nclick add\nanswer ok");
  ASSERT_EQ(framework::MessageBoxLog().size(), 1U);
  EXPECT_EQ(framework::MessageBoxLog()[0].text, kModeRefused);
  EXPECT_TRUE(Bench().CommandLines().empty()) << "no points were asked for";
}

TEST_F(PaneTest, CamerasThatCouldNotBeStoredAddNoItem) {
  const std::vector<std::int32_t> cameras = Longs(*OfClass("HRSection")[0], "@CamLst=");
  Bench().GetFaults().Add({.call = "qel_create_group", .entity = wb::FaultRule::kAnyEntity, .attribute = "", .times = -1});
  Run("click add\nrun 6");
  EXPECT_EQ(Tree(), "Cameras:\n  [x] Street perspective\n  [x] Axonometric\n  [x] Site plan\n");
  Run("tab sections\nselect A\nclick add-view");
  EXPECT_EQ(Tree(), "Sections:\n  [ ] A\n    [x] Default\n  [ ] B\n    [x] Default\n");
  EXPECT_EQ(Longs(*OfClass("HRSection")[0], "@CamLst="), cameras);
}

// A section deleted behind the pane's back gets no camera that nothing would list.
TEST_F(PaneTest, ACameraViewOfASectionThatIsGoneReloadsInstead) {
  Run("tab sections\nselect A");
  Drawing().Remove(OfClass("HRSection")[0]->handle);
  const std::size_t cameras = OfClass("hrSecCam").size();
  Run("click add-view");
  EXPECT_EQ(OfClass("hrSecCam").size(), cameras);
  EXPECT_EQ(Tree(), "Sections:\n  [ ] B\n    [x] Default\n");
}

// A name the drawing did not take is not shown either.
TEST_F(PaneTest, ANameTheDrawingRefusedLeavesTheOldLabel) {
  Bench().GetFaults().Add({.call = "qel_set_string_attribute", .entity = wb::FaultRule::kAnyEntity,
                           .attribute = "@CAMNAME=", .times = -1});
  Run("rename \"Site plan\" Garden");
  EXPECT_EQ(Tree(), "Cameras:\n  [x] Street perspective\n  [x] Axonometric\n  [x] Site plan\n");
  EXPECT_EQ(OfClass("HRCamera").size(), 3U);
  EXPECT_EQ(Text(CameraNamed("Site plan"), "@CAMNAME="), "Site plan");
}

TEST_F(PaneTest, ACameraThatNoLongerLoadsIsNotWrittenOverByUpdateOrTicks) {
  // Damaged behind the pane's back: a key every camera record must have is gone.
  wb::Entity& general = *Drawing().Find(CameraNamed("Axonometric").handle);
  wb::Entity& owned = *Drawing().Find(Longs(*OfClass("HRSection")[0], "@CamLst=").at(0));
  for (wb::Entity* camera : {&general, &owned}) {
    std::erase_if(camera->attributes, [](const wb::Attribute& a) { return a.name == "@PATTERN="; });
  }
  const Attributes generalBefore = general.attributes;
  const Attributes ownedBefore = owned.attributes;
  Run(R"(view eye 5,5,5 target 0,0,0
select Axonometric
click update
tab sections
select "A/Default"
click update
tick A)");
  EXPECT_EQ(general.attributes, generalBefore);
  EXPECT_EQ(owned.attributes, ownedBefore);
  EXPECT_EQ(Short(*OfClass("HRSection")[0], "@S2D="), 1) << "the section itself was ticked";
}

// The tab was changed by the host without a refill: the selected item is a camera, whose
// index here equals the handle of the section the drawing starts with.
TEST_F(PaneTest, RemoveOnATreeOfAnotherTabReloadsInsteadOfDeletingWhatTheDataNames) {
  Open(Start::kEmptyDrawing);
  Run("tab sections\nclick add\npick 0,0 4,0\ntab cameras");
  const host::EntityHandle section = OfClass("HRSection").at(0)->handle;
  std::string adds;
  for (host::EntityHandle i = 0; i <= section; ++i) adds += "click add\n";
  Run(adds);
  Run("run 7 2\nselect \"Camera " + std::to_string(section) + "\"\nclick remove");
  EXPECT_NE(Drawing().Find(section), nullptr);
  EXPECT_EQ(OfClass("HRCamera").size(), static_cast<std::size_t>(section) + 1);
  EXPECT_EQ(Tree(), "Sections:\n  [ ] Section 0\n    [ ] Default\n");
}

// Adds from the host while another tab is shown land on their own tab, under a name new among
// their own kind.
TEST_F(PaneTest, HostAddsWhileAnotherTabIsShownGoToTheirOwnTab) {
  Run("rename \"Street perspective\" \"Camera 3\"\ntab sections\nrun 6");
  EXPECT_EQ(Tree(), "Cameras:\n  [x] Camera 3\n  [x] Axonometric\n  [x] Site plan\n  [ ] Camera 4\n");
  Run("run 2 0,0 6,6\nselect \"Section 2\"\nclick remove");
  EXPECT_EQ(Tree(), "Sections:\n  [ ] A\n    [x] Default\n  [ ] B\n    [x] Default\n");
  EXPECT_EQ(OfClass("HRCamera").size(), 4U) << "no camera was taken for the section";
  EXPECT_EQ(OfClass("HRSection").size(), 2U);
}

TEST_F(PaneTest, ACheckChangeForAnItemThatIsGoneChangesNothing) {
  Bench().GetJournal().Clear();
  const HWND pane = PaneWindow();
  ::PostMessage(pane, WM_APP, 5016, 0x7FFFFFF0);
  ::PostMessage(pane, WM_APP, 5016, 0);
  framework::PumpPendingMessages();
  EXPECT_TRUE(Bench().GetJournal().Names(wb::JournalEntry::Kind::AttributeWrite).empty());
  EXPECT_EQ(Tree(), "Cameras:\n  [x] Street perspective\n  [x] Axonometric\n  [x] Site plan\n");
}

}  // namespace
