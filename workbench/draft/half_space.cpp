// Half-space clipping of meshes, segments and planar regions.
#include "workbench/draft/half_space.h"

#include <algorithm>
#include <cmath>
#include <map>
#include <utility>

namespace wb::draft {

namespace {

// Points this close to the plane, relative to their coordinates, lie in it: the drawing's
// coordinates are single precision, so a point meant to be in the plane is rarely exactly so.
constexpr double kPlaneTolerance = 1e-6;

bool Kept(double distance) { return distance > 0.0; }

// Where the segment from a (kept) to b (not kept) leaves the kept side; b itself when it lies
// in the plane, so that a crossing at a shared point gives the same point from every side.
Vec3 Crossing(Vec3 a, double distanceA, Vec3 b, double distanceB) {
  if (distanceB == 0.0) return b;
  return Lerp(a, b, distanceA / (distanceA - distanceB));
}

class MeshClipper {
 public:
  MeshClipper(const WeldedMesh& mesh, const ClipPlane& plane) : mesh_(mesh), plane_(plane) {
    distances_.reserve(mesh.points.size());
    result_.points = mesh.points;
    result_.onPlanes = mesh.onPlanes;
    const auto bit = static_cast<std::uint8_t>(1U << plane.bit);
    for (std::size_t i = 0; i < mesh.points.size(); ++i) {
      distances_.push_back(PlaneDistance(plane, mesh.points[i]));
      if (distances_.back() == 0.0) result_.onPlanes[i] |= bit;
    }
  }

  WeldedMesh Run() {
    for (std::size_t t = 0; t < mesh_.triangles.size(); ++t) ClipTriangle(t);
    return std::move(result_);
  }

 private:
  void ClipTriangle(std::size_t t) {
    const auto& corners = mesh_.triangles[t];
    const int keptCount = static_cast<int>(std::count_if(corners.begin(), corners.end(),
                                                         [&](std::uint32_t c) { return Kept(distances_[c]); }));
    if (keptCount == 0) return;
    if (keptCount == 3) {
      Emit(corners, t);
      return;
    }
    std::vector<std::uint32_t> polygon;
    for (std::size_t i = 0; i < 3; ++i) {
      const std::uint32_t from = corners[i];
      const std::uint32_t to = corners[(i + 1) % 3];
      if (Kept(distances_[from])) polygon.push_back(from);
      if (Kept(distances_[from]) != Kept(distances_[to])) polygon.push_back(CrossingPoint(from, to));
    }
    // A corner in the plane is reached from both of its edges.
    polygon.erase(std::unique(polygon.begin(), polygon.end()), polygon.end());
    if (polygon.size() > 1 && polygon.front() == polygon.back()) polygon.pop_back();
    for (std::size_t i = 1; i + 1 < polygon.size(); ++i) Emit({polygon[0], polygon[i], polygon[i + 1]}, t);
  }

  // One new point per crossed edge, computed from its lower index, so that both triangles on
  // the edge share it exactly.
  std::uint32_t CrossingPoint(std::uint32_t from, std::uint32_t to) {
    const std::uint32_t outside = Kept(distances_[from]) ? to : from;
    if (distances_[outside] == 0.0) return outside;
    const auto key = std::minmax(from, to);
    auto [found, inserted] = crossings_.try_emplace(key, static_cast<std::uint32_t>(result_.points.size()));
    if (inserted) {
      const auto [low, high] = key;
      result_.points.push_back(
          Lerp(mesh_.points[low], mesh_.points[high], distances_[low] / (distances_[low] - distances_[high])));
      result_.onPlanes.push_back(
          static_cast<std::uint8_t>((1U << plane_.bit) | (mesh_.onPlanes[low] & mesh_.onPlanes[high])));
    }
    return found->second;
  }

  void Emit(const std::array<std::uint32_t, 3>& corners, std::size_t parent) {
    result_.triangles.push_back(corners);
    result_.normals.push_back(mesh_.normals[parent]);
  }

  const WeldedMesh& mesh_;
  const ClipPlane& plane_;
  std::vector<double> distances_;
  std::map<std::pair<std::uint32_t, std::uint32_t>, std::uint32_t> crossings_;
  WeldedMesh result_;
};

}  // namespace

double PlaneDistance(const ClipPlane& plane, Vec3 point) {
  const double distance = Dot(plane.normal, point) - plane.offset;
  const double tolerance = kPlaneTolerance * std::fmax(1.0, std::fmax(MaxAbs(point), std::fabs(plane.offset)));
  return std::fabs(distance) <= tolerance ? 0.0 : distance;
}

WeldedMesh ClipMesh(const WeldedMesh& mesh, const ClipPlane& plane) { return MeshClipper(mesh, plane).Run(); }

std::optional<Segment3> ClipSegment(const Segment3& segment, const ClipPlane& plane) {
  const double da = PlaneDistance(plane, segment.a);
  const double db = PlaneDistance(plane, segment.b);
  if (Kept(da) && Kept(db)) return segment;
  if (Kept(da)) return Segment3{segment.a, Crossing(segment.a, da, segment.b, db)};
  if (Kept(db)) return Segment3{Crossing(segment.b, db, segment.a, da), segment.b};
  return std::nullopt;
}

std::vector<Segment3> SectionSegments(const WeldedMesh& mesh, const ClipPlane& plane) {
  std::vector<double> distances;
  distances.reserve(mesh.points.size());
  for (const Vec3& point : mesh.points) distances.push_back(PlaneDistance(plane, point));
  std::vector<Segment3> segments;
  for (const auto& corners : mesh.triangles) {
    std::vector<Vec3> ends;
    for (std::size_t i = 0; i < 3; ++i) {
      std::uint32_t from = corners[i];
      std::uint32_t to = corners[(i + 1) % 3];
      if (Kept(distances[from]) == Kept(distances[to])) continue;
      if (!Kept(distances[from])) std::swap(from, to);
      // From the lower index, as ClipMesh does, so both triangles on an edge agree exactly.
      const Vec3 crossing = distances[to] == 0.0 ? mesh.points[to]
                            : from < to ? Crossing(mesh.points[from], distances[from], mesh.points[to], distances[to])
                                        : Crossing(mesh.points[to], distances[to], mesh.points[from], distances[from]);
      ends.push_back(crossing);
    }
    if (ends.size() == 2 && !(ends[0] == ends[1])) segments.push_back({ends[0], ends[1]});
  }
  return segments;
}

ClippedRegion ClipRegion(const std::vector<Segment3>& boundary, Vec3 regionNormal, const ClipPlane& plane) {
  ClippedRegion region;
  // Where the boundary crosses the plane, ordered along the line both planes share; inside the
  // region and outside alternate between consecutive crossings.
  const Vec3 along = Cross(regionNormal, plane.normal);
  std::vector<std::pair<double, Vec3>> crossings;
  for (const Segment3& segment : boundary) {
    const double da = PlaneDistance(plane, segment.a);
    const double db = PlaneDistance(plane, segment.b);
    if (auto kept = ClipSegment(segment, plane)) region.kept.push_back(*kept);
    if (Kept(da) == Kept(db)) continue;
    const Vec3 crossing = Kept(da) ? Crossing(segment.a, da, segment.b, db) : Crossing(segment.b, db, segment.a, da);
    crossings.emplace_back(Dot(crossing, along), crossing);
  }
  std::sort(crossings.begin(), crossings.end(), [](const auto& x, const auto& y) { return x.first < y.first; });
  for (std::size_t i = 0; i + 1 < crossings.size(); i += 2) {
    if (!(crossings[i].second == crossings[i + 1].second)) {
      region.closing.push_back({crossings[i].second, crossings[i + 1].second});
    }
  }
  return region;
}

}  // namespace wb::draft
