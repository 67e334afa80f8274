// What the line clean-ups share: strokes as lines with a parameter, their order and a grid.
#pragma once

#include <cstddef>
#include <vector>

#include "workbench/draft/box_grid.h"
#include "workbench/draft/sheet.h"

namespace wb::draft {

// A stroke's supporting line: points are origin + t * direction, t in [0, length].
struct StrokeLine {
  Point2 origin;
  Point2 direction;  // unit length; (1, 0) for a stroke without length
  double length = 0.0;

  explicit StrokeLine(const Stroke& stroke);
  double ParameterOf(Point2 point) const;
  double DistanceOf(Point2 point) const;  // signed, left positive
  Point2 At(double t) const;
};

// The strokes the clean-ups work on, in the order they give way to each other (cut strokes
// before edges, long before short, then by coordinates), and the others they leave alone.
struct CleanupSet {
  std::vector<Stroke> ordered;
  std::vector<Stroke> untouched;  // preserved strokes
  BoxGrid grid;              // over `ordered`, boxes widened by the tolerance
};
CleanupSet PrepareCleanup(std::vector<Stroke> strokes, double tolerance);

// A usable tolerance: 0 for one below 0 or not finite.
double CleanTolerance(double tolerance);

// The tolerance plus room for rounding at the stroke's coordinates, so that a tolerance of 0
// still finds exact duplicates.
double WithRoundingSlack(const Stroke& stroke, double tolerance);

// Writes the result back in the answer's order, lower end of each stroke first.
void FinishCleanup(Sheet& sheet, std::vector<Stroke> cleaned, const std::vector<Stroke>& untouched);

}  // namespace wb::draft
