// Hidden-line removal against a brute-force reference: points sampled along every box edge of a
// small city are cast towards the eye through every triangle, and the drawing must show exactly
// the points that reach it.
#include <gtest/gtest.h>

#include <array>
#include <cmath>

#include "tests/draft/draft_fixture.h"
#include "workbench/draft/projection.h"

namespace {

using wb::draft::Cross;
using wb::draft::Dot;
using wb::draft::Vec3;

struct Box {
  Vec3 low, high;
};

struct Triangle {
  Vec3 p0, p1, p2;
};

std::vector<Box> SmallCity() {
  std::vector<Box> boxes;
  for (int row = 0; row < 5; ++row) {
    for (int column = 0; column < 5; ++column) {
      const double height = 2.0 + ((row * 5 + column) * 7 % 11) * 1.7;
      boxes.push_back({{column * 10.0, row * 10.0, 0.0}, {column * 10.0 + 7.0, row * 10.0 + 7.0, height}});
    }
  }
  return boxes;
}

Vec3 Corner(const Box& box, int i) {
  return {(i & 1) != 0 ? box.high.x : box.low.x, (i & 2) != 0 ? box.high.y : box.low.y,
          (i & 4) != 0 ? box.high.z : box.low.z};
}

std::vector<Triangle> Faces(const std::vector<Box>& boxes) {
  // Each face as two triangles over its four corners, in corner-bit order.
  const std::array<std::array<int, 4>, 6> faces{{{0, 1, 3, 2}, {4, 5, 7, 6}, {0, 1, 5, 4}, {2, 3, 7, 6}, {0, 2, 6, 4}, {1, 3, 7, 5}}};
  std::vector<Triangle> triangles;
  for (const Box& box : boxes) {
    for (const auto& f : faces) {
      triangles.push_back({Corner(box, f[0]), Corner(box, f[1]), Corner(box, f[2])});
      triangles.push_back({Corner(box, f[0]), Corner(box, f[2]), Corner(box, f[3])});
    }
  }
  return triangles;
}

// Moller-Trumbore: whether the ray origin + s * direction meets the triangle for s in (low, high).
bool Hits(const Triangle& t, Vec3 origin, Vec3 direction, double low, double high) {
  const Vec3 e1 = t.p1 - t.p0;
  const Vec3 e2 = t.p2 - t.p0;
  const Vec3 p = Cross(direction, e2);
  const double det = Dot(e1, p);
  if (std::fabs(det) < 1e-12) return false;
  const Vec3 s = origin - t.p0;
  const double u = Dot(s, p) / det;
  if (u < 0.0 || u > 1.0) return false;
  const Vec3 q = Cross(s, e1);
  const double v = Dot(direction, q) / det;
  if (v < 0.0 || u + v > 1.0) return false;
  const double along = Dot(e2, q) / det;
  return along > low && along < high;
}

double DistanceToStroke(wb::draft::Point2 p, const wb::draft::Stroke& s) {
  const double dx = s.b.x - s.a.x;
  const double dy = s.b.y - s.a.y;
  const double t = std::clamp(((p.x - s.a.x) * dx + (p.y - s.a.y) * dy) / (dx * dx + dy * dy), 0.0, 1.0);
  return std::hypot(p.x - (s.a.x + t * dx), p.y - (s.a.y + t * dy));
}

void CheckAgainstRayCasting(bool perspective) {
  const std::vector<Box> boxes = SmallCity();
  const std::vector<Triangle> triangles = Faces(boxes);
  wb::Drawing drawing;
  for (const Box& box : boxes) {
    draft_test::AddBox(drawing, {float(box.low.x), float(box.low.y), float(box.low.z)},
                       {float(box.high.x - box.low.x), float(box.high.y - box.low.y), float(box.high.z - box.low.z)});
  }
  const Vec3 eye{-60.0, -82.0, 68.0};
  const Vec3 target{22.0, 25.0, 3.0};
  wb::draft::GenerateOptions options;
  options.view = {{float(eye.x), float(eye.y), float(eye.z)}, {float(target.x), float(target.y), float(target.z)}, perspective};
  options.hideHiddenLines = true;
  const auto sheet = wb::draft::GenerateSheet(drawing, options);
  const wb::draft::Projection projection(options.view);
  const Vec3 forward = (target - eye) * (1.0 / wb::draft::Length(target - eye));

  const auto visible = [&](Vec3 point) {
    const Vec3 toward = perspective ? eye - point : forward * -1.0;
    const double high = perspective ? 1.0 : 1e9;
    return std::none_of(triangles.begin(), triangles.end(), [&](const Triangle& t) { return Hits(t, point, toward, 1e-9, high); });
  };
  int checked = 0;
  int shown = 0;
  for (const Box& box : boxes) {
    for (int i = 0; i < 8; ++i) {
      for (int bit = 1; bit < 8; bit <<= 1) {
        if ((i & bit) != 0) continue;
        const Vec3 a = Corner(box, i);
        const Vec3 b = Corner(box, i | bit);
        for (int k = 1; k < 40; ++k) {
          const double t = k / 40.0;
          const bool seen = visible(wb::draft::Lerp(a, b, t));
          // Near a change of visibility the reference itself is unsure.
          if (visible(wb::draft::Lerp(a, b, t - 0.004)) != seen || visible(wb::draft::Lerp(a, b, t + 0.004)) != seen) continue;
          const auto where = projection.Project(wb::draft::Lerp(a, b, t));
          const bool drawn = std::any_of(sheet.strokes.begin(), sheet.strokes.end(),
                                         [&](const wb::draft::Stroke& s) { return DistanceToStroke(where, s) < 1e-6; });
          EXPECT_EQ(drawn, seen) << "edge " << a.x << "," << a.y << "," << a.z << " - " << b.x << "," << b.y << ","
                                 << b.z << " at " << t;
          ++checked;
          shown += seen ? 1 : 0;
        }
      }
    }
  }
  // The sample must see both sides of the question.
  EXPECT_GT(checked, 8000);
  EXPECT_GT(shown, checked / 5);
  EXPECT_LT(shown, checked * 4 / 5);
}

TEST(HiddenLinesReference, ParallelViewMatchesRayCasting) { CheckAgainstRayCasting(false); }
TEST(HiddenLinesReference, PerspectiveViewMatchesRayCasting) { CheckAgainstRayCasting(true); }

}  // namespace
