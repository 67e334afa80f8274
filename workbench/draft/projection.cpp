// View frame and projection of the host view.
#include "workbench/draft/projection.h"

namespace wb::draft {

namespace {

constexpr double kNearFraction = 1e-3;
// Below this fraction of the coordinates' size, eye and target count as one point.
constexpr double kSamePointFraction = 1e-9;
// Below this sine the view is taken as straight up or down.
constexpr double kVerticalSine = 1e-9;

double FiniteOrZero(float value) { return std::isfinite(value) ? value : 0.0; }

Vec3 Sanitized(host::Point3f point) { return {FiniteOrZero(point.x), FiniteOrZero(point.y), FiniteOrZero(point.z)}; }

Vec3 Normalized(Vec3 v) { return v * (1.0 / Length(v)); }

}  // namespace

Projection::Projection(const ViewSpec& view) : eye_(Sanitized(view.eye)), target_(Sanitized(view.target)) {
  const Vec3 toTarget = target_ - eye_;
  distance_ = Length(toTarget);
  const double size = std::fmax(1.0, std::fmax(MaxAbs(eye_), MaxAbs(target_)));
  if (distance_ <= kSamePointFraction * size) {
    forward_ = {0.0, 0.0, -1.0};
    distance_ = 0.0;
  } else {
    forward_ = toTarget * (1.0 / distance_);
  }
  perspective_ = view.perspective && distance_ > 0.0;
  nearDepth_ = distance_ * kNearFraction;

  const Vec3 worldUp{0.0, 0.0, 1.0};
  const Vec3 acrossUp = Cross(forward_, worldUp);
  if (Length(acrossUp) > kVerticalSine) {
    right_ = Normalized(acrossUp);
  } else {
    right_ = Normalized(Cross(forward_, Vec3{0.0, 1.0, 0.0}));
  }
  up_ = Cross(right_, forward_);
}

double Projection::ClampedDepth(Vec3 point) const { return std::fmax(Depth(point), nearDepth_); }

Point2 Projection::Project(Vec3 point) const {
  if (!perspective_) {
    const Vec3 offset = point - target_;
    return {Dot(offset, right_), Dot(offset, up_)};
  }
  const Vec3 offset = point - eye_;
  const double scale = distance_ / ClampedDepth(point);
  return {Dot(offset, right_) * scale, Dot(offset, up_) * scale};
}

Vec3 Projection::ToScreen(Vec3 point) const {
  const Point2 flat = Project(point);
  const double z = perspective_ ? -distance_ / ClampedDepth(point) : Dot(point - target_, forward_);
  return {flat.x, flat.y, z};
}

std::optional<std::array<double, 3>> Projection::ScreenPlane(Vec3 normal, double offset) const {
  // Solves Dot(normal, p) = offset for z with p written in the view frame.
  const double alongX = Dot(normal, right_);
  const double alongY = Dot(normal, up_);
  const double alongZ = Dot(normal, forward_);
  if (!perspective_) {
    if (!(std::fabs(alongZ) > kVerticalSine)) return std::nullopt;
    return std::array<double, 3>{-alongX / alongZ, -alongY / alongZ, (offset - Dot(normal, target_)) / alongZ};
  }
  const double eyeOffset = offset - Dot(normal, eye_);
  if (!(std::fabs(eyeOffset) > kSamePointFraction * std::fmax(1.0, std::fabs(offset)))) return std::nullopt;
  return std::array<double, 3>{-alongX / eyeOffset, -alongY / eyeOffset, -distance_ * alongZ / eyeOffset};
}

}  // namespace wb::draft
