// Hidden-line removal: a cube's far edges, boxes and lines partly behind others, solids that
// touch, and what hides nothing.
#include <gtest/gtest.h>

#include <cmath>

#include "tests/draft/draft_fixture.h"
#include "workbench/draft/projection.h"

namespace {

using draft_test::AddBox;
using draft_test::AddLine;
using draft_test::Expected;
using wb::draft::GenerateOptions;
using wb::draft::GenerateSheet;
using wb::draft::Point2;
using wb::draft::Projection;
using wb::draft::Stroke;
using wb::draft::Vec3;

GenerateOptions Hidden(host::Point3f eye, host::Point3f target, bool perspective = false) {
  GenerateOptions options;
  options.view = {eye, target, perspective};
  options.hideHiddenLines = true;
  return options;
}

// Front view along +y with view x = world x and view y = world z.
GenerateOptions FrontView() { return Hidden({0.0F, -50.0F, 0.0F}, {0.0F, 0.0F, 0.0F}); }

// The cube's edges that do not meet the corner (0, 0, 0), projected.
std::vector<Expected> EdgesAwayFromOrigin(const Projection& projection) {
  std::vector<Expected> expected;
  for (int i = 1; i < 8; ++i) {
    for (int bit = 1; bit < 8; bit <<= 1) {
      if ((i & bit) == 0) {
        const int j = i | bit;
        const Vec3 a{double(i & 1), double((i >> 1) & 1), double((i >> 2) & 1)};
        const Vec3 b{double(j & 1), double((j >> 1) & 1), double((j >> 2) & 1)};
        expected.push_back({projection.Project(a), projection.Project(b)});
      }
    }
  }
  return expected;
}

TEST(HiddenLinesCube, CornerViewShowsNineEdges) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {1, 1, 1});
  for (bool perspective : {false, true}) {
    const auto options = Hidden({6.0F, 5.0F, 4.0F}, {0.5F, 0.5F, 0.5F}, perspective);
    const auto sheet = GenerateSheet(drawing, options);
    EXPECT_EQ(sheet.strokes.size(), 9U);
    EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, EdgesAwayFromOrigin(Projection(options.view)), 1e-6))
        << (perspective ? "perspective" : "parallel");
  }
}

// In an exact isometric view the hidden corner falls on the near one and the hidden edges on
// visible ones: they must go, not survive as duplicates.
TEST(HiddenLinesCube, IsometricViewHidesEdgesLyingUnderVisibleOnes) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {1, 1, 1});
  const auto options = Hidden({10.5F, 10.5F, 10.5F}, {0.5F, 0.5F, 0.5F});
  const auto sheet = GenerateSheet(drawing, options);
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, EdgesAwayFromOrigin(Projection(options.view)), 1e-6));
}

TEST(HiddenLinesPartial, BoxBehindBoxIsCutWhereTheFrontOneEnds) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {2, 1, 2}, 0, 1);
  AddBox(drawing, {1, 3, 0}, {3, 1, 1}, 0, 2);
  const auto sheet = GenerateSheet(drawing, FrontView());
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{0, 0}, {2, 0}},
                                                      {{2, 0}, {2, 2}},
                                                      {{2, 2}, {0, 2}},
                                                      {{0, 2}, {0, 0}},
                                                      {{2, 1}, {4, 1}},
                                                      {{2, 0}, {4, 0}},
                                                      {{4, 0}, {4, 1}}},
                                      1e-6));
  for (const Stroke& stroke : sheet.strokes) EXPECT_EQ(stroke.color, std::max(stroke.a.x, stroke.b.x) > 2.0 ? 2 : 1);
}

TEST(HiddenLinesPartial, PerspectiveSplitPointFollowsTheSilhouette) {
  wb::Drawing drawing;
  AddBox(drawing, {-1, 0, -1}, {2, 1, 2});
  // A line 10 behind the box, seen from 20 in front of it.
  AddLine(drawing, {-4, 11, 0}, {4, 11, 0});
  const auto options = Hidden({0.0F, -20.0F, 0.0F}, {0.0F, 0.0F, 0.0F}, true);
  const auto sheet = GenerateSheet(drawing, options);
  // Distance 20; the line at depth 31 projects x to x * 20 / 31, the silhouette to +-1.
  const double end = 4.0 * 20.0 / 31.0;
  std::vector<Stroke> lineParts;
  for (const Stroke& stroke : sheet.strokes) {
    if (stroke.a.y == 0.0 && stroke.b.y == 0.0) lineParts.push_back(stroke);
  }
  EXPECT_TRUE(draft_test::SameStrokes(lineParts, {{{-end, 0}, {-1, 0}}, {{1, 0}, {end, 0}}}, 1e-6));
}

TEST(HiddenLinesPartial, LinesInFrontOrOnAFaceStayWhole) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {2, 1, 2});
  AddLine(drawing, {-1, -1, 1}, {3, -1, 1});           // in front of the box
  AddLine(drawing, {0.5F, 0, 0.5F}, {1.5F, 0, 1.5F});  // drawn on its front face
  const auto sheet = GenerateSheet(drawing, FrontView());
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{0, 0}, {2, 0}},
                                                      {{2, 0}, {2, 2}},
                                                      {{2, 2}, {0, 2}},
                                                      {{0, 2}, {0, 0}},
                                                      {{-1, 1}, {3, 1}},
                                                      {{0.5, 0.5}, {1.5, 1.5}}}));
}

// Walls are built of boxes that share faces; the edges on shared faces must not hide each other.
TEST(HiddenLinesTouching, BoxesSharingAFaceKeepTheirFrontEdges) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {1, 1, 1});
  AddBox(drawing, {1, 0, 0}, {1, 1, 1});
  const auto options = Hidden({4.0F, -6.0F, 5.0F}, {1.0F, 0.5F, 0.5F});
  const Projection projection(options.view);
  const auto sheet = GenerateSheet(drawing, options);
  // The edge x = 1 on the front face is drawn by both boxes, in full; so is the top one.
  const Expected frontJoint{projection.Project({1, 0, 0}), projection.Project({1, 0, 1})};
  const Expected topJoint{projection.Project({1, 0, 1}), projection.Project({1, 1, 1})};
  int front = 0;
  int top = 0;
  for (const Stroke& stroke : sheet.strokes) {
    front += draft_test::SameStrokes({stroke}, {frontJoint}) ? 1 : 0;
    top += draft_test::SameStrokes({stroke}, {topJoint}) ? 1 : 0;
  }
  EXPECT_EQ(front, 2);
  EXPECT_EQ(top, 2);
  // Nine edges of each box face the eye; two of the left box's lie behind the right box.
  EXPECT_EQ(sheet.strokes.size(), 16U);
}

// A face is two triangles; a line right behind their shared diagonal lies on the edge of both,
// where rounding can put it just outside each.
TEST(HiddenLinesTouching, LineBehindTheDiagonalOfAFaceStaysHidden) {
  for (float k = 0; k < 40; ++k) {
    const float x0 = 0.1F + 0.013F * k;
    const float z0 = 0.2F + 0.007F * k;
    const float width = 0.6F + 0.011F * k;
    const float height = 0.7F + 0.003F * k;
    wb::Drawing drawing;
    AddBox(drawing, {x0, 0, z0}, {width, 1, height});
    AddLine(drawing, {x0, 5, z0}, {x0 + width, 5, z0 + height});
    EXPECT_EQ(GenerateSheet(drawing, FrontView()).strokes.size(), 4U) << k;
  }
}

TEST(HiddenLinesVisibility, HiddenEntitiesAndLayersThatAreOffHideNothing) {
  wb::Drawing drawing;
  AddLine(drawing, {0, 5, 1}, {2, 5, 1});
  wb::Entity& hiddenBox = AddBox(drawing, {-1, 0, 0}, {4, 1, 2});
  hiddenBox.header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
  AddBox(drawing, {-1, 0, 0}, {4, 1, 2}, 3);
  drawing.layers[3].on = false;
  const auto sheet = GenerateSheet(drawing, FrontView());
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{0, 1}, {2, 1}}}));
}


TEST(SheetAttributes, StrokesTakeTheirEntitysLayerAndColourAndTheSheetTheLayerNames) {
  wb::Drawing drawing;
  drawing.layers[4].name = "Walls";
  AddLine(drawing, {0, 0, 0}, {1, 0, 0}, 4, 12);
  AddLine(drawing, {0, 0, 1}, {1, 0, 1}, 5, 0);  // colour 0 cannot be drawn: the foreground
  wb::draft::GenerateOptions options = FrontView();
  const auto sheet = GenerateSheet(drawing, options);
  ASSERT_EQ(sheet.strokes.size(), 2U);
  EXPECT_EQ(sheet.strokes[0].layer, 4);
  EXPECT_EQ(sheet.strokes[0].color, 12);
  EXPECT_EQ(sheet.strokes[1].layer, 5);
  EXPECT_EQ(sheet.strokes[1].color, 7);
  EXPECT_EQ(sheet.layerNames[4], "Walls");
  EXPECT_EQ(sheet.layerNames[5], drawing.layers[5].name);
}

TEST(SheetAttributes, TextsAreNotDrawnAsLines) {
  wb::Drawing drawing;
  wb::Entity& text = AddLine(drawing, {0, 0, 0}, {1, 0, 0});
  wb::Attribute& block = text.attributes.emplace_back();
  block.name = "tb=";
  block.type = wb::AttributeType::FloatVector;
  EXPECT_TRUE(GenerateSheet(drawing, FrontView()).strokes.empty());
}

}  // namespace
