// Recognising the host's display mode from its state and switching to any of the eleven modes.
#pragma once

#include <cstdint>

namespace HRUtility {

enum DisplayMode : std::int16_t {
  kGeometric = 0,
  kWireframe = 1,
  kHiddenline = 2,
  kSurfaces = 3,
  kShaded = 4,
  kMonocromatic = 5,
  kShadowTerrain = 6,
  kShadowModel = 7,
  kMonoShadowTerrain = 8,
  kMonoShadowModel = 9,
  kRender = 10,
  kSolidBlank = 11,     // reported only
  kDesign = 12,         // reported only
  kGeometricA = 13,     // reported only
  kGeometricR = 14,     // reported only
  kUnknownMode = -1,
};

// The code of the mode the host shows now.
std::int16_t GetDisplayMode();
// Stores the code in globr[2] and, for codes 0 to 10, switches the host to it.
std::int16_t SetDisplayMode(std::int16_t code);
// Switches to the code held in globr[2]; reached through SetDisplayMode.
void ModeSwitch();
// Whether the pane's mode-bound commands may run in the host's present state.
bool IsModeAcceptable();

}  // namespace HRUtility
