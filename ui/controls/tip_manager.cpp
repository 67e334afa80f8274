// Registration of tips and the relay that shows them.
#include "ui/controls/tip_manager.h"

#include <algorithm>

#include "framework/resource_module.h"

void CTipManager::Setup(CWnd* owner, HitTest hitTest, int spacingX, int spacingY) {
  owner_ = owner;
  hitTest_ = std::move(hitTest);
  spacingX_ = std::max(0, spacingX);
  spacingY_ = std::max(0, spacingY);
  if (!tip_.m_hWnd) tip_.Create(owner, spacingX_, spacingY_);
  tip_.Hide();
  display_ = {6, 0, 5000, 0, 0};
}

void CTipManager::SetDisplayParameters(int first, int second, int third, int fourth, int fifth) {
  display_ = {first, second, third, fourth, fifth};
}

void CTipManager::AddTip(int id, UINT stringId) {
  std::string text = AfxLoadString(stringId);
  const auto existing = std::find_if(entries_.begin(), entries_.end(), [id](const auto& e) { return e.first == id; });
  if (existing != entries_.end()) {
    existing->second = std::move(text);
  } else {
    entries_.emplace_back(id, std::move(text));
  }
}

bool CTipManager::Relay(int id, CPoint point) {
  const auto entry = std::find_if(entries_.begin(), entries_.end(), [id](const auto& e) { return e.first == id; });
  if (entry == entries_.end() || !hitTest_) return false;
  CRect area;
  if (!hitTest_(owner_, id, point, area)) return false;
  tip_.SetTitle("");
  tip_.SetText(entry->second);
  tip_.Show(area, point, display_);
  return true;
}

bool CTipManager::RelayAll(CPoint point) {
  for (const auto& [id, text] : std::vector(entries_)) {
    if (Relay(id, point)) return true;
  }
  return false;
}
