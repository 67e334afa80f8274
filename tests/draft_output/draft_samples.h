// Sheets for the 2D output tests and the program that writes files for the independent audit.
#pragma once

#include <string>
#include <vector>

#include "workbench/draft/sheet_writer.h"

namespace draft_output_samples {

// Strokes and labels on up to `layers` layers, half named, with full-precision coordinates and
// texts that survive the DXF encoding unchanged. The same seed gives the same sheet.
wb::draft::Sheet MakeSheet(unsigned seed, int strokes, int labels, int layers);

// Layer names DXF programs would refuse or confuse, clashing once cleaned or by case only.
wb::draft::Sheet MakeOddNamesSheet();

// One stroke on every one of the 256 layers.
wb::draft::Sheet MakeAllLayersSheet();

// Texts with control characters, markup, characters beyond the code page, invalid UTF-8.
std::vector<std::string> OddTexts();

std::string WrittenBy(const wb::draft::SheetWriter& writer, const wb::draft::Sheet& sheet);

}  // namespace draft_output_samples
