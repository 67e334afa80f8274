// Vector arithmetic, conversions and the row-vector transform.
#include "math/vector.h"

#include <gtest/gtest.h>

#include <cmath>

#include "math/matrix.h"

namespace {

using HRMath::Matrix;
using HRMath::Vector;

void ExpectVector(const Vector& v, double x, double y, double z) {
  EXPECT_DOUBLE_EQ(v.x, x);
  EXPECT_DOUBLE_EQ(v.y, y);
  EXPECT_DOUBLE_EQ(v.z, z);
}

TEST(VectorTest, ConstructsFromNothingComponentsOrAnotherVector) {
  ExpectVector(Vector(), 0.0, 0.0, 0.0);
  const Vector given(1.5, -2.0, 3.25);
  ExpectVector(given, 1.5, -2.0, 3.25);
  ExpectVector(Vector(given), 1.5, -2.0, 3.25);
}

TEST(VectorTest, CrossReplacesThisVectorAndLeavesTheOtherAlone) {
  Vector x(1, 0, 0);
  const Vector y(0, 1, 0);
  x.Cross(y);
  ExpectVector(x, 0, 0, 1);
  ExpectVector(y, 0, 1, 0);

  Vector a(1, 2, 3);
  a.Cross(Vector(4, 5, 6));
  ExpectVector(a, -3, 6, -3);

  Vector b(4, 5, 6);
  b.Cross(Vector(1, 2, 3));
  ExpectVector(b, 3, -6, 3);
}

TEST(VectorTest, LengthAndNormalize) {
  Vector v(3, 4, 0);
  EXPECT_DOUBLE_EQ(v.Length(), 5.0);
  v.Normalize();
  ExpectVector(v, 0.6, 0.8, 0.0);
  EXPECT_DOUBLE_EQ(v.Length(), 1.0);
}

TEST(VectorTest, NormalizingTheZeroVectorGivesNonFiniteComponents) {
  Vector zero;
  zero.Normalize();
  EXPECT_FALSE(std::isfinite(zero.x));
  EXPECT_FALSE(std::isfinite(zero.y));
  EXPECT_FALSE(std::isfinite(zero.z));
}

// A vector whose length is fixed at 2, to see that Normalize asks the overridable Length.
class LengthTwo : public Vector {
 public:
  using Vector::Vector;
  double Length() const override { return 2.0; }
};

TEST(VectorTest, NormalizeDividesByTheLengthOfTheActualClass) {
  LengthTwo v(3, 4, 8);
  v.Normalize();
  ExpectVector(v, 1.5, 2.0, 4.0);
}

TEST(VectorTest, AdditionSubtractionAndAssignmentMakeNewVectors) {
  const Vector a(1, 2, 3);
  const Vector b(0.5, -4, 10);
  ExpectVector(a + b, 1.5, -2, 13);
  ExpectVector(a - b, 0.5, 6, -7);
  ExpectVector(a, 1, 2, 3);

  Vector target;
  Vector copy = (target = b);
  copy.x = 99;
  ExpectVector(target, 0.5, -4, 10);
}

TEST(VectorTest, ConvertsToDoublesExactlyAndToFloatsWithSinglePrecisionLoss) {
  const Vector v(0.1, 1.0 + 1e-12, -123456.789);
  double doubles[3] = {};
  v.CopyTo(doubles);
  EXPECT_EQ(doubles[0], 0.1);
  EXPECT_EQ(doubles[1], 1.0 + 1e-12);
  EXPECT_EQ(doubles[2], -123456.789);

  float floats[3] = {};
  v.CopyTo(floats);
  EXPECT_EQ(floats[0], 0.1F);
  EXPECT_EQ(floats[1], 1.0F);
  EXPECT_EQ(floats[2], -123456.789F);
  const Vector back(floats[0], floats[1], floats[2]);
  EXPECT_NE(back.x, v.x);
  EXPECT_NE(back.y, v.y);
  EXPECT_NE(back.z, v.z);
  EXPECT_NEAR(back.x, v.x, 1e-8);
}

TEST(VectorTest, TransformAppliesRowVectorConvention) {
  Matrix translation;
  translation.SetTranslation(1, 2, 3);
  ExpectVector(Vector().Transform(translation), 1, 2, 3);
  ExpectVector(Vector(1, 1, 1).Transform(translation), 2, 3, 4);

  // Mirror first, then translate: x = 2 becomes -2, then 3.
  Matrix mirror;
  mirror.SetMirror(1, 0, 0);
  Matrix shift;
  shift.SetTranslation(5, 0, 0);
  ExpectVector(Vector(2, 0, 0).Transform(mirror.Multiply(shift)), 3, 0, 0);
  ExpectVector(Vector(2, 0, 0).Transform(shift.Multiply(mirror)), -7, 0, 0);
}

TEST(VectorTest, TransformDoesNotDivideByW) {
  double elements[16] = {1, 0, 0, 7, 0, 1, 0, 7, 0, 0, 1, 7, 0, 0, 0, 9};
  ExpectVector(Vector(1, 2, 3).Transform(Matrix(elements)), 1, 2, 3);
}

TEST(VectorTest, TransformAddsTheProductsInTheFixedOrder) {
  // x' = m20*z + m10*y + m00*x + m30. With these values the fixed order gives 1; summing x
  // first would give 2, because 1 vanishes next to 1e16.
  double elements[16] = {-1e16, 0, 0, 0, 1e16, 0, 0, 0, 1, 0, 0, 0, 1, 0, 0, 1};
  const Vector moved = Vector(1, 1, 1).Transform(Matrix(elements));
  EXPECT_EQ(moved.x, 1.0);
}

}  // namespace
