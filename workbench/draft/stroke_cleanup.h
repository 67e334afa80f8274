// Line clean-up of a 2D drawing: coincident strokes removed, collinear runs merged.
#pragma once

#include "workbench/draft/sheet.h"

namespace wb::draft {

// Both clean-ups work within one layer, leave preserved strokes (carried over unchanged) and
// labels alone, drop strokes with coordinates that are not finite, and answer the strokes
// sorted (layer, colour, kind, then coordinates, each stroke's lower end first), so the same
// drawing always cleans up the same way. A tolerance below 0 or not finite counts as 0.

// Deletes exact and near duplicates and the parts of a stroke that lie (within the tolerance)
// on another. Of strokes on one another, cut strokes win over edges, then longer over shorter.
void RemoveCoincidentStrokes(Sheet& sheet, double tolerance);

// Joins strokes of one layer, colour and kind that lie on one line (within the tolerance) and
// touch or overlap into one stroke along the line of the longest of them.
void MergeCollinearStrokes(Sheet& sheet, double tolerance);

}  // namespace wb::draft
