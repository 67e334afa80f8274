// The host's view: eye, target, cone, projection, 2D or 3D, the view window, redraw holding,
// the wait cursor, scale keeping, and the section and plan cuts the 2D output will honour.
#pragma once

#include <array>
#include <cstdint>

#include "shell/host/host_types.h"

namespace wb {

// Slots of the argument blocks where the host publishes view values it keeps.
constexpr int kDimensionSlot = 132;  // globr: 2.0 while the view is 2D, 3.0 while 3D
constexpr int kScaleModeSlot = 22;   // globc: the scale mode as set_scale_mode took it

// The vertical cut of set_vsect_plane: the cut line's start and end, a point above the start
// and the side point, as handed over, and how the cut is coloured.
struct SectionCut {
  std::array<host::Point3f, 4> points{};
  char cutType = 'b';
  bool active = false;
};

// The horizontal cut of planv: the base point, the two points that span the plan from it, and
// the second picked point.
struct PlanView {
  host::Point3f base{};
  host::Point3f xPoint{};
  host::Point3f yPoint{};
  host::Point3f dir{};
  char cutType = 'b';
  bool active = false;
};

// What the screen went through. A redraw asked for while redrawing is off is held and done
// once when it is switched on again, so a run of view changes draws the screen once.
struct RedrawCounts {
  int full = 0;                          // redraw_all and released held redraws
  int regenerations = 0;                 // regen
  int displayList = 0;                   // wn3_dl_redraw
  std::int32_t lastDisplayListMode = 0;  // the mode of the last wn3_dl_redraw
  int drawParameterResets = 0;           // init_hdl_redraw_draw_params
  bool held = false;
};

struct ViewState {
  host::Point3f eye{10.0F, -10.0F, 10.0F};
  host::Point3f target{0.0F, 0.0F, 0.0F};
  float cone = 45.0F;  // opening of the viewing cone in degrees
  bool perspective = false;
  bool threeD = true;
  std::array<double, 4> window{-10.0, -10.0, 10.0, 10.0};  // x min, y min, x max, y max

  bool redrawOn = true;
  RedrawCounts redraws;

  int waitCursor = 0;            // adds not yet removed
  int waitCursorUnderflows = 0;  // removes with no add outstanding, refused

  // 'a' auto (the window follows the drawing), 'f' fixed (the scale is kept), 'o' and ' ' none.
  char scaleMode = 'a';
  // Width of the drawing box the window is shown in; the scale is the window width over it.
  double boxWidth = 1.0;
  float keptScale = 0.0F;  // 0: no scale kept yet
  bool keepingScale = false;
  int autoWindowFits = 0;

  SectionCut section;
  PlanView plan;

  // Back to the view of a freshly started host; publishes what the host keeps in the blocks.
  void Reset();
  // Switches between 2D and 3D and keeps globr[132] in step.
  void SetThreeD(bool on);
  bool FixedScaling() const { return scaleMode == 'f'; }
  bool AutoScaling() const { return scaleMode == 'a'; }
  // A redraw of the given kind, or a held one while redrawing is off.
  void Redraw(int RedrawCounts::*counter);
};

}  // namespace wb
