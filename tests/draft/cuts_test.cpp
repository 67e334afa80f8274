// Section and plan cuts: what is kept, the cut faces' outlines and colours, what they hide.
#include <gtest/gtest.h>

#include <algorithm>

#include "tests/draft/draft_fixture.h"
#include "workbench/draft/projection.h"

namespace {

using namespace draft_test;
using namespace wb::draft;

constexpr StrokeKind kCut = StrokeKind::Cut;

// A wall 4 long (x), 0.3 thick (y) and 3 high, on layer 2 in colour 3.
wb::Drawing WallDrawing() {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {4, 0.3F, 3}, 2, 3);
  return drawing;
}

// Across the wall at x = 2 as the section view hands it over: start, end, above start, side point.
SectionCut AcrossWall() { return {{{{2, -1, 0}, {2, 1, 0}, {2, -1, 1}, {0, -1, 0}}}, 'b'}; }

std::vector<Expected> Outline(double x0, double y0, double x1, double y1, StrokeKind kind = StrokeKind::Edge) {
  return {{{x0, y0}, {x1, y0}, kind}, {{x1, y0}, {x1, y1}, kind}, {{x1, y1}, {x0, y1}, kind}, {{x0, y1}, {x0, y0}, kind}};
}

long Count(const Sheet& sheet, auto predicate) {
  return std::count_if(sheet.strokes.begin(), sheet.strokes.end(), predicate);
}

// Seen from 8 in front of the cut, only the cut face shows (0.3 x 3, scaled by 10 / 8).
TEST(SectionCutFace, CutTypesChooseColourAndKind) {
  for (const auto& [type, color, kind] : {std::tuple{'w', 7, kCut}, std::tuple{'o', 3, StrokeKind::Edge},
                                          std::tuple{'b', 3, kCut}}) {
    GenerateOptions options = ViewOf({10, 0.15F, 1.5F}, {0, 0.15F, 1.5F}, true, true);
    options.section = AcrossWall();
    options.section->cutType = type;
    const Sheet sheet = GenerateSheet(WallDrawing(), options);
    EXPECT_TRUE(SameStrokes(sheet.strokes, Outline(-0.1875, -1.875, 0.1875, 1.875, kind), 1e-6)) << type;
    EXPECT_EQ(Count(sheet, [&](const Stroke& s) { return s.color == color && s.layer == 2; }), 4) << type;
  }
}

// From above, the kept half shows its top and bottom outlines on one another; a line is cut too.
TEST(SectionCutSides, TheSidePointsHalfIsKept) {
  wb::Drawing drawing = WallDrawing();
  AddLine(drawing, {-1, 0.5F, 2}, {5, 0.5F, 2});
  const auto half = [](double farEnd, Expected line) {
    std::vector<Expected> expected{line};
    for (const Expected& side : Outline(std::min(farEnd, 1.0), -0.15, std::max(farEnd, 1.0), 0.15)) {
      expected.insert(expected.end(), 2, {side.a, side.b, side.a.x == 1.0 && side.b.x == 1.0 ? kCut : side.kind});
    }
    return expected;
  };
  const SectionCut across = AcrossWall();
  // A side point on the plane keeps the left of the section line, as the section's own does.
  const std::vector<std::pair<host::Point3f, std::vector<Expected>>> cases = {
      {across.points[3], half(-1, {{-2, 0.35}, {1, 0.35}})},
      {{4, -1, 0}, half(3, {{1, 0.35}, {4, 0.35}})},
      {across.points[0], half(-1, {{-2, 0.35}, {1, 0.35}})}};
  for (const auto& [side, expected] : cases) {
    GenerateOptions options = ViewOf({1, 0.15F, 50}, {1, 0.15F, 0});
    options.section = across;
    options.section->points[3] = side;
    EXPECT_TRUE(SameStrokes(GenerateSheet(drawing, options).strokes, expected, 1e-6)) << side.x;
  }
}

TEST(PlanCutFace, PlanShowsTheWallsAtTheCutHeightAndWhatLiesBelow) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {5, 0.3F, 3}, 0, 1);        // wall along x
  AddBox(drawing, {0, 0.3F, 0}, {0.3F, 3.7F, 3}, 0, 1);  // wall along y, against it
  AddBox(drawing, {0, 0, 3}, {5, 4, 0.2F}, 1, 2);        // slab above the cut
  AddBox(drawing, {2, 1, 0}, {1, 1, 0.5F}, 3, 4);        // step below it
  GenerateOptions options = ViewOf({0, 0, 50}, {0, 0, 0}, false, true);
  options.plan = PlanCut{{7, 8, 1}, 'b'};
  const Sheet sheet = GenerateSheet(drawing, options);
  std::vector<Expected> expected = Outline(0, 0, 5, 0.3, kCut);
  for (const auto& side : Outline(0, 0.3, 0.3, 4, kCut)) expected.push_back(side);
  for (const auto& side : Outline(2, 1, 3, 2)) expected.push_back(side);
  EXPECT_TRUE(SameStrokes(sheet.strokes, expected, 1e-6));
  EXPECT_EQ(Count(sheet, [](const Stroke& s) { return s.color != (s.kind == kCut ? 1 : 4); }), 0);
}

// Looking ahead over a cut floor, its cut face reaches behind the eye and must still hide.
TEST(PlanCutFace, FaceReachingBehindTheEyeStillHidesWhatIsUnderIt) {
  wb::Drawing drawing;
  AddBox(drawing, {-50, -50, -10}, {100, 100, 10}, 0, 1);
  AddLine(drawing, {-40, 10, -5}, {40, 10, -5}, 0, 6);
  AddLine(drawing, {6, 40, -5}, {6, 2, -5}, 0, 6);
  AddLine(drawing, {-6, 2, -5}, {-6, 40, -5}, 0, 6);
  GenerateOptions options = ViewOf({0, 0, 5}, {0, 10, -1}, true, true);
  options.plan = PlanCut{{0, 0, -1}, 'b'};
  const Sheet sheet = GenerateSheet(drawing, options);
  EXPECT_EQ(Count(sheet, [](const Stroke& s) { return s.color == 6; }), 0);
  const Projection projection(options.view);
  EXPECT_EQ(CountMatching(sheet.strokes, {projection.Project({-50, 50, -1}), projection.Project({50, 50, -1}), kCut}), 1);
}

}  // namespace
