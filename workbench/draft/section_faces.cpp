// Section faces: each cut's section of the solid, trimmed by the other cuts.
#include "workbench/draft/section_faces.h"

#include <array>
#include <map>
#include <optional>

namespace wb::draft {

namespace {

// Straight runs of a face's outline come out of the mesh in pieces, one per triangle it
// crosses; the pieces share their end points exactly and are joined back into one line.
constexpr double kStraightSine = 1e-9;

using PointKey = std::array<double, 3>;
PointKey KeyOf(Vec3 p) { return {p.x, p.y, p.z}; }

std::vector<Segment3> JoinStraightRuns(const std::vector<Segment3>& pieces) {
  std::map<PointKey, std::vector<std::size_t>> atPoint;
  for (std::size_t i = 0; i < pieces.size(); ++i) {
    atPoint[KeyOf(pieces[i].a)].push_back(i);
    atPoint[KeyOf(pieces[i].b)].push_back(i);
  }
  std::vector<bool> used(pieces.size(), false);
  // The piece continuing `run` straight on beyond `end`, if exactly one other piece meets there.
  const auto continuation = [&](const Segment3& run, Vec3 end, std::size_t self) -> std::optional<std::size_t> {
    const auto& meeting = atPoint[KeyOf(end)];
    if (meeting.size() != 2) return std::nullopt;
    const std::size_t next = meeting[0] == self ? meeting[1] : meeting[0];
    if (used[next]) return std::nullopt;
    const Vec3 along = run.b - run.a;
    const Vec3 nextAlong = pieces[next].b - pieces[next].a;
    if (Length(Cross(along, nextAlong)) > kStraightSine * Length(along) * Length(nextAlong)) return std::nullopt;
    return next;
  };
  std::vector<Segment3> runs;
  for (std::size_t i = 0; i < pieces.size(); ++i) {
    if (used[i]) continue;
    used[i] = true;
    Segment3 run = pieces[i];
    for (bool forward : {true, false}) {
      std::size_t last = i;
      while (auto next = continuation(run, forward ? run.b : run.a, last)) {
        used[*next] = true;
        const Segment3& piece = pieces[*next];
        const Vec3 far = KeyOf(piece.a) == KeyOf(forward ? run.b : run.a) ? piece.b : piece.a;
        (forward ? run.b : run.a) = far;
        last = *next;
      }
    }
    runs.push_back(run);
  }
  return runs;
}

void Append(std::vector<Segment3>& to, const std::vector<Segment3>& from) { to.insert(to.end(), from.begin(), from.end()); }

}  // namespace

std::vector<SectionFace> SectionFaces(const WeldedMesh& mesh, const std::vector<Cut>& cuts) {
  std::vector<SectionFace> faces;
  for (std::size_t k = 0; k < cuts.size(); ++k) {
    SectionFace face;
    face.cut = k;
    face.boundary = SectionSegments(mesh, cuts[k].plane);
    face.outline = face.boundary;
    for (std::size_t other = 0; other < cuts.size() && !face.boundary.empty(); ++other) {
      if (other == k) continue;
      ClippedRegion trimmed = ClipRegion(face.boundary, cuts[k].plane.normal, cuts[other].plane);
      std::vector<Segment3> outline;
      for (const Segment3& segment : face.outline) {
        if (auto kept = ClipSegment(segment, cuts[other].plane)) outline.push_back(*kept);
      }
      if (other > k) Append(outline, trimmed.closing);
      face.outline = std::move(outline);
      face.boundary = std::move(trimmed.kept);
      Append(face.boundary, trimmed.closing);
    }
    if (face.boundary.empty()) continue;
    face.outline = JoinStraightRuns(face.outline);
    faces.push_back(std::move(face));
  }
  return faces;
}

std::vector<Segment3> ClipFaceBoundary(const std::vector<Segment3>& boundary, const Cut& face, const ClipPlane& plane) {
  ClippedRegion clipped = ClipRegion(boundary, face.plane.normal, plane);
  Append(clipped.kept, clipped.closing);
  return std::move(clipped.kept);
}

}  // namespace wb::draft
