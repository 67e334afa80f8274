// The button class: pressing with the mouse (capture until release) or the space bar, check
// states, the default-button look, an icon instead of a text, and owner drawing.
#include "framework/controls/button.h"

#include "framework/cdc.h"
#include "framework/controls/control_behaviour.h"
#include "framework/resource_module.h"
#include "framework/text_metrics.h"
#include "framework/window_classes.h"

namespace framework {
namespace {

class ButtonBehaviour : public ControlBehaviour {
 public:
  std::string StateWords(HWND hwnd) const override {
    std::string words;
    if (check_ == BST_CHECKED) words = "checked";
    if (check_ == BST_INDETERMINATE) words = "indeterminate";
    if (pushed_) words += words.empty() ? "pushed" : " pushed";
    if (Kind(hwnd) == BS_DEFPUSHBUTTON) words += words.empty() ? "default" : " default";
    return words;
  }

 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    const DWORD kind = Kind(hwnd);
    switch (message) {
      case WM_GETDLGCODE:
        if (kind == BS_GROUPBOX) return DLGC_STATIC;
        if (kind == BS_PUSHBUTTON || kind == BS_OWNERDRAW) return DLGC_BUTTON | DLGC_UNDEFPUSHBUTTON;
        if (kind == BS_DEFPUSHBUTTON) return DLGC_BUTTON | DLGC_DEFPUSHBUTTON;
        if (kind == BS_RADIOBUTTON || kind == BS_AUTORADIOBUTTON) return DLGC_BUTTON | DLGC_RADIOBUTTON;
        return DLGC_BUTTON;
      case WM_NCHITTEST:
        // A group box only frames other controls; clicks go to what lies in it.
        return kind == BS_GROUPBOX ? HTTRANSPARENT : HTCLIENT;
      case WM_LBUTTONDOWN:
      case WM_LBUTTONDBLCLK:
        if (kind == BS_GROUPBOX) return 0;
        ::SetFocus(hwnd);
        SetPushed(hwnd, true);
        ::SetCapture(hwnd);
        return 0;
      case WM_MOUSEMOVE:
        if (::GetCapture() == hwnd) {
          SetPushed(hwnd, ClientRect(hwnd).PtInRect({GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)}));
        }
        return 0;
      case WM_LBUTTONUP:
        if (::GetCapture() == hwnd) {
          const bool inside = ClientRect(hwnd).PtInRect({GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)});
          ::ReleaseCapture();
          if (inside) Click(hwnd);
        }
        return 0;
      case WM_CAPTURECHANGED:
        SetPushed(hwnd, false);
        return 0;
      case WM_KEYDOWN:
        if (wParam == VK_SPACE && kind != BS_GROUPBOX) SetPushed(hwnd, true);
        return 0;
      case WM_KEYUP:
        if (wParam == VK_SPACE && pushed_) Click(hwnd);
        return 0;
      case WM_SETFOCUS:
      case WM_KILLFOCUS:
      case WM_ENABLE:
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return 0;
      case BM_CLICK:
        if (::IsWindowEnabled(hwnd)) Click(hwnd);
        return 0;
      case BM_GETCHECK:
        return check_;
      case BM_SETCHECK:
        check_ = static_cast<int>(wParam);
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return 0;
      case BM_GETSTATE:
        return check_ | (pushed_ ? BST_PUSHED : 0) | (HasFocus(hwnd) ? BST_FOCUS : 0);
      case BM_SETSTATE:
        SetPushed(hwnd, wParam != 0);
        return 0;
      case BM_SETSTYLE:
        ::SetWindowStyle(hwnd, (::GetWindowStyle(hwnd) & ~BS_TYPEMASK) | (static_cast<DWORD>(wParam) & BS_TYPEMASK));
        if (lParam != 0) ::InvalidateRect(hwnd, nullptr, TRUE);
        return 0;
      case BM_SETIMAGE: {
        if (wParam != IMAGE_ICON) return 0;
        const HICON old = std::exchange(icon_, HICON::FromParam(lParam));
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return old.ToLParam();
      }
      case BM_GETIMAGE:
        return wParam == IMAGE_ICON ? icon_.ToLParam() : 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override {
    switch (Kind(hwnd)) {
      case BS_OWNERDRAW:
        PaintOwnerDrawn(hwnd, canvas);
        break;
      case BS_GROUPBOX:
        PaintGroupBox(hwnd, canvas);
        break;
      case BS_CHECKBOX:
      case BS_AUTOCHECKBOX:
      case BS_3STATE:
      case BS_AUTO3STATE:
      case BS_RADIOBUTTON:
      case BS_AUTORADIOBUTTON:
        PaintCheck(hwnd, canvas);
        break;
      default:
        PaintPush(hwnd, canvas);
    }
  }

 private:
  static DWORD Kind(HWND hwnd) { return ::GetWindowStyle(hwnd) & BS_TYPEMASK; }

  void SetPushed(HWND hwnd, bool pushed) {
    if (pushed_ == pushed) return;
    pushed_ = pushed;
    ::InvalidateRect(hwnd, nullptr, FALSE);
  }

  void Click(HWND hwnd) {
    SetPushed(hwnd, false);
    switch (Kind(hwnd)) {
      case BS_AUTOCHECKBOX:
        check_ = check_ == BST_CHECKED ? BST_UNCHECKED : BST_CHECKED;
        break;
      case BS_AUTO3STATE:
        check_ = (check_ + 1) % 3;
        break;
      case BS_AUTORADIOBUTTON:
        check_ = BST_CHECKED;
        break;
      default:
        break;
    }
    Command(hwnd, BN_CLICKED);
  }

  void PaintPush(HWND hwnd, Canvas& canvas) const {
    const CRect r = ClientRect(hwnd);
    const bool enabled = ::IsWindowEnabled(hwnd) != FALSE;
    canvas.FillRect(r, pushed_ ? RGB(204, 228, 247) : RGB(225, 225, 225));
    const bool isDefault = Kind(hwnd) == BS_DEFPUSHBUTTON;
    canvas.FrameRect(r, pushed_ ? RGB(0, 84, 153) : (isDefault || HasFocus(hwnd)) ? RGB(0, 120, 215) : RGB(173, 173, 173),
                     isDefault ? 2 : 1);
    const std::string_view picture = IconPicture(icon_);
    if (!picture.empty()) {
      const int size = std::min({16, r.Width() - 4, r.Height() - 4});
      const CPoint at(r.left + (r.Width() - size) / 2 + (pushed_ ? 1 : 0), r.top + (r.Height() - size) / 2 + (pushed_ ? 1 : 0));
      canvas.Picture(CRect(at, CSize(size, size)), picture, !enabled,
                     {{"data-icon", std::to_string(IconResourceId(icon_))}});
    } else {
      CDC& dc = canvas.Dc();
      dc.SetBkMode(TRANSPARENT);
      dc.SetTextColor(TextColor(hwnd));
      CRect text = r;
      dc.DrawText(::GetWindowText(hwnd), &text, DT_CENTER | DT_VCENTER | DT_SINGLELINE);
    }
    if (HasFocus(hwnd)) {
      CRect focus = r;
      focus.DeflateRect(3, 3);
      canvas.FocusRect(focus);
    }
  }

  void PaintCheck(HWND hwnd, Canvas& canvas) const {
    const CRect r = ClientRect(hwnd);
    const bool enabled = ::IsWindowEnabled(hwnd) != FALSE;
    const int top = r.top + (r.Height() - 13) / 2;
    const DWORD kind = Kind(hwnd);
    if (kind == BS_RADIOBUTTON || kind == BS_AUTORADIOBUTTON) {
      canvas.Circle({r.left + 6, top + 6}, 6, enabled ? RGB(255, 255, 255) : ::GetSysColor(COLOR_BTNFACE), RGB(51, 51, 51));
      if (check_ == BST_CHECKED) canvas.Circle({r.left + 6, top + 6}, 3, RGB(0, 0, 0), RGB(0, 0, 0));
    } else {
      PaintCheckBox(canvas, {r.left, top}, check_, enabled);
    }
    CDC& dc = canvas.Dc();
    dc.SetBkMode(TRANSPARENT);
    dc.SetTextColor(TextColor(hwnd));
    CRect text(r.left + 17, r.top, r.right, r.bottom);
    dc.DrawText(::GetWindowText(hwnd), &text, DT_LEFT | DT_VCENTER | DT_SINGLELINE);
    if (HasFocus(hwnd)) {
      CRect measured = text;
      dc.DrawText(::GetWindowText(hwnd), &measured, DT_CALCRECT | DT_SINGLELINE);
      canvas.FocusRect(CRect(text.left - 1, top - 1, measured.right + 2, top + 14));
    }
  }

  static void PaintGroupBox(HWND hwnd, Canvas& canvas) {
    const CRect r = ClientRect(hwnd);
    const std::string text = ::GetWindowText(hwnd);
    const int lineY = r.top + kLineHeight / 2;
    canvas.FrameRect(CRect(r.left, lineY, r.right, r.bottom), RGB(220, 220, 220));
    if (text.empty()) return;
    CDC& dc = canvas.Dc();
    dc.SetBkMode(OPAQUE);
    dc.SetBkColor(::GetSysColor(COLOR_BTNFACE));
    dc.SetTextColor(TextColor(hwnd));
    CRect label(r.left + 8, r.top, r.right - 8, r.top + kLineHeight);
    dc.DrawText(text, &label, DT_LEFT | DT_SINGLELINE);
  }

  void PaintOwnerDrawn(HWND hwnd, Canvas& canvas) const {
    const UINT state = (pushed_ ? ODS_SELECTED : 0) | (HasFocus(hwnd) ? ODS_FOCUS : 0) | (check_ == BST_CHECKED ? ODS_CHECKED : 0);
    AskOwnerToDraw(hwnd, canvas, ODT_BUTTON, 0, state, ClientRect(hwnd));
  }

  int check_ = BST_UNCHECKED;
  bool pushed_ = false;
  HICON icon_;
};

}  // namespace

void RegisterButtonClass() {
  RegisterWindowClass(kButtonClass, CS_DBLCLKS, [] { return std::make_unique<ButtonBehaviour>(); });
}

}  // namespace framework

BOOL CButton::Create(std::string_view text, DWORD style, const RECT& rect, CWnd* parent, UINT id) {
  return CWnd::Create(framework::kButtonClass, text, style, rect, parent, id);
}

int CButton::GetCheck() const { return static_cast<int>(SendMessage(BM_GETCHECK)); }
void CButton::SetCheck(int check) { SendMessage(BM_SETCHECK, static_cast<WPARAM>(check)); }
UINT CButton::GetState() const { return static_cast<UINT>(SendMessage(BM_GETSTATE)); }
void CButton::SetState(BOOL pushed) { SendMessage(BM_SETSTATE, static_cast<WPARAM>(pushed)); }
UINT CButton::GetButtonStyle() const { return GetStyle() & 0xFFFF; }
void CButton::SetButtonStyle(UINT style, BOOL redraw) { SendMessage(BM_SETSTYLE, style, redraw); }

HICON CButton::SetIcon(HICON icon) {
  ModifyStyle(BS_BITMAP, BS_ICON);
  return HICON::FromParam(SendMessage(BM_SETIMAGE, IMAGE_ICON, icon.ToLParam()));
}

HICON CButton::GetIcon() const { return HICON::FromParam(SendMessage(BM_GETIMAGE, IMAGE_ICON)); }

void CButton::DrawItem(LPDRAWITEMSTRUCT) {}

BOOL CButton::OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
  if (message == WM_DRAWITEM) {
    DrawItem(reinterpret_cast<LPDRAWITEMSTRUCT>(lParam));
    return TRUE;
  }
  return CWnd::OnChildNotify(message, wParam, lParam, result);
}
