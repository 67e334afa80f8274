// Matrix construction, mirror and translation, products and the host view frame.
#include "math/matrix.h"

#include <gtest/gtest.h>

#include "math/vector.h"
#include "shell/host/qeldll.h"
#include "workbench/workbench.h"

namespace {

using HRMath::Matrix;
using HRMath::Vector;

void ExpectDiagonal(const Matrix& m, double d0, double d1, double d2, double d3) {
  const double diagonal[4] = {d0, d1, d2, d3};
  for (int row = 0; row < 4; ++row) {
    for (int column = 0; column < 4; ++column) {
      EXPECT_EQ(m.Get(row, column), row == column ? diagonal[row] : 0.0) << row << "," << column;
    }
  }
}

void ExpectNear(const Vector& v, double x, double y, double z, double tolerance = 1e-5) {
  EXPECT_NEAR(v.x, x, tolerance);
  EXPECT_NEAR(v.y, y, tolerance);
  EXPECT_NEAR(v.z, z, tolerance);
}

TEST(MatrixTest, DefaultIsIdentityAndElementsAreStoredRowByRow) {
  ExpectDiagonal(Matrix(), 1, 1, 1, 1);

  double doubles[16];
  float floats[16];
  for (int i = 0; i < 16; ++i) {
    doubles[i] = i + 0.1;
    floats[i] = static_cast<float>(i) + 0.1F;
  }
  const Matrix fromDoubles(doubles);
  const Matrix fromFloats(floats);
  EXPECT_EQ(fromDoubles.Get(0, 1), 1.1);
  EXPECT_EQ(fromDoubles.Get(1, 0), 4.1);
  EXPECT_EQ(fromDoubles.Get(3, 2), 14.1);
  EXPECT_EQ(fromFloats.Get(2, 3), static_cast<double>(11.1F));
  EXPECT_NE(fromFloats.Get(2, 3), 11.1);

  double outDoubles[16];
  float outFloats[16];
  fromDoubles.CopyTo(outDoubles);
  fromDoubles.CopyTo(outFloats);
  for (int i = 0; i < 16; ++i) {
    EXPECT_EQ(outDoubles[i], doubles[i]);
    EXPECT_EQ(outFloats[i], static_cast<float>(doubles[i]));
  }
}

TEST(MatrixTest, CopyAndAssignmentTakeEveryElement) {
  Matrix source;
  source.SetTranslation(4, 5, 6);
  const Matrix copied(source);
  Matrix assigned;
  const Matrix returned = (assigned = source);
  for (const Matrix* m : {&copied, static_cast<const Matrix*>(&assigned), &returned}) {
    EXPECT_EQ(m->Get(3, 0), 4);
    EXPECT_EQ(m->Get(3, 1), 5);
    EXPECT_EQ(m->Get(3, 2), 6);
  }
}

TEST(MatrixTest, MirrorFlipsOnlyAxesWhoseFlagIsOne) {
  Matrix m;
  m.SetMirror(1, 0, 0);
  ExpectDiagonal(m, -1, 1, 1, 1);
  m.SetMirror(2, 1, 1);
  ExpectDiagonal(m, 1, -1, -1, 1);
  m.SetMirror(0, 255, 1);
  ExpectDiagonal(m, 1, 1, -1, 1);
}

TEST(MatrixTest, MirrorAndTranslationStartFromTheIdentity) {
  Matrix m;
  m.SetTranslation(9, 9, 9);
  m.SetMirror(0, 1, 0);
  ExpectDiagonal(m, 1, -1, 1, 1);

  m.SetMirror(1, 1, 1);
  m.SetTranslation(1, 2, 3);
  EXPECT_EQ(m.Get(0, 0), 1.0);
  EXPECT_EQ(m.Get(3, 0), 1.0);
  EXPECT_EQ(m.Get(3, 1), 2.0);
  EXPECT_EQ(m.Get(3, 2), 3.0);
  EXPECT_EQ(m.Get(0, 3), 0.0);

  m.SetIdentity();
  ExpectDiagonal(m, 1, 1, 1, 1);
}

TEST(MatrixTest, MultiplyIsThisTimesOther) {
  double a[16];
  double b[16];
  for (int i = 0; i < 16; ++i) {
    a[i] = i + 1;
    b[i] = 16 - i;
  }
  const Matrix product = Matrix(a).Multiply(Matrix(b));
  // Row 0 of a is (1, 2, 3, 4); column 0 of b is (16, 12, 8, 4); column 3 is (13, 9, 5, 1).
  EXPECT_EQ(product.Get(0, 0), 1 * 16 + 2 * 12 + 3 * 8 + 4 * 4);
  EXPECT_EQ(product.Get(0, 3), 1 * 13 + 2 * 9 + 3 * 5 + 4 * 1);
  // Row 3 of a is (13, 14, 15, 16); column 1 of b is (15, 11, 7, 3).
  EXPECT_EQ(product.Get(3, 1), 13 * 15 + 14 * 11 + 15 * 7 + 16 * 3);
  const Matrix reversed = Matrix(b).Multiply(Matrix(a));
  EXPECT_NE(reversed.Get(0, 0), product.Get(0, 0));
}

TEST(MatrixTest, MultiplyAddsTheProductsInTheFixedOrder) {
  // Element (0, 0) = a01*b10 + a00*b00 + a03*b30 + a02*b20. In that order these values give 1;
  // summed from a00 onwards they would give 0, because 1 vanishes next to 1e16.
  double a[16] = {1e16, 1, 1, -1e16, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1};
  double b[16] = {1, 0, 0, 0, 1, 1, 0, 0, 1, 0, 1, 0, 1, 0, 0, 1};
  EXPECT_EQ(Matrix(a).Multiply(Matrix(b)).Get(0, 0), 1.0);
}

class MatrixViewTest : public ::testing::Test {
 protected:
  void SetUp() override { wb::Workbench::Get().Reset(); }
  void TearDown() override { EXPECT_EQ(wb::Workbench::Get().Memory().Outstanding(), 0); }
};

TEST_F(MatrixViewTest, MapsTheFrameOntoTheThreePoints) {
  // Start (2, 2, 5), end (2, 6, 5) and the side point to the left of the line.
  const double points[9] = {2, 2, 5, 2, 6, 5, -2, 2, 5};
  Matrix view;
  EXPECT_EQ(view.SetView(points), 0);
  ExpectNear(Vector(0, 0, 0).Transform(view), 2, 2, 5);
  ExpectNear(Vector(4, 0, 0).Transform(view), 2, 6, 5);
  ExpectNear(Vector(0, 4, 0).Transform(view), -2, 2, 5);
  ExpectNear(Vector(0, 0, 1).Transform(view), 2, 2, 6);
}

TEST_F(MatrixViewTest, ObliqueLinePutsItsSecondPointOnTheFrameXAxis) {
  const double points[9] = {1, 2, 3, 4, 6, 3, -3, 5, 3};
  Matrix view;
  view.SetTranslation(100, 100, 100);  // earlier contents must not leak into the frame
  view.SetView(points);
  ExpectNear(Vector(0, 0, 0).Transform(view), 1, 2, 3);
  ExpectNear(Vector(5, 0, 0).Transform(view), 4, 6, 3);
  ExpectNear(Vector(0, 5, 0).Transform(view), -3, 5, 3);
}

TEST_F(MatrixViewTest, EqualsTheHostFrameSplitIntoRotationAndTranslation) {
  const double points[9] = {0.1, -7.3, 2.2, 10.4, 3.3, 2.2, -10.5, 3.2, 2.2};
  float narrowed[9];
  for (int i = 0; i < 9; ++i) narrowed[i] = static_cast<float>(points[i]);
  float frame[16] = {};
  std::int32_t status = 0;
  g32d(narrowed, frame, &status);

  Matrix view;
  view.SetView(points);
  // The origin is the narrowed start point, not the double one.
  EXPECT_EQ(view.Get(3, 0), static_cast<double>(frame[12]));
  EXPECT_EQ(view.Get(3, 0), static_cast<double>(0.1F));
  EXPECT_EQ(view.Get(3, 1), static_cast<double>(frame[13]));
  EXPECT_EQ(view.Get(3, 2), static_cast<double>(frame[14]));
  for (int row = 0; row < 3; ++row) {
    for (int column = 0; column < 4; ++column) {
      EXPECT_EQ(view.Get(row, column), static_cast<double>(frame[4 * row + column])) << row << "," << column;
    }
  }
  EXPECT_EQ(view.Get(3, 3), 1.0);
}

}  // namespace
