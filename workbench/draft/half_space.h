// Cutting geometry by a plane: what lies on the kept side stays, and where the plane meets a
// solid becomes its section outline.
#pragma once

#include <optional>
#include <vector>

#include "workbench/draft/vec3.h"
#include "workbench/draft/welded_mesh.h"

namespace wb::draft {

// Keeps the points strictly in front of the plane: Dot(normal, p) > offset. A point within a
// rounding tolerance of the plane lies in it and counts as cut away, so a face lying exactly
// in the plane goes with the removed side and the section outline takes its place.
struct ClipPlane {
  Vec3 normal;  // unit length
  double offset = 0.0;
  int bit = 0;  // the plane's bit in WeldedMesh::onPlanes
};

// Signed distance from the plane, 0 within the rounding tolerance.
double PlaneDistance(const ClipPlane& plane, Vec3 point);

struct Segment3 {
  Vec3 a;
  Vec3 b;
};

// The kept part of the mesh. Cut triangles become fans over the points where their edges
// cross the plane; points in or on the plane are marked with the plane's bit.
WeldedMesh ClipMesh(const WeldedMesh& mesh, const ClipPlane& plane);

// The kept part of a segment, nothing when none is left.
std::optional<Segment3> ClipSegment(const Segment3& segment, const ClipPlane& plane);

// Where the plane meets the mesh: one segment per triangle with corners on both sides. For a
// closed mesh the segments bound the section region (even-odd).
std::vector<Segment3> SectionSegments(const WeldedMesh& mesh, const ClipPlane& plane);

// A planar region given by its even-odd boundary, cut by another plane: the kept boundary, and
// the closing segments along the line where the two planes meet that bound the kept region.
struct ClippedRegion {
  std::vector<Segment3> kept;
  std::vector<Segment3> closing;
};
ClippedRegion ClipRegion(const std::vector<Segment3>& boundary, Vec3 regionNormal, const ClipPlane& plane);

}  // namespace wb::draft
