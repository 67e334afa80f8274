// The plan extents of what a drawing shows: the window a "fit everything" zoom goes to.
#pragma once

#include <array>
#include <optional>

#include "workbench/drawing.h"

namespace wb {

// x min, y min, x max, y max over the visible lines and points on layers that are on; nullopt
// when nothing is shown. An extent without width or height is widened to one drawing unit
// about its middle, so a window built from it always has an area.
std::optional<std::array<double, 4>> PlanExtents(const Drawing& drawing);

}  // namespace wb
