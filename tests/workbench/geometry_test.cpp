// The view frame of three points and its degenerate inputs, and double-byte text detection.
#include <array>
#include <cmath>
#include <vector>

#include "tests/workbench/host_fixture.h"

namespace {

using Point = std::array<double, 3>;

struct FrameCase {
  const char* what;
  std::array<float, 9> points;
  std::int32_t status;
  std::vector<std::pair<Point, Point>> mapped;  // a point of the frame, and where it lies in the drawing
};

using ViewFrame = HostTest;
using HostHelpers = HostTest;

}  // namespace

TEST_F(ViewFrame, LaysTheLineOntoThePickedPointsOrFallsBackToARigidFrame) {
  const FrameCase cases[] = {
      {"section seen from above, side point to the left", {2, 2, 5, 2, 6, 5, -2, 2, 5}, 1,
       {{{0, 0, 0}, {2, 2, 5}}, {{4, 0, 0}, {2, 6, 5}}, {{0, 0, 1}, {2, 2, 6}}, {{0, 4, 0}, {-2, 2, 5}}}},
      // Only the third point's side of the line counts: it lands in the frame's xy plane.
      {"third point not square to the line", {1, 1, 1, 4, 5, 1, 10, 20, 30}, 1,
       {{{5, 0, 0}, {4, 5, 1}}, {{20.6, std::sqrt(858.64), 0}, {10, 20, 30}}}},
      {"equal points: world axes at the first point", {3, 4, 5, 3, 4, 5, 3, 4, 5}, 0,
       {{{1, 0, 0}, {4, 4, 5}}, {{0, 1, 0}, {3, 5, 5}}}},
      {"collinear level points: the plan's left is y", {0, 0, 0, 0, 2, 0, 0, 7, 0}, 0,
       {{{2, 0, 0}, {0, 2, 0}}, {{0, 1, 0}, {-1, 0, 0}}}},
      {"collinear vertical points", {1, 1, 0, 1, 1, 3, 1, 1, 9}, 0, {{{3, 0, 0}, {1, 1, 3}}}},
      {"tiny offsets far from the origin are rounding", {1e5F, 1e5F, 0, 100010, 1e5F, 0, 100020, 100000.01F, 0}, 0, {}},
      {"non-finite input: the identity", {NAN, 0, 0, 1, 0, 0, 0, 1, 0}, 0,
       {{{1, 0, 0}, {1, 0, 0}}, {{0, 1, 0}, {0, 1, 0}}}},
  };
  for (const FrameCase& c : cases) {
    SCOPED_TRACE(c.what);
    float m[16];
    std::int32_t status = -1;
    g32d(c.points.data(), m, &status);
    EXPECT_EQ(status, c.status);
    // Rows 0 to 2 are orthonormal right-handed axes and row 3 the origin, all finite.
    for (int i = 0; i < 16; ++i) ASSERT_TRUE(std::isfinite(m[i])) << "element " << i;
    for (int r = 0; r < 3; ++r) {
      for (int s = 0; s < 3; ++s) {
        EXPECT_NEAR(m[4 * r] * m[4 * s] + m[4 * r + 1] * m[4 * s + 1] + m[4 * r + 2] * m[4 * s + 2], r == s, 1e-6);
      }
    }
    const double determinant =
        m[0] * (m[5] * m[10] - m[6] * m[9]) - m[1] * (m[4] * m[10] - m[6] * m[8]) + m[2] * (m[4] * m[9] - m[5] * m[8]);
    EXPECT_NEAR(determinant, 1.0, 1e-6);
    EXPECT_EQ((std::array{m[3], m[7], m[11], m[15]}), (std::array{0.0F, 0.0F, 0.0F, 1.0F}));
    for (const auto& [p, expected] : c.mapped) {
      for (int k = 0; k < 3; ++k) {
        EXPECT_NEAR(p[0] * m[k] + p[1] * m[4 + k] + p[2] * m[8 + k] + m[12 + k], expected[k], 1e-4) << k;
      }
    }
  }
}

TEST_F(HostHelpers, DoubleByteTextsAreRecognisedInEitherEncoding) {
  // UTF-8 or a double-byte code page; a lone or cut high byte forms no character.
  const std::pair<const char*, std::int16_t> texts[] = {
      {"Section A-A", 0}, {nullptr, 0}, {"A \xC3\xA9", 1}, {"\x92\x66\x96\xCA", 1}, {"caf\xE9", 0}, {"ab\xC3", 0},
  };
  for (const auto& [text, expected] : texts) EXPECT_EQ(iskanji_string(text), expected) << (text ? text : "null");
}
