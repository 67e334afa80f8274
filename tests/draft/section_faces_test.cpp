// Section faces of a cut solid: closed boundaries trimmed by the other cut, and outlines that
// draw a corner two faces share only once.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <map>

#include "workbench/draft/section_faces.h"

namespace {

using wb::draft::Cut;
using wb::draft::Segment3;
using wb::draft::Vec3;

struct Key {
  double x, y, z;
  auto operator<=>(const Key&) const = default;
};
Key KeyOf(Vec3 p) { return {p.x, p.y, p.z}; }

// Every end point is shared by an even number of segments: the boundary closes.
bool Closed(const std::vector<Segment3>& segments) {
  std::map<Key, int> ends;
  for (const Segment3& s : segments) {
    ++ends[KeyOf(s.a)];
    ++ends[KeyOf(s.b)];
  }
  return std::all_of(ends.begin(), ends.end(), [](const auto& entry) { return entry.second % 2 == 0; });
}

bool SameSegments(std::vector<Segment3> actual, std::vector<Segment3> expected) {
  const auto near = [](Vec3 p, Vec3 q) { return wb::draft::Length(p - q) < 1e-9; };
  for (const Segment3& e : expected) {
    auto match = std::find_if(actual.begin(), actual.end(), [&](const Segment3& s) {
      return (near(s.a, e.a) && near(s.b, e.b)) || (near(s.a, e.b) && near(s.b, e.a));
    });
    if (match == actual.end()) return false;
    actual.erase(match);
  }
  return actual.empty();
}

double DistanceToSegment(Vec3 p, const Segment3& s) {
  const Vec3 along = s.b - s.a;
  const double t = std::clamp(wb::draft::Dot(p - s.a, along) / wb::draft::Dot(along, along), 0.0, 1.0);
  return wb::draft::Length(p - wb::draft::Lerp(s.a, s.b, t));
}

// The pieces cover the outline exactly: each lies on it and together they are as long.
bool CoverExactly(const std::vector<Segment3>& pieces, const std::vector<Segment3>& outline) {
  double piecesLength = 0.0;
  double outlineLength = 0.0;
  for (const Segment3& s : outline) outlineLength += wb::draft::Length(s.b - s.a);
  for (const Segment3& piece : pieces) {
    piecesLength += wb::draft::Length(piece.b - piece.a);
    const bool onOutline = std::any_of(outline.begin(), outline.end(), [&](const Segment3& side) {
      return DistanceToSegment(piece.a, side) < 1e-9 && DistanceToSegment(piece.b, side) < 1e-9;
    });
    if (!onOutline) return false;
  }
  return std::fabs(piecesLength - outlineLength) < 1e-9;
}

std::vector<Segment3> Rectangle(Vec3 p0, Vec3 p1, Vec3 p2, Vec3 p3) { return {{p0, p1}, {p1, p2}, {p2, p3}, {p3, p0}}; }

class TwoCutWall : public ::testing::Test {
 protected:
  void SetUp() override {
    // Wall 4 x 0.3 x 3; the section keeps x < 2, the plan keeps z < 1.
    mesh_ = wb::draft::Weld(wb::draft::MakeBox({0, 0, 0}, {4, 0.3F, 3}));
    cuts_.push_back(*wb::draft::SectionCutPlane({{{{2, -1, 0}, {2, 1, 0}, {2, -1, 1}, {0, -1, 0}}}, 'b'}));
    cuts_.push_back(*wb::draft::PlanCutPlane({{0, 0, 1}, 'b'}));
  }
  wb::draft::WeldedMesh mesh_;
  std::vector<Cut> cuts_;
};

TEST_F(TwoCutWall, EachFaceIsClosedAndTrimmedByTheOtherCut) {
  const auto faces = wb::draft::SectionFaces(mesh_, cuts_);
  ASSERT_EQ(faces.size(), 2U);
  EXPECT_EQ(faces[0].cut, 0U);
  EXPECT_TRUE(Closed(faces[0].boundary));
  EXPECT_TRUE(CoverExactly(faces[0].boundary, Rectangle({2, 0, 0}, {2, 0.3F, 0}, {2, 0.3F, 1}, {2, 0, 1})));
  EXPECT_EQ(faces[1].cut, 1U);
  EXPECT_TRUE(Closed(faces[1].boundary));
  EXPECT_TRUE(CoverExactly(faces[1].boundary, Rectangle({0, 0, 1}, {2, 0, 1}, {2, 0.3F, 1}, {0, 0.3F, 1})));
}

TEST_F(TwoCutWall, SharedCornerIsOutlinedByTheEarlierCutOnly) {
  const auto faces = wb::draft::SectionFaces(mesh_, cuts_);
  ASSERT_EQ(faces.size(), 2U);
  EXPECT_TRUE(SameSegments(faces[0].outline, Rectangle({2, 0, 0}, {2, 0.3F, 0}, {2, 0.3F, 1}, {2, 0, 1})));
  EXPECT_TRUE(SameSegments(faces[1].outline, {{{0, 0, 1}, {2, 0, 1}}, {{0, 0.3F, 1}, {0, 0, 1}}, {{2, 0.3F, 1}, {0, 0.3F, 1}}}));
}

TEST_F(TwoCutWall, NearPlaneClipKeepsTheFaceClosed) {
  const auto faces = wb::draft::SectionFaces(mesh_, cuts_);
  // Keep y > 0.15 of the plan face: closed again along y = 0.15.
  const wb::draft::ClipPlane near{{0, 1, 0}, 0.15, wb::draft::kNearBit};
  const auto clipped = wb::draft::ClipFaceBoundary(faces[1].boundary, cuts_[1], near);
  EXPECT_TRUE(Closed(clipped));
  EXPECT_TRUE(CoverExactly(clipped, Rectangle({0, 0.15, 1}, {2, 0.15, 1}, {2, 0.3F, 1}, {0, 0.3F, 1})));
}

TEST_F(TwoCutWall, CutMissingTheSolidGivesNoFace) {
  cuts_ = {*wb::draft::PlanCutPlane({{0, 0, 5}, 'b'})};  // above the wall: all of it is kept
  EXPECT_TRUE(wb::draft::SectionFaces(mesh_, cuts_).empty());
}

}  // namespace
