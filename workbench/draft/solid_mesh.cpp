// The solid record: a vertex count and a triangle count, then the vertices as three floats and
// the triangles as three 32-bit indices, in the host's byte order like every other record.
#include "workbench/draft/solid_mesh.h"

#include <algorithm>
#include <cstring>

namespace wb::draft {

namespace {

struct MeshCounts {
  std::uint32_t vertices;
  std::uint32_t triangles;
};

constexpr std::size_t kVertexBytes = sizeof(host::Point3f);
constexpr std::size_t kTriangleBytes = 3 * sizeof(std::uint32_t);

template <typename Value>
void Append(std::vector<std::uint8_t>& bytes, const Value& value) {
  const auto* first = reinterpret_cast<const std::uint8_t*>(&value);
  bytes.insert(bytes.end(), first, first + sizeof(Value));
}

}  // namespace

void WriteSolidMesh(Entity& entity, const SolidMesh& mesh) {
  const MeshCounts counts{static_cast<std::uint32_t>(mesh.vertices.size()),
                          static_cast<std::uint32_t>(mesh.triangles.size())};
  std::vector<std::uint8_t> bytes;
  bytes.reserve(sizeof(counts) + counts.vertices * kVertexBytes + counts.triangles * kTriangleBytes);
  Append(bytes, counts);
  for (const host::Point3f& vertex : mesh.vertices) Append(bytes, vertex);
  for (const auto& triangle : mesh.triangles) Append(bytes, triangle);
  entity.record = std::move(bytes);
}

std::optional<SolidMesh> ReadSolidMesh(const Entity& entity) {
  const std::vector<std::uint8_t>& bytes = entity.record;
  MeshCounts counts{};
  if (bytes.size() < sizeof(counts)) return std::nullopt;
  std::memcpy(&counts, bytes.data(), sizeof(counts));
  // 64-bit sizes: counts near 2^32 cannot wrap into a size that happens to match.
  const std::uint64_t expected = sizeof(counts) + std::uint64_t{counts.vertices} * kVertexBytes +
                                 std::uint64_t{counts.triangles} * kTriangleBytes;
  if (expected != bytes.size()) return std::nullopt;

  SolidMesh mesh;
  mesh.vertices.resize(counts.vertices);
  mesh.triangles.resize(counts.triangles);
  const std::uint8_t* cursor = bytes.data() + sizeof(counts);
  if (counts.vertices > 0) std::memcpy(mesh.vertices.data(), cursor, counts.vertices * kVertexBytes);
  cursor += counts.vertices * kVertexBytes;
  if (counts.triangles > 0) std::memcpy(mesh.triangles.data(), cursor, counts.triangles * kTriangleBytes);
  const bool indicesInRange = std::all_of(mesh.triangles.begin(), mesh.triangles.end(), [&](const auto& triangle) {
    return std::all_of(triangle.begin(), triangle.end(), [&](std::uint32_t index) { return index < counts.vertices; });
  });
  if (!indicesInRange) return std::nullopt;
  return mesh;
}

SolidMesh MakeBox(host::Point3f corner, host::Point3f size) {
  // A negative size extends the box the other way; the lower corner keeps the faces outward.
  const float x0 = std::min(corner.x, corner.x + size.x);
  const float y0 = std::min(corner.y, corner.y + size.y);
  const float z0 = std::min(corner.z, corner.z + size.z);
  const float x1 = std::max(corner.x, corner.x + size.x);
  const float y1 = std::max(corner.y, corner.y + size.y);
  const float z1 = std::max(corner.z, corner.z + size.z);
  SolidMesh mesh;
  // Vertex i takes the far side of x, y and z where bit 0, 1 and 2 of i are set.
  for (std::uint32_t i = 0; i < 8; ++i) {
    mesh.vertices.push_back({(i & 1U) != 0 ? x1 : x0, (i & 2U) != 0 ? y1 : y0, (i & 4U) != 0 ? z1 : z0});
  }
  mesh.triangles = {{0, 2, 3}, {0, 3, 1},   // bottom
                    {4, 5, 7}, {4, 7, 6},   // top
                    {0, 1, 5}, {0, 5, 4},   // front (low y)
                    {2, 6, 7}, {2, 7, 3},   // back (high y)
                    {0, 4, 6}, {0, 6, 2},   // left (low x)
                    {1, 3, 7}, {1, 7, 5}};  // right (high x)
  return mesh;
}

}  // namespace wb::draft
