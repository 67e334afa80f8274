// The box grid finds every box a segment may cross, and keeps its lists within their budget
// however large the boxes are.
#include "workbench/draft/box_grid.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>

namespace {

using wb::draft::Box2;
using wb::draft::BoxGrid;
using wb::draft::Point2;

std::vector<bool> FoundAlong(const BoxGrid& grid, std::size_t boxes, Point2 a, Point2 b) {
  std::vector<bool> found(boxes, false);
  grid.ForEachAlong(a, b, 0.0, [&](std::uint32_t index) {
    found.at(index) = true;
    return true;
  });
  return found;
}

// Whether the segment meets the box (slab test).
bool Meets(const Box2& box, Point2 a, Point2 b) {
  double low = 0.0;
  double high = 1.0;
  const double from[2] = {a.x, a.y};
  const double delta[2] = {b.x - a.x, b.y - a.y};
  const double lower[2] = {box.min.x, box.min.y};
  const double upper[2] = {box.max.x, box.max.y};
  for (int axis = 0; axis < 2; ++axis) {
    if (delta[axis] == 0.0) {
      if (from[axis] < lower[axis] || from[axis] > upper[axis]) return false;
      continue;
    }
    double t1 = (lower[axis] - from[axis]) / delta[axis];
    double t2 = (upper[axis] - from[axis]) / delta[axis];
    if (t1 > t2) std::swap(t1, t2);
    low = std::max(low, t1);
    high = std::min(high, t2);
  }
  return low <= high;
}

// Small boxes scattered, and as many long diagonal strokes' boxes again over the whole view:
// the first make a fine grid, the second would make it list every box in every cell, past the
// budget for 6,000 boxes.
std::vector<Box2> Scattered(std::size_t count, bool withLongStrokes) {
  std::mt19937 random(7);
  std::uniform_real_distribution<double> where(0.0, 1000.0);
  std::vector<Box2> boxes;
  for (std::size_t i = 0; i < count; ++i) {
    const Point2 corner{where(random), where(random)};
    boxes.push_back({corner, {corner.x + 3.0, corner.y + 2.0}});
    if (withLongStrokes) boxes.push_back({{0.0, 0.0}, {1000.0, 1000.0}});
  }
  return boxes;
}

TEST(BoxGrid, EverySegmentFindsEveryBoxItMeetsOnFineAndCoarsenedGrids) {
  for (const bool longStrokes : {false, true}) {
    const std::vector<Box2> boxes = Scattered(3000, longStrokes);
    const BoxGrid grid(boxes);
    EXPECT_LE(grid.EntryCount(), BoxGrid::EntryBudget(boxes.size()));
    std::mt19937 random(11);
    std::uniform_real_distribution<double> where(-50.0, 1050.0);
    for (int segment = 0; segment < 20; ++segment) {
      const Point2 a{where(random), where(random)};
      const Point2 b = segment % 5 == 0 ? Point2{a.x, where(random)} : Point2{where(random), where(random)};
      const std::vector<bool> found = FoundAlong(grid, boxes.size(), a, b);
      for (std::uint32_t i = 0; i < boxes.size(); ++i) {
        if (Meets(boxes[i], a, b)) {
          ASSERT_TRUE(found[i]) << "box " << i << ", long strokes " << longStrokes;
        }
      }
    }
  }
}

TEST(BoxGrid, TensOfThousandsOfStrokesAcrossTheWholeViewStayWithinTheBudget) {
  // 66,000 boxes of one size on a square grid of about one cell per box: each covers all
  // 66,000 cells, 4.4 billion entries in all, past what 32 bits can count.
  constexpr std::size_t kStrokes = 66000;
  const std::vector<Box2> boxes(kStrokes, Box2{{0.0, 0.0}, {500.0, 500.0}});
  const BoxGrid grid(boxes);
  EXPECT_LE(grid.EntryCount(), BoxGrid::EntryBudget(kStrokes));
  EXPECT_GE(grid.EntryCount(), kStrokes);
  std::size_t visits = 0;
  grid.ForEachAlong({250.0, 250.0}, {250.0, 250.0}, 0.0, [&](std::uint32_t) {
    ++visits;
    return true;
  });
  EXPECT_EQ(visits, kStrokes) << "a point lies in one cell, which lists each box once";
}

}  // namespace
