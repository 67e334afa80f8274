// Solid records: meshes survive the round trip, damaged records are refused, boxes face out.
#include <gtest/gtest.h>

#include <cstring>
#include <optional>

#include "workbench/draft/solid_mesh.h"
#include "workbench/draft/vec3.h"

namespace {

using wb::draft::MakeBox;
using wb::draft::ReadSolidMesh;
using wb::draft::SolidMesh;
using wb::draft::WriteSolidMesh;

// Point3f has no comparison of its own.
bool SameMesh(const std::optional<SolidMesh>& read, const SolidMesh& written) {
  if (!read || read->triangles != written.triangles || read->vertices.size() != written.vertices.size()) return false;
  for (std::size_t i = 0; i < written.vertices.size(); ++i) {
    const host::Point3f& p = read->vertices[i];
    const host::Point3f& q = written.vertices[i];
    if (p.x != q.x || p.y != q.y || p.z != q.z) return false;
  }
  return true;
}

TEST(SolidMeshRecord, MeshesSurviveTheRoundTrip) {
  wb::Entity entity;
  const SolidMesh mesh{{{0, 0, 0}, {1, 0, 0}, {0, 1, 0}, {0, 0, 1}}, {{0, 2, 1}, {0, 1, 3}, {0, 3, 2}, {1, 2, 3}}};
  WriteSolidMesh(entity, mesh);
  EXPECT_EQ(entity.record.size(), 8U + 4 * 12 + 4 * 12);
  EXPECT_TRUE(SameMesh(ReadSolidMesh(entity), mesh));
  WriteSolidMesh(entity, SolidMesh{});
  EXPECT_TRUE(SameMesh(ReadSolidMesh(entity), SolidMesh{}));
}

TEST(SolidMeshRecord, DamagedRecordsAreRefused) {
  wb::Entity entity;
  WriteSolidMesh(entity, MakeBox({0, 0, 0}, {1, 1, 1}));
  const std::vector<std::uint8_t> good = entity.record;

  entity.record.pop_back();  // one byte short
  EXPECT_FALSE(ReadSolidMesh(entity));
  entity.record = good;
  entity.record.push_back(0);  // one byte over
  EXPECT_FALSE(ReadSolidMesh(entity));
  entity.record = {1, 2, 3};  // shorter than the counts
  EXPECT_FALSE(ReadSolidMesh(entity));

  entity.record = good;
  const std::uint32_t outOfRange = 8;  // the box has vertices 0 to 7
  std::memcpy(entity.record.data() + good.size() - 4, &outOfRange, 4);
  EXPECT_FALSE(ReadSolidMesh(entity));

  // Counts whose byte size, taken modulo 2^32, equals the record's: 12 * 2^30 wraps to 0.
  entity.record = good;
  ASSERT_EQ(good.size(), 8U + 12U * 20U);
  const std::uint32_t huge[2] = {0x40000000U, 20U};
  std::memcpy(entity.record.data(), huge, sizeof(huge));
  EXPECT_FALSE(ReadSolidMesh(entity));
}

TEST(SolidMeshBox, TrianglesFaceOutwardsWhateverTheSignOfTheSize) {
  for (const host::Point3f size : {host::Point3f{2, 3, 4}, host::Point3f{-2, 3, -4}}) {
    const SolidMesh box = MakeBox({1, 1, 1}, size);
    ASSERT_EQ(box.vertices.size(), 8U);
    ASSERT_EQ(box.triangles.size(), 12U);
    const wb::draft::Vec3 centre{1 + size.x / 2.0, 1 + size.y / 2.0, 1 + size.z / 2.0};
    double area = 0.0;
    for (const auto& t : box.triangles) {
      const auto p0 = wb::draft::Widen(box.vertices[t[0]]);
      const auto normal = wb::draft::Cross(wb::draft::Widen(box.vertices[t[1]]) - p0, wb::draft::Widen(box.vertices[t[2]]) - p0);
      EXPECT_GT(wb::draft::Dot(normal, p0 - centre), 0.0);
      area += wb::draft::Length(normal) / 2.0;
    }
    EXPECT_DOUBLE_EQ(area, 2.0 * (2 * 3 + 3 * 4 + 2 * 4));
  }
}

}  // namespace
