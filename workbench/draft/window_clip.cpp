// Liang-Barsky clipping of strokes against the window box.
#include "workbench/draft/window_clip.h"

#include <algorithm>
#include <cmath>
#include <optional>

namespace wb::draft {

namespace {

bool Finite(Point2 point) { return std::isfinite(point.x) && std::isfinite(point.y); }

bool Inside(const Box2& box, Point2 point) {
  return point.x >= box.min.x && point.x <= box.max.x && point.y >= box.min.y && point.y <= box.max.y;
}

// Narrows [low, high] by one boundary: the part where p * t <= q.
bool ClipBy(double p, double q, double& low, double& high) {
  if (p == 0.0) return q >= 0.0;
  const double t = q / p;
  if (p < 0.0) {
    low = std::max(low, t);
  } else {
    high = std::min(high, t);
  }
  return low <= high;
}

std::optional<Stroke> Clip(Stroke stroke, const Box2& box) {
  if (!Finite(stroke.a) || !Finite(stroke.b)) return std::nullopt;
  const double dx = stroke.b.x - stroke.a.x;
  const double dy = stroke.b.y - stroke.a.y;
  double low = 0.0;
  double high = 1.0;
  if (!ClipBy(-dx, stroke.a.x - box.min.x, low, high) || !ClipBy(dx, box.max.x - stroke.a.x, low, high) ||
      !ClipBy(-dy, stroke.a.y - box.min.y, low, high) || !ClipBy(dy, box.max.y - stroke.a.y, low, high)) {
    return std::nullopt;
  }
  const Point2 start = stroke.a;
  // Ends that were inside stay exactly as they were.
  if (low > 0.0) stroke.a = {start.x + low * dx, start.y + low * dy};
  if (high < 1.0) stroke.b = {start.x + high * dx, start.y + high * dy};
  return stroke;
}

}  // namespace

void ClipToWindow(Sheet& sheet, const Box2& window) {
  if (!Finite(window.min) || !Finite(window.max)) return;
  const Box2 box{{std::min(window.min.x, window.max.x), std::min(window.min.y, window.max.y)},
                 {std::max(window.min.x, window.max.x), std::max(window.min.y, window.max.y)}};
  std::vector<Stroke> kept;
  for (const Stroke& stroke : sheet.strokes) {
    if (auto clipped = Clip(stroke, box)) kept.push_back(*clipped);
  }
  sheet.strokes = std::move(kept);
  std::erase_if(sheet.labels, [&](const Label& label) { return !Finite(label.at) || !Inside(box, label.at); });
}

}  // namespace wb::draft
