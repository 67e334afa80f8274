// Coincident stroke removal: each stroke keeps what no stroke before it in the order covers.
#include <algorithm>
#include <cmath>
#include <cstdint>
#include <optional>

#include "workbench/draft/interval.h"
#include "workbench/draft/stroke_cleanup.h"
#include "workbench/draft/stroke_lines.h"

namespace wb::draft {

namespace {

// The part of the line's stroke that `other` lies on: where they overlap along the line, if
// all of `other` there is within the tolerance of the line.
std::optional<Interval> CoveredPart(const StrokeLine& line, const Stroke& other, double slack) {
  double t0 = line.ParameterOf(other.a);
  double t1 = line.ParameterOf(other.b);
  double d0 = line.DistanceOf(other.a);
  double d1 = line.DistanceOf(other.b);
  if (t0 > t1) {
    std::swap(t0, t1);
    std::swap(d0, d1);
  }
  const double from = std::max(t0, 0.0);
  const double to = std::min(t1, line.length);
  if (!(from < to)) return std::nullopt;
  const auto distanceAt = [&](double t) { return d0 + (t - t0) / (t1 - t0) * (d1 - d0); };
  if (std::fabs(distanceAt(from)) > slack || std::fabs(distanceAt(to)) > slack) return std::nullopt;
  return Interval{from, to};
}

}  // namespace

void RemoveCoincidentStrokes(Sheet& sheet, double tolerance) {
  tolerance = CleanTolerance(tolerance);
  const CleanupSet set = PrepareCleanup(std::move(sheet.strokes), tolerance);
  std::vector<Stroke> kept;
  std::vector<std::size_t> lastQuery(set.ordered.size(), SIZE_MAX);
  std::vector<Interval> covered;
  for (std::size_t i = 0; i < set.ordered.size(); ++i) {
    const Stroke& stroke = set.ordered[i];
    const StrokeLine line(stroke);
    const double slack = WithRoundingSlack(stroke, tolerance);
    covered.clear();
    set.grid.ForEachAlong(stroke.a, stroke.b, tolerance, [&](std::uint32_t j) {
      if (j >= i || lastQuery[j] == i) return true;
      lastQuery[j] = i;
      if (set.ordered[j].layer != stroke.layer) return true;
      if (auto part = CoveredPart(line, set.ordered[j], slack)) covered.push_back(*part);
      return true;
    });
    if (covered.empty()) {
      kept.push_back(stroke);
      continue;
    }
    std::sort(covered.begin(), covered.end(), [](const Interval& x, const Interval& y) { return x.from < y.from; });
    const auto keepPiece = [&](double from, double to) {
      if (to - from <= slack) return;
      Stroke piece = stroke;
      piece.a = from == 0.0 ? stroke.a : line.At(from);
      piece.b = to == line.length ? stroke.b : line.At(to);
      kept.push_back(piece);
    };
    double from = 0.0;
    for (const Interval& part : covered) {
      keepPiece(from, part.from);
      from = std::max(from, part.to);
    }
    keepPiece(from, line.length);
  }
  FinishCleanup(sheet, std::move(kept), set.untouched);
}

}  // namespace wb::draft
