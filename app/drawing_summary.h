// What a drawing holds, counted for `pandex info`.
#pragma once

#include <cstddef>
#include <map>
#include <ostream>
#include <string>
#include <vector>

#include "workbench/drawing.h"

namespace app {

struct LayerUse {
  int index = 0;  // 0-based
  std::string name;
  bool on = true;
  std::size_t entities = 0;
};

struct DrawingSummary {
  std::string title;
  std::size_t entities = 0;
  std::size_t hiddenEntities = 0;
  std::map<std::string, std::size_t> entitiesByType;  // by type name
  std::size_t attributeRecords = 0;                    // entities holding any attribute
  std::size_t attributes = 0;
  std::map<std::string, std::size_t> classMarkers;  // "@Class=" value -> entities
  std::vector<LayerUse> layers;                     // layers in use, or switched off
  host::EntityHandle nextHandle = 1;
};

// The name of a host entity type; texts are lines that carry a text block.
std::string EntityTypeName(const wb::Entity& entity);

DrawingSummary Summarize(const wb::Drawing& drawing);
void PrintSummary(const DrawingSummary& summary, std::ostream& out);

}  // namespace app
