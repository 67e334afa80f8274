// The host's display: render switch and image, display letter, background, text display,
// toolbar, the solid model and the hatch patterns.
//
// The one-letter flags the plug-in reads and writes straight in globc (solid state, render
// image, shadow kind, ...) live only there, as in the host the plug-in was written for: host
// commands read them when they run and write them when they change them. This state holds
// what only the host's commands change.
#pragma once

#include <cstddef>
#include <string>

namespace wb {

// globc slots of the one-letter flags.
namespace letter {
constexpr int kDisplay = 0;                 // handed to set_dspmode_info, answered by inq_dspmode_info
constexpr int kSolidState = 26;             // 's' in the solid modes, 'w' otherwise
constexpr int kSolidRebuild = 27;           // 'f' makes new_solid rebuild the solid model from scratch
constexpr int kGeometricKind = 32;          // 'a' or 'r' for the two geometric variants, else blank
constexpr int kRenderImage = 36;            // 'g' while a rendered image is shown
constexpr int kDesignMode = 65;             // 'p' in design mode
constexpr int kPatterns = 66;               // 'h' while hatch patterns are shown
constexpr int kShadowKind = 83;             // 'd' terrain, 's' model, 'c' none
constexpr int kCutType = 109;               // how a section or plan cut is coloured: 'b', 'o', 'w'
constexpr int kCutStyle = 243;              // 's' handed over with a section or plan cut
constexpr int kRememberedProjection = 403;  // 'a' perspective before rendering, 'e' parallel
}  // namespace letter

constexpr std::size_t kToolbarNameLength = 8;

struct DisplayState {
  bool renderOn = false;           // render_on, answered by inq_render_mode
  bool renderImage = false;        // rnd_make drew one; rnd_clear removes it
  bool renderWindowShown = false;  // rnd_smain / rnd_smain_off
  bool glSurface = false;          // the rendering surface rnd_make opens and gloff closes
  char displayLetter = 'a';        // set_dspmode_info and the solid mode commands
  int backgroundColor = 1;         // host colour index
  bool textShown = true;           // draw_text_on_off
  bool hiddenLine2d = false;       // hidlin2d: 2D hidden-line drawing of the solid modes
  int solidBuilds = 0;             // new_solid runs
  int freshSolidBuilds = 0;        // of them, rebuilds from scratch (globc[27] 'f')
  int allWireResets = 0;           // wire_frame_all / wireframe_all: every edge drawn as a wire
  std::string toolbar = "GEOM    ";
  bool hatchPatterns = false;  // refh
  // Scriptable: a host that cannot show hatch patterns drops them when refh asks for them.
  bool patternsShowable = true;

  // Back to plain geometry as a freshly started host shows it; writes the standing letters.
  void Reset();
  bool SolidState() const;
  // Render on leaves the solid state: the rendered image replaces the solid drawing, and the
  // way back to plain geometry (which does not touch the solid letter) must find geometry.
  void EnterRender();
};

}  // namespace wb
