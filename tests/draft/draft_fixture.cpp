// Helpers of the 2D pipeline tests.
#include "tests/draft/draft_fixture.h"

#include <algorithm>
#include <cmath>
#include <sstream>

namespace draft_test {
namespace {

wb::Entity& AddEntity(wb::Drawing& drawing, std::uint8_t type, std::uint8_t layer, std::uint8_t color) {
  wb::Entity& entity = drawing.Add(type);
  entity.header.bytes[host::kHeaderLayer] = layer;
  entity.header.bytes[host::kHeaderColor] = color;
  return entity;
}

bool Matches(const Stroke& stroke, const Expected& expected, double tolerance) {
  const auto near = [&](Point2 p, Point2 q) { return std::hypot(p.x - q.x, p.y - q.y) <= tolerance; };
  return stroke.kind == expected.kind && ((near(stroke.a, expected.a) && near(stroke.b, expected.b)) ||
                                          (near(stroke.a, expected.b) && near(stroke.b, expected.a)));
}

}  // namespace

wb::Entity& AddBox(wb::Drawing& drawing, host::Point3f corner, host::Point3f size, std::uint8_t layer,
                   std::uint8_t color) {
  wb::Entity& entity = AddEntity(drawing, host::kTypeSolid, layer, color);
  wb::draft::WriteSolidMesh(entity, wb::draft::MakeBox(corner, size));
  return entity;
}

wb::Entity& AddLine(wb::Drawing& drawing, host::Point3f start, host::Point3f end, std::uint8_t layer,
                    std::uint8_t color) {
  wb::Entity& entity = AddEntity(drawing, host::kTypeLine, layer, color);
  host::LineRecord line{};
  line.start = start;
  line.end = end;
  wb::WriteRecord(entity, line);
  return entity;
}

wb::draft::GenerateOptions ViewOf(host::Point3f eye, host::Point3f target, bool perspective, bool hideHiddenLines) {
  wb::draft::GenerateOptions options;
  options.view = {eye, target, perspective};
  options.hideHiddenLines = hideHiddenLines;
  return options;
}

::testing::AssertionResult SameStrokes(const std::vector<Stroke>& actual, std::vector<Expected> expected,
                                       double tolerance) {
  std::ostringstream problems;
  const auto describe = [&](const char* what, Point2 a, Point2 b, StrokeKind kind) {
    problems << "\n  " << what << " (" << a.x << ", " << a.y << ")-(" << b.x << ", " << b.y << ") kind "
             << static_cast<int>(kind);
  };
  for (const Stroke& stroke : actual) {
    auto match = std::find_if(expected.begin(), expected.end(),
                              [&](const Expected& candidate) { return Matches(stroke, candidate, tolerance); });
    if (match == expected.end()) {
      describe("unexpected", stroke.a, stroke.b, stroke.kind);
    } else {
      expected.erase(match);
    }
  }
  for (const Expected& missing : expected) describe("missing", missing.a, missing.b, missing.kind);
  if (problems.str().empty()) return ::testing::AssertionSuccess();
  return ::testing::AssertionFailure() << problems.str();
}

long CountMatching(const std::vector<Stroke>& strokes, const Expected& expected, double tolerance) {
  return std::count_if(strokes.begin(), strokes.end(), [&](const Stroke& s) { return Matches(s, expected, tolerance); });
}

}  // namespace draft_test
