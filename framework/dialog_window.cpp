// The dialog window class: building a dialog from its template, its default handling (default
// button, Close as Cancel, focus) and the keyboard handling of dialogs.
#include <algorithm>

#include "framework/cdialog.h"
#include "framework/canvas.h"
#include "framework/message_queue.h"
#include "framework/window_class.h"
#include "framework/window_classes.h"

namespace {

bool IsTabStop(HWND hwnd) {
  const DWORD style = ::GetWindowStyle(hwnd);
  return (style & WS_TABSTOP) != 0 && (style & WS_VISIBLE) != 0 && (style & WS_DISABLED) == 0;
}

// The tab stops of a dialog in template order.
std::vector<HWND> TabStops(HWND dialog) {
  std::vector<HWND> stops;
  for (HWND child : framework::GetChildren(dialog)) {
    if (IsTabStop(child)) stops.push_back(child);
  }
  return stops;
}

// The dialog's child that holds (or contains) the focus.
HWND FocusedControl(HWND dialog) {
  for (HWND h = ::GetFocus(); h; h = ::GetParent(h)) {
    if (::GetParent(h) == dialog && (::GetWindowStyle(h) & WS_CHILD) != 0) return h;
    if ((::GetWindowStyle(h) & WS_CHILD) == 0) break;
  }
  return HWND();
}

void FocusControl(HWND control) {
  ::SetFocus(control);
  if ((::SendMessage(control, WM_GETDLGCODE, 0, 0) & DLGC_HASSETSEL) != 0) ::SendMessage(control, EM_SETSEL, 0, -1);
}

void MoveFocus(HWND dialog, bool backwards) {
  const std::vector<HWND> stops = TabStops(dialog);
  if (stops.empty()) return;
  const auto at = std::find(stops.begin(), stops.end(), FocusedControl(dialog));
  std::ptrdiff_t index = at == stops.end() ? (backwards ? 0 : -1) : at - stops.begin();
  const auto count = static_cast<std::ptrdiff_t>(stops.size());
  index = ((index + (backwards ? -1 : 1)) % count + count) % count;
  FocusControl(stops[static_cast<std::size_t>(index)]);
}

HWND DefaultButton(HWND dialog) {
  for (HWND child : framework::GetChildren(dialog)) {
    if (::GetClassName(child) == framework::kButtonClass && (::GetWindowStyle(child) & BS_TYPEMASK) == BS_DEFPUSHBUTTON) {
      return child;
    }
  }
  return HWND();
}

void SendCommand(HWND dialog, int id, HWND button) {
  // A disabled button cannot be pressed, not even by its key.
  if (button && !::IsWindowEnabled(button)) return;
  ::SendMessage(dialog, WM_COMMAND, MAKEWPARAM(static_cast<unsigned>(id), BN_CLICKED), button.ToLParam());
}

class DialogBehaviour : public framework::WindowBehaviour {
 public:
  LRESULT Handle(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case WM_PAINT: {
        RECT client;
        ::GetClientRect(hwnd, &client);
        reinterpret_cast<Canvas*>(wParam)->FillRect(client, ::GetSysColor(COLOR_BTNFACE));
        return 0;
      }
      case WM_CLOSE:
        SendCommand(hwnd, IDCANCEL, ::GetDlgItem(hwnd, IDCANCEL));
        return 0;
      case DM_GETDEFID: {
        const int id = defaultId_ != 0 ? defaultId_ : ::GetDlgCtrlID(DefaultButton(hwnd));
        return id != 0 ? static_cast<LRESULT>(MAKELONG(static_cast<unsigned>(id), DC_HASDEFID)) : 0;
      }
      case DM_SETDEFID:
        SetDefault(hwnd, static_cast<int>(wParam));
        return TRUE;
      case WM_NEXTDLGCTL:
        if (lParam != 0) {
          FocusControl(HWND::FromParam(wParam));
        } else {
          MoveFocus(hwnd, wParam != 0);
        }
        return 0;
      case WM_SETFOCUS:
        if (const std::vector<HWND> stops = TabStops(hwnd); !stops.empty()) ::SetFocus(stops.front());
        return 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

 private:
  void SetDefault(HWND dialog, int id) {
    if (const HWND old = DefaultButton(dialog)) ::SendMessage(old, BM_SETSTYLE, BS_PUSHBUTTON, TRUE);
    defaultId_ = id;
    const HWND button = ::GetDlgItem(dialog, id);
    if (::GetClassName(button) == framework::kButtonClass && (::GetWindowStyle(button) & BS_TYPEMASK) == BS_PUSHBUTTON) {
      ::SendMessage(button, BM_SETSTYLE, BS_DEFPUSHBUTTON, TRUE);
    }
  }

  int defaultId_ = 0;
};

}  // namespace

namespace framework {

void RegisterDialogClass() {
  RegisterWindowClass(kDialogClass, 0, [] { return std::make_unique<DialogBehaviour>(); });
}

HWND CreateDialogWindow(const DialogTemplate& dialogTemplate, HWND parentOrOwner, CWnd* attach, LPARAM initParam) {
  const DWORD style = dialogTemplate.style;
  DWORD exStyle = dialogTemplate.exStyle | WS_EX_CONTROLPARENT;
  if ((style & DS_MODALFRAME) != 0) exStyle |= WS_EX_DLGMODALFRAME;
  const CRect client = DialogUnitsToPixels(dialogTemplate.x, dialogTemplate.y, dialogTemplate.cx, dialogTemplate.cy);
  const RECT insets = NonClientInsets(style, exStyle);
  const CSize size(client.Width() + insets.left + insets.right, client.Height() + insets.top + insets.bottom);

  // A child dialog is placed in its parent's client area; a popup relative to its owner's
  // client area, or centred on the owner (the screen without one) with DS_CENTER.
  CPoint position = client.TopLeft();
  const bool child = (style & WS_CHILD) != 0;
  if ((style & DS_CENTER) != 0) {
    CRect area(0, 0, ::GetSystemMetrics(SM_CXSCREEN), ::GetSystemMetrics(SM_CYSCREEN));
    if (child && parentOrOwner) {
      ::GetClientRect(parentOrOwner, &area);
    } else if (parentOrOwner) {
      ::GetWindowRect(parentOrOwner, &area);
    }
    position = CPoint(area.left + (area.Width() - size.cx) / 2, area.top + (area.Height() - size.cy) / 2);
  } else if (!child && parentOrOwner && (style & DS_ABSALIGN) == 0) {
    ::ClientToScreen(parentOrOwner, &position);
  }

  if (attach != nullptr) AttachToNextWindow(attach);
  const HWND dialog = ::CreateWindowEx(exStyle, kDialogClass, dialogTemplate.caption, style & ~WS_VISIBLE, position.x,
                                       position.y, size.cx, size.cy, parentOrOwner, 0, initParam);
  if (!dialog) {
    AttachToNextWindow(nullptr);
    return HWND();
  }
  for (const DialogItemTemplate& item : dialogTemplate.items) {
    const CRect r = DialogUnitsToPixels(item.x, item.y, item.cx, item.cy);
    const HWND control = ::CreateWindowEx(item.exStyle, item.className, item.text, item.style | WS_CHILD, r.left, r.top,
                                          r.Width(), r.Height(), dialog, item.id);
    if (!control) {
      ::DestroyWindow(dialog);
      return HWND();
    }
    const bool combo = item.className == kComboBoxClass || item.className == kComboBoxExClass;
    for (std::string_view entry : item.initialStrings) {
      const std::string text(entry);
      ::SendMessage(control, combo ? CB_ADDSTRING : LB_ADDSTRING, 0, reinterpret_cast<LPARAM>(text.c_str()));
    }
  }
  const std::vector<HWND> stops = TabStops(dialog);
  const HWND first = stops.empty() ? HWND() : stops.front();
  const LRESULT focusFirst = ::SendMessage(dialog, WM_INITDIALOG, first.ToWParam(), initParam);
  if (!::IsWindow(dialog)) return HWND();
  if (focusFirst != 0 && ::IsWindow(first)) FocusControl(first);
  if ((style & WS_VISIBLE) != 0) ::ShowWindow(dialog, SW_SHOWNORMAL);
  return dialog;
}

}  // namespace framework

BOOL IsDialogMessage(HWND dialog, MSG* msg) {
  if (msg == nullptr || (msg->hwnd != dialog && !::IsChild(dialog, msg->hwnd))) return FALSE;
  const bool keyDown = msg->message == WM_KEYDOWN;
  const bool character = msg->message == WM_CHAR;
  const LRESULT code = ::SendMessage(msg->hwnd, WM_GETDLGCODE, msg->wParam, reinterpret_cast<LPARAM>(msg));
  if ((keyDown || character) && (code & DLGC_WANTALLKEYS) == 0) {
    const UINT key = static_cast<UINT>(msg->wParam);
    if (keyDown && key == VK_TAB && (code & DLGC_WANTTAB) == 0) {
      MoveFocus(dialog, (::GetKeyState(static_cast<int>(VK_SHIFT)) & 0x8000) != 0);
      return TRUE;
    }
    if (keyDown && key == VK_RETURN) {
      const HWND focus = ::GetFocus();
      if ((code & (DLGC_DEFPUSHBUTTON | DLGC_UNDEFPUSHBUTTON)) != 0 && focus == msg->hwnd) {
        SendCommand(dialog, ::GetDlgCtrlID(focus), focus);
      } else {
        const DWORD def = static_cast<DWORD>(::SendMessage(dialog, DM_GETDEFID, 0, 0));
        const int id = HIWORD(def) == DC_HASDEFID ? LOWORD(def) : IDOK;
        SendCommand(dialog, id, ::GetDlgItem(dialog, id));
      }
      return TRUE;
    }
    if (keyDown && key == VK_ESCAPE) {
      SendCommand(dialog, IDCANCEL, ::GetDlgItem(dialog, IDCANCEL));
      return TRUE;
    }
    // The characters of the keys the dialog took are not typed into the control.
    if (character && (key == '\r' || key == 0x1B || (key == '\t' && (code & DLGC_WANTTAB) == 0))) return TRUE;
  }
  ::TranslateMessage(*msg);
  ::DispatchMessage(*msg);
  return TRUE;
}
