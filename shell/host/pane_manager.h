// The host's docking panes: its main frame answers the registered message
// "Quorvel_GetPaneManager" with its pane manager, which docks a window as a pane, takes it away
// and docks it again, each by the pane's id. The plug-in reaches the manager only through that
// pointer, so its calls are virtual and need nothing linked from the host.
#pragma once

#include "framework/win_types.h"

// The side of the main frame a docking pane sits on.
enum XTPDockingPaneDirection : int {
  xtpPaneDockLeft = 0,
  xtpPaneDockRight = 1,
  xtpPaneDockTop = 2,
  xtpPaneDockBottom = 3,
};

class CPaneManager {
 public:
  // Docks `window` as pane `id` under `title` on one side of the main frame; the rectangle's
  // width (left and right sides) or height (top and bottom) is the room the pane gets.
  virtual bool AddPane(int id, const char* title, HWND window, const RECT& rect,
                       XTPDockingPaneDirection direction) = 0;
  // Takes the pane away from the frame; the manager remembers it.
  virtual bool RemovePane(int id) = 0;
  // Docks a removed pane again where it was, with the window given.
  virtual bool ReattachPane(int id, HWND window) = 0;

 protected:
  ~CPaneManager() = default;
};

namespace host {

// The registered messages the host and the plug-in share: the first is sent to the host's main
// window and answers its CPaneManager; the second carries the host's mouse messages (wParam
// points at the MSG) to a docked pane.
inline constexpr const char* kGetPaneManagerMessageName = "Quorvel_GetPaneManager";
inline constexpr const char* kPreTranslateMessageName = "Quorvel_PreTranslateMessage";

}  // namespace host
