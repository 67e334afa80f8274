// Shared helpers of the 2D pipeline tests: drawings of boxes and lines, views, and stroke sets
// compared without regard to order or direction.
#pragma once

#include <gtest/gtest.h>

#include <cstdint>
#include <vector>

#include "workbench/draft/generate_sheet.h"
#include "workbench/draft/solid_mesh.h"

namespace draft_test {

using wb::draft::Point2;
using wb::draft::Stroke;
using wb::draft::StrokeKind;

wb::Entity& AddBox(wb::Drawing& drawing, host::Point3f corner, host::Point3f size, std::uint8_t layer = 0,
                   std::uint8_t color = 1);
wb::Entity& AddLine(wb::Drawing& drawing, host::Point3f start, host::Point3f end, std::uint8_t layer = 0,
                    std::uint8_t color = 1);
wb::draft::GenerateOptions ViewOf(host::Point3f eye, host::Point3f target, bool perspective = false,
                                  bool hideHiddenLines = false);

// A stroke as a test expects it: two ends and a kind.
struct Expected {
  Point2 a;
  Point2 b;
  StrokeKind kind = StrokeKind::Edge;
};

// Each stroke matches one expected (ends within the tolerance, either way round, same kind).
::testing::AssertionResult SameStrokes(const std::vector<Stroke>& actual, std::vector<Expected> expected,
                                       double tolerance = 1e-9);
long CountMatching(const std::vector<Stroke>& strokes, const Expected& expected, double tolerance = 1e-6);

}  // namespace draft_test
