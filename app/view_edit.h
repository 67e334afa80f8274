// Preparing a drawing from the command line: ticking views for 2D and adding cameras.
#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "workbench/drawing.h"

namespace app {

// Ticks (or unticks) views of the drawing open in the workbench. A view is named as a general
// camera's name, or "OWNER/CAMERA" for a camera of the section or plan OWNER (a general camera
// of the whole name first, then sections, then plans; names may hold '/' themselves). Throws
// std::runtime_error naming the first view not found; nothing is changed then.
void SetTicks(const std::vector<std::string>& views, bool tick);

struct NewCamera {
  std::string name;
  std::array<float, 3> eye{};
  std::array<float, 3> target{};
  bool perspective = false;
  bool flat = false;             // a 2D view
  std::int16_t displayMode = 0;  // 0 Geometric .. 10 Render
  std::array<double, 4> window{-10.0, -10.0, 10.0, 10.0};
  bool tick = true;
};

// Adds a general camera to the drawing open in the workbench; answers its index. Throws
// std::runtime_error for an empty name, an eye or target that is not finite, or an eye on the
// target.
std::int32_t AddCamera(const NewCamera& camera);

}  // namespace app
