// The display commands and overlays: render switch and image, display letters in and out of
// the solid state, background, texts, toolbar, 2D hidden lines and hatch patterns.
#include <cstring>

#include "tests/workbench_view/view_host_fixture.h"

namespace {

class DisplayCommandsTest : public ViewHostTest {
 protected:
  static void EnterSolidState() {
    globc[26] = 's';
    ASSERT_EQ(Run("set_background_color"), 1);
  }
  static char DisplayLetter() {
    globc[0] = '?';
    Run("inq_dspmode_info");
    return globc[0];
  }
};

TEST_F(DisplayCommandsTest, RenderOnLeavesTheSolidStateAndRenderOffKeepsGeometry) {
  EnterSolidState();
  globr[0] = 1.0F;
  ASSERT_EQ(Run("render_on"), 1);
  EXPECT_EQ(globc[26], 'w');
  Run("inq_render_mode");
  EXPECT_EQ(globr[0], 1.0F);

  globr[0] = 0.0F;
  Run("render_on");
  Run("inq_render_mode");
  EXPECT_EQ(globr[0], 0.0F);
  EXPECT_EQ(globc[26], 'w');
}

TEST_F(DisplayCommandsTest, RenderingShowsAnImageUntilCleared) {
  EnterSolidState();
  ASSERT_EQ(Run("rnd_make"), 1);
  EXPECT_EQ(globc[36], 'g');
  EXPECT_TRUE(Display().renderImage);
  EXPECT_TRUE(Display().renderOn) << "rendering is a render mode of its own";
  EXPECT_EQ(globc[26], 'w');
  Run("rnd_smain");
  EXPECT_TRUE(Display().renderWindowShown);

  Run("gloff");
  EXPECT_FALSE(Display().glSurface);
  Run("rnd_clear");
  EXPECT_EQ(globc[36], ' ');
  EXPECT_FALSE(Display().renderImage);
  Run("rnd_smain_off");
  EXPECT_FALSE(Display().renderWindowShown);
}

TEST_F(DisplayCommandsTest, DisplayLetterSetAndInquiredThroughSlotZero) {
  globc[0] = 'b';
  ASSERT_EQ(Run("set_dspmode_info"), 1);
  globc[0] = 'x';
  EXPECT_EQ(DisplayLetter(), 'b');
  globc[0] = '\0';
  EXPECT_EQ(Run("set_dspmode_info"), 0);
  EXPECT_EQ(DisplayLetter(), 'b');
}

TEST_F(DisplayCommandsTest, SolidStylesSetTheirLetterAndKeepTheShadowKind) {
  EnterSolidState();
  struct Case {
    const char* command;
    float shading;
    char letter;
  };
  const Case cases[] = {
      {"wireframe", 3.0F, 'w'},
      {"hidden_lines", 3.0F, 'h'},
      {"shaded_surfaces", 1.0F, 's'},
      {"shaded_surfaces", 3.0F, 'S'},
      {"shaded_pale_surfaces", 3.0F, 'M'},
      {"shadowed_surfaces", 3.0F, 'o'},
      {"shadowed_pale_surfaces", 3.0F, 'O'},
  };
  for (const Case& c : cases) {
    globc[83] = 'd';
    globp[26].y = c.shading;
    ASSERT_EQ(Run(c.command), 1) << c.command;
    EXPECT_EQ(DisplayLetter(), c.letter) << c.command;
    EXPECT_EQ(globc[83], 'd') << c.command;
  }
}

TEST_F(DisplayCommandsTest, SolidStylesAreRefusedOutsideTheSolidState) {
  globc[0] = 'a';
  Run("set_dspmode_info");
  for (const char* command : {"wireframe", "hidden_lines", "shaded_surfaces", "shaded_pale_surfaces",
                              "shadowed_surfaces", "shadowed_pale_surfaces"}) {
    EXPECT_EQ(Run(command), 0) << command;
  }
  EXPECT_EQ(DisplayLetter(), 'a');
}

TEST_F(DisplayCommandsTest, BothSpellingsOfAllWiresAreTaken) {
  EXPECT_EQ(Run("wire_frame_all"), 1);
  EXPECT_EQ(Run("wireframe_all"), 1);
  EXPECT_EQ(Display().allWireResets, 2);
}

TEST_F(DisplayCommandsTest, BackgroundTakesAColourIndexAndRefusesOthers) {
  globp[25].y = 7.0F;
  ASSERT_EQ(Run("set_background_color"), 1);
  EXPECT_EQ(Display().backgroundColor, 7);
  for (float bad : {-1.0F, 256.0F, std::numeric_limits<float>::quiet_NaN()}) {
    globp[25].y = bad;
    EXPECT_EQ(Run("set_background_color"), 0) << bad;
  }
  EXPECT_EQ(Display().backgroundColor, 7);
}

TEST_F(DisplayCommandsTest, ToolbarRecordsExactlyEightCharacters) {
  std::memcpy(globc, "SOLID   ", 8);
  globc[8] = 'Z';
  ASSERT_EQ(Overlay("toolbar"), 1);
  EXPECT_EQ(Display().toolbar, "SOLID   ");
  EXPECT_EQ(Session().GetJournal().Names(wb::JournalEntry::Kind::Overlay), std::vector<std::string>{"toolbar"});
}

TEST_F(DisplayCommandsTest, HiddenLinesInTwoDSwitchOnTwoAndOffThree) {
  globr[1] = 2.0F;
  ASSERT_EQ(Overlay("hidlin2d"), 1);
  EXPECT_TRUE(Display().hiddenLine2d);
  globr[1] = 5.0F;
  EXPECT_EQ(Overlay("hidlin2d"), 0);
  EXPECT_TRUE(Display().hiddenLine2d);
  globr[1] = 3.0F;
  ASSERT_EQ(Overlay("hidlin2d"), 1);
  EXPECT_FALSE(Display().hiddenLine2d);
}

TEST_F(DisplayCommandsTest, HatchPatternsFollowTheLetterUnlessTheHostCannotShowThem) {
  globc[66] = 'h';
  Overlay("refh");
  EXPECT_TRUE(Display().hatchPatterns);
  EXPECT_EQ(globc[66], 'h');

  globc[66] = ' ';
  Overlay("refh");
  EXPECT_FALSE(Display().hatchPatterns);

  Display().patternsShowable = false;
  globc[66] = 'h';
  Overlay("refh");
  EXPECT_FALSE(Display().hatchPatterns);
  EXPECT_EQ(globc[66], ' ');
}

TEST_F(DisplayCommandsTest, UnknownOverlayIsJournaledButNotReportedAsDone) {
  EXPECT_EQ(Overlay("no_such_overlay"), 0);
  EXPECT_EQ(Session().GetJournal().Names(wb::JournalEntry::Kind::Overlay), std::vector<std::string>{"no_such_overlay"});
}

TEST_F(DisplayCommandsTest, ResetBringsBackPlainGeometry) {
  EnterSolidState();
  Run("rnd_make");
  globc[83] = 'd';
  Display().patternsShowable = false;
  Session().Reset();
  EXPECT_EQ(globc[26], 'w');
  EXPECT_EQ(globc[36], ' ');
  EXPECT_FALSE(Display().renderOn);
  EXPECT_FALSE(Display().renderImage);
  EXPECT_TRUE(Display().patternsShowable);
}

}  // namespace
