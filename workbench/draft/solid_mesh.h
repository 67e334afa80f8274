// Solids (walls, slabs, roofs, stairs) are host entities of type 9 whose record holds a closed
// triangle mesh. These functions write and read that record.
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <vector>

#include "shell/host/host_types.h"
#include "workbench/drawing.h"

namespace wb::draft {

struct SolidMesh {
  std::vector<host::Point3f> vertices;
  std::vector<std::array<std::uint32_t, 3>> triangles;  // counter-clockwise seen from outside
  bool operator==(const SolidMesh&) const = default;
};

// Stores the mesh as the entity's record (the entity should be of type 9).
void WriteSolidMesh(Entity& entity, const SolidMesh& mesh);
// The mesh of a solid entity; nothing when the record is no well-formed mesh (wrong size,
// indices out of range).
std::optional<SolidMesh> ReadSolidMesh(const Entity& entity);

// A box from its lower corner and size, as 12 triangles.
SolidMesh MakeBox(host::Point3f corner, host::Point3f size);

}  // namespace wb::draft
