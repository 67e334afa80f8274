// A solid's triangles over shared points, the form cutting and edge finding work on.
#pragma once

#include <array>
#include <cstdint>
#include <vector>

#include "workbench/draft/solid_mesh.h"
#include "workbench/draft/vec3.h"

namespace wb::draft {

struct WeldedMesh {
  std::vector<Vec3> points;
  // Bit k set: the point lies in clip plane k (see half_space.h).
  std::vector<std::uint8_t> onPlanes;
  std::vector<std::array<std::uint32_t, 3>> triangles;
  // Unit normal per triangle. Pieces of a cut triangle keep their parent's, so a thin sliver
  // left by a cut never turns a flat face into a crease.
  std::vector<Vec3> normals;
};

// Vertices at the same position become one point, so neighbouring triangles share edges even
// when the record repeats vertices. Triangles with a non-finite corner, a repeated corner or no
// area are left out.
WeldedMesh Weld(const SolidMesh& mesh);

// Every edge is shared by an even number of triangles: the mesh bounds a volume.
bool IsClosed(const WeldedMesh& mesh);

struct MeshEdge {
  std::uint32_t a = 0;
  std::uint32_t b = 0;
};

// The edges a drawing shows: boundary edges, edges between faces that are not coplanar, folds
// and edges of more than two faces. A boundary edge lying in a clip plane is left out: it is
// where a cut opened the mesh, and the cut outline draws it.
std::vector<MeshEdge> FeatureEdges(const WeldedMesh& mesh);

}  // namespace wb::draft
