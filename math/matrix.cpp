// Matrix construction and products; the order of each sum is fixed so that results match bit
// for bit.
#include "math/matrix.h"

#include <algorithm>
#include <cstdint>

#include "shell/host/qeldll.h"

namespace HRMath {

Matrix::Matrix() : elements_() { SetIdentity(); }

Matrix::Matrix(const Matrix& other) = default;

Matrix::Matrix(const double elements[16]) : elements_() { std::copy_n(elements, 16, elements_); }

Matrix::Matrix(const float elements[16]) : elements_() {
  std::transform(elements, elements + 16, elements_, [](float value) { return static_cast<double>(value); });
}

Matrix::~Matrix() = default;

void Matrix::SetIdentity() {
  for (int row = 0; row < 4; ++row) {
    for (int column = 0; column < 4; ++column) At(row, column) = row == column ? 1.0 : 0.0;
  }
}

std::int16_t Matrix::SetView(const double coordinates[9]) {
  float points[9];
  std::transform(coordinates, coordinates + 9, points, [](double value) { return static_cast<float>(value); });
  float frame[16] = {};
  std::int32_t status = 0;
  g32d(points, frame, &status);

  Matrix translation;
  translation.SetTranslation(frame[12], frame[13], frame[14]);
  frame[12] = 0.0F;
  frame[13] = 0.0F;
  frame[14] = 0.0F;
  *this = Matrix(frame).Multiply(translation);
  return 0;
}

void Matrix::SetMirror(std::uint8_t flagX, std::uint8_t flagY, std::uint8_t flagZ) {
  SetIdentity();
  if (flagX == 1) At(0, 0) = -1.0;
  if (flagY == 1) At(1, 1) = -1.0;
  if (flagZ == 1) At(2, 2) = -1.0;
}

void Matrix::SetTranslation(double tx, double ty, double tz) {
  SetIdentity();
  At(3, 0) = tx;
  At(3, 1) = ty;
  At(3, 2) = tz;
}

void Matrix::CopyTo(double out[16]) const { std::copy_n(elements_, 16, out); }

void Matrix::CopyTo(float out[16]) const {
  std::transform(elements_, elements_ + 16, out, [](double value) { return static_cast<float>(value); });
}

double Matrix::Get(int row, int column) const { return elements_[4 * row + column]; }

Matrix Matrix::Multiply(const Matrix& other) const {
  Matrix product;
  for (int row = 0; row < 4; ++row) {
    for (int column = 0; column < 4; ++column) {
      product.At(row, column) = Get(row, 1) * other.Get(1, column) + Get(row, 0) * other.Get(0, column) +
                                Get(row, 3) * other.Get(3, column) + Get(row, 2) * other.Get(2, column);
    }
  }
  return product;
}

Matrix Matrix::operator=(const Matrix& other) {
  std::copy_n(other.elements_, 16, elements_);
  return *this;
}

}  // namespace HRMath
