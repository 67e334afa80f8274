// The sample drawing built into the program, used when no drawing is named.
#pragma once

#include "workbench/drawing.h"

namespace samples {

// The sample house with its views, built in a fresh workbench session through the plug-in.
// Leaves the workbench reset.
wb::Drawing MakeSampleDrawing();

}  // namespace samples
