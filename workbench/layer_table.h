// The layer table the host hands out: a snapshot of the current drawing's 256 layers, and the
// handles that name a drawing's table.
#pragma once

#include <array>
#include <string>

#include "shell/host/qeldll_view.h"

namespace wb {

// Table handles are kept apart from database handles, so a caller that hands one for the
// other is refused instead of reaching some drawing by chance.
constexpr host::LayerTableHandle kLayerTableHandleBase = 0x10000;

struct LayerTableSnapshot {
  // Refreshed from the current drawing by every GetLayersInCurrentHDL.
  std::array<host::LayerEntry, host::kHostLayerCount> entries{};
  // The text HDL_Get_LayerName answered last; valid until the next layer call.
  std::string name;
};

}  // namespace wb
