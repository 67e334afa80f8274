// The main frame's docking panes: the host's CPaneManager. Each pane is a window the frame
// lays out on one of its sides under a caption with the pane's title; a removed pane is
// remembered and takes its place again when it is reattached.
#pragma once

#include <functional>
#include <string>
#include <vector>

#include "framework/geometry.h"
#include "shell/host/pane_manager.h"

namespace wb::ui {

struct DockingPane {
  int id = 0;
  std::string title;
  HWND window;
  CRect rect;  // the room asked for: its width for a side pane, its height for a top or bottom one
  XTPDockingPaneDirection direction = xtpPaneDockLeft;
  bool attached = false;  // docked and shown; false after RemovePane
};

class DockingPanes final : public CPaneManager {
 public:
  // `changed` is told after every change, so the frame can lay itself out again.
  explicit DockingPanes(std::function<void()> changed) : changed_(std::move(changed)) {}

  bool AddPane(int id, const char* title, HWND window, const RECT& rect, XTPDockingPaneDirection direction) override;
  bool RemovePane(int id) override;
  bool ReattachPane(int id, HWND window) override;

  const std::vector<DockingPane>& Panes() const { return panes_; }
  const DockingPane* Find(int id) const;
  // The attached pane whose window is `window` or holds it, or null.
  const DockingPane* Holding(HWND window) const;

 private:
  DockingPane* FindMutable(int id);

  std::vector<DockingPane> panes_;
  std::function<void()> changed_;
};

}  // namespace wb::ui
