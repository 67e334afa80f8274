// The host's view state and the values it keeps published in the argument blocks.
#include "workbench/view_state.h"

#include "shell/host/argument_blocks.h"

namespace wb {

void ViewState::Reset() {
  *this = ViewState{};
  SetThreeD(threeD);
  globc[kScaleModeSlot] = scaleMode;
}

void ViewState::SetThreeD(bool on) {
  threeD = on;
  globr[kDimensionSlot] = on ? 3.0F : 2.0F;
}

void ViewState::Redraw(int RedrawCounts::*counter) {
  if (redrawOn) {
    ++(redraws.*counter);
  } else {
    redraws.held = true;
  }
}

}  // namespace wb
