// Display modes from the library's side: the command sequences of each switch, the re-entry on
// the way back to plain geometry, round trips, and the query over the host's letters.
#include "display/display_mode.h"

#include <limits>
#include <string>

#include "shell/host/qeldll.h"
#include "tests/views/views_fixture.h"
#include "views/section_symbols.h"

namespace {

using namespace HRUtility;

class DisplayModeTest : public ViewsTest {
 protected:
  static StepList Switched(std::int16_t mode) {
    ClearJournal();
    SetDisplayMode(mode);
    return Steps();
  }
  static StepList FromRender(const std::string& projection) {
    return {"inq_render_mode", "set_dspmode_info", "gloff",           "rnd_clear",     "render_on",
            "rnd_smain_off",   projection,         "overlay toolbar", "overlay Pandex"};
  }
};

TEST_F(DisplayModeTest, SwitchToPlainGeometryUndoesWhatTheHostShows) {
  EXPECT_EQ(Switched(kGeometric), StepList{"inq_render_mode"});
  // Rendering switched on by the host itself, before anything remembered a projection.
  globr[0] = 1.0F;
  execute_internal_command("render_on");
  EXPECT_EQ(Switched(kGeometric), FromRender("set_parallel"));
  execute_internal_command("set_perspective");
  SetDisplayMode(kRender);
  EXPECT_EQ(Switched(kGeometric), FromRender("set_perspective"));

  SetDisplayMode(kShaded);
  globi[0] = 0;
  EXPECT_EQ(Switched(kGeometric), (StepList{"inq_render_mode", "overlay hidlin2d", "set_background_color",
                                            "wire_frame_all", "regen", "overlay toolbar", "overlay Pandex"}));
  EXPECT_EQ(Bench().Display().toolbar, "GEOM    ");
  EXPECT_EQ(globi[0], 3);  // the overlay re-entered this library to show the section symbols again
  EXPECT_EQ(globc[26], 'w');
  EXPECT_EQ(globp[25].x, 0.0F);
  EXPECT_EQ(globr[68], 1.0F);
}

TEST_F(DisplayModeTest, SolidSetUpRunsOnlyWhenComingFromOutside) {
  SectionsShown = 0;
  globr[103] = 0.0F;
  globc[8] = 'Q';
  SetDisplayMode(kSurfaces);
  EXPECT_EQ(globc[8], 'Q');                   // the toolbar name is exactly eight characters
  EXPECT_FALSE(Bench().Display().textShown);  // texts follow globr[103] while the symbols are off
  EXPECT_EQ(Switched(kShadowModel), (StepList{"inq_render_mode", "shadowed_surfaces"}));
  SectionsShown = 1;
  SetDisplayMode(kGeometric);
  SetDisplayMode(kWireframe);
  EXPECT_TRUE(Bench().Display().textShown);
  EXPECT_EQ(globp[25].x, 0.0F);  // wireframe alone keeps the set-up flag off
}

TEST_F(DisplayModeTest, EveryModeReadsBackWhatIsNoModeIsIgnoredAndTheLettersAreReadInOrder) {
  for (std::int16_t from = kGeometric; from <= kRender; ++from) {
    for (std::int16_t to = kGeometric; to <= kRender; ++to) {
      SetDisplayMode(from);
      SetDisplayMode(to);
      EXPECT_EQ(GetDisplayMode(), to) << "from " << from;
    }
  }
  globr[2] = 2.9F;
  ModeSwitch();
  EXPECT_EQ(GetDisplayMode(), kHiddenline);  // the slot is truncated
  for (const float value : {11.0F, -1.0F, std::numeric_limits<float>::quiet_NaN(), 1e9F}) {
    ClearJournal();
    globr[2] = value;
    ModeSwitch();
    EXPECT_TRUE(Log().Entries().empty()) << value;
  }
  globc[36] = 'g';  // a rendered image wins over the solid state
  EXPECT_EQ(GetDisplayMode(), kRender);
  globc[36] = ' ';
  SetDisplayMode(kGeometric);
  globc[32] = 'a';
  EXPECT_EQ(GetDisplayMode(), kGeometricA);
  EXPECT_FALSE(IsModeAcceptable());
}

}  // namespace
