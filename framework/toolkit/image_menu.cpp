// The image menu: a popup menu whose items carry an image each, tracked for its answer.
#include "framework/toolkit/image_menu.h"

BOOL CImageMenu::Create(const CImageList& images) {
  images_ = images.GetSafeHandle();
  return CreatePopupMenu();
}

BOOL CImageMenu::AddItem(UINT id, std::string_view text, int image) {
  if (!AppendMenu(MF_STRING, id, text)) return FALSE;
  return SetMenuItemImage(m_hMenu, static_cast<UINT>(GetMenuItemCount() - 1), MF_BYPOSITION, images_, image);
}

UINT CImageMenu::Track(CWnd* owner, CPoint screenPoint) {
  const UINT flags = TPM_CENTERALIGN | TPM_VCENTERALIGN | TPM_LEFTBUTTON | TPM_RETURNCMD | TPM_NONOTIFY;
  return static_cast<UINT>(TrackPopupMenu(flags, screenPoint.x, screenPoint.y, owner));
}
