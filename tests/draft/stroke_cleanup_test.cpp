// Line clean-up within a layer, with a result that does not depend on the order of strokes.
#include "workbench/draft/stroke_cleanup.h"

#include <gtest/gtest.h>

#include <cmath>

#include "tests/draft/draft_fixture.h"

namespace {

using namespace draft_test;
using namespace wb::draft;

Stroke S(double ax, double ay, double bx, double by, std::uint8_t layer = 0, std::uint8_t color = 1,
         StrokeKind kind = StrokeKind::Edge) {
  return {{ax, ay}, {bx, by}, layer, color, kind};
}

std::vector<Expected> Unchanged(const std::vector<Stroke>& strokes) {
  std::vector<Expected> expected;
  for (const Stroke& s : strokes) expected.push_back({s.a, s.b, s.kind});
  return expected;
}

std::vector<Stroke> Cleaned(void (*cleanUp)(Sheet&, double), std::vector<Stroke> strokes, double tolerance) {
  Sheet sheet{std::move(strokes), {}, {}};
  cleanUp(sheet, tolerance);
  return sheet.strokes;
}

TEST(StrokeCleanup, CoincidentAndCollinearStrokesByCase) {
  struct Case {
    const char* name;
    void (*cleanUp)(Sheet&, double);
    double tolerance;
    std::vector<Stroke> input;
    std::vector<Expected> expected;
    double match = 1e-9;
  };
  const auto remove = RemoveCoincidentStrokes;
  const auto merge = MergeCollinearStrokes;
  const double nan = std::nan("");
  const std::vector<Stroke> apart = {S(0, 0, 10, 0, 0), S(0, 0, 10, 0, 1), S(5, -5, 5, 5, 0), S(0, 1, 10, 1, 0),
                                     S(0, 0, 10, 0.5, 0), S(11, 0, 15, 0, 0)};
  const std::vector<Stroke> unjoined = {S(0, 0, 5, 0, 0, 1), S(5.5, 0, 8, 0, 0, 1), S(8, 0, 9, 0, 0, 2),
                                        S(9, 0, 10, 0, 1, 2), S(10, 0, 11, 0, 1, 2, StrokeKind::Cut), S(0, 0, 0, 5)};
  const std::vector<Case> cases = {
      {"exact and near duplicates leave one", remove, 0.01,
       {S(0, 0, 10, 0), S(10, 0, 0, 0), S(0, 0.001, 10, -0.001), S(0.002, 0, 9.999, 0)}, {{{0, 0}, {10, 0}}}, 0.002},
      {"the overlap goes from the shorter", remove, 1e-9, {S(4, 0, 12, 0), S(0, 0, 10, 0), S(2, 0, 3, 0)},
       {{{0, 0}, {10, 0}}, {{10, 0}, {12, 0}}}},
      {"each keeps what longer ones leave", remove, 0.0, {S(0, 5, 0, 0), S(0, 0, 0, 1), S(0, 3, 0, 4), S(0, 4, 0, 8)},
       {{{0, 0}, {0, 5}}, {{0, 5}, {0, 8}}}},
      {"other layers, crossing and parallel strokes stay", remove, 0.01, apart, Unchanged(apart)},
      {"cuts win over edges, preserved strokes are left alone", remove, 1e-6,
       {S(0, 0, 10, 0), S(2, 0, 8, 0, 0, 5, StrokeKind::Cut), S(0, 0, 10, 0, 0, 1, StrokeKind::Preserved)},
       {{{0, 0}, {2, 0}}, {{8, 0}, {10, 0}}, {{2, 0}, {8, 0}, StrokeKind::Cut}, {{0, 0}, {10, 0}, StrokeKind::Preserved}}},
      {"gaps, other colours, kinds and layers are not joined", merge, 0.01, unjoined, Unchanged(unjoined)},
      {"nearly straight pieces join along the longest", merge, 0.01,
       {S(0, 0, 10, 0), S(10, 0.004, 13, -0.003), S(-2, 0.005, 0, 0.001)}, {{{-2, 0}, {13, 0}}}, 1e-12},
      // Strokes that are not finite are dropped; a tolerance that is not usable means zero.
      {"removal with a bad tolerance", remove, nan, {S(0, 0, nan, 0), S(0, 0, 1, 0), S(0, 0.001, 1, 0.001), S(1, 0, 0, 0)},
       {{{0, 0}, {1, 0}}, {{0, 0.001}, {1, 0.001}}}},
      {"merging with a bad tolerance", merge, -1.0, {S(0, 0, 1, 0), S(0, 0.001, 1, 0.001), S(1, 0, 2, INFINITY)},
       {{{0, 0}, {1, 0}}, {{0, 0.001}, {1, 0.001}}}},
  };
  for (const Case& c : cases) {
    const std::vector<Stroke> cleaned = Cleaned(c.cleanUp, c.input, c.tolerance);
    EXPECT_TRUE(SameStrokes(cleaned, c.expected, c.match)) << c.name;
    EXPECT_EQ(Cleaned(c.cleanUp, {c.input.rbegin(), c.input.rend()}, c.tolerance), cleaned) << c.name;
  }
}

// Joining neighbour by neighbour, each within the tolerance, would flatten an arc into a chord.
TEST(StrokeCleanup, AGentleArcIsNotFlattened) {
  std::vector<Stroke> arc;
  for (double a = 0, step = 0.5 / 60; a < 0.4999; a += step) {
    arc.push_back(S(100 * std::cos(a), 100 * std::sin(a), 100 * std::cos(a + step), 100 * std::sin(a + step)));
  }
  const std::vector<Stroke> merged = Cleaned(MergeCollinearStrokes, arc, 0.01);
  EXPECT_GT(merged.size(), 5U);
  for (const Stroke& s : merged) EXPECT_LT(100 - std::hypot((s.a.x + s.b.x) / 2, (s.a.y + s.b.y) / 2), 0.02);
}

}  // namespace
