// Length conversion by the host's unit letter and number formatting by its precision.
#include <cmath>
#include <limits>

#include "shell/display_units.h"
#include "shell/host/argument_blocks.h"
#include "tests/shell/plugin_fixture.h"

namespace {

using DisplayUnitsTest = LoadedPluginTest;

TEST_F(DisplayUnitsTest, CentimetresAndMetresScaleBothWays) {
  globc[94] = 'c';
  EXPECT_FLOAT_EQ(ToDisplayLength(250.0F), 2.5F);
  EXPECT_FLOAT_EQ(FromDisplayLength(2.5F), 250.0F);
  globc[94] = 'l';
  EXPECT_FLOAT_EQ(ToDisplayLength(2500.0F), 2.5F);
  EXPECT_FLOAT_EQ(FromDisplayLength(2.5F), 2500.0F);
}

TEST_F(DisplayUnitsTest, OtherLettersLeaveLengthsUnchanged) {
  for (char letter : {'m', 'x', '\0', static_cast<char>(-61)}) {
    globc[94] = letter;
    EXPECT_EQ(ToDisplayLength(123.25F), 123.25F) << static_cast<int>(letter);
    EXPECT_EQ(FromDisplayLength(123.25F), 123.25F) << static_cast<int>(letter);
  }
}

TEST_F(DisplayUnitsTest, FormatterTruncatesThePrecisionSetting) {
  globr[56] = 2.0F;
  EXPECT_EQ(FormatNumber(1.5F), "1.50");
  globr[56] = 3.9F;
  EXPECT_EQ(FormatNumber(1.5F), "1.500");
  globr[56] = 0.0F;
  EXPECT_EQ(FormatNumber(2.75F), "3");
  globr[56] = 1.0F;
  EXPECT_EQ(FormatNumber(-0.25F), "-0.2");
}

TEST_F(DisplayUnitsTest, DamagedPrecisionSettingsStayBounded) {
  globr[56] = -3.0F;
  EXPECT_EQ(FormatNumber(1.5F), "2");
  globr[56] = std::numeric_limits<float>::quiet_NaN();
  EXPECT_EQ(FormatNumber(1.5F), "2");
  globr[56] = 1e30F;
  EXPECT_EQ(FormatNumber(1.0F), "1.00000000000000000");
}

}  // namespace
