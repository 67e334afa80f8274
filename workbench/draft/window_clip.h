// Clipping a 2D drawing to a window.
#pragma once

#include "workbench/draft/sheet.h"

namespace wb::draft {

// Cuts strokes at the window's edges and drops what lies outside; labels are kept when their
// anchor lies inside. Corners given the wrong way round are put in order. A window that is not
// finite clips nothing; strokes with coordinates that are not finite are dropped.
void ClipToWindow(Sheet& sheet, const Box2& window);

}  // namespace wb::draft
