// Section and plan cuts: what is kept, the outline of the cut faces, their colours, and the
// faces hiding what lies behind them.
#include <gtest/gtest.h>

#include <algorithm>

#include "tests/draft/draft_fixture.h"
#include "workbench/draft/projection.h"

namespace {

using draft_test::AddBox;
using draft_test::AddLine;
using draft_test::Expected;
using wb::draft::GenerateOptions;
using wb::draft::GenerateSheet;
using wb::draft::PlanCut;
using wb::draft::SectionCut;
using wb::draft::Stroke;
using wb::draft::StrokeKind;

constexpr StrokeKind kCut = StrokeKind::Cut;
constexpr StrokeKind kEdge = StrokeKind::Edge;

// A wall 4 long (x), 0.3 thick (y) and 3 high, on layer 2 in colour 3.
wb::Drawing WallDrawing() {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {4, 0.3F, 3}, 2, 3);
  return drawing;
}

// The section across the wall at x = 2, drawn from y = -1 to y = 1, as the section view hands
// it over: start, end, start + z, and the side point start + z x (end - start), at x = 0.
SectionCut AcrossWall(char cutType = 'b') {
  return {{{{2, -1, 0}, {2, 1, 0}, {2, -1, 1}, {0, -1, 0}}}, cutType};
}

// Looking at the cut face from the cut-away side, 8 in front of it: x shows world y - 0.15,
// y shows world z - 1.5, both scaled by 10 / 8 at the face.
GenerateOptions FacingTheCut(bool hide) {
  GenerateOptions options;
  options.view = {{10.0F, 0.15F, 1.5F}, {0.0F, 0.15F, 1.5F}, true};
  options.hideHiddenLines = hide;
  options.section = AcrossWall();
  return options;
}

std::vector<Expected> Rectangle(double halfWidth, double halfHeight, StrokeKind kind) {
  const wb::draft::Point2 p0{-halfWidth, -halfHeight}, p1{halfWidth, -halfHeight}, p2{halfWidth, halfHeight},
      p3{-halfWidth, halfHeight};
  return {{p0, p1, kind}, {p1, p2, kind}, {p2, p3, kind}, {p3, p0, kind}};
}

// Top view: x shows world x - 1, y shows world y - 0.15.
GenerateOptions FromAbove() {
  GenerateOptions options;
  options.view = {{1.0F, 0.15F, 50.0F}, {1.0F, 0.15F, 0.0F}, false};
  return options;
}

TEST(SectionCutFace, WallCutShowsItsThicknessAndHeightAndHidesWhatIsBehind) {
  const auto sheet = GenerateSheet(WallDrawing(), FacingTheCut(true));
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, Rectangle(0.15 * 1.25, 1.5 * 1.25, kCut), 1e-6));
  for (const Stroke& stroke : sheet.strokes) {
    EXPECT_EQ(stroke.layer, 2);
    EXPECT_EQ(stroke.color, 3);
  }
}

TEST(SectionCutFace, WithoutHiddenLineRemovalTheFarEndShowsInsideTheCut) {
  const auto sheet = GenerateSheet(WallDrawing(), FacingTheCut(false));
  std::vector<Stroke> cut;
  std::vector<Stroke> edges;
  for (const Stroke& stroke : sheet.strokes) (stroke.kind == kCut ? cut : edges).push_back(stroke);
  EXPECT_TRUE(draft_test::SameStrokes(cut, Rectangle(0.15 * 1.25, 1.5 * 1.25, kCut), 1e-6));
  // The far end at x = 0 is 10 from the eye: scale 1. Four edges run from it to the cut.
  const auto farEnd = Rectangle(0.15, 1.5, kEdge);
  for (const Expected& side : farEnd) {
    EXPECT_EQ(std::count_if(edges.begin(), edges.end(), [&](const Stroke& s) { return draft_test::SameStrokes({s}, {side}, 1e-6); }), 1);
  }
  EXPECT_EQ(edges.size(), 8U);
}

TEST(SectionCutFace, CutTypesChooseColourAndKind) {
  for (const auto& [type, color, kind] : {std::tuple{'w', 7, kCut}, std::tuple{'o', 3, kEdge}, std::tuple{'b', 3, kCut}}) {
    auto options = FacingTheCut(true);
    options.section->cutType = type;
    const auto sheet = GenerateSheet(WallDrawing(), options);
    EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, Rectangle(0.15 * 1.25, 1.5 * 1.25, kind), 1e-6)) << type;
    for (const Stroke& stroke : sheet.strokes) EXPECT_EQ(stroke.color, color) << type;
  }
}

TEST(SectionCutSides, TheSidePointsHalfIsKept) {
  wb::Drawing drawing = WallDrawing();
  AddLine(drawing, {-1, 0.5F, 2}, {5, 0.5F, 2});
  auto options = FromAbove();
  options.section = AcrossWall();
  // Bottom and top outlines coincide from above; the cut face is seen edge-on as one line.
  EXPECT_TRUE(draft_test::SameStrokes(GenerateSheet(drawing, options).strokes,
                                      {{{-1, -0.15}, {1, -0.15}}, {{-1, -0.15}, {1, -0.15}},
                                       {{-1, 0.15}, {1, 0.15}}, {{-1, 0.15}, {1, 0.15}},
                                       {{-1, -0.15}, {-1, 0.15}}, {{-1, -0.15}, {-1, 0.15}},
                                       {{1, -0.15}, {1, 0.15}, kCut}, {{1, -0.15}, {1, 0.15}, kCut},
                                       {{-2, 0.35}, {1, 0.35}}},
                                      1e-6));

  options.section->points[3] = {4, -1, 0};  // the other side
  EXPECT_TRUE(draft_test::SameStrokes(GenerateSheet(drawing, options).strokes,
                                      {{{1, -0.15}, {3, -0.15}}, {{1, -0.15}, {3, -0.15}},
                                       {{1, 0.15}, {3, 0.15}}, {{1, 0.15}, {3, 0.15}},
                                       {{3, -0.15}, {3, 0.15}}, {{3, -0.15}, {3, 0.15}},
                                       {{1, -0.15}, {1, 0.15}, kCut}, {{1, -0.15}, {1, 0.15}, kCut},
                                       {{1, 0.35}, {4, 0.35}}},
                                      1e-6));
}

TEST(SectionCutSides, SideOnThePlaneKeepsTheLeftOfTheSectionLine) {
  auto options = FromAbove();
  options.section = AcrossWall();
  options.section->points[3] = options.section->points[0];
  // From y = -1 to y = 1, left is towards -x: the same half as the side point at x = 0.
  auto reference = FromAbove();
  reference.section = AcrossWall();
  EXPECT_EQ(GenerateSheet(WallDrawing(), options), GenerateSheet(WallDrawing(), reference));
}

TEST(PlanCutFace, PlanShowsTheWallsAtTheCutHeightAndWhatLiesBelow) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {5, 0.3F, 3}, 0, 1);        // wall along x
  AddBox(drawing, {0, 0.3F, 0}, {0.3F, 3.7F, 3}, 0, 1);  // wall along y, against it
  AddBox(drawing, {0, 0, 3}, {5, 4, 0.2F}, 1, 2);        // slab above the cut
  AddBox(drawing, {2, 1, 0}, {1, 1, 0.5F}, 3, 4);        // step below it
  GenerateOptions options;
  options.view = {{0.0F, 0.0F, 50.0F}, {0.0F, 0.0F, 0.0F}, false};
  options.hideHiddenLines = true;
  options.plan = PlanCut{{7, 8, 1}, 'b'};
  const auto sheet = GenerateSheet(drawing, options);
  const auto outline = [](double x0, double y0, double x1, double y1, StrokeKind kind) {
    return std::vector<Expected>{{{x0, y0}, {x1, y0}, kind}, {{x1, y0}, {x1, y1}, kind},
                                 {{x1, y1}, {x0, y1}, kind}, {{x0, y1}, {x0, y0}, kind}};
  };
  std::vector<Expected> expected = outline(0, 0, 5, 0.3, kCut);
  for (const Expected& side : outline(0, 0.3, 0.3, 4, kCut)) expected.push_back(side);
  for (const Expected& side : outline(2, 1, 3, 2, kEdge)) expected.push_back(side);
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, expected, 1e-6));
  for (const Stroke& stroke : sheet.strokes) EXPECT_EQ(stroke.color, stroke.kind == kCut ? 1 : 4);
}

// Standing above a cut floor and looking ahead, the cut face reaches behind the eye; the part in
// front must still hide what lies under it.
TEST(PlanCutFace, FaceReachingBehindTheEyeStillHidesWhatIsUnderIt) {
  wb::Drawing drawing;
  AddBox(drawing, {-50, -50, -10}, {100, 100, 10}, 0, 1);
  // Lines inside the floor, under the cut, running every way.
  AddLine(drawing, {-40, 10, -5}, {40, 10, -5}, 0, 6);
  AddLine(drawing, {6, 40, -5}, {6, 2, -5}, 0, 6);
  AddLine(drawing, {-6, 2, -5}, {-6, 40, -5}, 0, 6);
  GenerateOptions options;
  options.view = {{0.0F, 0.0F, 5.0F}, {0.0F, 10.0F, -1.0F}, true};
  options.hideHiddenLines = true;
  options.plan = PlanCut{{0, 0, -1}, 'b'};
  const auto sheet = GenerateSheet(drawing, options);
  EXPECT_TRUE(draft_test::AllFinite(sheet));
  EXPECT_TRUE(std::none_of(sheet.strokes.begin(), sheet.strokes.end(), [](const Stroke& s) { return s.color == 6; }));
  const wb::draft::Projection projection(options.view);
  const Expected farSide{projection.Project({-50, 50, -1}), projection.Project({50, 50, -1}), kCut};
  EXPECT_EQ(std::count_if(sheet.strokes.begin(), sheet.strokes.end(), [&](const Stroke& s) { return draft_test::SameStrokes({s}, {farSide}, 1e-6); }), 1);
}

TEST(CombinedCuts, SectionAndPlanFacesShareOneCornerLine) {
  GenerateOptions options;
  options.view = {{9.0F, -7.0F, 6.0F}, {1.0F, 0.15F, 1.0F}, false};
  options.section = AcrossWall();
  options.plan = PlanCut{{0, 0, 1}, 'b'};
  const auto sheet = GenerateSheet(WallDrawing(), options);
  const wb::draft::Projection projection(options.view);
  const Expected corner{projection.Project({2, 0, 1}), projection.Project({2, 0.3, 1}), kCut};
  std::vector<Stroke> cut;
  std::copy_if(sheet.strokes.begin(), sheet.strokes.end(), std::back_inserter(cut),
               [](const Stroke& s) { return s.kind == kCut; });
  // The section face below z = 1 and the plan face left of x = 2: four sides each, one shared.
  EXPECT_EQ(cut.size(), 7U);
  EXPECT_EQ(std::count_if(cut.begin(), cut.end(), [&](const Stroke& s) { return draft_test::SameStrokes({s}, {corner}, 1e-6); }), 1);
  const Expected planFar{projection.Project({0, 0, 1}), projection.Project({0, 0.3, 1}), kCut};
  const Expected sectionFoot{projection.Project({2, 0, 0}), projection.Project({2, 0.3, 0}), kCut};
  for (const Expected& side : {planFar, sectionFoot}) {
    EXPECT_EQ(std::count_if(cut.begin(), cut.end(), [&](const Stroke& s) { return draft_test::SameStrokes({s}, {side}, 1e-6); }), 1);
  }
}

// Just behind the section face, trimmed at the plan height, lines are seen only through the
// face: it must hide them whichever way they run.
TEST(CombinedCuts, TrimmedFaceHidesWhatLiesBehindIt) {
  wb::Drawing drawing = WallDrawing();
  AddLine(drawing, {1.95F, 0.05F, 0.5F}, {1.95F, 0.25F, 0.5F}, 0, 6);
  AddLine(drawing, {1.95F, 0.2F, 0.9F}, {1.95F, 0.1F, 0.9F}, 0, 6);
  AddLine(drawing, {1.95F, 0.15F, 0.2F}, {1.95F, 0.15F, 0.9F}, 0, 6);
  AddLine(drawing, {1.9F, 0.1F, 0.95F}, {1.9F, 0.1F, 0.1F}, 0, 6);
  GenerateOptions options;
  options.view = {{9.0F, -7.0F, 6.0F}, {1.0F, 0.15F, 1.0F}, false};
  options.hideHiddenLines = true;
  options.section = AcrossWall();
  options.plan = PlanCut{{0, 0, 1}, 'b'};
  const auto sheet = GenerateSheet(drawing, options);
  EXPECT_EQ(std::count_if(sheet.strokes.begin(), sheet.strokes.end(), [](const Stroke& s) { return s.kind == kCut; }), 7);
  EXPECT_TRUE(std::none_of(sheet.strokes.begin(), sheet.strokes.end(), [](const Stroke& s) { return s.color == 6; }));
  options.hideHiddenLines = false;
  const auto seeThrough = GenerateSheet(drawing, options);
  EXPECT_EQ(std::count_if(seeThrough.strokes.begin(), seeThrough.strokes.end(), [](const Stroke& s) { return s.color == 6; }), 4);
}

}  // namespace
