// Shared plumbing of the control classes.
#include "framework/controls/control_behaviour.h"

#include "framework/message_queue.h"
#include "framework/window_system.h"

namespace framework {

LRESULT ControlBehaviour::Handle(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) {
  if (message == WM_PAINT) {
    if (wParam != 0) Paint(hwnd, *reinterpret_cast<Canvas*>(wParam));
    return 0;
  }
  return OnMessage(hwnd, message, wParam, lParam);
}

LRESULT ControlBehaviour::OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) {
  return ::DefWindowProc(hwnd, message, wParam, lParam);
}

LRESULT ControlBehaviour::Notify(HWND control, UINT code, NMHDR* header) {
  NMHDR plain;
  NMHDR* h = header != nullptr ? header : &plain;
  h->hwndFrom = control;
  h->idFrom = static_cast<UINT_PTR>(::GetDlgCtrlID(control));
  h->code = code;
  return ::SendMessage(::GetParent(control), WM_NOTIFY, h->idFrom, reinterpret_cast<LPARAM>(h));
}

void ControlBehaviour::Command(HWND control, UINT code) {
  ::SendMessage(::GetParent(control), WM_COMMAND, MAKEWPARAM(static_cast<unsigned>(::GetDlgCtrlID(control)), code),
                control.ToLParam());
}

void ControlBehaviour::AskOwnerToDraw(HWND control, Canvas& canvas, UINT type, UINT item, UINT state, const RECT& rect,
                                      UINT_PTR data) {
  DRAWITEMSTRUCT draw;
  draw.CtlType = type;
  draw.CtlID = static_cast<UINT>(::GetDlgCtrlID(control));
  draw.itemID = item;
  draw.itemAction = ODA_DRAWENTIRE;
  draw.itemState = state | (::IsWindowEnabled(control) ? 0 : ODS_DISABLED);
  draw.hwndItem = control;
  draw.hDC = &canvas;
  draw.rcItem = rect;
  draw.itemData = data;
  ::SendMessage(::GetParent(control), WM_DRAWITEM, draw.CtlID, reinterpret_cast<LPARAM>(&draw));
}

CRect ControlBehaviour::ClientRect(HWND hwnd) {
  RECT r;
  ::GetClientRect(hwnd, &r);
  return r;
}

COLORREF ControlBehaviour::TextColor(HWND hwnd) {
  return ::IsWindowEnabled(hwnd) ? ::GetSysColor(COLOR_WINDOWTEXT) : ::GetSysColor(COLOR_GRAYTEXT);
}

bool ControlBehaviour::HasFocus(HWND hwnd) { return ::GetFocus() == hwnd; }

void PaintCheckBox(Canvas& canvas, POINT origin, int checkState, bool enabled) {
  const CRect box(origin, CSize(13, 13));
  canvas.FillRect(box, enabled ? RGB(255, 255, 255) : ::GetSysColor(COLOR_BTNFACE));
  canvas.FrameRect(box, enabled ? RGB(51, 51, 51) : ::GetSysColor(COLOR_BTNSHADOW));
  const COLORREF ink = enabled ? RGB(0, 0, 0) : ::GetSysColor(COLOR_GRAYTEXT);
  if (checkState == BST_CHECKED) {
    canvas.Polyline({{box.left + 3, box.top + 6}, {box.left + 5, box.top + 9}, {box.left + 10, box.top + 3}}, ink, 2);
  } else if (checkState == BST_INDETERMINATE) {
    canvas.FillRect(CRect(box.left + 3, box.top + 3, box.right - 3, box.bottom - 3), ink);
  }
}

}  // namespace framework
