// Planes of the section and plan cuts, with their kept sides.
#include "workbench/draft/cut_planes.h"

namespace wb::draft {

namespace {

// Below this length of the cross product, relative to the points' spread, the three points
// are taken as collinear.
constexpr double kCollinearFraction = 1e-9;

}  // namespace

std::optional<Cut> SectionCutPlane(const SectionCut& section) {
  std::array<Vec3, 4> p{};
  for (std::size_t i = 0; i < p.size(); ++i) {
    p[i] = Widen(section.points[i]);
    if (!IsFinite(p[i])) return std::nullopt;
  }
  const Vec3 along = p[1] - p[0];
  const Vec3 up = p[2] - p[0];
  // Up across along points to the left of the section line, where its own side point lies.
  const Vec3 normal = Cross(up, along);
  const double length = Length(normal);
  if (!(length > kCollinearFraction * Length(along) * Length(up))) return std::nullopt;
  Cut cut;
  cut.plane.normal = normal * (1.0 / length);
  cut.plane.offset = Dot(cut.plane.normal, p[0]);
  cut.plane.bit = kSectionBit;
  if (PlaneDistance(cut.plane, p[3]) < 0.0) {
    cut.plane.normal = cut.plane.normal * -1.0;
    cut.plane.offset = -cut.plane.offset;
  }
  cut.cutType = section.cutType;
  return cut;
}

std::optional<Cut> PlanCutPlane(const PlanCut& plan) {
  if (!std::isfinite(plan.base.z)) return std::nullopt;
  Cut cut;
  cut.plane = {{0.0, 0.0, -1.0}, -static_cast<double>(plan.base.z), kPlanBit};
  cut.cutType = plan.cutType;
  return cut;
}

}  // namespace wb::draft
