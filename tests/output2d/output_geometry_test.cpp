// What a 2D save writes, by value: a view put on screen through a camera, Save2D through the
// host's 2D commands, and the DXF read back.
#include <cmath>

#include "display/display_mode.h"
#include "display/save2d.h"
#include "tests/output2d/output2d_fixture.h"
#include "views/hr_section.h"

namespace output2d_test {
namespace {

using draft_test::Expected;
using draft_test::SameStrokes;
using wb::draft::Point2;
using wb::draft::Sheet;
using wb::draft::Stroke;
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
  const Vec eye{view.eye.x, view.eye.y, view.eye.z};
  const Vec target{view.target.x, view.target.y, view.target.z};
  const Vec forward = Unit(target - eye);
  const Vec right = Unit(Cross(forward, {0.0, 0.0, 1.0}));
  const Vec up = Cross(right, forward);
  if (!view.perspective) {
    const Vec offset = point - target;
    return {Dot(offset, right), Dot(offset, up)};
  }
  const Vec offset = point - eye;
  const double scale = std::sqrt(Dot(target - eye, target - eye)) / Dot(offset, forward);
  return {Dot(offset, right) * scale, Dot(offset, up) * scale};
}

// The twelve edges of the unit cube at the origin, by their corners (bit 0 x, bit 1 y, bit 2 z).
std::vector<std::pair<int, int>> CubeEdges() {
  std::vector<std::pair<int, int>> edges;
  for (int corner = 0; corner < 8; ++corner) {
    for (const int bit : {1, 2, 4}) {
      if ((corner & bit) == 0) edges.emplace_back(corner, corner | bit);
    }
  }
  return edges;
}

Vec Corner(int corner) { return {double(corner & 1), double((corner >> 1) & 1), double((corner >> 2) & 1)}; }

// The cube's edges as the view shows them, leaving out those that end in `hiddenCorner` (-1: none).
std::vector<Expected> CubeSeenFrom(const View& view, int hiddenCorner = -1) {
  std::vector<Expected> expected;
  for (const auto& [a, b] : CubeEdges()) {
    if (a == hiddenCorner || b == hiddenCorner) continue;
    expected.push_back({Projected(view, Corner(a)), Projected(view, Corner(b))});
  }
  return expected;
}

std::vector<Stroke> OfKind(const Sheet& sheet, StrokeKind kind) {
  std::vector<Stroke> strokes;
  for (const Stroke& stroke : sheet.strokes) {
    if (stroke.kind == kind) strokes.push_back(stroke);
  }
  return strokes;
}

// From the front right, above: the cube shows its +x, -y and +z faces; corner 2 (0, 1, 0) is
// the one no visible face touches.
const View kCorner{{3.0F, -4.0F, 2.0F}, {0.5F, 0.5F, 0.5F}, false, HRUtility::kGeometric};
constexpr int kHiddenCorner = 2;
// Straight down onto the xy plane: view coordinates are drawing x and y.
const View kTop{{0.0F, 0.0F, 10.0F}, {0.0F, 0.0F, 0.0F}, false, HRUtility::kGeometric};

class OutputGeometryTest : public Output2DTest {
 protected:
  std::filesystem::path Target() const { return Folder() / "view"; }
  Sheet SaveAndRead(const View& view, const SaveOptions& options = {}) {
    Show(view);
    EXPECT_TRUE(Save(Target(), options));
    return ReadOutput(Target());
  }
};

TEST_F(OutputGeometryTest, ParallelViewDrawsEveryEdgeOfTheCube) {
  AddCube({0.0F, 0.0F, 0.0F});
  const Sheet sheet = SaveAndRead(kCorner);
  EXPECT_TRUE(SameStrokes(sheet.strokes, CubeSeenFrom(kCorner), kTolerance));
  EXPECT_TRUE(sheet.labels.empty());
}

TEST_F(OutputGeometryTest, PerspectiveViewDrawsEveryEdgeSmallerWithDistance) {
  AddCube({0.0F, 0.0F, 0.0F});
  View perspective = kCorner;
  perspective.perspective = true;
  const Sheet sheet = SaveAndRead(perspective);
  EXPECT_TRUE(SameStrokes(sheet.strokes, CubeSeenFrom(perspective), kTolerance));
  // The far corner draws nearer the centre than a parallel view puts it.
  const Point2 far = Projected(perspective, Corner(kHiddenCorner));
  const Point2 flat = Projected(kCorner, Corner(kHiddenCorner));
  EXPECT_LT(std::hypot(far.x, far.y), std::hypot(flat.x, flat.y));
}

TEST_F(OutputGeometryTest, SolidModeRemovesHiddenEdgesThatGeometricKeeps) {
  AddCube({0.0F, 0.0F, 0.0F});
  View hiddenline = kCorner;
  hiddenline.displayMode = HRUtility::kHiddenline;
  EXPECT_TRUE(SameStrokes(SaveAndRead(hiddenline).strokes, CubeSeenFrom(hiddenline, kHiddenCorner), kTolerance));

  View perspective = hiddenline;
  perspective.perspective = true;
  EXPECT_TRUE(SameStrokes(SaveAndRead(perspective).strokes, CubeSeenFrom(perspective, kHiddenCorner), kTolerance));

  EXPECT_EQ(SaveAndRead(kCorner).strokes.size(), 12U) << "back in Geometric every edge shows again";
}

TEST_F(OutputGeometryTest, SectionOfAWallDrawsItsCutOutline) {
  // A wall 4 long, 0.3 thick and 3 high, cut square across at x = 2.
  draft_test::AddBox(Drawing(), {0.0F, 0.0F, 0.0F}, {4.0F, 0.3F, 3.0F}, 0, 1);
  HRSection section;
  SectionSettings settings;
  settings.start[0] = 2.0F;
  settings.start[1] = -1.0F;
  settings.end[0] = 2.0F;
  settings.end[1] = 2.0F;
  settings.symbolFile = "...sec_sym\\sec01";
  section.SetName("A");
  section.SetSettings(settings);
  ASSERT_EQ(section.Create(), 0);
  ASSERT_EQ(section.ShowView(-1), 0);
  ASSERT_TRUE(Save(Target(), {.removeCoincident = 1, .lineMerge = 1}));
  const Sheet sheet = ReadOutput(Target());

  // Looking along -x onto the cut face, centred on the cut line: x is drawing y - 0.5, y is z.
  const std::vector<Expected> outline = {
      {{-0.5, 0.0}, {-0.2, 0.0}, StrokeKind::Cut},
      {{-0.2, 0.0}, {-0.2, 3.0}, StrokeKind::Cut},
      {{-0.2, 3.0}, {-0.5, 3.0}, StrokeKind::Cut},
      {{-0.5, 3.0}, {-0.5, 0.0}, StrokeKind::Cut},
  };
  EXPECT_TRUE(SameStrokes(OfKind(sheet, StrokeKind::Cut), outline, kTolerance));
  EXPECT_TRUE(OfKind(sheet, StrokeKind::Edge).empty()) << "the rest of the wall lies behind its cut face";
}

TEST_F(OutputGeometryTest, CleanupRemovesCoincidentLinesAndMergesCollinearOnes) {
  draft_test::AddLine(Drawing(), {0.0F, 0.0F, 0.0F}, {2.0F, 0.0F, 0.0F});
  draft_test::AddLine(Drawing(), {0.0F, 0.0F, 0.0F}, {2.0F, 0.0F, 0.0F});
  draft_test::AddLine(Drawing(), {2.0F, 0.0F, 0.0F}, {3.0F, 0.0F, 0.0F});
  draft_test::AddLine(Drawing(), {0.0F, 1.0F, 0.0F}, {1.0F, 1.0F, 0.0F});
  const Expected whole{{0.0, 0.0}, {2.0, 0.0}};
  const Expected end{{2.0, 0.0}, {3.0, 0.0}};
  const Expected merged{{0.0, 0.0}, {3.0, 0.0}};
  const Expected apart{{0.0, 1.0}, {1.0, 1.0}};

  EXPECT_TRUE(SameStrokes(SaveAndRead(kTop).strokes, {whole, whole, end, apart}));
  EXPECT_TRUE(SameStrokes(SaveAndRead(kTop, {.removeCoincident = 1}).strokes, {whole, end, apart}));
  EXPECT_TRUE(SameStrokes(SaveAndRead(kTop, {.lineMerge = 1}).strokes, {merged, apart}));
  EXPECT_TRUE(SameStrokes(SaveAndRead(kTop, {.removeCoincident = 1, .lineMerge = 1}).strokes, {merged, apart}));
}

TEST_F(OutputGeometryTest, PreservedTextsAndDimensionsAreCarriedIntoTheDrawing) {
  AddCube({0.0F, 0.0F, 0.0F});
  AddText("Hall", {0.5F, 0.5F, 0.0F}, 5);
  AddDimension({0.0F, -1.0F, 0.0F}, {1.0F, -1.0F, 0.0F}, "1.00", 4);

  const Sheet plain = SaveAndRead(kTop);
  EXPECT_TRUE(plain.labels.empty());
  EXPECT_TRUE(OfKind(plain, StrokeKind::Preserved).empty());

  const Sheet kept = SaveAndRead(kTop, {.dimensions = 1, .texts = 1});
  ASSERT_EQ(kept.labels.size(), 2U);
  EXPECT_EQ(kept.labels[0].text, "Hall");
  EXPECT_NEAR(kept.labels[0].at.x, 0.5, kTolerance);
  EXPECT_NEAR(kept.labels[0].at.y, 0.5, kTolerance);
  EXPECT_NEAR(kept.labels[0].height, 0.5, kTolerance);
  EXPECT_EQ(kept.labels[0].layer, 5);
  EXPECT_EQ(kept.labels[1].text, "1.00");
  EXPECT_NEAR(kept.labels[1].at.x, 0.5, kTolerance);
  EXPECT_NEAR(kept.labels[1].at.y, -1.0, kTolerance);
  const std::vector<Stroke> dimension = OfKind(kept, StrokeKind::Preserved);
  EXPECT_TRUE(SameStrokes(dimension, {{{0.0, -1.0}, {1.0, -1.0}, StrokeKind::Preserved}}, kTolerance));
  ASSERT_EQ(dimension.size(), 1U);
  EXPECT_EQ(dimension[0].layer, 4);
  EXPECT_EQ(OfKind(kept, StrokeKind::Edge), OfKind(plain, StrokeKind::Edge)) << "the model itself is unchanged";

  // Only the texts: the dimension is neither carried over nor drawn as part of the model.
  const Sheet textsOnly = SaveAndRead(kTop, {.texts = 1});
  ASSERT_EQ(textsOnly.labels.size(), 1U);
  EXPECT_EQ(textsOnly.labels[0].text, "Hall");
  EXPECT_TRUE(OfKind(textsOnly, StrokeKind::Preserved).empty());
}

TEST_F(OutputGeometryTest, OnlyPreservedEntitiesTheViewShowsAreCarriedOver) {
  AddText("Shown", {0.5F, 0.5F, 0.0F}, 5);
  AddText("Layer off", {1.5F, 0.5F, 0.0F}, 6);
  const host::EntityHandle hidden = AddText("Hidden", {2.5F, 0.5F, 0.0F}, 5).handle;
  Drawing().Find(hidden)->header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
  Show(kTop);
  Drawing().layers[6].on = false;
  ASSERT_TRUE(Save(Target(), {.texts = 1}));
  const Sheet sheet = ReadOutput(Target());
  ASSERT_EQ(sheet.labels.size(), 1U);
  EXPECT_EQ(sheet.labels[0].text, "Shown");
  EXPECT_TRUE(Drawing().Find(hidden)->Hidden()) << "an entity hidden before stays hidden";
}

TEST_F(OutputGeometryTest, EntitiesSetAsideForOneViewAreNotCarriedIntoTheNext) {
  AddCube({0.0F, 0.0F, 0.0F});
  AddText("Hall", {0.5F, 0.5F, 0.0F}, 5);
  ASSERT_EQ(SaveAndRead(kTop, {.texts = 1}).labels.size(), 1U);
  // The drawing has no dimension, so this view sets nothing aside.
  const Sheet next = SaveAndRead(kTop, {.dimensions = 1});
  EXPECT_TRUE(next.labels.empty());
  EXPECT_TRUE(OfKind(next, StrokeKind::Preserved).empty());
}

TEST_F(OutputGeometryTest, ViewThatCouldNotBeWrittenLeavesNothingForTheNext) {
  AddCube({0.0F, 0.0F, 0.0F});
  Show(kCorner);
  // No file registered under kind 10: the host has nowhere to write this view.
  EXPECT_FALSE(HRUtility::Save2D("", 0, 1, 0, 0, 0, 0, 0, 0, 0));
  EXPECT_TRUE(SameStrokes(SaveAndRead(kCorner).strokes, CubeSeenFrom(kCorner), kTolerance));
}

TEST_F(OutputGeometryTest, OverwriteReplacesTheTargetAndMergeAddsToIt) {
  AddCube({0.0F, 0.0F, 0.0F});
  const std::vector<Expected> first = CubeSeenFrom(kCorner);
  View moved = kCorner;  // the same direction from one unit further along x
  moved.eye.x += 1.0F;
  moved.target.x += 1.0F;
  const std::vector<Expected> second = CubeSeenFrom(moved);

  SaveAndRead(kCorner, {.overwrite = 1});
  EXPECT_TRUE(SameStrokes(SaveAndRead(moved, {.overwrite = 1}).strokes, second, kTolerance));

  SaveAndRead(kCorner, {.overwrite = 1});
  std::vector<Expected> both = first;
  both.insert(both.end(), second.begin(), second.end());
  EXPECT_TRUE(SameStrokes(SaveAndRead(moved, {.overwrite = 0}).strokes, both, kTolerance));
}

TEST_F(OutputGeometryTest, AutoClipCutsTheDrawingToTheViewWindow) {
  draft_test::AddLine(Drawing(), {-5.0F, 0.0F, 0.0F}, {5.0F, 0.0F, 0.0F});
  draft_test::AddLine(Drawing(), {-5.0F, 3.0F, 0.0F}, {5.0F, 3.0F, 0.0F});  // outside the window
  View windowed = kTop;
  windowed.window = {-1.0, -1.0, 2.0, 1.0};

  EXPECT_TRUE(SameStrokes(SaveAndRead(windowed, {.autoClip = 1}).strokes, {{{-1.0, 0.0}, {2.0, 0.0}}}, kTolerance));
  EXPECT_TRUE(SameStrokes(SaveAndRead(windowed, {.autoClip = 0}).strokes,
                          {{{-5.0, 0.0}, {5.0, 0.0}}, {{-5.0, 3.0}, {5.0, 3.0}}}, kTolerance));
}

}  // namespace
}  // namespace output2d_test
