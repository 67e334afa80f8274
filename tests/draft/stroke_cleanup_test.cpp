// Line clean-up: duplicates and overlaps removed within a layer, collinear runs merged, both
// with a sorted, repeatable result.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <random>

#include "tests/draft/draft_fixture.h"
#include "workbench/draft/stroke_cleanup.h"

namespace {

using draft_test::Expected;
using wb::draft::MergeCollinearStrokes;
using wb::draft::RemoveCoincidentStrokes;
using wb::draft::Sheet;
using wb::draft::Stroke;
using wb::draft::StrokeKind;

Stroke S(double ax, double ay, double bx, double by, std::uint8_t layer = 0, std::uint8_t color = 1,
         StrokeKind kind = StrokeKind::Edge) {
  return {{ax, ay}, {bx, by}, layer, color, kind};
}

Sheet SheetOf(std::vector<Stroke> strokes) {
  Sheet sheet;
  sheet.strokes = std::move(strokes);
  return sheet;
}

TEST(RemoveCoincident, ExactAndNearDuplicatesLeaveOneStroke) {
  Sheet sheet = SheetOf({S(0, 0, 10, 0), S(10, 0, 0, 0), S(0, 0.001, 10, -0.001), S(0.002, 0, 9.999, 0)});
  RemoveCoincidentStrokes(sheet, 0.01);
  ASSERT_EQ(sheet.strokes.size(), 1U);
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{0, 0}, {10, 0}}}, 0.002));
}

TEST(RemoveCoincident, OverlappedPartIsRemovedFromTheShorterStroke) {
  Sheet sheet = SheetOf({S(4, 0, 12, 0), S(0, 0, 10, 0), S(2, 0, 3, 0)});
  RemoveCoincidentStrokes(sheet, 1e-9);
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{0, 0}, {10, 0}}, {{10, 0}, {12, 0}}}));
}

TEST(RemoveCoincident, EachStrokeKeepsWhatLongerOnesLeaveUncovered) {
  Sheet sheet = SheetOf({S(0, 5, 0, 0), S(0, 0, 0, 1), S(0, 3, 0, 4), S(0, 4, 0, 8)});
  RemoveCoincidentStrokes(sheet, 0.0);
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{0, 0}, {0, 5}}, {{0, 5}, {0, 8}}}));
}

TEST(RemoveCoincident, OtherLayersCrossingAndParallelStrokesStay) {
  const std::vector<Stroke> strokes = {S(0, 0, 10, 0, 0), S(0, 0, 10, 0, 1),  S(5, -5, 5, 5, 0),
                                       S(0, 1, 10, 1, 0), S(0, 0, 10, 0.5, 0), S(11, 0, 15, 0, 0)};
  Sheet sheet = SheetOf(strokes);
  RemoveCoincidentStrokes(sheet, 0.01);
  std::vector<Expected> expected;
  for (const Stroke& stroke : strokes) expected.push_back({stroke.a, stroke.b});
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, expected));
}

TEST(RemoveCoincident, CutStrokesWinOverEdgesAndPreservedOnesAreLeftAlone) {
  Sheet sheet = SheetOf({S(0, 0, 10, 0, 0, 1, StrokeKind::Edge), S(2, 0, 8, 0, 0, 5, StrokeKind::Cut),
                         S(0, 0, 10, 0, 0, 1, StrokeKind::Preserved)});
  RemoveCoincidentStrokes(sheet, 1e-6);
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{0, 0}, {2, 0}, StrokeKind::Edge},
                                                      {{8, 0}, {10, 0}, StrokeKind::Edge},
                                                      {{2, 0}, {8, 0}, StrokeKind::Cut},
                                                      {{0, 0}, {10, 0}, StrokeKind::Preserved}}));
}

TEST(RemoveCoincident, ResultDoesNotDependOnInputOrder) {
  std::vector<Stroke> strokes = {S(0, 0, 10, 0), S(5, 0, 15, 0), S(15, 0, 5, 0), S(3, 3, 3, 9, 2), S(3, 4, 3, 6, 2),
                                 S(1, 1, 2, 2, 1, 4), S(2, 2, 1, 1, 1, 3)};
  Sheet first = SheetOf(strokes);
  RemoveCoincidentStrokes(first, 1e-6);
  std::mt19937 random(7);
  for (int round = 0; round < 5; ++round) {
    std::shuffle(strokes.begin(), strokes.end(), random);
    Sheet again = SheetOf(strokes);
    RemoveCoincidentStrokes(again, 1e-6);
    EXPECT_EQ(again.strokes, first.strokes);
  }
  EXPECT_TRUE(std::is_sorted(first.strokes.begin(), first.strokes.end(), [](const Stroke& x, const Stroke& y) {
    return std::tie(x.layer, x.color) < std::tie(y.layer, y.color);
  }));
}

TEST(MergeCollinear, TouchingAndOverlappingRunsBecomeOne) {
  Sheet sheet = SheetOf({S(5, 0, 10, 0), S(0, 0, 5, 0), S(12, 0, 8, 0), S(20, 20, 20, 25), S(20, 24, 20, 30)});
  MergeCollinearStrokes(sheet, 1e-6);
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{0, 0}, {12, 0}}, {{20, 20}, {20, 30}}}));
}

TEST(MergeCollinear, GapsOtherColoursKindsAndLayersAreNotJoined) {
  const std::vector<Stroke> strokes = {S(0, 0, 5, 0, 0, 1), S(5.5, 0, 8, 0, 0, 1), S(8, 0, 9, 0, 0, 2),
                                       S(9, 0, 10, 0, 1, 2), S(10, 0, 11, 0, 1, 2, StrokeKind::Cut),
                                       S(0, 0, 0, 5, 0, 1)};
  Sheet sheet = SheetOf(strokes);
  MergeCollinearStrokes(sheet, 0.01);
  std::vector<Expected> expected;
  for (const Stroke& stroke : strokes) expected.push_back({stroke.a, stroke.b, stroke.kind});
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, expected));
}

TEST(MergeCollinear, NearlyStraightPiecesJoinAlongTheLongestOne) {
  Sheet sheet = SheetOf({S(0, 0, 10, 0), S(10, 0.004, 13, -0.003), S(-2, 0.005, 0, 0.001)});
  MergeCollinearStrokes(sheet, 0.01);
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{-2, 0}, {13, 0}}}, 1e-12));
}

// Many short strokes along a gentle arc, each within the tolerance of its neighbour: joining
// neighbour by neighbour would flatten the arc into one chord.
TEST(MergeCollinear, AGentleArcIsNotFlattened) {
  std::vector<Stroke> arc;
  const double radius = 100.0;
  const int pieces = 60;
  for (int i = 0; i < pieces; ++i) {
    const double a0 = 0.5 * i / pieces;
    const double a1 = 0.5 * (i + 1) / pieces;
    arc.push_back(S(radius * std::cos(a0), radius * std::sin(a0), radius * std::cos(a1), radius * std::sin(a1)));
  }
  Sheet sheet = SheetOf(arc);
  MergeCollinearStrokes(sheet, 0.01);
  // Every stroke's ends stay on the arc within the tolerance.
  EXPECT_GT(sheet.strokes.size(), 5U);
  for (const Stroke& stroke : sheet.strokes) {
    const double mid = std::hypot((stroke.a.x + stroke.b.x) / 2, (stroke.a.y + stroke.b.y) / 2);
    EXPECT_LT(radius - mid, 0.02);
  }
}

TEST(CleanupInput, StrokesThatAreNotFiniteAreDroppedAndBadTolerancesMeanZero) {
  const double nan = std::nan("");
  for (double tolerance : {nan, -1.0, double(INFINITY)}) {
    Sheet sheet = SheetOf({S(0, 0, nan, 0), S(0, 0, 1, 0), S(0, 0.001, 1, 0.001), S(0, 0, 1, 0)});
    RemoveCoincidentStrokes(sheet, tolerance);
    EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{0, 0}, {1, 0}}, {{0, 0.001}, {1, 0.001}}}));
    MergeCollinearStrokes(sheet, tolerance);
    EXPECT_EQ(sheet.strokes.size(), 2U);
  }
}

}  // namespace
