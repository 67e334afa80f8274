// Window clip: strokes cut exactly at the window's edges, what lies outside dropped.
#include <gtest/gtest.h>

#include <cmath>

#include "tests/draft/draft_fixture.h"
#include "workbench/draft/window_clip.h"

namespace {

using wb::draft::Box2;
using wb::draft::ClipToWindow;
using wb::draft::Label;
using wb::draft::Sheet;
using wb::draft::Stroke;

Sheet SheetOf(std::vector<Stroke> strokes) {
  Sheet sheet;
  sheet.strokes = std::move(strokes);
  return sheet;
}

const Box2 kWindow{{0, 0}, {10, 5}};

TEST(ClipToWindow, StrokesAreCutAtEachEdge) {
  Sheet sheet = SheetOf({{{-5, 2}, {15, 2}, 3, 4},   // through left and right
                         {{4, -1}, {4, 7}},          // through bottom and top
                         {{-2, -1}, {4, 2}},         // in through the left side at y = 0
                         {{8, 4}, {12, 6}}});        // out through the right side at y = 5
  ClipToWindow(sheet, kWindow);
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{0, 2}, {10, 2}}, {{4, 0}, {4, 5}}, {{0, 0}, {4, 2}}, {{8, 4}, {10, 5}}}));
  EXPECT_EQ(sheet.strokes[0].layer, 3);
  EXPECT_EQ(sheet.strokes[0].color, 4);
  EXPECT_EQ(sheet.strokes[0].a, (wb::draft::Point2{0, 2}));  // direction kept
}

TEST(ClipToWindow, InsideStaysExactAndOutsideGoes) {
  const Stroke inside{{1.1, 1.3}, {9.7, 4.9}};
  Sheet sheet = SheetOf({inside, {{-3, -3}, {-1, 8}}, {{11, 1}, {12, 2}}, {{-1, 7}, {12, 7}}, {{-1, 6}, {6, 12}}});
  ClipToWindow(sheet, kWindow);
  ASSERT_EQ(sheet.strokes.size(), 1U);
  EXPECT_EQ(sheet.strokes[0], inside);
}

TEST(ClipToWindow, CornersInAnyOrderGiveTheSameWindow) {
  Sheet sheet = SheetOf({{{-5, 2}, {15, 2}}});
  ClipToWindow(sheet, Box2{{10, 5}, {0, 0}});
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{0, 2}, {10, 2}}}));
}

TEST(ClipToWindow, LabelsOutsideAreDropped) {
  Sheet sheet;
  sheet.labels = {Label{{5, 2}, 2.5, 0, "in"}, Label{{11, 2}, 2.5, 0, "out"}, Label{{std::nan(""), 1}, 2.5, 0, "bad"}};
  ClipToWindow(sheet, kWindow);
  ASSERT_EQ(sheet.labels.size(), 1U);
  EXPECT_EQ(sheet.labels[0].text, "in");
}

TEST(ClipToWindow, UnusableInputIsHandledSafely) {
  const double nan = std::nan("");
  Sheet sheet = SheetOf({{{nan, 0}, {1, 1}}, {{1, 1}, {2, INFINITY}}, {{1, 1}, {2, 2}}});
  ClipToWindow(sheet, kWindow);
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{1, 1}, {2, 2}}}));
  const Sheet before = sheet;
  ClipToWindow(sheet, Box2{{nan, 0}, {10, 10}});
  EXPECT_EQ(sheet, before);
}

}  // namespace
