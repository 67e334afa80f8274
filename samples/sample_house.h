// The sample house: a small two-storey house with its views, built in code.
#pragma once

#include "workbench/drawing.h"

namespace samples {

// Layers of the sample drawing (0-based indices).
enum SampleLayer : std::uint8_t { kWalls = 0, kSlabs = 1, kRoof = 2, kStairs = 3, kDimensions = 4, kTexts = 5 };

// Adds the house (walls with openings, slabs, pitched roof, stairs, dimensions, texts) to the
// workbench's current drawing, then its views through the loaded plug-in: three general
// cameras, two sections and a plan each with a camera, all ticked, and a selection set.
void BuildSampleHouse();

}  // namespace samples
