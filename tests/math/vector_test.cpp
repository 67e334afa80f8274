// Vector arithmetic, conversions and the row-vector transform.
#include "math/vector.h"

#include <gtest/gtest.h>

#include "math/matrix.h"

namespace {

using HRMath::Matrix;
using HRMath::Vector;

void ExpectVector(const Vector& v, double x, double y, double z) {
  EXPECT_DOUBLE_EQ(v.x, x);
  EXPECT_DOUBLE_EQ(v.y, y);
  EXPECT_DOUBLE_EQ(v.z, z);
}

TEST(VectorTest, CrossAndNormalizeReplaceThisVector) {
  Vector a(1, 2, 3);
  a.Cross(Vector(4, 5, 6));
  ExpectVector(a, -3, 6, -3);
  Vector v(3, 4, 0);
  v.Normalize();
  ExpectVector(v, 0.6, 0.8, 0.0);
}

TEST(VectorTest, ArithmeticAndConversionsMakeNewValues) {
  const Vector a(1, 2, 3);
  const Vector b(0.5, -4, 10);
  ExpectVector(a + b, 1.5, -2, 13);
  ExpectVector(a - b, 0.5, 6, -7);
  const Vector v(0.1, 1.0 + 1e-12, -123456.789);
  double doubles[3] = {};
  float floats[3] = {};
  v.CopyTo(doubles);
  v.CopyTo(floats);
  EXPECT_EQ(doubles[1], 1.0 + 1e-12);
  EXPECT_EQ(floats[0], 0.1F);
}

TEST(VectorTest, TransformTakesRowVectorsSummedInTheFixedOrderWithoutDividingByW) {
  Matrix mirror;
  mirror.SetMirror(1, 0, 0);
  Matrix shift;
  shift.SetTranslation(5, 1, 2);
  // Mirror first, then translate: x = 2 becomes -2, then 3.
  ExpectVector(Vector(2, 1, 1).Transform(mirror.Multiply(shift)), 3, 2, 3);
  const double projective[16] = {1, 0, 0, 7, 0, 1, 0, 7, 0, 0, 1, 7, 0, 0, 0, 9};
  ExpectVector(Vector(1, 2, 3).Transform(Matrix(projective)), 1, 2, 3);
  // x' = m20*z + m10*y + m00*x + m30. With these values the fixed order gives 1; summing x
  // first would give 2, because 1 vanishes next to 1e16.
  const double big[16] = {-1e16, 0, 0, 0, 1e16, 0, 0, 0, 1, 0, 0, 0, 1, 0, 0, 1};
  EXPECT_EQ(Vector(1, 1, 1).Transform(Matrix(big)).x, 1.0);
}

}  // namespace
