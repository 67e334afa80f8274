// The anchoring rules and the resize pass.
#include "ui/controls/resize_layout.h"

void CResizeLayout::Setup(CWnd* owner) {
  owner_ = owner;
  CRect client;
  if (owner_ != nullptr) owner_->GetClientRect(&client);
  setupSize_ = client.Size();
}

void CResizeLayout::AddControl(int id, Rule rule) {
  if (owner_ == nullptr) return;
  CWnd* control = owner_->GetDlgItem(id);
  if (control == nullptr) return;
  CRect rect;
  control->GetWindowRect(&rect);
  owner_->ScreenToClient(&rect);
  controls_.emplace(id, std::make_pair(rect, rule));
}

CRect CResizeLayout::Place(const CRect& remembered, CSize setupSize, CSize newSize, Rule rule) const {
  const LONG dx = newSize.cx - setupSize.cx;
  const LONG dy = newSize.cy - setupSize.cy;
  CRect r = remembered;
  switch (rule) {
    case Rule::kStretch:
      r.right += dx;
      r.bottom += dy;
      break;
    case Rule::kFollowRight:
      r.OffsetRect(dx, 0);
      break;
    case Rule::kFollowCorner:
      r.OffsetRect(dx, dy);
      break;
  }
  return r;
}

void CResizeLayout::Resize(int cx, int cy) {
  if (owner_ == nullptr) return;
  for (const auto& [id, anchor] : controls_) {
    CWnd* control = owner_->GetDlgItem(id);
    if (control == nullptr) continue;
    control->MoveWindow(Place(anchor.first, setupSize_, CSize(cx, cy), anchor.second), TRUE);
    control->InvalidateRect(nullptr, FALSE);
  }
}
