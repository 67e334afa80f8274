// The display commands and overlays: display letters in and out of the solid state, background,
// toolbar, 2D hidden lines and hatch patterns.
#include <cstring>
#include <limits>
#include <tuple>

#include "tests/workbench/host_fixture.h"

namespace {

class DisplayCommandsTest : public HostTest {
 protected:
  static char DisplayLetter() {
    globc[0] = '?';
    Run("inq_dspmode_info");
    return globc[0];
  }
};

TEST_F(DisplayCommandsTest, SolidStylesSetTheirLetterOnlyInTheSolidStateAndKeepTheShadowKind) {
  globc[0] = 'b';
  ASSERT_EQ(Run("set_dspmode_info"), 1);
  EXPECT_EQ(Run("shaded_surfaces"), 0) << "outside the solid state";
  EXPECT_EQ(DisplayLetter(), 'b');
  globc[26] = 's';  // the solid state, entered through the background command
  ASSERT_EQ(Run("set_background_color"), 1);
  const std::tuple<const char*, float, char> styles[] = {
      {"wireframe", 3.0F, 'w'},       {"hidden_lines", 3.0F, 'h'},         {"shaded_surfaces", 1.0F, 's'},
      {"shaded_surfaces", 3.0F, 'S'}, {"shaded_pale_surfaces", 3.0F, 'M'}, {"shadowed_surfaces", 3.0F, 'o'},
      {"shadowed_pale_surfaces", 3.0F, 'O'},
  };
  for (const auto& [command, shading, letter] : styles) {
    globc[83] = 'd';
    globp[26].y = shading;
    ASSERT_EQ(Run(command), 1) << command;
    EXPECT_EQ(DisplayLetter(), letter) << command;
    EXPECT_EQ(globc[83], 'd') << command;
  }
}

TEST_F(DisplayCommandsTest, OverlaysAndTheBackgroundTakeOnlyValuesTheyKnow) {
  std::memcpy(globc, "SOLID   Z", 9);
  ASSERT_EQ(execute_quorvel_overlay("toolbar"), 1);
  EXPECT_EQ(Display().toolbar, "SOLID   ") << "exactly eight characters";
  EXPECT_EQ(execute_quorvel_overlay("no_such_overlay"), 0) << "an unknown overlay is not reported as done";
  const std::tuple<float, Status, bool> hiddenLines[] = {{2.0F, 1, true}, {5.0F, 0, true}, {3.0F, 1, false}};
  for (const auto& [code, status, shown] : hiddenLines) {
    globr[1] = code;
    EXPECT_EQ(execute_quorvel_overlay("hidlin2d"), status) << code;
    EXPECT_EQ(Display().hiddenLine2d, shown) << code;
  }
  const std::tuple<bool, char, bool> patterns[] = {{true, 'h', true}, {true, ' ', false}, {false, 'h', false}};
  for (const auto& [showable, letter, shown] : patterns) {
    Display().patternsShowable = showable;
    globc[66] = letter;
    execute_quorvel_overlay("refh");
    EXPECT_EQ(Display().hatchPatterns, shown) << showable << letter;
    EXPECT_EQ(globc[66], shown ? 'h' : ' ') << "the letter tells what is shown";
  }
  for (float colour : {7.0F, -1.0F, 256.0F, std::numeric_limits<float>::quiet_NaN()}) {
    globp[25].y = colour;
    EXPECT_EQ(Run("set_background_color"), colour == 7.0F ? 1 : 0) << colour;
  }
  EXPECT_EQ(Display().backgroundColor, 7);
}

}  // namespace
