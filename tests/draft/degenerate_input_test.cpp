// Degenerate views, meshes, records and cuts never give a stroke that is not finite.
#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <limits>

#include "tests/draft/draft_fixture.h"
#include "workbench/draft/projection.h"

namespace {

using namespace draft_test;
using namespace wb::draft;

const float kNan = std::numeric_limits<float>::quiet_NaN();

// An eye on the target looks straight down in parallel; values not finite count as 0; a line
// reaching behind the eye stops at the near depth, a thousandth of the distance (10).
TEST(ProjectionFrame, FallbacksStillGiveAFiniteView) {
  EXPECT_FALSE(Projection({{3, 4, 5}, {3, 4, 5}, true}).Perspective());
  EXPECT_EQ(Projection({{3, 4, 5}, {3, 4, 5}, true}).Project({4, 6, -20}), (Point2{1, 2}));
  EXPECT_EQ(Projection({{kNan, 0, 10}, {0, 0, INFINITY}, true}).Project({1, 2, 5}), (Point2{2, 4}));
  wb::Drawing drawing;
  AddLine(drawing, {1, -100, 0}, {1, 100, 0});
  EXPECT_TRUE(SameStrokes(GenerateSheet(drawing, ViewOf({0, -10, 0}, {0, 0, 0}, true)).strokes,
                          {{{1000, 0}, {10.0 / 110.0, 0}}}, 1e-6));
}

std::vector<GenerateOptions> AllModes(host::Point3f eye) {
  std::vector<GenerateOptions> modes;
  for (int mode = 0; mode < 8; ++mode) {
    GenerateOptions& options = modes.emplace_back(ViewOf(eye, {0.5F, 0.5F, 0.5F}, (mode & 1) != 0, (mode & 2) != 0));
    if ((mode & 4) != 0) {
      options.section = SectionCut{{{{0.5F, -5, 0}, {0.5F, 5, 0}, {0.5F, -5, 1}, {-5, -5, 0}}}, 'b'};
      options.plan = PlanCut{{0, 0, 0.7F}, 'w'};
    }
  }
  return modes;
}

TEST(DegenerateInput, BrokenMeshesDamagedRecordsAndViewsFromAnywhereStayFinite) {
  wb::Drawing drawing;
  SolidMesh mesh = MakeBox({0, 0, 0}, {1, 1, 1});
  mesh.vertices.insert(mesh.vertices.end(), {{kNan, 0, 0}, {2, 2, 2}, {3, 3, 3}, {0, 0, 0}});
  // A corner that is not finite, collinear corners, two corners at one point, a repeated index.
  mesh.triangles.insert(mesh.triangles.end(), {{8, 0, 1}, {0, 9, 10}, {0, 11, 2}, {3, 3, 5}});
  WriteSolidMesh(drawing.Add(host::kTypeSolid), mesh);
  // Records too short, out of range, or with counts wrapping at 2^32 (12 * 2^30) are refused.
  drawing.Add(host::kTypeSolid).record = {1, 2, 3, 4, 5};
  wb::Entity& outOfRange = AddBox(drawing, {0, 0, 0}, {1, 1, 1});
  outOfRange.record[outOfRange.record.size() - 4] = 8;  // the box has vertices 0 to 7
  wb::Entity& wrapping = AddBox(drawing, {0, 0, 0}, {1, 1, 1});
  const std::uint32_t huge[2] = {0x40000000U, 20U};
  std::memcpy(wrapping.record.data(), huge, sizeof(huge));
  EXPECT_EQ(GenerateSheet(drawing, ViewOf({6, 5, 4}, {0.5F, 0.5F, 0.5F})).strokes.size(), 12U);  // the box only
  AddBox(drawing, {-3, -3, -3}, {6, 6, 6});
  AddLine(drawing, {-10, 0.5F, 0.5F}, {10, 0.5F, 0.5F});
  AddBox(drawing, {0, 0, 0}, {1, 1, 0});  // no height
  AddBox(drawing, {2, 2, 2}, {0, 0, 0});  // a point
  WriteSolidMesh(drawing.Add(host::kTypeSolid), SolidMesh{});
  AddLine(drawing, {1, 1, 1}, {1, 1, 1});  // no length
  AddLine(drawing, {kNan, 1, 1}, {2, 2, 2});
  drawing.Add(host::kTypeLine);  // no record at all
  // Outside, on the target, inside the outer solid, and nowhere; in every mode.
  for (host::Point3f eye : {host::Point3f{6, 5, 4}, host::Point3f{0.5F, 0.5F, 0.5F}, host::Point3f{0.5F, -0.5F, 0.5F},
                            host::Point3f{kNan, kNan, kNan}}) {
    for (const GenerateOptions& options : AllModes(eye)) {
      const Sheet sheet = GenerateSheet(drawing, options);
      EXPECT_FALSE(sheet.strokes.empty());
      for (const Stroke& s : sheet.strokes) EXPECT_TRUE(std::isfinite(s.a.x + s.a.y + s.b.x + s.b.y));
    }
  }
}

TEST(DegenerateCuts, CutsWithoutAPlaneCutNothingAndAFaceOnThePlanIsCutAway) {
  wb::Drawing drawing;
  AddBox(drawing, {0, 0, 0}, {1, 1, 1});
  const GenerateOptions plain = ViewOf({6, 5, 4}, {0.5F, 0.5F, 0.5F});
  const std::vector<std::pair<std::optional<SectionCut>, std::optional<PlanCut>>> cuts = {
      {SectionCut{{{{1, 1, 1}, {1, 1, 1}, {1, 1, 2}, {1, 1, 1}}}, 'b'}, {}},  // start = end
      {SectionCut{{{{0, 0, 0}, {kNan, 0, 0}, {0, 0, 1}, {1, 0, 0}}}, 'b'}, {}},
      {{}, PlanCut{{0, 0, kNan}, 'b'}},
      {{}, PlanCut{{0, 0, 5}, 'b'}},  // above the box: all of it is kept
  };
  for (std::size_t i = 0; i < cuts.size(); ++i) {
    GenerateOptions cut = plain;
    std::tie(cut.section, cut.plan) = cuts[i];
    EXPECT_EQ(GenerateSheet(drawing, cut), GenerateSheet(drawing, plain)) << i;
  }
  GenerateOptions top = ViewOf({0.5F, 0.5F, 20}, {0.5F, 0.5F, 0}, false, true);
  top.plan = PlanCut{{0, 0, 1}, 'b'};  // exactly at the top face
  const Point2 p0{-0.5, -0.5}, p1{0.5, -0.5}, p2{0.5, 0.5}, p3{-0.5, 0.5};
  EXPECT_TRUE(SameStrokes(GenerateSheet(drawing, top).strokes,
                          {{p0, p1, StrokeKind::Cut}, {p1, p2, StrokeKind::Cut}, {p2, p3, StrokeKind::Cut},
                           {p3, p0, StrokeKind::Cut}}));
  top.plan = PlanCut{{0, 0, 0}, 'b'};  // at the bottom face: nothing is left
  EXPECT_TRUE(GenerateSheet(drawing, top).strokes.empty());
}

}  // namespace
