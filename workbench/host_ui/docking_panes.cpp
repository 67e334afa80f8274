// Docking, removing and reattaching panes, each journaled as the host call it is.
#include "workbench/host_ui/docking_panes.h"

#include <algorithm>

#include "framework/window_system.h"
#include "workbench/host_call_support.h"

namespace wb::ui {

bool DockingPanes::AddPane(int id, const char* title, HWND window, const RECT& rect,
                           XTPDockingPaneDirection direction) {
  if (call::Fault("CPaneManager::AddPane")) return false;
  call::AddToJournal(JournalEntry::Kind::HostCall, "CPaneManager::AddPane", 0, id);
  if (!::IsWindow(window) || direction < xtpPaneDockLeft || direction > xtpPaneDockBottom) return false;
  // A pane added again under its id replaces the one it had.
  std::erase_if(panes_, [id](const DockingPane& pane) { return pane.id == id; });
  panes_.push_back({id, title != nullptr ? title : "", window, CRect(rect), direction, true});
  changed_();
  return true;
}

bool DockingPanes::RemovePane(int id) {
  if (call::Fault("CPaneManager::RemovePane")) return false;
  call::AddToJournal(JournalEntry::Kind::HostCall, "CPaneManager::RemovePane", 0, id);
  DockingPane* pane = FindMutable(id);
  if (pane == nullptr) return false;
  pane->attached = false;
  changed_();
  return true;
}

bool DockingPanes::ReattachPane(int id, HWND window) {
  if (call::Fault("CPaneManager::ReattachPane")) return false;
  call::AddToJournal(JournalEntry::Kind::HostCall, "CPaneManager::ReattachPane", 0, id);
  DockingPane* pane = FindMutable(id);
  if (pane == nullptr || !::IsWindow(window)) return false;
  pane->window = window;
  pane->attached = true;
  changed_();
  return true;
}

const DockingPane* DockingPanes::Find(int id) const {
  const auto found = std::find_if(panes_.begin(), panes_.end(), [id](const DockingPane& p) { return p.id == id; });
  return found != panes_.end() ? &*found : nullptr;
}

DockingPane* DockingPanes::FindMutable(int id) { return const_cast<DockingPane*>(Find(id)); }

const DockingPane* DockingPanes::Holding(HWND window) const {
  for (const DockingPane& pane : panes_) {
    if (pane.attached && (pane.window == window || ::IsChild(pane.window, window))) return &pane;
  }
  return nullptr;
}

}  // namespace wb::ui
