// Degenerate input never gives a stroke that is not finite: broken meshes, points behind the
// eye, views and cuts without a direction.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "tests/draft/draft_fixture.h"
#include "workbench/draft/window_clip.h"

namespace {

using draft_test::AddBox;
using draft_test::AddLine;
using wb::draft::GenerateOptions;
using wb::draft::GenerateSheet;
using wb::draft::SolidMesh;

const float kNan = std::numeric_limits<float>::quiet_NaN();

// Every combination of projection, hidden-line removal and cuts.
std::vector<GenerateOptions> AllModes(host::Point3f eye, host::Point3f target) {
  std::vector<GenerateOptions> modes;
  for (bool perspective : {false, true}) {
    for (bool hide : {false, true}) {
      for (bool cut : {false, true}) {
        GenerateOptions options;
        options.view = {eye, target, perspective};
        options.hideHiddenLines = hide;
        if (cut) {
          options.section = wb::draft::SectionCut{{{{0.5F, -5, 0}, {0.5F, 5, 0}, {0.5F, -5, 1}, {-5, -5, 0}}}, 'b'};
          options.plan = wb::draft::PlanCut{{0, 0, 0.7F}, 'w'};
        }
        modes.push_back(options);
      }
    }
  }
  return modes;
}

TEST(DegenerateMeshes, BrokenTrianglesAreSkippedAndTheRestDrawn) {
  wb::Drawing drawing;
  wb::Entity& solid = drawing.Add(host::kTypeSolid);
  SolidMesh mesh = wb::draft::MakeBox({0, 0, 0}, {1, 1, 1});
  mesh.vertices.push_back({kNan, 0, 0});
  mesh.vertices.push_back({2, 2, 2});
  mesh.vertices.push_back({3, 3, 3});
  mesh.vertices.push_back({0, 0, 0});  // repeats vertex 0
  mesh.triangles.push_back({8, 0, 1});    // a corner that is not finite
  mesh.triangles.push_back({0, 9, 10});   // collinear corners
  mesh.triangles.push_back({0, 11, 2});   // two corners at one point
  mesh.triangles.push_back({3, 3, 5});    // a repeated index
  wb::draft::WriteSolidMesh(solid, mesh);
  for (const GenerateOptions& options : AllModes({6, 5, 4}, {0.5F, 0.5F, 0.5F})) {
    const auto sheet = GenerateSheet(drawing, options);
    EXPECT_TRUE(draft_test::AllFinite(sheet));
    EXPECT_FALSE(sheet.strokes.empty());
  }
  GenerateOptions plain;
  plain.view = {{6, 5, 4}, {0.5F, 0.5F, 0.5F}, false};
  EXPECT_EQ(GenerateSheet(drawing, plain).strokes.size(), 12U);  // the box, nothing more
}

TEST(DegenerateMeshes, FlatAndEmptySolidsAndMalformedRecordsGiveNoNaN) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {1, 1, 0});  // no height
  AddBox(drawing, {2, 2, 2}, {0, 0, 0});  // a point
  drawing.Add(host::kTypeSolid).record = {1, 2, 3, 4, 5};
  wb::draft::WriteSolidMesh(drawing.Add(host::kTypeSolid), SolidMesh{});
  AddLine(drawing, {1, 1, 1}, {1, 1, 1});  // no length
  AddLine(drawing, {kNan, 1, 1}, {2, 2, 2});
  drawing.Add(host::kTypeLine);  // no record at all
  for (const GenerateOptions& options : AllModes({6, 5, 4}, {0.5F, 0.5F, 0.5F})) {
    EXPECT_TRUE(draft_test::AllFinite(GenerateSheet(drawing, options)));
  }
}

TEST(DegenerateViews, EyeOnTheTargetAndEyeInsideASolidStayFinite) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {1, 1, 1});
  AddBox(drawing, {-3, -3, -3}, {6, 6, 6});
  AddLine(drawing, {-10, 0.5F, 0.5F}, {10, 0.5F, 0.5F});
  for (host::Point3f eye : {host::Point3f{0.5F, 0.5F, 0.5F}, host::Point3f{0.5F, -0.5F, 0.5F}, host::Point3f{kNan, kNan, kNan}}) {
    for (const GenerateOptions& options : AllModes(eye, {0.5F, 0.5F, 0.5F})) {
      const auto sheet = GenerateSheet(drawing, options);
      EXPECT_TRUE(draft_test::AllFinite(sheet));
      EXPECT_FALSE(sheet.strokes.empty());
    }
  }
}

TEST(DegenerateViews, LinesReachingBehindTheEyeStopAtTheNearDepth) {
  wb::Drawing drawing;
  AddLine(drawing, {1, -100, 0}, {1, 100, 0});  // passes beside the eye, from behind to far ahead
  GenerateOptions options;
  options.view = {{0, -10, 0}, {0, 0, 0}, true};
  const auto sheet = GenerateSheet(drawing, options);
  ASSERT_EQ(sheet.strokes.size(), 1U);
  // Distance 10, near depth 0.01: the near end projects to x = 1 * 10 / 0.01, the far end
  // (depth 110) to 10 / 110.
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{1000, 0}, {10.0 / 110.0, 0}}}, 1e-6));
}

TEST(DegenerateCuts, CutsWithoutAPlaneCutNothing) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {1, 1, 1});
  GenerateOptions plain;
  plain.view = {{6, 5, 4}, {0.5F, 0.5F, 0.5F}, false};
  const auto uncut = GenerateSheet(drawing, plain);
  GenerateOptions cut = plain;
  cut.section = wb::draft::SectionCut{{{{1, 1, 1}, {1, 1, 1}, {1, 1, 2}, {1, 1, 1}}}, 'b'};  // start = end
  EXPECT_EQ(GenerateSheet(drawing, cut), uncut);
  cut.section = wb::draft::SectionCut{{{{0, 0, 0}, {kNan, 0, 0}, {0, 0, 1}, {1, 0, 0}}}, 'b'};
  EXPECT_EQ(GenerateSheet(drawing, cut), uncut);
  cut.section.reset();
  cut.plan = wb::draft::PlanCut{{0, 0, kNan}, 'b'};
  EXPECT_EQ(GenerateSheet(drawing, cut), uncut);
}

TEST(DegenerateCuts, PlanAtAFaceCountsTheFaceAsCutAway) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {1, 1, 1}, 0, 2);
  GenerateOptions options;
  options.view = {{0.5F, 0.5F, 20}, {0.5F, 0.5F, 0}, false};
  options.hideHiddenLines = true;
  options.plan = wb::draft::PlanCut{{0, 0, 1}, 'b'};  // exactly at the top face
  const auto sheet = GenerateSheet(drawing, options);
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{{-0.5, -0.5}, {0.5, -0.5}, wb::draft::StrokeKind::Cut},
                                                      {{0.5, -0.5}, {0.5, 0.5}, wb::draft::StrokeKind::Cut},
                                                      {{0.5, 0.5}, {-0.5, 0.5}, wb::draft::StrokeKind::Cut},
                                                      {{-0.5, 0.5}, {-0.5, -0.5}, wb::draft::StrokeKind::Cut}},
                                      1e-9));
  options.plan = wb::draft::PlanCut{{0, 0, 0}, 'b'};  // at the bottom face: nothing is left
  EXPECT_TRUE(GenerateSheet(drawing, options).strokes.empty());
}

}  // namespace
