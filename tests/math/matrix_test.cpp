// Matrix construction, mirror and translation, products and the host view frame.
#include "math/matrix.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "math/vector.h"
#include "shell/host/qeldll.h"
#include "workbench/workbench.h"

namespace {

using HRMath::Matrix;

void ExpectDiagonal(const Matrix& m, const std::vector<double>& diagonal) {
  for (int i = 0; i < 16; ++i) EXPECT_EQ(m.Get(i / 4, i % 4), i % 5 == 0 ? diagonal[i / 5] : 0.0) << i;
}

TEST(MatrixTest, ElementsAreStoredRowByRowAndCopiedWhole) {
  double doubles[16];
  for (int i = 0; i < 16; ++i) doubles[i] = i + 0.1;
  Matrix assigned;
  EXPECT_EQ((assigned = Matrix(doubles)).Get(1, 0), 4.1);
  double copied[16];
  assigned.CopyTo(copied);
  EXPECT_TRUE(std::equal(doubles, doubles + 16, copied));
}

TEST(MatrixTest, MirrorAndTranslationStartFromTheIdentity) {
  Matrix m;
  m.SetTranslation(9, 9, 9);
  m.SetMirror(1, 0, 0);
  ExpectDiagonal(m, {-1, 1, 1, 1});
  m.SetMirror(2, 1, 1);
  ExpectDiagonal(m, {1, -1, -1, 1});
  m.SetMirror(0, 255, 1);  // only a flag of exactly 1 flips
  ExpectDiagonal(m, {1, 1, -1, 1});
  m.SetTranslation(1, 2, 3);
  EXPECT_EQ((std::vector<double>{m.Get(0, 0), m.Get(2, 2), m.Get(3, 0), m.Get(3, 1), m.Get(3, 2), m.Get(0, 3)}),
            (std::vector<double>{1, 1, 1, 2, 3, 0}));
}

TEST(MatrixTest, MultiplySumsEachElementInTheFixedOrder) {
  // Element (0, 0) = a01*b10 + a00*b00 + a03*b30 + a02*b20. In that order these values give 1;
  // summed from a00 onwards they would give 0, because 1 vanishes next to 1e16.
  const double big[16] = {1e16, 1, 1, -1e16, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1};
  const double ones[16] = {1, 0, 0, 0, 1, 1, 0, 0, 1, 0, 1, 0, 1, 0, 0, 1};
  EXPECT_EQ(Matrix(big).Multiply(Matrix(ones)).Get(0, 0), 1.0);
}

TEST(MatrixTest, ViewIsTheHostFrameSplitIntoRotationAndTranslation) {
  wb::Workbench::Get().Reset();
  const double points[9] = {0.1, -7.3, 2.2, 10.4, 3.3, 2.2, -10.5, 3.2, 2.2};
  float narrowed[9];
  for (int i = 0; i < 9; ++i) narrowed[i] = static_cast<float>(points[i]);
  float frame[16] = {};
  std::int32_t status = 0;
  g32d(narrowed, frame, &status);
  Matrix view;
  view.SetTranslation(100, 100, 100);  // earlier contents must not leak into the frame
  EXPECT_EQ(view.SetView(points), 0);
  // Every element is the host's, the origin included: the narrowed start point, not the double one.
  for (int i = 0; i < 15; ++i) EXPECT_EQ(view.Get(i / 4, i % 4), static_cast<double>(frame[i])) << i;
  EXPECT_EQ(view.Get(3, 3), 1.0);
}

}  // namespace
