// The sample drawing built into the program, used when no drawing is named.
#pragma once

#include "workbench/drawing.h"

namespace samples {

// An empty drawing with the sample's named layers; the house and its views are added on top.
wb::Drawing MakeSampleDrawing();

}  // namespace samples
