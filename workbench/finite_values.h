// Checks of values handed over in the argument blocks: the host refuses what it cannot draw
// rather than carry a NaN or an infinity into its view.
#pragma once

#include <cmath>

#include "shell/host/host_types.h"

namespace wb {

inline bool IsFinite(const host::Point3f& point) {
  return std::isfinite(point.x) && std::isfinite(point.y) && std::isfinite(point.z);
}

}  // namespace wb
