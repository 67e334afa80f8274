// The rules a drawing must keep to be saved and that every opened drawing is held to, so that a
// damaged file never reaches the host calls and a saved file always opens again.
#pragma once

#include <optional>
#include <string>

#include "workbench/drawing.h"

namespace wb::drawing_file {

// What is wrong with the drawing, or nothing when it holds together: every slot holds its own
// handle or is deleted, typed records have their type's size, members and placed blocks refer to
// handles of this drawing, and no block or group contains itself (which would send anything that
// expands them round for ever).
std::optional<std::string> FindInconsistency(const Drawing& drawing);

}  // namespace wb::drawing_file
