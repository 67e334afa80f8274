// Sheets for the 2D output tests and the program that writes files for the independent audit.
#pragma once

#include <string>
#include <vector>

#include "workbench/draft/sheet_writer.h"

namespace draft_output_samples {

// Strokes of every kind and labels on up to `layers` layers, some named and some not, with
// coordinates of full double precision and texts mixing accents, symbols, "%%" and "\U" that
// survive the DXF text encoding unchanged. The same seed gives the same sheet.
wb::draft::Sheet MakeSheet(unsigned seed, int strokes, int labels, int layers);

// Layer names DXF programs would refuse or confuse: reserved characters, names that clash once
// cleaned or differ only in case, blanks, characters outside the code page, a 300-character name.
wb::draft::Sheet MakeOddNamesSheet();

// One stroke on every one of the 256 layers.
wb::draft::Sheet MakeAllLayersSheet();

// Label texts the encoding has to work on: line breaks, control characters, quotes and markup,
// characters beyond the code page and beyond the first plane, invalid UTF-8.
std::vector<std::string> OddTexts();

// What a writer makes of a sheet.
std::string WrittenBy(const wb::draft::SheetWriter& writer, const wb::draft::Sheet& sheet);

}  // namespace draft_output_samples
