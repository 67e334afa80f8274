// Closed triangle meshes for the sample models: convex prisms made by sweeping a face.
#pragma once

#include <vector>

#include "shell/host/host_types.h"
#include "workbench/draft/solid_mesh.h"

namespace samples {

// Sweeps a convex planar face (its corners in order) along `sweep`; the result is closed and
// its triangles face outwards whichever way the corners turn.
wb::draft::SolidMesh SweptPrism(const std::vector<host::Point3f>& face, host::Point3f sweep);

// An axis-aligned box from its lower corner and its size.
wb::draft::SolidMesh Block(float x, float y, float z, float sizeX, float sizeY, float sizeZ);

}  // namespace samples
