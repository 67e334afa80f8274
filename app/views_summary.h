// The views a drawing keeps (cameras, sections and plans with their cameras, selection sets),
// read through the plug-in running in the workbench.
#pragma once

#include <cstdint>
#include <ostream>
#include <string>
#include <vector>

#include "shell/host/host_types.h"

namespace app {

struct CameraLine {
  host::EntityHandle handle = 0;
  std::string name;
  bool for2D = false;
  std::int16_t displayMode = 0;
  std::int16_t viewMode = 0;
};

struct OwnerLine {  // a section or a plan
  host::EntityHandle handle = 0;
  std::string name;
  bool for2D = false;
  std::vector<CameraLine> cameras;
};

struct SelectionLine {
  host::EntityHandle handle = 0;
  std::string name;
  std::int32_t cameras = 0;
  std::int32_t sections = 0;
  std::int32_t plans = 0;
};

struct ViewsSummary {
  std::vector<CameraLine> cameras;
  std::vector<OwnerLine> sections;
  std::vector<OwnerLine> plans;
  std::vector<SelectionLine> selections;
};

// Reads the views of the current drawing of the workbench; the plug-in must be loaded.
ViewsSummary CollectViews();
void PrintViews(const ViewsSummary& views, std::ostream& out);

}  // namespace app
