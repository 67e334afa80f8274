// The 2D drawing of a view: what the host's 2D model commands produce before clean-up and clip.
#pragma once

#include <optional>

#include "workbench/draft/cut_planes.h"
#include "workbench/draft/projection.h"
#include "workbench/draft/sheet.h"
#include "workbench/drawing.h"

namespace wb::draft {

struct GenerateOptions {
  ViewSpec view;
  bool hideHiddenLines = false;  // the solid display modes
  std::optional<SectionCut> section;
  std::optional<PlanCut> plan;
};

// Draws every shown entity (not hidden, on a layer that is on): the edges of solids and the
// lines that are not texts, each on its entity's layer and in its colour (colour 0, which no
// stroke can carry, draws in 7). Cuts drop what they cut away and draw their section faces;
// with hidden lines removed, only what no solid face or section face covers is drawn.
// Strokes are in view coordinates (see Projection).
Sheet GenerateSheet(const Drawing& drawing, const GenerateOptions& options);

}  // namespace wb::draft
