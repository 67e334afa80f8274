// Conversions between the drawing's single-precision points and double-precision vectors.
#pragma once

#include "math/vector.h"
#include "shell/host/host_types.h"

inline host::Point3f ToHostPoint(double x, double y, double z) {
  return {static_cast<float>(x), static_cast<float>(y), static_cast<float>(z)};
}

inline host::Point3f ToHostPoint(const double point[3]) { return ToHostPoint(point[0], point[1], point[2]); }

inline host::Point3f ToHostPoint(const HRMath::Vector& v) { return ToHostPoint(v.x, v.y, v.z); }

inline HRMath::Vector ToVector(const host::Point3f& point) { return {point.x, point.y, point.z}; }
