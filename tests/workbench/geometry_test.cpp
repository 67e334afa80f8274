// Geometry and text helpers: the view frame of three points read the way the plug-in reads it,
// its degenerate inputs, distances and double-byte detection.
#include <array>
#include <cmath>

#include "tests/workbench/host_fixture.h"

namespace {

using Matrix = std::array<double, 16>;
struct Point {
  double x, y, z;
};

Matrix Multiply(const Matrix& a, const Matrix& b) {
  Matrix product{};
  for (int r = 0; r < 4; ++r) {
    for (int c = 0; c < 4; ++c) {
      for (int k = 0; k < 4; ++k) product[4 * r + c] += a[4 * r + k] * b[4 * k + c];
    }
  }
  return product;
}

// What the plug-in builds from the host's frame: R (G with row 3 cleared) times T (the
// translation by G's row 3).
Matrix ViewFromFrame(const float frame[16]) {
  Matrix rotation{};
  for (int i = 0; i < 16; ++i) rotation[i] = frame[i];
  rotation[12] = rotation[13] = rotation[14] = 0.0;
  Matrix translation{1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, frame[12], frame[13], frame[14], 1};
  return Multiply(rotation, translation);
}

Point Transform(const Matrix& m, Point p) {
  return {p.x * m[0] + p.y * m[4] + p.z * m[8] + m[12], p.x * m[1] + p.y * m[5] + p.z * m[9] + m[13],
          p.x * m[2] + p.y * m[6] + p.z * m[10] + m[14]};
}

struct Frame {
  float matrix[16];
  std::int32_t status;
};

Frame FrameOf(std::array<float, 9> points) {
  Frame frame{};
  frame.status = -1;
  g32d(points.data(), frame.matrix, &frame.status);
  return frame;
}

void ExpectNear(Point actual, Point expected) {
  EXPECT_NEAR(actual.x, expected.x, 1e-5);
  EXPECT_NEAR(actual.y, expected.y, 1e-5);
  EXPECT_NEAR(actual.z, expected.z, 1e-5);
}

// Rows 0 to 2 orthonormal and right-handed, column 3 (0, 0, 0, 1), nothing non-finite.
void ExpectRigidFrame(const float m[16]) {
  for (int i = 0; i < 16; ++i) ASSERT_TRUE(std::isfinite(m[i])) << "element " << i;
  for (int r = 0; r < 3; ++r) {
    for (int s = 0; s < 3; ++s) {
      const double dot = m[4 * r] * m[4 * s] + m[4 * r + 1] * m[4 * s + 1] + m[4 * r + 2] * m[4 * s + 2];
      EXPECT_NEAR(dot, r == s ? 1.0 : 0.0, 1e-6) << "rows " << r << " and " << s;
    }
  }
  const double determinant =
      m[0] * (m[5] * m[10] - m[6] * m[9]) - m[1] * (m[4] * m[10] - m[6] * m[8]) + m[2] * (m[4] * m[9] - m[5] * m[8]);
  EXPECT_NEAR(determinant, 1.0, 1e-6);
  EXPECT_EQ(m[3], 0.0F);
  EXPECT_EQ(m[7], 0.0F);
  EXPECT_EQ(m[11], 0.0F);
  EXPECT_EQ(m[15], 1.0F);
}

}  // namespace

using ViewFrame = HostTest;

TEST_F(ViewFrame, SectionFrameLaysTheLineOntoThePickedPoints) {
  // A section from (2, 2, 5) to (2, 6, 5) with its side point to the left, seen from above.
  const Frame frame = FrameOf({2, 2, 5, 2, 6, 5, -2, 2, 5});
  EXPECT_EQ(frame.status, 1);
  ExpectRigidFrame(frame.matrix);
  const Matrix view = ViewFromFrame(frame.matrix);
  ExpectNear(Transform(view, {0, 0, 0}), {2, 2, 5});
  ExpectNear(Transform(view, {4, 0, 0}), {2, 6, 5});
  ExpectNear(Transform(view, {0, 0, 1}), {2, 2, 6});
  ExpectNear(Transform(view, {0, 4, 0}), {-2, 2, 5});
}

TEST_F(ViewFrame, ThirdPointOnlyChoosesTheSideOfThePlane) {
  // The third point need not be square to the line: only its side of the x axis counts.
  const Frame frame = FrameOf({1, 1, 1, 4, 5, 1, 10, 20, 30});
  EXPECT_EQ(frame.status, 1);
  ExpectRigidFrame(frame.matrix);
  const Matrix view = ViewFromFrame(frame.matrix);
  ExpectNear(Transform(view, {5, 0, 0}), {4, 5, 1});
  // Back from the drawing into the frame: (p - origin) · Rᵀ. The third point lies in the
  // frame's xy plane on the positive y side.
  const float* m = frame.matrix;
  const Point d{10 - 1, 20 - 1, 30 - 1};
  EXPECT_GT(d.x * m[4] + d.y * m[5] + d.z * m[6], 0.0);
  EXPECT_NEAR(d.x * m[8] + d.y * m[9] + d.z * m[10], 0.0, 1e-4);
}

TEST_F(ViewFrame, EqualPointsFallBackToWorldAxesAtTheFirstPoint) {
  const Frame frame = FrameOf({3, 4, 5, 3, 4, 5, 3, 4, 5});
  EXPECT_EQ(frame.status, 0);
  const float expected[16] = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 3, 4, 5, 1};
  for (int i = 0; i < 16; ++i) EXPECT_EQ(frame.matrix[i], expected[i]) << "element " << i;
}

TEST_F(ViewFrame, CollinearPointsKeepTheLineAndTakeThePlanLeftAsY) {
  const Frame level = FrameOf({0, 0, 0, 0, 2, 0, 0, 7, 0});
  EXPECT_EQ(level.status, 0);
  ExpectRigidFrame(level.matrix);
  ExpectNear(Transform(ViewFromFrame(level.matrix), {2, 0, 0}), {0, 2, 0});
  ExpectNear(Transform(ViewFromFrame(level.matrix), {0, 1, 0}), {-1, 0, 0});

  const Frame vertical = FrameOf({1, 1, 0, 1, 1, 3, 1, 1, 9});
  EXPECT_EQ(vertical.status, 0);
  ExpectRigidFrame(vertical.matrix);
  ExpectNear(Transform(ViewFromFrame(vertical.matrix), {3, 0, 0}), {1, 1, 3});

  const Frame noLine = FrameOf({0, 0, 0, 0, 0, 0, 0, 5, 0});
  EXPECT_EQ(noLine.status, 0);
  ExpectRigidFrame(noLine.matrix);
  ExpectNear(Transform(ViewFromFrame(noLine.matrix), {0, 5, 0}), {0, 5, 0});
}

TEST_F(ViewFrame, FarFromTheOriginTinyOffsetsCountAsRounding) {
  const Frame frame = FrameOf({100000, 100000, 0, 100010, 100000, 0, 100020, 100000.01F, 0});
  EXPECT_EQ(frame.status, 0);
  ExpectRigidFrame(frame.matrix);
}

TEST_F(ViewFrame, NonFiniteInputGivesTheIdentity) {
  const Frame frame = FrameOf({NAN, 0, 0, 1, 0, 0, 0, 1, 0});
  EXPECT_EQ(frame.status, 0);
  for (int i = 0; i < 16; ++i) EXPECT_EQ(frame.matrix[i], i % 5 == 0 ? 1.0F : 0.0F) << "element " << i;
}

using HostHelpers = HostTest;

TEST_F(HostHelpers, DistanceIsTheThreeDimensionalLength) {
  const host::Point3f a{1, 2, 3};
  const host::Point3f b{4, 6, 15};
  EXPECT_FLOAT_EQ(distance_3d(&a, &b), 13.0F);
  EXPECT_EQ(distance_3d(&a, &a), 0.0F);
  EXPECT_EQ(distance_3d(&a, nullptr), 0.0F);
}

TEST_F(HostHelpers, DoubleByteTextsAreRecognisedInEitherEncoding) {
  EXPECT_EQ(iskanji_string("Section A-A"), 0);
  EXPECT_EQ(iskanji_string(""), 0);
  EXPECT_EQ(iskanji_string(nullptr), 0);
  EXPECT_EQ(iskanji_string("\xE6\x96\xAD\xE9\x9D\xA2"), 1) << "UTF-8";
  EXPECT_EQ(iskanji_string("A \xC3\xA9"), 1) << "a two-byte UTF-8 character";
  EXPECT_EQ(iskanji_string("\x92\x66\x96\xCA"), 1) << "double-byte code page";
  EXPECT_EQ(iskanji_string("caf\xE9"), 0) << "a lone high byte at the end forms no character";
  EXPECT_EQ(iskanji_string("ab\xC3"), 0) << "a cut two-byte sequence";
}
