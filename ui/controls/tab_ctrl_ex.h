// The pane's icon tabs: an owner-drawn tab control that draws each tab's icon and text itself,
// the selected tab's text centred in blue, the others' at the bottom in dark grey.
#pragma once

#include "framework/cdc.h"
#include "framework/controls/tab_control.h"

class CTabCtrlEx : public CTabCtrl {
 public:
  void DrawItem(LPDRAWITEMSTRUCT drawItem) override;

  COLORREF selectedColor = RGB(0, 0, 255);
  COLORREF otherColor = RGB(50, 50, 50);
  // Fonts of the selected and the other tabs; left uncreated, drawing keeps the context's font.
  CFont selectedFont;
  CFont otherFont;

 protected:
  BOOL PreCreateWindow(CREATESTRUCT& cs) override;
  void PreSubclassWindow() override;
};
