// Collinear merge: each stroke, longest first, gathers the strokes along its line that touch
// what it has gathered so far.
#include <algorithm>
#include <cmath>
#include <cstdint>

#include "workbench/draft/stroke_cleanup.h"
#include "workbench/draft/stroke_lines.h"

namespace wb::draft {

namespace {

bool SameStyle(const Stroke& x, const Stroke& y) { return x.layer == y.layer && x.color == y.color && x.kind == y.kind; }

}  // namespace

void MergeCollinearStrokes(Sheet& sheet, double tolerance) {
  tolerance = CleanTolerance(tolerance);
  const CleanupSet set = PrepareCleanup(std::move(sheet.strokes), tolerance);
  std::vector<Stroke> merged;
  std::vector<bool> taken(set.ordered.size(), false);
  for (std::size_t i = 0; i < set.ordered.size(); ++i) {
    if (taken[i]) continue;
    taken[i] = true;
    const Stroke& seed = set.ordered[i];
    // Measured against the seed's line only, so a run of slightly bent strokes cannot creep
    // away from it.
    const StrokeLine line(seed);
    const double slack = WithRoundingSlack(seed, tolerance);
    double low = 0.0;
    double high = line.length;
    bool joined = false;
    for (bool grew = true; grew;) {
      grew = false;
      set.grid.ForEachAlong(line.At(low), line.At(high), tolerance, [&](std::uint32_t j) {
        const Stroke& other = set.ordered[j];
        if (taken[j] || !SameStyle(seed, other)) return true;
        if (std::fabs(line.DistanceOf(other.a)) > slack || std::fabs(line.DistanceOf(other.b)) > slack) return true;
        const double t0 = line.ParameterOf(other.a);
        const double t1 = line.ParameterOf(other.b);
        if (std::max(t0, t1) < low - slack || std::min(t0, t1) > high + slack) return true;
        taken[j] = true;
        low = std::min({low, t0, t1});
        high = std::max({high, t0, t1});
        joined = grew = true;
        return true;
      });
    }
    if (!joined) {
      merged.push_back(seed);
      continue;
    }
    Stroke run = seed;
    run.a = low == 0.0 ? seed.a : line.At(low);
    run.b = high == line.length ? seed.b : line.At(high);
    merged.push_back(run);
  }
  FinishCleanup(sheet, std::move(merged), set.untouched);
}

}  // namespace wb::draft
