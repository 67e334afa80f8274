// Drawings to save and open in the drawing file tests, the benchmark and the fuzzer's seeds.
#pragma once

#include <cstddef>

#include "workbench/drawing.h"

namespace drawing_file_samples {

// Every entity type, with deleted slots between them and at the end, every attribute type,
// names, members, an element's library names, renamed and switched-off layers and a title.
wb::Drawing MakeDrawingWithEverything();

// `count` slots of the kinds a real drawing is made of: mostly lines and texts, elements with
// attribute records, groups, blocks and their placements, and some deleted slots. The same
// seed gives the same drawing.
wb::Drawing MakeBulkDrawing(std::size_t count, unsigned seed);

}  // namespace drawing_file_samples
