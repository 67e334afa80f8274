// The icon push button: a plain push button whose picture is its icon.
#include "framework/toolkit/button_st.h"

#include "framework/resource_module.h"

void CButtonST::PreSubclassWindow() { ModifyStyle(0, BS_ICON); }

BOOL CButtonST::SetIcon(UINT iconId) { return SetIcon(AfxLoadIcon(iconId)); }

BOOL CButtonST::SetIcon(HICON icon) {
  if (!icon) return FALSE;
  CButton::SetIcon(icon);
  return TRUE;
}
