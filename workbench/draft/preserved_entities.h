// Entities carried into a 2D drawing as they are: projected through the view, but neither cut,
// nor hidden, nor cleaned up.
#pragma once

#include <vector>

#include "workbench/draft/projection.h"
#include "workbench/draft/sheet.h"
#include "workbench/drawing.h"

namespace wb::draft {

// Adds the entities (solids' edges, lines and dimensions as strokes, texts and dimension
// values as labels) to the sheet as Preserved strokes on their own layers and colours.
void AddPreservedEntities(const Drawing& drawing, const std::vector<host::EntityHandle>& entities,
                          const ViewSpec& view, Sheet& sheet);

}  // namespace wb::draft
