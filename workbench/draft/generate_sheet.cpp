// Gathers the shown lines and solids, cuts them, projects them and removes hidden lines.
#include "workbench/draft/generate_sheet.h"

#include <array>

#include <algorithm>
#include <cmath>

#include "workbench/draft/half_space.h"
#include "workbench/draft/hidden_lines.h"
#include "workbench/draft/section_faces.h"
#include "workbench/draft/solid_mesh.h"
#include "workbench/draft/welded_mesh.h"

namespace wb::draft {

namespace {

// Tolerances relative to the size of the coordinates: flat ones for double rounding in the
// view plane, depth ones for single-precision drawing coordinates meant to lie in a face.
constexpr double kFlatFraction = 1e-9;
constexpr double kDepthFraction = 1e-6;
constexpr std::uint8_t kForeground = 7;

struct Style {
  std::uint8_t layer = 0;
  std::uint8_t color = kForeground;
  StrokeKind kind = StrokeKind::Edge;
};

struct PendingEdge {
  ScreenEdge edge;
  Style style;
};

bool Shown(const Drawing& drawing, const Entity& entity) {
  return entity.Alive() && !entity.Hidden() && drawing.layers[entity.header.bytes[host::kHeaderLayer]].on;
}

Style EntityStyle(const Entity& entity) {
  const std::uint8_t color = entity.header.bytes[host::kHeaderColor];
  return {entity.header.bytes[host::kHeaderLayer], color == 0 ? kForeground : color, StrokeKind::Edge};
}

Style CutStyle(Style solid, char cutType) {
  if (cutType == kCutAsEdges) return solid;
  if (cutType == kCutInForeground) return {solid.layer, kForeground, StrokeKind::Cut};
  return {solid.layer, solid.color, StrokeKind::Cut};
}

Point2 PointAt(const ScreenEdge& edge, double t) {
  return {edge.a.x + t * (edge.b.x - edge.a.x), edge.a.y + t * (edge.b.y - edge.a.y)};
}

class SheetBuilder {
 public:
  SheetBuilder(const Drawing& drawing, const GenerateOptions& options)
      : drawing_(drawing), projection_(options.view), hide_(options.hideHiddenLines) {
    if (options.section) {
      if (auto cut = SectionCutPlane(*options.section)) cuts_.push_back(*cut);
    }
    if (options.plan) {
      if (auto cut = PlanCutPlane(*options.plan)) cuts_.push_back(*cut);
    }
    if (projection_.Perspective()) {
      const Vec3 forward = projection_.Forward();
      near_ = ClipPlane{forward, Dot(forward, projection_.Eye()) + projection_.NearDepth(), kNearBit};
    }
  }

  Sheet Build() {
    Sheet sheet;
    for (std::size_t i = 0; i < sheet.layerNames.size(); ++i) sheet.layerNames[i] = drawing_.layers[i].name;
    // Block members are drawn where their blocks are placed, never on their own.
    std::vector<bool> member(drawing_.slots.size() + 1, false);
    for (const Entity& entity : drawing_.slots) {
      if (!entity.Alive() || entity.Type() != host::kTypeBlock) continue;
      for (const host::EntityHandle handle : entity.members) {
        if (handle > 0 && static_cast<std::size_t>(handle) < member.size()) member[static_cast<std::size_t>(handle)] = true;
      }
    }
    for (const Entity& entity : drawing_.slots) {
      if (!Shown(drawing_, entity) || member[static_cast<std::size_t>(entity.handle)]) continue;
      AddEntity(entity, kIdentity, 0);
    }
    EmitStrokes(sheet);
    return sheet;
  }

 private:
  using Placement = std::array<double, 16>;  // row-vector 4x4, translation in row 3
  static constexpr Placement kIdentity = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1};
  // Blocks placed inside placed blocks are followed this deep; a damaged drawing whose blocks
  // place each other can then not recurse without end.
  static constexpr int kMaxNesting = 8;

  static Vec3 Place(const Placement& m, Vec3 p) {
    return {p.x * m[0] + p.y * m[4] + p.z * m[8] + m[12], p.x * m[1] + p.y * m[5] + p.z * m[9] + m[13],
            p.x * m[2] + p.y * m[6] + p.z * m[10] + m[14]};
  }

  // The placement of a block inside `outer`: inner first, then outer (row vectors).
  static Placement Combine(const double (&inner)[16], const Placement& outer) {
    Placement combined{};
    for (int r = 0; r < 4; ++r) {
      for (int c = 0; c < 4; ++c) {
        double sum = 0.0;
        for (int k = 0; k < 4; ++k) sum += inner[4 * r + k] * outer[static_cast<std::size_t>(4 * k + c)];
        combined[static_cast<std::size_t>(4 * r + c)] = sum;
      }
    }
    return combined;
  }

  void AddEntity(const Entity& entity, const Placement& placement, int nesting) {
    if (entity.Type() == host::kTypeSolid) {
      auto mesh = ReadSolidMesh(entity);
      if (!mesh) return;
      if (nesting > 0) {
        for (host::Point3f& point : mesh->vertices) {
          const Vec3 placed = Place(placement, Widen(point));
          point = {static_cast<float>(placed.x), static_cast<float>(placed.y), static_cast<float>(placed.z)};
        }
      }
      AddSolid(Weld(*mesh), EntityStyle(entity));
    } else if (entity.Type() == host::kTypeLine && entity.FindAttribute("tb=") == nullptr) {
      const auto line = ReadRecord<host::LineRecord>(entity);
      AddLine({Place(placement, Widen(line.start)), Place(placement, Widen(line.end))}, EntityStyle(entity));
    } else if (entity.Type() == host::kTypePlacedBlock && nesting < kMaxNesting) {
      const auto placed = ReadRecord<host::PlacedBlockRecord>(entity);
      const Entity* block = drawing_.Find(placed.block);
      if (block == nullptr || block->Type() != host::kTypeBlock) return;
      const Placement inner = Combine(placed.placement, placement);
      for (const host::EntityHandle handle : block->members) {
        const Entity* part = drawing_.Find(handle);
        if (part != nullptr && Shown(drawing_, *part)) AddEntity(*part, inner, nesting + 1);
      }
    }
  }
  void Measure(Vec3 point) { worldScale_ = std::max(worldScale_, MaxAbs(point)); }

  void AddSolid(const WeldedMesh& mesh, Style style) {
    if (mesh.triangles.empty()) return;
    const auto solid = solidCount_++;
    for (const Vec3& point : mesh.points) Measure(point);
    WeldedMesh kept = mesh;
    for (const Cut& cut : cuts_) kept = ClipMesh(kept, cut.plane);
    if (near_) kept = ClipMesh(kept, *near_);
    std::vector<Vec3> screen;
    screen.reserve(kept.points.size());
    for (const Vec3& point : kept.points) screen.push_back(projection_.ToScreen(point));
    for (const MeshEdge& edge : FeatureEdges(kept)) {
      edges_.push_back({{screen[edge.a], screen[edge.b], solid, edge.a, edge.b}, style});
    }
    if (hide_) {
      for (const auto& corners : kept.triangles) {
        triangles_.push_back({{screen[corners[0]], screen[corners[1]], screen[corners[2]]}, solid, corners});
      }
    }
    if (!cuts_.empty()) AddSectionFaces(mesh, style);
  }

  void AddSectionFaces(const WeldedMesh& mesh, Style style) {
    // A face hides what lies behind it only when the mesh encloses a volume to cut.
    const bool hides = hide_ && IsClosed(mesh);
    for (const SectionFace& face : SectionFaces(mesh, cuts_)) {
      const Cut& cut = cuts_[face.cut];
      for (const Segment3& segment : face.outline) AddSegment(segment, CutStyle(style, cut.cutType));
      if (hides) AddRegion(near_ ? ClipFaceBoundary(face.boundary, cut, *near_) : face.boundary, cut.plane);
    }
  }

  void AddRegion(const std::vector<Segment3>& boundary, const ClipPlane& plane) {
    const auto depth = projection_.ScreenPlane(plane.normal, plane.offset);
    if (!depth || boundary.empty()) return;
    ScreenRegion region;
    region.zx = (*depth)[0];
    region.zy = (*depth)[1];
    region.z0 = (*depth)[2];
    for (const Segment3& segment : boundary) region.boundary.push_back({projection_.Project(segment.a), projection_.Project(segment.b)});
    regions_.push_back(std::move(region));
  }

  // A line: what the cuts keep of it.
  void AddLine(Segment3 segment, Style style) {
    if (!IsFinite(segment.a) || !IsFinite(segment.b)) return;
    Measure(segment.a);
    Measure(segment.b);
    for (const Cut& cut : cuts_) {
      auto kept = ClipSegment(segment, cut.plane);
      if (!kept) return;
      segment = *kept;
    }
    AddSegment(segment, style);
  }

  // A line or a section outline, cut already: what lies in front of the near plane, projected.
  void AddSegment(Segment3 segment, Style style) {
    if (near_) {
      auto kept = ClipSegment(segment, *near_);
      if (!kept) return;
      segment = *kept;
    }
    edges_.push_back({{projection_.ToScreen(segment.a), projection_.ToScreen(segment.b)}, style});
  }

  ScreenTolerance Tolerance() const {
    double flatScale = 0.0;
    for (const PendingEdge& pending : edges_) {
      flatScale = std::max({flatScale, std::fabs(pending.edge.a.x), std::fabs(pending.edge.a.y),
                            std::fabs(pending.edge.b.x), std::fabs(pending.edge.b.y)});
    }
    ScreenTolerance tolerance;
    tolerance.flat = kFlatFraction * flatScale;
    // Perspective depth is -distance / depth: a relative tolerance there is one relative to the
    // distance from the eye.
    if (projection_.Perspective()) {
      tolerance.depthRelative = kDepthFraction;
    } else {
      tolerance.depthAbsolute = kDepthFraction * worldScale_;
    }
    return tolerance;
  }

  void EmitStrokes(Sheet& sheet) {
    const ScreenTolerance tolerance = Tolerance();
    const auto emit = [&](const PendingEdge& pending, double from, double to) {
      sheet.strokes.push_back({PointAt(pending.edge, from), PointAt(pending.edge, to), pending.style.layer,
                               pending.style.color, pending.style.kind});
    };
    if (!hide_) {
      for (const PendingEdge& pending : edges_) {
        const ScreenEdge& edge = pending.edge;
        if (std::hypot(edge.b.x - edge.a.x, edge.b.y - edge.a.y) > tolerance.flat) emit(pending, 0.0, 1.0);
      }
      return;
    }
    const HiddenLines hiddenLines(std::move(triangles_), std::move(regions_), tolerance);
    HiddenLines::Scratch scratch = hiddenLines.MakeScratch();
    for (const PendingEdge& pending : edges_) {
      for (const Interval& part : hiddenLines.VisibleParts(pending.edge, scratch)) emit(pending, part.from, part.to);
    }
  }

  const Drawing& drawing_;
  Projection projection_;
  bool hide_;
  std::vector<Cut> cuts_;
  std::optional<ClipPlane> near_;
  std::uint32_t solidCount_ = 0;
  double worldScale_ = 1.0;
  std::vector<PendingEdge> edges_;
  std::vector<ScreenTriangle> triangles_;
  std::vector<ScreenRegion> regions_;
};

}  // namespace

Sheet GenerateSheet(const Drawing& drawing, const GenerateOptions& options) {
  return SheetBuilder(drawing, options).Build();
}

}  // namespace wb::draft
