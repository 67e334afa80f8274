// What a 2D save writes, by value: a view put on screen through a camera, Save2D through the
// host's 2D commands, and the DXF read back.
#include <cmath>

#include "display/display_mode.h"
#include "tests/output2d/output2d_fixture.h"
#include "views/hr_section.h"
#include "workbench/draft/dxf_reader.h"

namespace output2d_test {
namespace {

using draft_test::Expected;
using wb::draft::Point2;
using wb::draft::Sheet;
using wb::draft::StrokeKind;

constexpr double kTolerance = 1e-4;

struct Vec {
  double x, y, z;
};
Vec operator-(Vec a, Vec b) { return {a.x - b.x, a.y - b.y, a.z - b.z}; }
double Dot(Vec a, Vec b) { return a.x * b.x + a.y * b.y + a.z * b.z; }
Vec Cross(Vec a, Vec b) { return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x}; }
Vec Unit(Vec a) {
  const double length = std::sqrt(Dot(a, a));
  return {a.x / length, a.y / length, a.z / length};
}

// The view plane as a CAD user knows it: centred on the target, x to the right, y up; a
// perspective scales by distance over depth. Written here again so the test does not lean on
// the projection it checks.
Point2 Projected(const View& view, Vec point) {
  const Vec eye{view.eye[0], view.eye[1], view.eye[2]}, target{view.target[0], view.target[1], view.target[2]};
  const Vec forward = Unit(target - eye), right = Unit(Cross(forward, {0.0, 0.0, 1.0})), up = Cross(right, forward);
  const Vec offset = point - (view.perspective ? eye : target);
  const double scale = view.perspective ? std::sqrt(Dot(target - eye, target - eye)) / Dot(offset, forward) : 1.0;
  return {Dot(offset, right) * scale, Dot(offset, up) * scale};
}

// The unit cube's edges as the view shows them, without those that end in `hiddenCorner` (bit 0
// x, bit 1 y, bit 2 z; -1 for none).
std::vector<Expected> CubeSeenFrom(const View& view, int hiddenCorner) {
  const auto at = [&](int c) { return Projected(view, {double(c & 1), double((c >> 1) & 1), double((c >> 2) & 1)}); };
  std::vector<Expected> edges;
  for (int corner = 0; corner < 8; ++corner) {
    for (const int bit : {1, 2, 4}) {
      const int other = corner | bit;
      if (other != corner && corner != hiddenCorner && other != hiddenCorner) edges.push_back({at(corner), at(other)});
    }
  }
  return edges;
}

std::vector<wb::draft::Stroke> OfKind(const Sheet& sheet, StrokeKind kind) {
  std::vector<wb::draft::Stroke> strokes;
  std::ranges::copy_if(sheet.strokes, std::back_inserter(strokes), [&](const auto& s) { return s.kind == kind; });
  return strokes;
}

// Straight down onto the xy plane: view coordinates are drawing x and y.
const View kTop{{0.0F, 0.0F, 10.0F}, {0.0F, 0.0F, 0.0F}, false, HRUtility::kGeometric};

class OutputGeometryTest : public Output2DTest {
 protected:
  Sheet SaveAndRead(const View& view, const SaveOptions& options = {}) {
    Show(view);
    EXPECT_TRUE(Save(Target(), options));
    return wb::draft::ReadDxfSheet(Target().string() + ".dxf");
  }
};

TEST_F(OutputGeometryTest, CubeShowsEveryEdgeButInSolidModesOnlyTheVisibleOnes) {
  AddCube();
  // Back in Geometric after a solid mode, every edge shows again.
  for (const std::int16_t mode : {HRUtility::kGeometric, HRUtility::kHiddenline, HRUtility::kGeometric}) {
    for (const bool perspective : {false, true}) {
      SCOPED_TRACE(testing::Message() << "mode " << mode << (perspective ? ", perspective" : ", parallel"));
      // From the front right, above: corner 2 (0, 1, 0) is the one no visible face touches.
      const View view{{3.0F, -4.0F, 2.0F}, {0.5F, 0.5F, 0.5F}, perspective, mode};
      const Sheet sheet = SaveAndRead(view);
      EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, CubeSeenFrom(view, mode == HRUtility::kGeometric ? -1 : 2),
                                          kTolerance));
      EXPECT_TRUE(sheet.labels.empty());
    }
  }
}

TEST_F(OutputGeometryTest, SectionOfAWallDrawsItsCutOutline) {
  // A wall 4 long, 0.3 thick and 3 high, cut square across at x = 2.
  draft_test::AddBox(Drawing(), {0.0F, 0.0F, 0.0F}, {4.0F, 0.3F, 3.0F}, 0, 1);
  HRSection section;
  SectionSettings settings;
  settings.start[0] = settings.end[0] = 2.0F;
  settings.start[1] = -1.0F;
  settings.end[1] = 2.0F;
  settings.symbolFile = "...sec_sym\\sec01";
  section.SetName("A");
  section.SetSettings(settings);
  ASSERT_EQ(section.Create(), 0);
  ASSERT_EQ(section.ShowView(-1), 0);
  ASSERT_TRUE(Save(Target(), {.removeCoincident = 1, .lineMerge = 1}));
  const Sheet sheet = wb::draft::ReadDxfSheet(Target().string() + ".dxf");
  // Looking along -x onto the cut face, centred on the cut line: x is drawing y - 0.5, y is z.
  EXPECT_TRUE(draft_test::SameStrokes(OfKind(sheet, StrokeKind::Cut),
                                      {{{-0.5, 0.0}, {-0.2, 0.0}, StrokeKind::Cut},
                                       {{-0.2, 0.0}, {-0.2, 3.0}, StrokeKind::Cut},
                                       {{-0.2, 3.0}, {-0.5, 3.0}, StrokeKind::Cut},
                                       {{-0.5, 3.0}, {-0.5, 0.0}, StrokeKind::Cut}},
                                      kTolerance));
  EXPECT_TRUE(OfKind(sheet, StrokeKind::Edge).empty()) << "the rest of the wall lies behind its cut face";
}

TEST_F(OutputGeometryTest, CleanupRemovesCoincidentLinesAndMergesCollinearOnes) {
  draft_test::AddLine(Drawing(), {0.0F, 0.0F, 0.0F}, {2.0F, 0.0F, 0.0F});
  draft_test::AddLine(Drawing(), {0.0F, 0.0F, 0.0F}, {2.0F, 0.0F, 0.0F});
  draft_test::AddLine(Drawing(), {2.0F, 0.0F, 0.0F}, {3.0F, 0.0F, 0.0F});
  draft_test::AddLine(Drawing(), {0.0F, 1.0F, 0.0F}, {1.0F, 1.0F, 0.0F});
  const Expected whole{{0.0, 0.0}, {2.0, 0.0}}, end{{2.0, 0.0}, {3.0, 0.0}}, merged{{0.0, 0.0}, {3.0, 0.0}};
  const Expected apart{{0.0, 1.0}, {1.0, 1.0}};
  EXPECT_TRUE(draft_test::SameStrokes(SaveAndRead(kTop).strokes, {whole, whole, end, apart}));
  EXPECT_TRUE(draft_test::SameStrokes(SaveAndRead(kTop, {.removeCoincident = 1}).strokes, {whole, end, apart}));
  EXPECT_TRUE(draft_test::SameStrokes(SaveAndRead(kTop, {.lineMerge = 1}).strokes, {merged, apart}));
  EXPECT_TRUE(
      draft_test::SameStrokes(SaveAndRead(kTop, {.removeCoincident = 1, .lineMerge = 1}).strokes, {merged, apart}));
}

TEST_F(OutputGeometryTest, AutoClipCutsTheDrawingToTheViewWindow) {
  draft_test::AddLine(Drawing(), {-5.0F, 0.0F, 0.0F}, {5.0F, 0.0F, 0.0F});
  draft_test::AddLine(Drawing(), {-5.0F, 3.0F, 0.0F}, {5.0F, 3.0F, 0.0F});  // outside the window
  View windowed = kTop;
  windowed.window = {-1.0, -1.0, 2.0, 1.0};
  const std::vector<Expected> clipped = {{{-1.0, 0.0}, {2.0, 0.0}}};
  EXPECT_TRUE(draft_test::SameStrokes(SaveAndRead(windowed, {.autoClip = 1}).strokes, clipped, kTolerance));
  EXPECT_EQ(SaveAndRead(windowed, {.autoClip = 0}).strokes.size(), 2U);
  // Merged into what an earlier view left, only the new drawing is clipped.
  const Sheet merged = SaveAndRead(windowed, {.autoClip = 1, .overwrite = 0});
  EXPECT_TRUE(draft_test::SameStrokes(merged.strokes,
                                      {{{-5.0, 0.0}, {5.0, 0.0}}, {{-5.0, 3.0}, {5.0, 3.0}}, {{-1.0, 0.0}, {2.0, 0.0}}},
                                      kTolerance));
  // A window beside everything leaves the drawing unclipped rather than empty.
  windowed.window = {50.0, 50.0, 60.0, 60.0};
  EXPECT_EQ(SaveAndRead(windowed, {.autoClip = 1}).strokes.size(), 2U);
}

}  // namespace
}  // namespace output2d_test
