// Pictures of windows: a window with all its children drawn to SVG, each window by its class's
// WM_PAINT, the frames and captions by the system.
#pragma once

#include <string>

#include "framework/win_types.h"

class Canvas;

namespace framework {

// The window and its children in the window's own pixels (its top-left corner is 0, 0). The
// same state gives the same bytes. A hidden window is drawn all the same (it is what was asked
// for); its hidden children appear only as markers.
std::string RenderWindow(HWND hwnd);

// Draws the window into a canvas at its place in the canvas's current coordinates.
void PaintWindow(HWND hwnd, Canvas& canvas, const RECT& place);

}  // namespace framework
