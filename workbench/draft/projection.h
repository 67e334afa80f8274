// The host view as a projection from the drawing onto the view plane.
#pragma once

#include <array>
#include <optional>

#include "shell/host/host_types.h"
#include "workbench/draft/sheet.h"
#include "workbench/draft/vec3.h"

namespace wb::draft {

// The host's view: looking from the eye to the target, world z up.
struct ViewSpec {
  host::Point3f eye{};
  host::Point3f target{};
  bool perspective = false;
};

// View coordinates: origin at the target, x to the right, y up (world z projected, or world y
// when looking straight up or down), in drawing units at the target's distance. An eye that
// coincides with the target gives no direction: the view then looks straight down in parallel
// projection, the plan view a CAD user expects from an unset camera. Coordinates that are not
// finite count as 0, so a damaged view still draws something finite.
class Projection {
 public:
  explicit Projection(const ViewSpec& view);

  bool Perspective() const { return perspective_; }
  Vec3 Eye() const { return eye_; }
  Vec3 Forward() const { return forward_; }
  // Perspective only: nearer points are clipped off before projecting. A thousandth of the
  // eye-target distance keeps the scale of anything drawable bounded.
  double NearDepth() const { return nearDepth_; }

  // Distance in front of the eye along the view direction (negative behind it).
  double Depth(Vec3 point) const { return Dot(point - eye_, forward_); }
  // Points nearer than NearDepth are projected as if they were on it: callers clip first, and a
  // stray point is never projected through infinity.
  Point2 Project(Vec3 point) const;
  // Screen space of hidden-line removal: x and y as Project, z growing with depth. Perspective
  // uses -distance / depth, which keeps straight lines and planes straight and flat.
  Vec3 ToScreen(Vec3 point) const;
  // The screen z of the plane Dot(normal, p) = offset as zx * x + zy * y + z0, for points in
  // front of the eye; nothing when the view sees the plane edge-on.
  std::optional<std::array<double, 3>> ScreenPlane(Vec3 normal, double offset) const;

 private:
  double ClampedDepth(Vec3 point) const;

  Vec3 eye_;
  Vec3 target_;
  Vec3 forward_;
  Vec3 right_;
  Vec3 up_;
  double distance_ = 0.0;  // eye to target
  double nearDepth_ = 0.0;
  bool perspective_ = false;
};

}  // namespace wb::draft
