// Vector arithmetic; the order of each sum is fixed so that results match bit for bit.
#include "math/vector.h"

#include <cmath>

#include "math/matrix.h"

namespace HRMath {

Vector::Vector() : x(0.0), y(0.0), z(0.0) {}

Vector::Vector(double xValue, double yValue, double zValue) : x(xValue), y(yValue), z(zValue) {}

Vector::Vector(const Vector& other) = default;

Vector::~Vector() = default;

void Vector::Cross(const Vector& other) {
  const double crossX = y * other.z - z * other.y;
  const double crossY = z * other.x - x * other.z;
  const double crossZ = x * other.y - other.x * y;
  x = crossX;
  y = crossY;
  z = crossZ;
}

void Vector::Normalize() {
  const double length = Length();
  x /= length;
  y /= length;
  z /= length;
}

double Vector::Length() const { return std::sqrt(x * x + y * y + z * z); }

Vector Vector::operator+(const Vector& other) const { return {x + other.x, y + other.y, z + other.z}; }

Vector Vector::operator-(const Vector& other) const { return {x - other.x, y - other.y, z - other.z}; }

Vector Vector::operator=(const Vector& other) {
  x = other.x;
  y = other.y;
  z = other.z;
  return *this;
}

void Vector::CopyTo(double out[3]) const {
  out[0] = x;
  out[1] = y;
  out[2] = z;
}

void Vector::CopyTo(float out[3]) const {
  out[0] = static_cast<float>(x);
  out[1] = static_cast<float>(y);
  out[2] = static_cast<float>(z);
}

Vector Vector::Transform(const Matrix& m) const {
  return {m.Get(2, 0) * z + m.Get(1, 0) * y + m.Get(0, 0) * x + m.Get(3, 0),
          m.Get(2, 1) * z + m.Get(1, 1) * y + m.Get(0, 1) * x + m.Get(3, 1),
          m.Get(2, 2) * z + m.Get(1, 2) * y + m.Get(0, 2) * x + m.Get(3, 2)};
}

}  // namespace HRMath
