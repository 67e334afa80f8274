// Hidden-line removal against brute-force ray casting, and where it is easy to get wrong.
#include <gtest/gtest.h>

#include <array>
#include <cmath>

#include "tests/draft/draft_fixture.h"
#include "workbench/draft/projection.h"

namespace {

using namespace draft_test;
using namespace wb::draft;

using Triangle = std::array<Vec3, 3>;

// Moller-Trumbore: whether the ray origin + s * direction meets the triangle for s in (low, high).
bool Hits(const Triangle& t, Vec3 origin, Vec3 direction, double low, double high) {
  const Vec3 e1 = t[1] - t[0];
  const Vec3 e2 = t[2] - t[0];
  const Vec3 p = Cross(direction, e2);
  const double det = Dot(e1, p);
  if (std::fabs(det) < 1e-12) return false;
  const Vec3 s = origin - t[0];
  const Vec3 q = Cross(s, e1);
  const double u = Dot(s, p) / det;
  const double v = Dot(direction, q) / det;
  const double along = Dot(e2, q) / det;
  return u >= 0.0 && v >= 0.0 && u + v <= 1.0 && along > low && along < high;
}

bool OnStroke(Point2 p, const Stroke& s) {
  const Point2 d{s.b.x - s.a.x, s.b.y - s.a.y};
  const double t = std::clamp(((p.x - s.a.x) * d.x + (p.y - s.a.y) * d.y) / (d.x * d.x + d.y * d.y), 0.0, 1.0);
  return std::hypot(p.x - (s.a.x + t * d.x), p.y - (s.a.y + t * d.y)) < 1e-6;
}

// Points along every box edge are drawn exactly when a ray from them reaches the eye.
void CheckAgainstRayCasting(bool perspective) {
  wb::Drawing drawing;
  std::vector<Triangle> triangles;
  std::vector<std::pair<Vec3, Vec3>> edges;
  for (int cell = 0; cell < 25; ++cell) {
    const host::Point3f low{float(cell % 5 * 10), float(cell / 5 * 10), 0.0F};
    const host::Point3f size{7.0F, 7.0F, 2.0F + float(cell * 7 % 11) * 1.7F};
    AddBox(drawing, low, size);
    const SolidMesh box = MakeBox(low, size);
    for (const auto& t : box.triangles) {
      triangles.push_back({Widen(box.vertices[t[0]]), Widen(box.vertices[t[1]]), Widen(box.vertices[t[2]])});
    }
    const auto corner = [&](int i) {
      return Widen(low) + Vec3{double(i & 1) * size.x, double(i >> 1 & 1) * size.y, double(i >> 2 & 1) * size.z};
    };
    for (int i = 0; i < 8; ++i) {
      for (int bit = 1; bit < 8; bit <<= 1) {
        if ((i & bit) == 0) edges.emplace_back(corner(i), corner(i | bit));
      }
    }
  }
  const GenerateOptions options = ViewOf({-60, -82, 68}, {22, 25, 3}, perspective, true);
  const Sheet sheet = GenerateSheet(drawing, options);
  const Projection projection(options.view);
  const auto visible = [&](Vec3 point) {
    const Vec3 toward = perspective ? projection.Eye() - point : projection.Forward() * -1.0;
    return std::none_of(triangles.begin(), triangles.end(),
                        [&](const Triangle& t) { return Hits(t, point, toward, 1e-9, perspective ? 1.0 : 1e9); });
  };
  int checked = 0, shown = 0;
  for (const auto& [a, b] : edges) {
    for (double t = 0.025; t < 0.99; t += 0.025) {
      const bool seen = visible(Lerp(a, b, t));
      if (visible(Lerp(a, b, t - 0.004)) != seen || visible(Lerp(a, b, t + 0.004)) != seen) continue;
      const Point2 where = projection.Project(Lerp(a, b, t));
      const bool drawn = std::any_of(sheet.strokes.begin(), sheet.strokes.end(),
                                     [&](const Stroke& s) { return OnStroke(where, s); });
      EXPECT_EQ(drawn, seen) << a.x << "," << a.y << "," << a.z << " - " << b.x << "," << b.y << "," << b.z << " at " << t;
      ++checked;
      shown += seen ? 1 : 0;
    }
  }
  // The sample must see both sides of the question.
  EXPECT_GT(checked, 8000);
  EXPECT_GT(shown, checked / 5);
  EXPECT_LT(shown, checked * 4 / 5);
}

TEST(HiddenLinesReference, ParallelViewMatchesRayCasting) { CheckAgainstRayCasting(false); }
TEST(HiddenLinesReference, PerspectiveViewMatchesRayCasting) { CheckAgainstRayCasting(true); }

// Walls are built of boxes that share faces; the edges on shared faces must not hide each other.
TEST(HiddenLinesTouching, BoxesSharingAFaceKeepTheirFrontEdges) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {1, 1, 1});
  AddBox(drawing, {1, 0, 0}, {1, 1, 1});
  const GenerateOptions options = ViewOf({4, -6, 5}, {1, 0.5F, 0.5F}, false, true);
  const Projection projection(options.view);
  const Sheet sheet = GenerateSheet(drawing, options);
  EXPECT_EQ(CountMatching(sheet.strokes, {projection.Project({1, 0, 0}), projection.Project({1, 0, 1})}), 2);
  EXPECT_EQ(CountMatching(sheet.strokes, {projection.Project({1, 0, 1}), projection.Project({1, 1, 1})}), 2);
  // Nine edges of each box face the eye; two of the left box's lie behind the right box.
  EXPECT_EQ(sheet.strokes.size(), 16U);
}

// Lines on or before a face stay whole; solids not shown hide nothing; texts are not lines.
TEST(HiddenLinesVisibility, OnlyShownSolidsHideAndStrokesKeepTheirAttributes) {
  wb::Drawing drawing;
  drawing.layers[4].name = "Walls";
  AddBox(drawing, {0, 0, 0}, {2, 1, 2});
  AddLine(drawing, {-1, -1, 1}, {3, -1, 1}, 4, 12);
  AddLine(drawing, {0.5F, 0, 0.5F}, {1.5F, 0, 1.5F});
  AddLine(drawing, {4, 5, 1}, {6, 5, 1}, 5, 0);  // colour 0 cannot be drawn: the foreground
  AddBox(drawing, {3, 0, 0}, {4, 1, 2}).header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
  AddBox(drawing, {3, 0, 0}, {4, 1, 2}, 3);
  drawing.layers[3].on = false;
  wb::Attribute& textBlock = AddLine(drawing, {0, -2, 0}, {1, -2, 0}).attributes.emplace_back();
  textBlock.name = "tb=";
  textBlock.type = wb::AttributeType::FloatVector;
  const Sheet sheet = GenerateSheet(drawing, ViewOf({0, -50, 0}, {0, 0, 0}, false, true));  // x is x, y is z
  ASSERT_TRUE(SameStrokes(sheet.strokes, {{{0, 0}, {2, 0}}, {{2, 0}, {2, 2}}, {{2, 2}, {0, 2}}, {{0, 2}, {0, 0}},
                                          {{-1, 1}, {3, 1}}, {{0.5, 0.5}, {1.5, 1.5}}, {{4, 1}, {6, 1}}}));
  EXPECT_EQ(sheet.strokes[4], (Stroke{{-1, 1}, {3, 1}, 4, 12}));
  EXPECT_EQ(sheet.strokes[6], (Stroke{{4, 1}, {6, 1}, 5, 7}));
  EXPECT_EQ(sheet.layerNames[4], "Walls");
}

}  // namespace
