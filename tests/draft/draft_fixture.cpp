// Helpers of the 2D pipeline tests.
#include "tests/draft/draft_fixture.h"

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

bool Near(Point2 p, Point2 q, double tolerance) { return std::hypot(p.x - q.x, p.y - q.y) <= tolerance; }

bool Matches(const Stroke& stroke, const Expected& expected, double tolerance) {
  if (stroke.kind != expected.kind) return false;
  return (Near(stroke.a, expected.a, tolerance) && Near(stroke.b, expected.b, tolerance)) ||
         (Near(stroke.a, expected.b, tolerance) && Near(stroke.b, expected.a, tolerance));
}

std::string Describe(Point2 a, Point2 b, StrokeKind kind) {
  std::ostringstream text;
  text << "(" << a.x << ", " << a.y << ")-(" << b.x << ", " << b.y << ") kind " << static_cast<int>(kind);
  return text.str();
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

::testing::AssertionResult SameStrokes(const std::vector<Stroke>& actual, std::vector<Expected> expected,
                                       double tolerance) {
  std::ostringstream problems;
  for (const Stroke& stroke : actual) {
    auto match = std::find_if(expected.begin(), expected.end(),
                              [&](const Expected& candidate) { return Matches(stroke, candidate, tolerance); });
    if (match == expected.end()) {
      problems << "\n  unexpected " << Describe(stroke.a, stroke.b, stroke.kind);
    } else {
      expected.erase(match);
    }
  }
  for (const Expected& missing : expected) problems << "\n  missing " << Describe(missing.a, missing.b, missing.kind);
  if (problems.str().empty()) return ::testing::AssertionSuccess();
  return ::testing::AssertionFailure() << problems.str();
}

bool AllFinite(const wb::draft::Sheet& sheet) {
  return std::all_of(sheet.strokes.begin(), sheet.strokes.end(), [](const Stroke& s) {
    return std::isfinite(s.a.x) && std::isfinite(s.a.y) && std::isfinite(s.b.x) && std::isfinite(s.b.y);
  });
}

}  // namespace draft_test
