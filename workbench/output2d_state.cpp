// Resetting the 2D output state.
#include "workbench/output2d_state.h"

namespace wb {

void Output2DState::Reset() {
  const std::filesystem::path folder = specialFolder;
  *this = Output2DState{};
  specialFolder = folder;
}

}  // namespace wb
