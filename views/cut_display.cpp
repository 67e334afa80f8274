// The command sequence that brings the host into its cut display.
#include "views/cut_display.h"

#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll.h"

namespace cut_display {
namespace {

constexpr int kCutTypeSlot = 109;    // globc
constexpr int kCutStyleSlot = 243;   // globc
constexpr int kCutFlagsPoint = 25;   // globp: .y 7.0 asks for the cut
constexpr int kSolidStateSlot = 26;  // globc: 's' in the solid state
constexpr int kSolidRebuildSlot = 27;

void Run(const char* command) { execute_internal_command(command); }

}  // namespace

bool RenderingActive() {
  Run("inq_render_mode");
  return globr[0] == 1.0F;
}

void Begin(char cutType) {
  globc[kCutTypeSlot] = cutType;
  globc[kCutStyleSlot] = 's';
  globp[kCutFlagsPoint].y = 7.0F;
  if (globc[kSolidStateSlot] != 's') {
    globc[kSolidStateSlot] = 's';
    Run("set_background_color");
    globr[0] = 0.0F;
    Run("wire_frame_all");
  }
  globc[0] = 'b';
  Run("set_dspmode_info");
}

void Finish(char displayLetter) {
  globc[kSolidRebuildSlot] = 'f';
  Run("new_solid");
  Run("redraw_all");
  if (globc[0] != displayLetter) {
    globc[0] = displayLetter;
    Run("set_dspmode_info");
  }
}

}  // namespace cut_display
