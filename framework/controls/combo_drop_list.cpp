// The drop-down list window: rows of the combo's items, a scroll bar when they do not all fit,
// hot tracking, and closing on a choice or on a press anywhere else.
#include "framework/controls/combo_drop_list.h"

#include <algorithm>

#include "framework/controls/control_behaviour.h"
#include "framework/controls/scroll_bar.h"
#include "framework/window_classes.h"
#include "framework/window_system.h"

namespace framework::detail {
namespace {

struct OpenRequest {
  HWND combo;
  DropListOwner* owner = nullptr;
  int visibleRows = 1;
  int highlighted = -1;
};

class DropListBehaviour : public ControlBehaviour {
 public:
  std::string StateWords(HWND) const override { return "dropped"; }

  void MoveHighlight(HWND hwnd, int delta) {
    const int count = owner_->ItemCount();
    if (count == 0) return;
    // With nothing highlighted the list is entered from its top going down, from its end going up.
    const int from = hot_ >= 0 ? hot_ : (delta > 0 ? -1 : count);
    hot_ = std::clamp(from + delta, 0, count - 1);
    if (hot_ < top_) top_ = hot_;
    if (hot_ >= top_ + rows_) top_ = hot_ - rows_ + 1;
    Layout(hwnd);
  }

  int Highlight() const { return hot_; }

 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case WM_CREATE: {
        const auto* request = reinterpret_cast<const OpenRequest*>(reinterpret_cast<const CREATESTRUCT*>(lParam)->lpCreateParams);
        combo_ = request->combo;
        owner_ = request->owner;
        rows_ = std::max(1, request->visibleRows);
        hot_ = request->highlighted;
        bar_ = ::CreateWindowEx(0, kScrollBarClass, "", WS_CHILD | SBS_VERT, 0, 0, 0, 0, hwnd, 1);
        if (hot_ >= rows_) top_ = hot_ - rows_ + 1;
        return 0;
      }
      case WM_SIZE:
        Layout(hwnd);
        return 0;
      case WM_NCHITTEST:
        return HTCLIENT;
      case WM_MOUSEMOVE: {
        const int row = RowAt(hwnd, {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)});
        if (row >= 0 && row != hot_) {
          hot_ = row;
          ::InvalidateRect(hwnd, nullptr, FALSE);
        }
        return 0;
      }
      case WM_LBUTTONDOWN:
      case WM_LBUTTONDBLCLK:
      case WM_RBUTTONDOWN: {
        const CPoint p(GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam));
        if (!ClientRect(hwnd).PtInRect(p)) {
          owner_->CloseList(combo_, -1);  // a press anywhere else dismisses the list
          return 0;
        }
        if (::IsWindowVisible(bar_) && BarRect().PtInRect(p)) {
          ::SendMessage(bar_, message, wParam, MAKELPARAM(p.x - BarRect().left, p.y - BarRect().top));
        }
        return 0;
      }
      case WM_LBUTTONUP: {
        const int row = RowAt(hwnd, {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)});
        if (row >= 0) owner_->CloseList(combo_, row);
        return 0;
      }
      case WM_VSCROLL:
        Scroll(hwnd, LOWORD(wParam));
        return 0;
      case WM_CAPTURECHANGED:
        // Another window took the mouse (a modal box): the list goes, as nothing is chosen.
        if (HWND::FromParam(lParam) != hwnd && ::IsWindow(combo_) && !closing_) {
          closing_ = true;
          owner_->CloseList(combo_, -1);
        }
        return 0;
      case LB_GETCOUNT:
        return owner_->ItemCount();
      case LB_GETTOPINDEX:
        return top_;
      case LB_GETCURSEL:
        return hot_;
      case LB_GETITEMRECT: {
        const int index = static_cast<int>(wParam);
        if (lParam == 0 || index < 0 || index >= owner_->ItemCount()) return -1;
        *reinterpret_cast<RECT*>(lParam) = RowRect(hwnd, index);
        return 1;
      }
      case WM_DESTROY:
        closing_ = true;
        if (::GetCapture() == hwnd) ::ReleaseCapture();
        return 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override {
    const CRect client = ClientRect(hwnd);
    canvas.FillRect(client, ::GetSysColor(COLOR_WINDOW));
    const int last = std::min(owner_->ItemCount(), top_ + rows_);
    for (int row = top_; row < last; ++row) owner_->PaintItem(combo_, canvas, row, RowRect(hwnd, row), row == hot_);
  }

 private:
  CRect BarRect() const {
    RECT r;
    ::GetWindowRect(bar_, &r);
    POINT origin{r.left, r.top};
    ::ScreenToClient(::GetParent(bar_), &origin);
    return CRect(origin, CRect(r).Size());
  }

  int ItemsWidth(HWND hwnd) const {
    return ClientRect(hwnd).Width() - (::IsWindowVisible(bar_) ? kScrollBarWidth : 0);
  }

  CRect RowRect(HWND hwnd, int index) const {
    const int height = owner_->ItemHeight(combo_);
    return {0, (index - top_) * height, ItemsWidth(hwnd), (index - top_ + 1) * height};
  }

  int RowAt(HWND hwnd, POINT p) const {
    if (!ClientRect(hwnd).PtInRect(p) || p.x >= ItemsWidth(hwnd)) return -1;
    const int row = top_ + p.y / std::max(1, owner_->ItemHeight(combo_));
    return row < owner_->ItemCount() && row < top_ + rows_ ? row : -1;
  }

  void Layout(HWND hwnd) {
    const int count = owner_->ItemCount();
    top_ = std::clamp(top_, 0, std::max(0, count - rows_));
    ShowListScrollBar(bar_, ClientRect(hwnd), count, rows_, top_);
    ::InvalidateRect(hwnd, nullptr, FALSE);
  }

  void Scroll(HWND hwnd, WORD request) {
    if (request == SB_LINEUP) top_ -= 1;
    if (request == SB_LINEDOWN) top_ += 1;
    if (request == SB_PAGEUP) top_ -= rows_;
    if (request == SB_PAGEDOWN) top_ += rows_;
    Layout(hwnd);
  }

  HWND combo_;
  DropListOwner* owner_ = nullptr;
  HWND bar_;
  int rows_ = 1;
  int top_ = 0;
  int hot_ = -1;
  bool closing_ = false;
};

}  // namespace

HWND OpenDropList(HWND combo, DropListOwner& owner, int visibleRows, int highlighted) {
  RECT field;
  ::GetWindowRect(combo, &field);
  const int rows = std::max(1, std::min(visibleRows, owner.ItemCount()));
  const int height = rows * owner.ItemHeight(combo) + 2;  // and the one-pixel border
  OpenRequest request{combo, &owner, visibleRows, highlighted};
  const HWND list = ::CreateWindowEx(WS_EX_TOOLWINDOW | WS_EX_TOPMOST, kComboListClass, "", WS_POPUP | WS_BORDER,
                                     field.left, field.bottom, CRect(field).Width(), height, combo, 0,
                                     reinterpret_cast<LPARAM>(&request));
  if (!list) return HWND();
  ::ShowWindow(list, SW_SHOWNA);
  ::SetCapture(list);
  return list;
}

void MoveDropListHighlight(HWND list, int delta) {
  if (auto* behaviour = BehaviourOf<DropListBehaviour>(list)) behaviour->MoveHighlight(list, delta);
}

int DropListHighlight(HWND list) {
  const auto* behaviour = BehaviourOf<DropListBehaviour>(list);
  return behaviour != nullptr ? behaviour->Highlight() : -1;
}

void RegisterDropListClass() {
  RegisterWindowClass(kComboListClass, 0, [] { return std::make_unique<DropListBehaviour>(); });
}

}  // namespace framework::detail
