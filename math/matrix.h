// A 4x4 affine transform in double precision for row vectors: p' = (x, y, z, 1) * M, with the
// translation in row 3.
#pragma once

#include <cstdint>

namespace HRMath {

class Matrix {
 public:
  // The identity.
  Matrix();
  Matrix(const Matrix& other);
  // Sixteen elements row by row.
  explicit Matrix(const double elements[16]);
  explicit Matrix(const float elements[16]);
  virtual ~Matrix();

  virtual void SetIdentity();
  // The host's view frame through three points (origin, a point on the x axis, a point in the
  // xy plane), given as nine coordinates in that order. Always answers 0.
  virtual std::int16_t SetView(const double coordinates[9]);
  // Only a flag equal to 1 mirrors its axis.
  virtual void SetMirror(std::uint8_t flagX, std::uint8_t flagY, std::uint8_t flagZ);
  virtual void SetTranslation(double tx, double ty, double tz);
  virtual void CopyTo(double out[16]) const;
  virtual void CopyTo(float out[16]) const;

  double Get(int row, int column) const;
  // This * other.
  Matrix Multiply(const Matrix& other) const;
  // Hands back a copy rather than a reference, as every caller of the model expects.
  Matrix operator=(const Matrix& other);

 private:
  double& At(int row, int column) { return elements_[4 * row + column]; }

  double elements_[16];
};

}  // namespace HRMath
