// The faces cuts leave on a solid: where each cut plane meets it, inside the other cuts.
#pragma once

#include <cstddef>
#include <vector>

#include "workbench/draft/cut_planes.h"
#include "workbench/draft/half_space.h"
#include "workbench/draft/welded_mesh.h"

namespace wb::draft {

struct SectionFace {
  std::size_t cut = 0;  // index into the cuts
  // The face's whole boundary (even-odd), to hide what lies behind it.
  std::vector<Segment3> boundary;
  // The lines the face draws: its boundary, less the corner it shares with a face of an
  // earlier cut, which that face draws.
  std::vector<Segment3> outline;
};

// One face per cut that meets the mesh, computed on the uncut mesh so that each face is whole
// before the other cuts trim it.
std::vector<SectionFace> SectionFaces(const WeldedMesh& mesh, const std::vector<Cut>& cuts);

// The part of a face in front of another plane (the perspective near plane): its boundary
// closed along that plane again, so it still bounds a region.
std::vector<Segment3> ClipFaceBoundary(const std::vector<Segment3>& boundary, const Cut& face, const ClipPlane& plane);

}  // namespace wb::draft
