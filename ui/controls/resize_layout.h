// Anchoring of a window's controls: each control remembers where it was when the window had
// its first size, and a rule moves it when the window is resized.
#pragma once

#include <map>
#include <utility>

#include "framework/cwnd.h"

class CResizeLayout {
 public:
  enum class Rule {
    kStretch,       // left and top stay; right and bottom move with the window's edges
    kFollowRight,   // moves sideways with the right edge, keeps its size
    kFollowCorner,  // moves with the bottom-right corner, keeps its size
  };

  CResizeLayout() = default;
  CResizeLayout(const CResizeLayout&) = delete;
  CResizeLayout& operator=(const CResizeLayout&) = delete;
  virtual ~CResizeLayout() = default;

  // Remembers the owner and its client size now.
  void Setup(CWnd* owner);
  // Anchors the owner's child with this id (nothing when there is none). An id added twice
  // keeps its first rectangle and rule.
  void AddControl(int id, Rule rule);
  // Moves every anchored control, in ascending id order, for a new client size.
  void Resize(int cx, int cy);

 protected:
  // The placement of one control: its remembered rectangle, moved by the change of size.
  virtual CRect Place(const CRect& remembered, CSize setupSize, CSize newSize, Rule rule) const;

 private:
  CWnd* owner_ = nullptr;
  CSize setupSize_;
  std::map<int, std::pair<CRect, Rule>> controls_;
};
