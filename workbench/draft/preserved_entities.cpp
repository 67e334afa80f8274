// Projection of preserved entities into the 2D drawing.
#include "workbench/draft/preserved_entities.h"

#include <cmath>

#include "workbench/draft/welded_mesh.h"

namespace wb::draft {
namespace {

constexpr float kDefaultTextHeight = 2.5F;

struct Style {
  std::uint8_t layer;
  std::uint8_t color;
};

Style StyleOf(const Entity& entity) {
  const std::uint8_t color = entity.header.bytes[host::kHeaderColor];
  return {entity.header.bytes[host::kHeaderLayer], color == 0 ? std::uint8_t{7} : color};
}

// Segments reaching behind the eye's near limit are left out rather than drawn through it.
void AddStroke(const Projection& projection, Vec3 a, Vec3 b, Style style, Sheet& sheet) {
  if (!IsFinite(a) || !IsFinite(b)) return;
  if (projection.Perspective() && (projection.Depth(a) < projection.NearDepth() || projection.Depth(b) < projection.NearDepth())) {
    return;
  }
  sheet.strokes.push_back({projection.Project(a), projection.Project(b), style.layer, style.color, StrokeKind::Preserved});
}

void AddLabel(const Projection& projection, Vec3 at, const std::string& text, double height, Style style,
              Sheet& sheet) {
  if (!IsFinite(at) || text.empty()) return;
  if (projection.Perspective() && projection.Depth(at) < projection.NearDepth()) return;
  sheet.labels.push_back({projection.Project(at), height, 0.0, text, style.layer, style.color});
}

std::string TextOf(const Entity& entity) {
  const Attribute* text = entity.FindAttribute("t=");
  return text != nullptr && text->type == AttributeType::String ? text->text : std::string();
}

double TextHeight(const Entity& entity) {
  const Attribute* block = entity.FindAttribute("tb=");
  if (block == nullptr || block->floats.empty() || !std::isfinite(block->floats[0]) || block->floats[0] == 0.0F) {
    return kDefaultTextHeight;
  }
  return std::fabs(block->floats[0]);
}

void AddEntity(const Entity& entity, const Projection& projection, Sheet& sheet) {
  const Style style = StyleOf(entity);
  switch (entity.Type()) {
    case host::kTypeSolid: {
      const std::optional<SolidMesh> mesh = ReadSolidMesh(entity);
      if (!mesh) return;
      const WeldedMesh welded = Weld(*mesh);
      for (const MeshEdge& edge : FeatureEdges(welded)) {
        AddStroke(projection, welded.points[edge.a], welded.points[edge.b], style, sheet);
      }
      return;
    }
    case host::kTypeLine:
    case host::kTypeDimension: {
      const host::LineRecord line = ReadRecord<host::LineRecord>(entity);
      const bool text = entity.Type() == host::kTypeLine && entity.FindAttribute("tb=") != nullptr;
      if (text) {
        AddLabel(projection, Widen(line.start), TextOf(entity), TextHeight(entity), style, sheet);
        return;
      }
      AddStroke(projection, Widen(line.start), Widen(line.end), style, sheet);
      if (entity.Type() == host::kTypeDimension) {
        AddLabel(projection, Lerp(Widen(line.start), Widen(line.end), 0.5), TextOf(entity), kDefaultTextHeight / 10.0,
                 style, sheet);
      }
      return;
    }
    default:
      return;
  }
}

}  // namespace

void AddPreservedEntities(const Drawing& drawing, const std::vector<host::EntityHandle>& entities,
                          const ViewSpec& view, Sheet& sheet) {
  const Projection projection(view);
  for (const host::EntityHandle handle : entities) {
    if (const Entity* entity = drawing.Find(handle)) AddEntity(*entity, projection, sheet);
  }
}

}  // namespace wb::draft
