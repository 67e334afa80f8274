// Tools by string id.
#include "ui/controls/tool_tip_ctrl_ex.h"

BOOL CToolTipCtrlEx::AddTool(CWnd* control, UINT stringId) {
  if (control == nullptr) return FALSE;
  TOOLINFO info;
  info.uFlags = TTF_SUBCLASS;
  info.hwnd = control->m_hWnd;
  control->GetClientRect(&info.rect);
  info.lpszText = MAKEINTRESOURCE(static_cast<WORD>(stringId));
  return static_cast<BOOL>(SendMessage(TTM_ADDTOOL, 0, reinterpret_cast<LPARAM>(&info)));
}
