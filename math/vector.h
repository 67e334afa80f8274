// A point or direction in double precision; the drawing's single-precision points are widened
// on the way in and narrowed on the way out.
#pragma once

namespace HRMath {

class Matrix;

class Vector {
 public:
  Vector();
  Vector(double xValue, double yValue, double zValue);
  Vector(const Vector& other);
  virtual ~Vector();

  // Replaces this vector by this x other.
  virtual void Cross(const Vector& other);
  // There is deliberately no guard for length 0: the components then become non-finite.
  virtual void Normalize();
  virtual double Length() const;

  Vector operator+(const Vector& other) const;
  Vector operator-(const Vector& other) const;
  // Hands back a copy rather than a reference, as every caller of the model expects.
  Vector operator=(const Vector& other);

  void CopyTo(double out[3]) const;
  // Narrows each component to single precision, the form of the host's points.
  void CopyTo(float out[3]) const;

  // The point (x, y, z, 1) times the matrix, without a division by w.
  Vector Transform(const Matrix& matrix) const;

  double x;
  double y;
  double z;
};

}  // namespace HRMath
