// Display modes from the library's side: the query over the host's letters, the command
// sequences of each switch, the re-entry on the way back to plain geometry, and round trips.
#include <cmath>
#include <limits>
#include <string>
#include <vector>

#include "display/display_mode.h"
#include "shell/host/qeldll.h"
#include "tests/views/views_fixture.h"
#include "views/section_symbols.h"

namespace {

using StepList = std::vector<std::string>;
using namespace HRUtility;

class DisplayModeTest : public ViewsTest {
 protected:
  // The host's display letter as set_dspmode_info leaves it; inq_dspmode_info answers it.
  static void SetDisplayLetter(char letter) {
    globc[0] = letter;
    execute_internal_command("set_dspmode_info");
  }
};

TEST_F(DisplayModeTest, EverySwitchableModeReadsBack) {
  for (std::int16_t mode = kGeometric; mode <= kRender; ++mode) {
    SetDisplayMode(mode);
    EXPECT_EQ(GetDisplayMode(), mode);
    // And from that mode to every other one.
    for (std::int16_t next = kGeometric; next <= kRender; ++next) {
      SetDisplayMode(mode);
      SetDisplayMode(next);
      EXPECT_EQ(GetDisplayMode(), next) << "from " << mode;
    }
  }
}

TEST_F(DisplayModeTest, GeometricFromPlainGeometryOnlyAsks) {
  ClearJournal();
  SetDisplayMode(kGeometric);
  EXPECT_EQ(Steps(), StepList{"inq_render_mode"});
  EXPECT_EQ(globr[2], 0.0F);
}

TEST_F(DisplayModeTest, GeometricFromASolidModeTearsTheSolidStateDown) {
  SetDisplayMode(kShaded);
  globi[0] = 0;
  ClearJournal();
  SetDisplayMode(kGeometric);
  EXPECT_EQ(Steps(), (StepList{"inq_render_mode", "overlay hidlin2d", "set_background_color", "wire_frame_all",
                               "regen", "overlay toolbar", "overlay Pandex"}));
  EXPECT_EQ(globc[26], 'w');
  EXPECT_EQ(globc[65], ' ');
  EXPECT_EQ(globc[32], ' ');
  EXPECT_EQ(globp[25].x, 0.0F);
  EXPECT_EQ(globr[68], 1.0F);
  EXPECT_EQ(Bench().Display().toolbar, "GEOM    ");
  // The overlay re-enters this library's entry to show the section symbols again.
  EXPECT_EQ(globi[0], 3);
  EXPECT_EQ(GetDisplayMode(), kGeometric);
}

TEST_F(DisplayModeTest, GeometricFromRenderRestoresTheRememberedProjection) {
  execute_internal_command("set_perspective");
  SetDisplayMode(kRender);
  EXPECT_EQ(globc[403], 'a');
  ClearJournal();
  SetDisplayMode(kGeometric);
  EXPECT_EQ(Steps(), (StepList{"inq_render_mode", "set_dspmode_info", "gloff", "rnd_clear", "render_on",
                               "rnd_smain_off", "set_perspective", "overlay toolbar", "overlay Pandex"}));
  EXPECT_EQ(globc[36], ' ');
  EXPECT_EQ(GetDisplayMode(), kGeometric);

  execute_internal_command("set_parallel");
  SetDisplayMode(kRender);
  EXPECT_EQ(globc[403], 'e');
  ClearJournal();
  SetDisplayMode(kGeometric);
  EXPECT_EQ(Steps()[6], "set_parallel");
}

TEST_F(DisplayModeTest, GeometricFromRenderWithoutARememberedProjectionGoesParallel) {
  // Rendering switched on by the host itself: the plug-in never wrote globc[403].
  globr[0] = 1.0F;
  execute_internal_command("render_on");
  ASSERT_NE(globc[403], 'a');
  ClearJournal();
  SetDisplayMode(kGeometric);
  const StepList steps = Steps();
  ASSERT_GE(steps.size(), 7U);
  EXPECT_EQ(steps[6], "set_parallel");
}

TEST_F(DisplayModeTest, SolidSetUpRunsOnlyWhenComingFromOutside) {
  SectionsShown = 0;
  globr[103] = 0.0F;
  ClearJournal();
  SetDisplayMode(kSurfaces);
  EXPECT_EQ(Steps(), (StepList{"inq_render_mode", "overlay hidlin2d", "set_background_color", "wireframe_all",
                               "set_dspmode_info", "draw_text_on_off", "new_solid", "redraw_all", "overlay toolbar",
                               "shaded_surfaces"}));
  EXPECT_EQ(Bench().Display().toolbar, "SOLID   ");
  EXPECT_FALSE(Bench().Display().textShown);  // texts follow globr[103] while the symbols are off
  EXPECT_EQ(globc[109], 'o');

  ClearJournal();
  SetDisplayMode(kShaded);
  EXPECT_EQ(Steps(), (StepList{"inq_render_mode", "shaded_surfaces"}));
  EXPECT_EQ(GetDisplayMode(), kShaded);
}

TEST_F(DisplayModeTest, TextsAreShownWhileSectionSymbolsAre) {
  SectionsShown = 1;
  globr[103] = 0.0F;
  SetDisplayMode(kHiddenline);
  EXPECT_TRUE(Bench().Display().textShown);
}

TEST_F(DisplayModeTest, WireframeAloneKeepsTheSetUpFlagOff) {
  SetDisplayMode(kWireframe);
  EXPECT_EQ(globp[25].x, 0.0F);
  for (std::int16_t mode = kHiddenline; mode <= kMonoShadowModel; ++mode) {
    SetDisplayMode(kGeometric);
    SetDisplayMode(mode);
    EXPECT_EQ(globp[25].x, 1.0F) << "mode " << mode;
  }
}

TEST_F(DisplayModeTest, ShadowModesDifferByLightHeightAndLetter) {
  SetDisplayMode(kShadowTerrain);
  EXPECT_EQ(globp[38].z, 0.0F);
  EXPECT_EQ(globc[83], 'd');
  SetDisplayMode(kShadowModel);
  EXPECT_EQ(globp[38].z, 2.0F);
  EXPECT_EQ(globc[83], 's');
  SetDisplayMode(kMonoShadowTerrain);
  EXPECT_EQ(globc[83], 'd');
  EXPECT_EQ(GetDisplayMode(), kMonoShadowTerrain);
}

TEST_F(DisplayModeTest, ToolbarNameIsExactlyEightCharacters) {
  globc[8] = 'Q';
  SetDisplayMode(kHiddenline);
  EXPECT_EQ(Bench().Display().toolbar, "SOLID   ");
  EXPECT_EQ(globc[8], 'Q');
  SetDisplayMode(kRender);
  EXPECT_EQ(Bench().Display().toolbar, "RENDER  ");
  EXPECT_EQ(globc[8], 'Q');
}

TEST_F(DisplayModeTest, CodesThatCannotBeSwitchedToOnlyReachTheSlot) {
  for (const std::int16_t code : {std::int16_t{11}, std::int16_t{12}, std::int16_t{-1}, std::int16_t{300}}) {
    ClearJournal();
    SetDisplayMode(code);
    EXPECT_TRUE(Log().Entries().empty()) << code;
    EXPECT_EQ(globr[2], static_cast<float>(code));
  }
}

TEST_F(DisplayModeTest, SwitchTruncatesTheSlotAndRefusesWhatIsNoNumber) {
  globr[2] = 2.9F;
  ModeSwitch();
  EXPECT_EQ(GetDisplayMode(), kHiddenline);
  SetDisplayMode(kGeometric);
  for (const float value : {std::numeric_limits<float>::quiet_NaN(), std::numeric_limits<float>::infinity(), 1e9F}) {
    ClearJournal();
    globr[2] = value;
    ModeSwitch();
    EXPECT_TRUE(Log().Entries().empty());
  }
}

TEST_F(DisplayModeTest, QueryReadsTheLettersInItsOrder) {
  // A rendered image wins over everything else.
  SetDisplayMode(kSurfaces);
  globc[36] = 'g';
  EXPECT_EQ(GetDisplayMode(), kRender);
  globc[36] = ' ';

  SetDisplayLetter('b');
  EXPECT_EQ(GetDisplayMode(), kSolidBlank);
  SetDisplayLetter('o');
  globc[83] = 'x';
  EXPECT_EQ(GetDisplayMode(), kUnknownMode);
  SetDisplayLetter('O');
  EXPECT_EQ(GetDisplayMode(), kUnknownMode);
  SetDisplayLetter('Z');
  EXPECT_EQ(GetDisplayMode(), kUnknownMode);

  globc[65] = 'p';
  EXPECT_EQ(GetDisplayMode(), kDesign);
  globc[65] = ' ';

  SetDisplayMode(kGeometric);
  globc[32] = 'a';
  EXPECT_EQ(GetDisplayMode(), kGeometricA);
  globc[32] = 'r';
  EXPECT_EQ(GetDisplayMode(), kGeometricR);
  globc[32] = ' ';

  // Geometry with rendering on, but no image yet.
  globr[0] = 1.0F;
  execute_internal_command("render_on");
  EXPECT_EQ(GetDisplayMode(), kRender);

  globc[26] = 'x';
  EXPECT_EQ(GetDisplayMode(), kUnknownMode);
}

TEST_F(DisplayModeTest, ModeTestAcceptsGeometrySolidsAndRenderingOnly) {
  struct Case {
    char solid, geometricKind, render;
    bool acceptable;
  };
  for (const Case c : {Case{'w', ' ', ' ', true}, Case{'s', ' ', ' ', true}, Case{'x', ' ', 'g', true},
                       Case{'x', ' ', ' ', false}, Case{'w', 'a', ' ', false}, Case{'s', 'r', ' ', false},
                       Case{'x', 'a', 'g', false}}) {
    globc[26] = c.solid;
    globc[32] = c.geometricKind;
    globc[36] = c.render;
    EXPECT_EQ(IsModeAcceptable(), c.acceptable) << c.solid << c.geometricKind << c.render;
  }
}

}  // namespace
