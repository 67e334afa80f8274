// Counting a drawing's entities, attribute records and layers.
#include "app/drawing_summary.h"

#include <array>

namespace app {

std::string EntityTypeName(const wb::Entity& entity) {
  static constexpr std::array<const char*, 13> kNames = {
      "unknown", "line",  "arc",   "circle", "element", "polyline",    "hatch",
      "dimension", "point", "solid", "group",  "block",   "placed block"};
  const std::uint8_t type = entity.Type();
  if (type == host::kTypeLine && entity.FindAttribute("tb=") != nullptr) return "text";
  if (type < kNames.size()) return kNames[type];
  return "type " + std::to_string(type);
}

DrawingSummary Summarize(const wb::Drawing& drawing) {
  DrawingSummary summary;
  summary.title = drawing.title;
  summary.nextHandle = drawing.NextHandle();
  std::array<std::size_t, wb::kLayerCount> perLayer{};
  for (const wb::Entity& entity : drawing.slots) {
    if (!entity.Alive()) continue;
    ++summary.entities;
    if (entity.Hidden()) ++summary.hiddenEntities;
    ++summary.entitiesByType[EntityTypeName(entity)];
    ++perLayer[entity.header.bytes[host::kHeaderLayer]];
    if (!entity.attributes.empty()) ++summary.attributeRecords;
    summary.attributes += entity.attributes.size();
    if (const wb::Attribute* marker = entity.FindAttribute("@Class=");
        marker != nullptr && marker->type == wb::AttributeType::String) {
      ++summary.classMarkers[marker->text];
    }
  }
  for (int i = 0; i < wb::kLayerCount; ++i) {
    const wb::Layer& layer = drawing.layers[static_cast<std::size_t>(i)];
    const std::size_t count = perLayer[static_cast<std::size_t>(i)];
    if (count > 0 || !layer.on) summary.layers.push_back({i, layer.name, layer.on, count});
  }
  return summary;
}

void PrintSummary(const DrawingSummary& summary, std::ostream& out) {
  out << "Drawing: " << (summary.title.empty() ? "(untitled)" : summary.title) << '\n';
  out << "Entities: " << summary.entities;
  if (summary.hiddenEntities > 0) out << " (" << summary.hiddenEntities << " hidden)";
  out << '\n';
  for (const auto& [type, count] : summary.entitiesByType) out << "  " << type << ": " << count << '\n';
  out << "Attribute records: " << summary.attributeRecords << " holding " << summary.attributes
      << " attributes\n";
  for (const auto& [marker, count] : summary.classMarkers) out << "  @Class=" << marker << ": " << count << '\n';
  out << "Layers in use: " << summary.layers.size() << " of " << wb::kLayerCount << '\n';
  for (const LayerUse& layer : summary.layers) {
    out << "  " << layer.index + 1 << " " << layer.name << ": " << layer.entities << " entities"
        << (layer.on ? "" : ", off") << '\n';
  }
}

}  // namespace app
