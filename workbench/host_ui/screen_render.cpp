// The screen as SVG, composed of the pictures of its top-level windows.
#include "workbench/host_ui/screen_render.h"

#include "framework/canvas.h"
#include "framework/geometry.h"
#include "framework/render.h"
#include "framework/window_system.h"

namespace wb::ui {

std::string RenderScreen() {
  Canvas canvas(::GetSystemMetrics(SM_CXSCREEN), ::GetSystemMetrics(SM_CYSCREEN));
  for (const HWND window : framework::TopLevelWindows()) {
    if (!::IsWindowVisible(window)) continue;
    CRect place;
    ::GetWindowRect(window, &place);
    framework::PaintWindow(window, canvas, place);
  }
  return canvas.Svg();
}

}  // namespace wb::ui
