// Hidden-line removal in screen space: which parts of an edge no face in front of it covers.
#pragma once

#include <array>
#include <cstdint>
#include <vector>

#include "workbench/draft/interval.h"
#include "workbench/draft/box_grid.h"
#include "workbench/draft/sheet.h"
#include "workbench/draft/vec3.h"

namespace wb::draft {

constexpr std::uint32_t kNoSolid = UINT32_MAX;

// Screen space is Projection::ToScreen's: x and y in the view plane, z growing with depth.

// A face triangle of a solid; `points` are its corners' indices in that solid's mesh.
struct ScreenTriangle {
  std::array<Vec3, 3> corners;
  std::uint32_t solid = kNoSolid;
  std::array<std::uint32_t, 3> points{};
};

// A flat face given by its boundary (even-odd) and its depth z = zx * x + zy * y + z0; the
// section faces of cut solids, which need not be convex or simply connected.
struct ScreenRegion {
  std::vector<std::array<Point2, 2>> boundary;
  double zx = 0.0;
  double zy = 0.0;
  double z0 = 0.0;
};

// An edge to draw. An edge of a solid names its end points' indices in that solid's mesh: the
// faces that hold it never hide it.
struct ScreenEdge {
  Vec3 a;
  Vec3 b;
  std::uint32_t solid = kNoSolid;
  std::uint32_t pointA = 0;
  std::uint32_t pointB = 0;
};

// How far apart things must be to count as apart: depths closer than depthAbsolute +
// depthRelative * |face z| are one (perspective z is -distance / depth, so the relative part
// is relative to the distance from the eye); flat tolerances are in view units, and widen
// faces so that a line behind two faces sharing an edge shows no gap there.
struct ScreenTolerance {
  double flat = 0.0;
  double depthAbsolute = 0.0;
  double depthRelative = 0.0;
};

class HiddenLines {
 public:
  HiddenLines(std::vector<ScreenTriangle> triangles, std::vector<ScreenRegion> regions, ScreenTolerance tolerance);

  // Per-caller working memory, so that several threads can share one HiddenLines.
  struct Scratch {
    std::vector<std::uint32_t> seen;  // per occluder, the query that last tested it
    std::uint32_t query = 0;
    std::vector<Interval> hidden;
  };
  Scratch MakeScratch() const;

  // The parts of the edge that nothing hides, as parameter ranges from a (0) to b (1), in order.
  // Parts shorter than the flat tolerance are dropped.
  std::vector<Interval> VisibleParts(const ScreenEdge& edge, Scratch& scratch) const;

 private:
  struct Triangle {
    // Barycentric coordinate i at (x, y) is a[i] * x + b[i] * y + c[i].
    std::array<double, 3> a, b, c;
    std::array<double, 3> slack;  // the flat tolerance in barycentric units
    std::array<double, 3> z;
    std::uint32_t solid;
    std::array<std::uint32_t, 3> points;
  };

  void AddTriangle(const ScreenTriangle& triangle, std::vector<Box2>& boxes);
  void AddRegion(ScreenRegion region, std::vector<Box2>& boxes);
  bool TriangleHides(const Triangle& triangle, const ScreenEdge& edge, Interval& hidden) const;
  void RegionHides(const ScreenRegion& region, const ScreenEdge& edge, std::vector<Interval>& hidden) const;
  // Narrows [from, to] to where the edge lies behind a face whose z runs linearly from zFrom to
  // zTo over it; false when no part does.
  bool Behind(const ScreenEdge& edge, double zFrom, double zTo, Interval& range) const;

  ScreenTolerance tolerance_;
  std::vector<Triangle> triangles_;
  std::vector<ScreenRegion> regions_;
  std::vector<double> nearestZ_;  // per occluder (triangles, then regions): its least z
  BoxGrid grid_;
};

}  // namespace wb::draft
