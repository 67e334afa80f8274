// The static class: a label or an icon that lets clicks through unless it asks for them.
#include "framework/controls/static_control.h"

#include "framework/cdc.h"
#include "framework/controls/control_behaviour.h"
#include "framework/resource_module.h"
#include "framework/window_classes.h"

namespace framework {
namespace {

class StaticBehaviour : public ControlBehaviour {
 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case WM_NCHITTEST:
        return (::GetWindowStyle(hwnd) & SS_NOTIFY) != 0 ? HTCLIENT : HTTRANSPARENT;
      case WM_GETDLGCODE:
        return DLGC_STATIC;
      case STM_SETICON: {
        const HICON old = std::exchange(icon_, HICON::FromParam(wParam));
        ::InvalidateRect(hwnd, nullptr, TRUE);
        return old.ToLParam();
      }
      case STM_GETICON:
        return icon_.ToLParam();
      case WM_LBUTTONDOWN:
        if ((::GetWindowStyle(hwnd) & SS_NOTIFY) != 0) Command(hwnd, 0);  // STN_CLICKED
        return 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override {
    const CRect r = ClientRect(hwnd);
    const DWORD style = ::GetWindowStyle(hwnd);
    if ((style & SS_TYPEMASK) == SS_ICON) {
      const std::string_view picture = IconPicture(icon_);
      const int size = ::GetSystemMetrics(SM_CXICON);
      if (!picture.empty()) {
        canvas.Picture(CRect(r.TopLeft(), CSize(size, size)), picture, !::IsWindowEnabled(hwnd),
                       {{"data-icon", std::to_string(IconResourceId(icon_))}});
      }
      return;
    }
    if ((style & SS_SUNKEN) != 0) canvas.Dc().Draw3dRect(r, RGB(160, 160, 160), RGB(255, 255, 255));
    CDC& dc = canvas.Dc();
    dc.SetBkMode(TRANSPARENT);
    dc.SetTextColor(TextColor(hwnd));
    CRect text = r;
    UINT format = DT_WORDBREAK | ((style & SS_NOPREFIX) != 0 ? DT_NOPREFIX : 0);
    if ((style & SS_TYPEMASK) == SS_CENTER) format |= DT_CENTER;
    if ((style & SS_TYPEMASK) == SS_RIGHT) format |= DT_RIGHT;
    dc.DrawText(::GetWindowText(hwnd), &text, format);
  }

 private:
  HICON icon_;
};

}  // namespace

void RegisterStaticClass() {
  RegisterWindowClass(kStaticClass, 0, [] { return std::make_unique<StaticBehaviour>(); });
}

}  // namespace framework

BOOL CStatic::Create(std::string_view text, DWORD style, const RECT& rect, CWnd* parent, UINT id) {
  return CWnd::Create(framework::kStaticClass, text, style, rect, parent, id);
}

HICON CStatic::SetIcon(HICON icon) { return HICON::FromParam(SendMessage(STM_SETICON, icon.ToWParam())); }
HICON CStatic::GetIcon() const { return HICON::FromParam(SendMessage(STM_GETICON)); }
