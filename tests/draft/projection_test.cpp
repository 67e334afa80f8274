// Projection of the host view: a unit cube seen head-on and obliquely, in parallel and in
// perspective, against corners worked out here; the fallbacks of a view without direction.
#include <gtest/gtest.h>

#include <array>
#include <cmath>

#include "tests/draft/draft_fixture.h"
#include "workbench/draft/projection.h"

namespace {

using draft_test::Expected;
using wb::draft::GenerateOptions;
using wb::draft::GenerateSheet;
using wb::draft::Point2;
using wb::draft::Projection;
using wb::draft::Vec3;
using wb::draft::ViewSpec;

struct Cube {
  std::array<Vec3, 8> corners;
  std::array<std::array<int, 2>, 12> edges;
};

// The unit cube's corners (bit 0 x, bit 1 y, bit 2 z) and the twelve pairs differing in one bit.
Cube UnitCube() {
  Cube cube{};
  for (int i = 0; i < 8; ++i) cube.corners[i] = {double(i & 1), double((i >> 1) & 1), double((i >> 2) & 1)};
  int n = 0;
  for (int i = 0; i < 8; ++i) {
    for (int bit = 1; bit < 8; bit <<= 1) {
      if ((i & bit) == 0) cube.edges[n++] = {i, i | bit};
    }
  }
  return cube;
}

wb::Drawing CubeDrawing() {
  wb::Drawing drawing;
  draft_test::AddBox(drawing, {0, 0, 0}, {1, 1, 1});
  return drawing;
}

// The view frame by Gram-Schmidt: up is world z with its part along the view taken out.
struct Frame {
  Vec3 forward, right, up;
};
Frame FrameOf(Vec3 eye, Vec3 target) {
  const Vec3 d = target - eye;
  const Vec3 forward = d * (1.0 / wb::draft::Length(d));
  const Vec3 z{0, 0, 1};
  const Vec3 upRaw = z - forward * wb::draft::Dot(z, forward);
  const Vec3 up = upRaw * (1.0 / wb::draft::Length(upRaw));
  return {forward, wb::draft::Cross(forward, up), up};
}

std::vector<Expected> ExpectedEdges(const Cube& cube, auto project) {
  std::vector<Expected> expected;
  for (const auto& edge : cube.edges) expected.push_back({project(cube.corners[edge[0]]), project(cube.corners[edge[1]])});
  return expected;
}

TEST(ProjectionFrontView, ParallelShowsTheSquareTwiceAndDropsEdgesSeenEndOn) {
  GenerateOptions options;
  options.view = {{0.5F, -10.0F, 0.5F}, {0.5F, 0.5F, 0.5F}, false};
  const auto sheet = GenerateSheet(CubeDrawing(), options);
  // Front and back faces fall on one square; the four edges along y are single points.
  const Point2 p00{-0.5, -0.5}, p10{0.5, -0.5}, p11{0.5, 0.5}, p01{-0.5, 0.5};
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, {{p00, p10}, {p10, p11}, {p11, p01}, {p01, p00},
                                                      {p00, p10}, {p10, p11}, {p11, p01}, {p01, p00}}));
}

TEST(ProjectionFrontView, PerspectiveShrinksTheBackFaceByTheRatioOfDepths) {
  GenerateOptions options;
  options.view = {{0.5F, -10.0F, 0.5F}, {0.5F, 0.5F, 0.5F}, true};
  const auto sheet = GenerateSheet(CubeDrawing(), options);
  // Eye to target 10.5: the front face (depth 10) scales by 1.05, the back (depth 11) by 10.5/11.
  const double front = 0.5 * 10.5 / 10.0;
  const double back = 0.5 * 10.5 / 11.0;
  std::vector<Expected> expected;
  for (double s : {front, back}) {
    expected.push_back({{-s, -s}, {s, -s}});
    expected.push_back({{s, -s}, {s, s}});
    expected.push_back({{s, s}, {-s, s}});
    expected.push_back({{-s, s}, {-s, -s}});
  }
  for (double x : {-1.0, 1.0}) {
    for (double y : {-1.0, 1.0}) expected.push_back({{x * front, y * front}, {x * back, y * back}});
  }
  EXPECT_TRUE(draft_test::SameStrokes(sheet.strokes, expected));
}

TEST(ProjectionObliqueView, ParallelCornersMatchTheViewFrame) {
  const Vec3 eye{4.0, -3.0, 2.5};
  const Vec3 target{0.25, 0.5, 0.125};
  GenerateOptions options;
  options.view = {{4.0F, -3.0F, 2.5F}, {0.25F, 0.5F, 0.125F}, false};
  const Frame frame = FrameOf(eye, target);
  const auto project = [&](Vec3 p) {
    return Point2{wb::draft::Dot(p - target, frame.right), wb::draft::Dot(p - target, frame.up)};
  };
  EXPECT_TRUE(draft_test::SameStrokes(GenerateSheet(CubeDrawing(), options).strokes, ExpectedEdges(UnitCube(), project)));
}

TEST(ProjectionObliqueView, PerspectiveCornersScaleByDistanceOverDepth) {
  const Vec3 eye{4.0, -3.0, 2.5};
  const Vec3 target{0.25, 0.5, 0.125};
  GenerateOptions options;
  options.view = {{4.0F, -3.0F, 2.5F}, {0.25F, 0.5F, 0.125F}, true};
  const Frame frame = FrameOf(eye, target);
  const double distance = wb::draft::Length(target - eye);
  const auto project = [&](Vec3 p) {
    const double scale = distance / wb::draft::Dot(p - eye, frame.forward);
    return Point2{wb::draft::Dot(p - eye, frame.right) * scale, wb::draft::Dot(p - eye, frame.up) * scale};
  };
  EXPECT_TRUE(draft_test::SameStrokes(GenerateSheet(CubeDrawing(), options).strokes, ExpectedEdges(UnitCube(), project)));
}

TEST(ProjectionFrame, LookingStraightDownPutsWorldYUp) {
  const Projection projection(ViewSpec{{3.0F, 4.0F, 50.0F}, {3.0F, 4.0F, 0.0F}, false});
  const Point2 p = projection.Project({5.0, 7.0, 1.0});
  EXPECT_DOUBLE_EQ(p.x, 2.0);
  EXPECT_DOUBLE_EQ(p.y, 3.0);
  EXPECT_DOUBLE_EQ(projection.Depth({5.0, 7.0, 1.0}), 49.0);
}

TEST(ProjectionFrame, EyeOnTheTargetFallsBackToAParallelPlanView) {
  const Projection projection(ViewSpec{{3.0F, 4.0F, 5.0F}, {3.0F, 4.0F, 5.0F}, true});
  EXPECT_FALSE(projection.Perspective());
  const Point2 p = projection.Project({4.0, 6.0, -20.0});
  EXPECT_DOUBLE_EQ(p.x, 1.0);
  EXPECT_DOUBLE_EQ(p.y, 2.0);
}

TEST(ProjectionFrame, CoordinatesThatAreNotFiniteCountAsZero) {
  const float nan = std::nanf("");
  const Projection projection(ViewSpec{{nan, 0.0F, 10.0F}, {0.0F, 0.0F, INFINITY}, true});
  // Eye (0, 0, 10) looking at the origin: straight down, perspective at distance 10.
  EXPECT_TRUE(projection.Perspective());
  const Point2 p = projection.Project({1.0, 2.0, 5.0});
  EXPECT_DOUBLE_EQ(p.x, 2.0);
  EXPECT_DOUBLE_EQ(p.y, 4.0);
}

TEST(ProjectionFrame, PointsBehindTheEyeProjectFinitelyAtTheNearDepth) {
  const Projection projection(ViewSpec{{0.0F, -10.0F, 0.0F}, {0.0F, 0.0F, 0.0F}, true});
  EXPECT_DOUBLE_EQ(projection.NearDepth(), 0.01);
  const Point2 behind = projection.Project({1.0, -20.0, 0.0});
  EXPECT_DOUBLE_EQ(behind.x, 1.0 * 10.0 / 0.01);
  const Point2 onEye = projection.Project({0.0, -10.0, 0.0});
  EXPECT_TRUE(std::isfinite(onEye.x) && std::isfinite(onEye.y));
}

}  // namespace
