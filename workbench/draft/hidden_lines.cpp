// Edge against triangle and edge against region, over the candidates the grid finds.
#include "workbench/draft/hidden_lines.h"

#include <algorithm>
#include <cmath>

namespace wb::draft {

namespace {

double Cross2(double ax, double ay, double bx, double by) { return ax * by - ay * bx; }

void Include(Box2& box, double x, double y) {
  box.min = {std::min(box.min.x, x), std::min(box.min.y, y)};
  box.max = {std::max(box.max.x, x), std::max(box.max.y, y)};
}

Box2 Widened(Box2 box, double margin) {
  return {{box.min.x - margin, box.min.y - margin}, {box.max.x + margin, box.max.y + margin}};
}

// Narrows `range` to where value + t * slope >= 0.
bool KeepNonNegative(double value, double slope, Interval& range) {
  if (slope > 0.0) {
    range.from = std::max(range.from, -value / slope);
  } else if (slope < 0.0) {
    range.to = std::min(range.to, -value / slope);
  } else if (value < 0.0) {
    return false;
  }
  return range.from < range.to;
}

}  // namespace

HiddenLines::HiddenLines(std::vector<ScreenTriangle> triangles, std::vector<ScreenRegion> regions,
                         ScreenTolerance tolerance)
    : tolerance_(tolerance) {
  std::vector<Box2> boxes;
  triangles_.reserve(triangles.size());
  for (const ScreenTriangle& triangle : triangles) AddTriangle(triangle, boxes);
  for (ScreenRegion& region : regions) AddRegion(std::move(region), boxes);
  grid_ = BoxGrid(boxes);
}

void HiddenLines::AddTriangle(const ScreenTriangle& triangle, std::vector<Box2>& boxes) {
  const auto& p = triangle.corners;
  const double area2 = Cross2(p[1].x - p[0].x, p[1].y - p[0].y, p[2].x - p[0].x, p[2].y - p[0].y);
  double longest = 0.0;
  for (std::size_t i = 0; i < 3; ++i) {
    const Vec3& from = p[i];
    const Vec3& to = p[(i + 1) % 3];
    longest = std::max(longest, std::hypot(to.x - from.x, to.y - from.y));
  }
  // A face seen edge-on, thinner than the tolerance, covers nothing.
  if (!(std::fabs(area2) > tolerance_.flat * longest)) return;
  Triangle prepared{};
  for (std::size_t i = 0; i < 3; ++i) {
    // Coordinate i is the signed area over the edge opposite corner i, over the whole area.
    const Vec3& from = p[(i + 1) % 3];
    const Vec3& to = p[(i + 2) % 3];
    const double ex = to.x - from.x;
    const double ey = to.y - from.y;
    prepared.a[i] = -ey / area2;
    prepared.b[i] = ex / area2;
    prepared.c[i] = (ey * from.x - ex * from.y) / area2;
    prepared.slack[i] = tolerance_.flat * std::hypot(ex, ey) / std::fabs(area2);
    prepared.z[i] = p[i].z;
  }
  prepared.solid = triangle.solid;
  prepared.points = triangle.points;
  triangles_.push_back(prepared);
  nearestZ_.push_back(std::min({p[0].z, p[1].z, p[2].z}));
  Box2 box{{p[0].x, p[0].y}, {p[0].x, p[0].y}};
  for (const Vec3& corner : p) Include(box, corner.x, corner.y);
  boxes.push_back(Widened(box, tolerance_.flat));
}

void HiddenLines::AddRegion(ScreenRegion region, std::vector<Box2>& boxes) {
  if (region.boundary.empty()) return;
  const Point2 first = region.boundary.front()[0];
  Box2 box{first, first};
  double nearest = HUGE_VAL;
  for (const auto& segment : region.boundary) {
    for (const Point2& point : segment) {
      Include(box, point.x, point.y);
      nearest = std::min(nearest, region.zx * point.x + region.zy * point.y + region.z0);
    }
  }
  regions_.push_back(std::move(region));
  nearestZ_.push_back(nearest);
  boxes.push_back(Widened(box, tolerance_.flat));
}

HiddenLines::Scratch HiddenLines::MakeScratch() const {
  Scratch scratch;
  scratch.seen.assign(triangles_.size() + regions_.size(), 0);
  return scratch;
}

bool HiddenLines::Behind(const ScreenEdge& edge, double zFrom, double zTo, Interval& range) const {
  // How far the edge lies behind the face at each end of the range, and how far counts as apart.
  const double behindFrom = edge.a.z + range.from * (edge.b.z - edge.a.z) - zFrom;
  const double behindTo = edge.a.z + range.to * (edge.b.z - edge.a.z) - zTo;
  const double slackFrom = tolerance_.depthAbsolute + tolerance_.depthRelative * std::fabs(zFrom);
  const double slackTo = tolerance_.depthAbsolute + tolerance_.depthRelative * std::fabs(zTo);
  const bool fromBehind = behindFrom > slackFrom;
  const bool toBehind = behindTo > slackTo;
  if (fromBehind == toBehind) return fromBehind;
  // The edge goes behind the face. An end that touches it (a corner on the face, an edge
  // meeting another solid) hides with the rest rather than leave a sliver as long as the
  // tolerance; an end truly in front keeps the part up to where the edge passes the face.
  const bool touches = fromBehind ? behindTo >= -slackTo : behindFrom >= -slackFrom;
  if (touches) return true;
  const double cross = range.from + (range.to - range.from) * behindFrom / (behindFrom - behindTo);
  if (fromBehind) {
    range.to = cross;
  } else {
    range.from = cross;
  }
  return range.from < range.to;
}

bool HiddenLines::TriangleHides(const Triangle& triangle, const ScreenEdge& edge, Interval& hidden) const {
  if (triangle.solid == edge.solid && edge.solid != kNoSolid) {
    const auto holds = [&](std::uint32_t point) {
      return std::find(triangle.points.begin(), triangle.points.end(), point) != triangle.points.end();
    };
    if (holds(edge.pointA) && holds(edge.pointB)) return false;
  }
  std::array<double, 3> atA{};
  std::array<double, 3> atB{};
  Interval range{0.0, 1.0};
  for (std::size_t i = 0; i < 3; ++i) {
    atA[i] = triangle.a[i] * edge.a.x + triangle.b[i] * edge.a.y + triangle.c[i];
    atB[i] = triangle.a[i] * edge.b.x + triangle.b[i] * edge.b.y + triangle.c[i];
    if (!KeepNonNegative(atA[i] + triangle.slack[i], atB[i] - atA[i], range)) return false;
  }
  const auto faceZ = [&](double t) {
    double z = 0.0;
    for (std::size_t i = 0; i < 3; ++i) z += (atA[i] + t * (atB[i] - atA[i])) * triangle.z[i];
    return z;
  };
  if (!Behind(edge, faceZ(range.from), faceZ(range.to), range)) return false;
  hidden = range;
  return true;
}

void HiddenLines::RegionHides(const ScreenRegion& region, const ScreenEdge& edge, std::vector<Interval>& hidden) const {
  const double dx = edge.b.x - edge.a.x;
  const double dy = edge.b.y - edge.a.y;
  const double lengthSquared = dx * dx + dy * dy;
  const double length = std::sqrt(lengthSquared);
  const auto parameterOf = [&](Point2 p) { return ((p.x - edge.a.x) * dx + (p.y - edge.a.y) * dy) / lengthSquared; };
  // Crossings of the boundary with the edge's line; a boundary point on the line counts as
  // below it, so a line through a corner crosses twice or not at all and the parity holds.
  std::vector<double> crossings;
  std::vector<Interval> inside;
  bool insideAtA = false;
  for (const auto& [p, q] : region.boundary) {
    const double sideP = Cross2(dx, dy, p.x - edge.a.x, p.y - edge.a.y);
    const double sideQ = Cross2(dx, dy, q.x - edge.a.x, q.y - edge.a.y);
    // Like a triangle's, the region takes in its boundary: an edge along it counts as inside.
    if (std::fabs(sideP) <= tolerance_.flat * length && std::fabs(sideQ) <= tolerance_.flat * length) {
      const double tp = parameterOf(p);
      const double tq = parameterOf(q);
      const Interval along{std::max(std::min(tp, tq), 0.0), std::min(std::max(tp, tq), 1.0)};
      if (along.from < along.to) inside.push_back(along);
    }
    if ((sideP > 0.0) == (sideQ > 0.0)) continue;
    const double u = sideP / (sideP - sideQ);
    const double t = parameterOf({p.x + u * (q.x - p.x), p.y + u * (q.y - p.y)});
    if (t <= 0.0) continue;
    insideAtA = !insideAtA;  // an odd count of crossings beyond a puts a inside
    if (t < 1.0) crossings.push_back(t);
  }
  std::sort(crossings.begin(), crossings.end());
  crossings.push_back(1.0);
  bool parityInside = insideAtA;
  double from = 0.0;
  for (double to : crossings) {
    if (parityInside && from < to) inside.push_back({from, to});
    parityInside = !parityInside;
    from = to;
  }
  std::sort(inside.begin(), inside.end(), [](const Interval& x, const Interval& y) { return x.from < y.from; });
  const auto faceZ = [&](double t) { return region.zx * (edge.a.x + t * dx) + region.zy * (edge.a.y + t * dy) + region.z0; };
  for (std::size_t i = 0; i < inside.size();) {
    Interval range = inside[i];
    for (++i; i < inside.size() && inside[i].from <= range.to; ++i) range.to = std::max(range.to, inside[i].to);
    if (Behind(edge, faceZ(range.from), faceZ(range.to), range)) hidden.push_back(range);
  }
}

std::vector<Interval> HiddenLines::VisibleParts(const ScreenEdge& edge, Scratch& scratch) const {
  const double length = std::hypot(edge.b.x - edge.a.x, edge.b.y - edge.a.y);
  if (!(length > tolerance_.flat)) return {};
  if (++scratch.query == 0) {  // wrapped: forget every mark
    std::fill(scratch.seen.begin(), scratch.seen.end(), 0);
    scratch.query = 1;
  }
  std::vector<Interval>& hidden = scratch.hidden;
  hidden.clear();
  const double farthest = std::max(edge.a.z, edge.b.z);
  // Only an occluder reaching nearer than the edge's far end can hide any of it.
  const auto canHide = [&](std::size_t index) { return farthest - nearestZ_[index] > tolerance_.depthAbsolute; };

  grid_.ForEachAlong({edge.a.x, edge.a.y}, {edge.b.x, edge.b.y}, tolerance_.flat, [&](std::uint32_t index) {
    if (scratch.seen[index] == scratch.query) return true;
    scratch.seen[index] = scratch.query;
    if (!canHide(index)) return true;
    if (index >= triangles_.size()) {
      RegionHides(regions_[index - triangles_.size()], edge, hidden);
      return true;
    }
    Interval range;
    if (!TriangleHides(triangles_[index], edge, range)) return true;
    hidden.push_back(range);
    return !(range.from <= 0.0 && range.to >= 1.0);
  });

  std::sort(hidden.begin(), hidden.end(), [](const Interval& x, const Interval& y) { return x.from < y.from; });
  const double shortest = tolerance_.flat / length;
  std::vector<Interval> visible;
  double from = 0.0;
  for (const Interval& range : hidden) {
    if (range.from - from > shortest) visible.push_back({from, range.from});
    from = std::max(from, range.to);
  }
  if (1.0 - from > shortest) visible.push_back({from, 1.0});
  return visible;
}

}  // namespace wb::draft
