// Prism meshes: two fan-triangulated caps and a quad of two triangles per side.
#include "samples/solid_shapes.h"

#include <cstdint>

namespace samples {
namespace {

host::Point3f Add(host::Point3f a, host::Point3f b) { return {a.x + b.x, a.y + b.y, a.z + b.z}; }
host::Point3f Sub(host::Point3f a, host::Point3f b) { return {a.x - b.x, a.y - b.y, a.z - b.z}; }
host::Point3f Cross(host::Point3f a, host::Point3f b) {
  return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
}
float Dot(host::Point3f a, host::Point3f b) { return a.x * b.x + a.y * b.y + a.z * b.z; }

}  // namespace

wb::draft::SolidMesh SweptPrism(const std::vector<host::Point3f>& face, host::Point3f sweep) {
  wb::draft::SolidMesh mesh;
  const auto n = static_cast<std::uint32_t>(face.size());
  if (n < 3) return mesh;
  // Orient the base so that its normal points away from the sweep: then the base faces out.
  std::vector<host::Point3f> base = face;
  if (Dot(Cross(Sub(base[1], base[0]), Sub(base[2], base[0])), sweep) > 0.0F) {
    base.assign(face.rbegin(), face.rend());
  }
  for (const host::Point3f& p : base) mesh.vertices.push_back(p);
  for (const host::Point3f& p : base) mesh.vertices.push_back(Add(p, sweep));
  for (std::uint32_t i = 1; i + 1 < n; ++i) {
    mesh.triangles.push_back({0, i, i + 1});              // base, facing away from the sweep
    mesh.triangles.push_back({n, n + i + 1, n + i});      // top, facing along it
  }
  for (std::uint32_t i = 0; i < n; ++i) {
    const std::uint32_t j = (i + 1) % n;
    mesh.triangles.push_back({i, n + i, n + j});
    mesh.triangles.push_back({i, n + j, j});
  }
  return mesh;
}

wb::draft::SolidMesh Block(float x, float y, float z, float sizeX, float sizeY, float sizeZ) {
  return SweptPrism({{x, y, z}, {x + sizeX, y, z}, {x + sizeX, y + sizeY, z}, {x, y + sizeY, z}}, {0.0F, 0.0F, sizeZ});
}

}  // namespace samples
