// The scroll-bar class: its range, page and position, the parts a click can land on, and the
// WM_VSCROLL requests those clicks send to the parent.
#include "framework/controls/scroll_bar.h"

#include <algorithm>

#include "framework/controls/control_behaviour.h"
#include "framework/window_classes.h"

namespace framework {
namespace {

class ScrollBarBehaviour : public ControlBehaviour {
 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case SBM_SETSCROLLINFO: {
        const auto* info = reinterpret_cast<const SCROLLINFO*>(lParam);
        if (info == nullptr) return pos_;
        if ((info->fMask & SIF_RANGE) != 0) {
          min_ = info->nMin;
          max_ = std::max(info->nMin, info->nMax);
        }
        if ((info->fMask & SIF_PAGE) != 0) page_ = static_cast<int>(info->nPage);
        if ((info->fMask & SIF_POS) != 0) pos_ = info->nPos;
        Clamp();
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return pos_;
      }
      case SBM_GETSCROLLINFO: {
        auto* info = reinterpret_cast<SCROLLINFO*>(lParam);
        if (info == nullptr) return FALSE;
        info->nMin = min_;
        info->nMax = max_;
        info->nPage = static_cast<UINT>(page_);
        info->nPos = info->nTrackPos = pos_;
        return TRUE;
      }
      case SBM_SETPOS: {
        const int old = std::exchange(pos_, static_cast<int>(wParam));
        Clamp();
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return old;
      }
      case SBM_GETPOS:
        return pos_;
      case SBM_SETRANGE:
        min_ = static_cast<int>(wParam);
        max_ = std::max(min_, static_cast<int>(lParam));
        Clamp();
        return TRUE;
      case WM_LBUTTONDOWN:
      case WM_LBUTTONDBLCLK:
        if (const WORD request = RequestAt(hwnd, {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)}); request != SB_ENDSCROLL) {
          const HWND parent = ::GetParent(hwnd);
          ::SendMessage(parent, WM_VSCROLL, MAKEWPARAM(request, 0), hwnd.ToLParam());
          ::SendMessage(parent, WM_VSCROLL, MAKEWPARAM(SB_ENDSCROLL, 0), hwnd.ToLParam());
        }
        return 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override {
    const CRect r = ClientRect(hwnd);
    canvas.FillRect(r, RGB(240, 240, 240));
    const COLORREF arrow = ::IsWindowEnabled(hwnd) ? RGB(96, 96, 96) : RGB(191, 191, 191);
    const CRect up = UpArrow(r);
    const CRect down = DownArrow(r);
    const int cx = r.left + r.Width() / 2;
    canvas.Polygon({{cx - 4, up.top + 10}, {cx + 4, up.top + 10}, {cx, up.top + 6}}, arrow);
    canvas.Polygon({{cx - 4, down.top + 6}, {cx + 4, down.top + 6}, {cx, down.top + 10}}, arrow);
    canvas.BeginGroup({{"data-part", "thumb"},
                       {"data-position", std::to_string(pos_)},
                       {"data-range", std::to_string(min_) + " " + std::to_string(max_)},
                       {"data-page", std::to_string(page_)}});
    canvas.FillRect(Thumb(r), RGB(205, 205, 205));
    canvas.EndGroup();
  }

 private:
  void Clamp() {
    const int last = std::max(min_, max_ - std::max(page_, 1) + 1);
    pos_ = std::clamp(pos_, min_, last);
  }

  static CRect UpArrow(const CRect& r) { return {r.left, r.top, r.right, r.top + std::min(kScrollBarWidth, r.Height() / 2)}; }
  static CRect DownArrow(const CRect& r) {
    return {r.left, r.bottom - std::min(kScrollBarWidth, r.Height() / 2), r.right, r.bottom};
  }

  CRect Thumb(const CRect& r) const {
    const int trackTop = UpArrow(r).bottom;
    const int track = std::max(0, DownArrow(r).top - trackTop);
    const int span = std::max(1, max_ - min_ + 1);
    const int page = std::clamp(page_ > 0 ? page_ : 1, 1, span);
    const int height = std::max(8, track * page / span);
    const int room = std::max(0, track - height);
    const int steps = std::max(1, span - page);
    const int top = trackTop + room * (pos_ - min_) / steps;
    return {r.left + 2, top, r.right - 2, std::min(top + height, trackTop + track)};
  }

  WORD RequestAt(HWND hwnd, POINT p) const {
    const CRect r = ClientRect(hwnd);
    if (!r.PtInRect(p)) return SB_ENDSCROLL;
    if (UpArrow(r).PtInRect(p)) return SB_LINEUP;
    if (DownArrow(r).PtInRect(p)) return SB_LINEDOWN;
    const CRect thumb = Thumb(r);
    if (p.y < thumb.top) return SB_PAGEUP;
    if (p.y >= thumb.bottom) return SB_PAGEDOWN;
    return SB_ENDSCROLL;  // the thumb itself is not dragged
  }

  int min_ = 0;
  int max_ = 0;
  int page_ = 0;
  int pos_ = 0;
};

}  // namespace

void RegisterScrollBarClass() {
  RegisterWindowClass(kScrollBarClass, CS_DBLCLKS, [] { return std::make_unique<ScrollBarBehaviour>(); });
}

bool ShowListScrollBar(HWND bar, const RECT& area, int total, int visible, int top) {
  const bool needed = total > visible;
  if (needed) {
    const CRect a(area);
    ::SetWindowPos(bar, a.right - kScrollBarWidth, a.top, kScrollBarWidth, a.Height(), SWP_NOZORDER);
    SCROLLINFO info;
    info.fMask = SIF_ALL;
    info.nMax = total - 1;
    info.nPage = static_cast<UINT>(std::max(1, visible));
    info.nPos = top;
    ::SendMessage(bar, SBM_SETSCROLLINFO, TRUE, reinterpret_cast<LPARAM>(&info));
  }
  if ((::IsWindowVisible(bar) != FALSE) != needed) ::ShowWindow(bar, needed ? SW_SHOWNA : SW_HIDE);
  return needed;
}

}  // namespace framework

BOOL CScrollBar::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
  return CWnd::Create(framework::kScrollBarClass, "", style, rect, parent, id);
}

int CScrollBar::GetScrollPos() const { return static_cast<int>(SendMessage(SBM_GETPOS)); }
int CScrollBar::SetScrollPos(int position) { return static_cast<int>(SendMessage(SBM_SETPOS, static_cast<WPARAM>(position))); }

BOOL CScrollBar::SetScrollInfo(const SCROLLINFO& info) {
  SendMessage(SBM_SETSCROLLINFO, TRUE, reinterpret_cast<LPARAM>(&info));
  return TRUE;
}

BOOL CScrollBar::GetScrollInfo(SCROLLINFO* info, UINT mask) const {
  if (info == nullptr) return FALSE;
  info->fMask = mask;
  return static_cast<BOOL>(SendMessage(SBM_GETSCROLLINFO, 0, reinterpret_cast<LPARAM>(info)));
}
