// Stroke lines, clean-up order and the stroke grid.
#include "workbench/draft/stroke_lines.h"

#include <algorithm>
#include <cmath>
#include <tuple>

namespace wb::draft {

namespace {

bool Finite(const Stroke& stroke) {
  return std::isfinite(stroke.a.x) && std::isfinite(stroke.a.y) && std::isfinite(stroke.b.x) && std::isfinite(stroke.b.y);
}

double Length(const Stroke& stroke) { return std::hypot(stroke.b.x - stroke.a.x, stroke.b.y - stroke.a.y); }

int KindRank(StrokeKind kind) { return kind == StrokeKind::Cut ? 0 : 1; }

auto Coordinates(const Stroke& stroke) { return std::tie(stroke.a.x, stroke.a.y, stroke.b.x, stroke.b.y); }

Stroke LowerEndFirst(Stroke stroke) {
  if (std::tie(stroke.b.x, stroke.b.y) < std::tie(stroke.a.x, stroke.a.y)) std::swap(stroke.a, stroke.b);
  return stroke;
}

}  // namespace

StrokeLine::StrokeLine(const Stroke& stroke) : origin(stroke.a), length(Length(stroke)) {
  direction = length > 0.0 ? Point2{(stroke.b.x - stroke.a.x) / length, (stroke.b.y - stroke.a.y) / length}
                           : Point2{1.0, 0.0};
}

double StrokeLine::ParameterOf(Point2 point) const {
  return (point.x - origin.x) * direction.x + (point.y - origin.y) * direction.y;
}

double StrokeLine::DistanceOf(Point2 point) const {
  return direction.x * (point.y - origin.y) - direction.y * (point.x - origin.x);
}

Point2 StrokeLine::At(double t) const { return {origin.x + t * direction.x, origin.y + t * direction.y}; }

double CleanTolerance(double tolerance) { return std::isfinite(tolerance) && tolerance > 0.0 ? tolerance : 0.0; }

double WithRoundingSlack(const Stroke& stroke, double tolerance) {
  constexpr double kRounding = 1e-12;
  return tolerance + kRounding * std::max({1.0, std::fabs(stroke.a.x), std::fabs(stroke.a.y), std::fabs(stroke.b.x),
                                           std::fabs(stroke.b.y)});
}

CleanupSet PrepareCleanup(std::vector<Stroke> strokes, double tolerance) {
  CleanupSet set;
  for (const Stroke& stroke : strokes) {
    if (!Finite(stroke)) continue;
    (stroke.kind == StrokeKind::Preserved ? set.untouched : set.ordered).push_back(LowerEndFirst(stroke));
  }
  std::sort(set.ordered.begin(), set.ordered.end(), [](const Stroke& x, const Stroke& y) {
    const double lengthX = Length(x);
    const double lengthY = Length(y);
    if (KindRank(x.kind) != KindRank(y.kind)) return KindRank(x.kind) < KindRank(y.kind);
    if (lengthX != lengthY) return lengthX > lengthY;
    if (Coordinates(x) != Coordinates(y)) return Coordinates(x) < Coordinates(y);
    return std::tie(x.layer, x.color) < std::tie(y.layer, y.color);
  });
  std::vector<Box2> boxes;
  boxes.reserve(set.ordered.size());
  for (const Stroke& stroke : set.ordered) {
    boxes.push_back({{std::min(stroke.a.x, stroke.b.x) - tolerance, std::min(stroke.a.y, stroke.b.y) - tolerance},
                     {std::max(stroke.a.x, stroke.b.x) + tolerance, std::max(stroke.a.y, stroke.b.y) + tolerance}});
  }
  set.grid = BoxGrid(boxes);
  return set;
}

void FinishCleanup(Sheet& sheet, std::vector<Stroke> cleaned, const std::vector<Stroke>& untouched) {
  cleaned.insert(cleaned.end(), untouched.begin(), untouched.end());
  for (Stroke& stroke : cleaned) stroke = LowerEndFirst(stroke);
  std::sort(cleaned.begin(), cleaned.end(), [](const Stroke& x, const Stroke& y) {
    return std::tie(x.layer, x.color, x.kind, x.a.x, x.a.y, x.b.x, x.b.y) <
           std::tie(y.layer, y.color, y.kind, y.a.x, y.a.y, y.b.x, y.b.y);
  });
  sheet.strokes = std::move(cleaned);
}

}  // namespace wb::draft
