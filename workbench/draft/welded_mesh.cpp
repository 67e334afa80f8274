// Welding, closedness and feature edges of solid meshes.
#include "workbench/draft/welded_mesh.h"

#include <algorithm>
#include <cmath>

namespace wb::draft {

namespace {

// Sine of the angle below which three corners count as collinear.
constexpr double kDegenerateSine = 1e-12;
// Faces whose normals differ by less than this angle (radians) count as coplanar.
constexpr double kCoplanarAngle = 1e-4;

struct EdgeUse {
  std::uint32_t low;
  std::uint32_t high;
  std::uint32_t triangle;
  bool operator<(const EdgeUse& other) const {
    return low != other.low ? low < other.low : high != other.high ? high < other.high : triangle < other.triangle;
  }
};

std::vector<EdgeUse> SortedEdgeUses(const WeldedMesh& mesh) {
  std::vector<EdgeUse> uses;
  uses.reserve(mesh.triangles.size() * 3);
  for (std::uint32_t t = 0; t < mesh.triangles.size(); ++t) {
    const auto& corners = mesh.triangles[t];
    for (std::size_t i = 0; i < 3; ++i) {
      const std::uint32_t a = corners[i];
      const std::uint32_t b = corners[(i + 1) % 3];
      uses.push_back({std::min(a, b), std::max(a, b), t});
    }
  }
  std::sort(uses.begin(), uses.end());
  return uses;
}

// Calls `visit` with each run of uses of one edge.
template <typename Visit>
void ForEachEdge(const std::vector<EdgeUse>& uses, Visit visit) {
  for (std::size_t first = 0; first < uses.size();) {
    std::size_t last = first + 1;
    while (last < uses.size() && uses[last].low == uses[first].low && uses[last].high == uses[first].high) ++last;
    visit(first, last);
    first = last;
  }
}

std::uint32_t ThirdCorner(const std::array<std::uint32_t, 3>& corners, std::uint32_t a, std::uint32_t b) {
  for (std::uint32_t corner : corners) {
    if (corner != a && corner != b) return corner;
  }
  return a;
}

// Two faces on one edge draw no line when they are coplanar and lie on opposite sides of it;
// coplanar faces on the same side are a fold, which does.
bool SmoothJoin(const WeldedMesh& mesh, const EdgeUse& first, const EdgeUse& second) {
  const Vec3 n1 = mesh.normals[first.triangle];
  const Vec3 n2 = mesh.normals[second.triangle];
  if (std::fabs(Dot(n1, n2)) < std::cos(kCoplanarAngle)) return false;
  const Vec3 a = mesh.points[first.low];
  const Vec3 along = mesh.points[first.high] - a;
  const Vec3 out1 = mesh.points[ThirdCorner(mesh.triangles[first.triangle], first.low, first.high)] - a;
  const Vec3 out2 = mesh.points[ThirdCorner(mesh.triangles[second.triangle], first.low, first.high)] - a;
  return Dot(Cross(along, out1), n1) * Dot(Cross(along, out2), n1) < 0.0;
}

}  // namespace

WeldedMesh Weld(const SolidMesh& mesh) {
  WeldedMesh welded;
  // Sorting the vertex indices by position puts equal positions next to each other.
  std::vector<std::uint32_t> order;
  for (std::uint32_t i = 0; i < mesh.vertices.size(); ++i) {
    if (IsFinite(Widen(mesh.vertices[i]))) order.push_back(i);
  }
  const auto position = [&](std::uint32_t i) {
    const host::Point3f& p = mesh.vertices[i];
    return std::array<float, 3>{p.x, p.y, p.z};
  };
  std::sort(order.begin(), order.end(), [&](std::uint32_t a, std::uint32_t b) { return position(a) < position(b); });
  constexpr std::uint32_t kMissing = UINT32_MAX;
  std::vector<std::uint32_t> pointOf(mesh.vertices.size(), kMissing);
  for (std::size_t k = 0; k < order.size(); ++k) {
    if (k == 0 || position(order[k]) != position(order[k - 1])) welded.points.push_back(Widen(mesh.vertices[order[k]]));
    pointOf[order[k]] = static_cast<std::uint32_t>(welded.points.size() - 1);
  }
  welded.onPlanes.assign(welded.points.size(), 0);

  for (const auto& triangle : mesh.triangles) {
    std::array<std::uint32_t, 3> corners{};
    bool usable = true;
    for (std::size_t i = 0; i < 3; ++i) {
      corners[i] = triangle[i] < pointOf.size() ? pointOf[triangle[i]] : kMissing;
      usable = usable && corners[i] != kMissing;
    }
    if (!usable || corners[0] == corners[1] || corners[1] == corners[2] || corners[0] == corners[2]) continue;
    const Vec3 u = welded.points[corners[1]] - welded.points[corners[0]];
    const Vec3 v = welded.points[corners[2]] - welded.points[corners[0]];
    const Vec3 normal = Cross(u, v);
    const double area = Length(normal);
    if (!(area > kDegenerateSine * Length(u) * Length(v))) continue;
    welded.triangles.push_back(corners);
    welded.normals.push_back(normal * (1.0 / area));
  }
  return welded;
}

bool IsClosed(const WeldedMesh& mesh) {
  bool closed = !mesh.triangles.empty();
  ForEachEdge(SortedEdgeUses(mesh), [&](std::size_t first, std::size_t last) { closed = closed && (last - first) % 2 == 0; });
  return closed;
}

std::vector<MeshEdge> FeatureEdges(const WeldedMesh& mesh) {
  std::vector<MeshEdge> edges;
  const std::vector<EdgeUse> uses = SortedEdgeUses(mesh);
  ForEachEdge(uses, [&](std::size_t first, std::size_t last) {
    const EdgeUse& use = uses[first];
    const std::size_t count = last - first;
    if (count == 1 && (mesh.onPlanes[use.low] & mesh.onPlanes[use.high]) != 0) return;
    if (count == 2 && SmoothJoin(mesh, use, uses[first + 1])) return;
    edges.push_back({use.low, use.high});
  });
  return edges;
}

}  // namespace wb::draft
