// The section and plan cuts of a view as clip planes.
#pragma once

#include <array>
#include <optional>

#include "shell/host/host_types.h"
#include "workbench/draft/half_space.h"

namespace wb::draft {

// How the faces a cut leaves are drawn: 'b' as cut lines in the solid's colour, 'w' as cut
// lines in colour 7, 'o' as ordinary edges. Any other value is taken as 'b'.
constexpr char kCutInSolidColor = 'b';
constexpr char kCutInForeground = 'w';
constexpr char kCutAsEdges = 'o';

// The vertical cut of a section: the plane through points 0, 1 and 2 (start, end and a point
// above the start). What lies on the side of point 3 (the side point) is kept and the rest
// dropped; a side point in the plane keeps the side the section's own side point would mark,
// left of the direction from start to end seen from above. Three collinear points give no
// plane, and the view is not cut.
struct SectionCut {
  std::array<host::Point3f, 4> points{};
  char cutType = kCutInSolidColor;
};

// The horizontal cut of a plan: what lies below base.z is kept.
struct PlanCut {
  host::Point3f base{};
  char cutType = kCutInSolidColor;
};

struct Cut {
  ClipPlane plane;
  char cutType = kCutInSolidColor;
};

// Clip plane bits: the section's, the plan's, and the perspective near plane's.
constexpr int kSectionBit = 0;
constexpr int kPlanBit = 1;
constexpr int kNearBit = 2;

std::optional<Cut> SectionCutPlane(const SectionCut& section);
std::optional<Cut> PlanCutPlane(const PlanCut& plan);

}  // namespace wb::draft
