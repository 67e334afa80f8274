// Drawing of the icon tabs.
#include "ui/controls/tab_ctrl_ex.h"

#include "framework/image_list.h"

BOOL CTabCtrlEx::PreCreateWindow(CREATESTRUCT& cs) {
  cs.style |= TCS_OWNERDRAWFIXED;
  return CTabCtrl::PreCreateWindow(cs);
}

void CTabCtrlEx::PreSubclassWindow() {
  ModifyStyle(0, TCS_OWNERDRAWFIXED);
  CTabCtrl::PreSubclassWindow();
}

void CTabCtrlEx::DrawItem(LPDRAWITEMSTRUCT drawItem) {
  const int index = static_cast<int>(drawItem->itemID);
  if (index < 0 || index >= GetItemCount()) return;
  char text[64] = {};
  TCITEM item;
  item.mask = TCIF_TEXT | TCIF_IMAGE;
  item.pszText = text;
  item.cchTextMax = 63;
  GetItem(index, &item);

  CDC* dc = CDC::FromHandle(drawItem->hDC);
  CRect rect(drawItem->rcItem);
  dc->FillSolidRect(rect, ::GetSysColor(COLOR_BTNFACE));
  dc->SetBkMode(TRANSPARENT);
  const bool selected = index == GetCurSel();
  rect.top += ::GetSystemMetrics(SM_CXEDGE);
  if (selected) rect.top -= ::GetSystemMetrics(SM_CXEDGE);

  const HIMAGELIST images = GetImageList();
  if (images && item.iImage >= 0) {
    rect.left += dc->GetTextExtent(" ").cx;
    int cx = 0;
    int cy = 0;
    ImageList_GetIconSize(images, &cx, &cy);
    dc->DrawState(rect.TopLeft(), CSize(cx, cy), ImageList_GetIcon(images, item.iImage, ILD_TRANSPARENT),
                  DST_ICON | DSS_NORMAL);
    rect.left += cx;
  }
  if (selected) {
    dc->SetTextColor(selectedColor);
    dc->SelectObject(&selectedFont);
    dc->DrawText(text, &rect, DT_SINGLELINE | DT_VCENTER | DT_CENTER);
  } else {
    dc->SetTextColor(otherColor);
    dc->SelectObject(&otherFont);
    dc->DrawText(text, &rect, DT_SINGLELINE | DT_BOTTOM | DT_CENTER);
  }
}
