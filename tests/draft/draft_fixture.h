// Shared helpers of the 2D pipeline tests: drawings of boxes and lines, and stroke sets
// compared without regard to order or direction.
#pragma once

#include <gtest/gtest.h>

#include <cstdint>
#include <vector>

#include "workbench/draft/generate_sheet.h"
#include "workbench/draft/sheet.h"
#include "workbench/draft/solid_mesh.h"
#include "workbench/drawing.h"

namespace draft_test {

using wb::draft::Point2;
using wb::draft::Stroke;
using wb::draft::StrokeKind;

wb::Entity& AddBox(wb::Drawing& drawing, host::Point3f corner, host::Point3f size, std::uint8_t layer = 0,
                   std::uint8_t color = 1);
wb::Entity& AddLine(wb::Drawing& drawing, host::Point3f start, host::Point3f end, std::uint8_t layer = 0,
                    std::uint8_t color = 1);

// A stroke as a test expects it: two ends and, optionally, a kind to match.
struct Expected {
  Point2 a;
  Point2 b;
  StrokeKind kind = StrokeKind::Edge;
};

// Every stroke matches one expected segment (ends within the tolerance, either direction,
// same kind) and every expected segment is matched once.
::testing::AssertionResult SameStrokes(const std::vector<Stroke>& actual, std::vector<Expected> expected,
                                       double tolerance = 1e-9);

// True when every stroke coordinate is finite.
bool AllFinite(const wb::draft::Sheet& sheet);

}  // namespace draft_test
