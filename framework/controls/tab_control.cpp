// The tab control class: tabs of one width in a row across the top, the selected one raised,
// selection by mouse (with TCN_SELCHANGING and TCN_SELCHANGE) or by TCM_SETCURSEL (silently).
#include "framework/controls/tab_control.h"

#include <cstring>
#include <vector>

#include "framework/cdc.h"
#include "framework/controls/control_behaviour.h"
#include "framework/image_list.h"
#include "framework/text_metrics.h"
#include "framework/window_classes.h"

namespace framework {
namespace {

constexpr int kPadding = 6;        // pixels between a tab's edge and its content
constexpr int kMinimumTabWidth = 42;
constexpr int kRaise = 2;          // the selected tab stands this much above and beside the others

struct Tab {
  std::string text;
  int image = -1;
  LPARAM param = 0;
};

class TabBehaviour : public ControlBehaviour {
 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case TCM_INSERTITEM:
        return Insert(hwnd, static_cast<int>(wParam), reinterpret_cast<const TCITEM*>(lParam));
      case TCM_DELETEITEM:
        return Delete(hwnd, static_cast<int>(wParam));
      case TCM_DELETEALLITEMS:
        tabs_.clear();
        selected_ = -1;
        ::InvalidateRect(hwnd, nullptr, TRUE);
        return TRUE;
      case TCM_GETITEMCOUNT:
        return static_cast<LRESULT>(tabs_.size());
      case TCM_GETITEM:
        return GetItem(static_cast<int>(wParam), reinterpret_cast<TCITEM*>(lParam));
      case TCM_SETITEM:
        return SetItem(hwnd, static_cast<int>(wParam), reinterpret_cast<const TCITEM*>(lParam));
      case TCM_GETCURSEL:
        return selected_;
      case TCM_SETCURSEL: {
        const auto index = static_cast<int>(static_cast<std::intptr_t>(wParam));
        if (!Valid(index)) return -1;
        const int previous = std::exchange(selected_, index);
        ::InvalidateRect(hwnd, nullptr, TRUE);
        return previous;
      }
      case TCM_GETITEMRECT:
        if (!Valid(static_cast<int>(wParam)) || lParam == 0) return FALSE;
        *reinterpret_cast<RECT*>(lParam) = TabRect(static_cast<int>(wParam));
        return TRUE;
      case TCM_HITTEST: {
        auto* info = reinterpret_cast<TCHITTESTINFO*>(lParam);
        const int index = HitTest(info->pt);
        info->flags = index >= 0 ? TCHT_ONITEM : TCHT_NOWHERE;
        return index;
      }
      case TCM_SETIMAGELIST:
        ::InvalidateRect(hwnd, nullptr, TRUE);
        return std::exchange(images_, HIMAGELIST::FromParam(lParam)).ToLParam();
      case TCM_GETIMAGELIST:
        return images_.ToLParam();
      case TCM_SETITEMSIZE: {
        const SIZE old{TabWidth(), TabHeight()};
        fixedSize_ = SIZE{LOWORD(static_cast<std::uintptr_t>(lParam)), HIWORD(static_cast<std::uintptr_t>(lParam))};
        return static_cast<LRESULT>(MAKELONG(static_cast<unsigned>(old.cx), static_cast<unsigned>(old.cy)));
      }
      case WM_NCHITTEST: {
        // Only the tabs themselves take the mouse; the page below lets clicks through to the
        // controls that lie on it.
        POINT p{GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)};
        ::ScreenToClient(hwnd, &p);
        return HitTest(p) >= 0 ? HTCLIENT : HTTRANSPARENT;
      }
      case WM_GETDLGCODE:
        return DLGC_WANTARROWS;
      case WM_LBUTTONDOWN: {
        const int index = HitTest({GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)});
        if ((::GetWindowStyle(hwnd) & TCS_FOCUSNEVER) == 0) ::SetFocus(hwnd);
        if (index >= 0) Select(hwnd, index);
        return 0;
      }
      case WM_KEYDOWN:
        if (wParam == VK_LEFT || wParam == VK_RIGHT) {
          const int step = wParam == VK_LEFT ? -1 : 1;
          if (Valid(selected_ + step)) Select(hwnd, selected_ + step);
        }
        return 0;
      case WM_SETFOCUS:
      case WM_KILLFOCUS:
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override {
    const CRect client = ClientRect(hwnd);
    canvas.FillRect(client, ::GetSysColor(COLOR_BTNFACE));
    const CRect page(client.left, TabHeight() + kRaise, client.right, client.bottom);
    canvas.FillRect(page, ::GetSysColor(COLOR_WINDOW));
    canvas.FrameRect(page, RGB(217, 217, 217));
    const bool ownerDrawn = (::GetWindowStyle(hwnd) & TCS_OWNERDRAWFIXED) != 0;
    // Unselected tabs first, so that the raised selected tab covers its neighbours' edges.
    for (int pass = 0; pass < 2; ++pass) {
      for (int i = 0; i < static_cast<int>(tabs_.size()); ++i) {
        if ((i == selected_) != (pass == 1)) continue;
        CRect r = TabRect(i);
        Canvas::Attributes attributes = {{"data-tab", std::to_string(i)}};
        if (i == selected_) {
          r.InflateRect(kRaise, 0);
          r.top -= kRaise;
          r.bottom += 1;
          attributes.emplace_back("data-state", "selected");
        }
        canvas.BeginGroup(attributes);
        canvas.FillRect(r, i == selected_ ? ::GetSysColor(COLOR_WINDOW) : ::GetSysColor(COLOR_BTNFACE));
        canvas.FrameRect(r, RGB(217, 217, 217));
        if (i == selected_) canvas.FillRect(CRect(r.left + 1, r.bottom - 1, r.right - 1, r.bottom), ::GetSysColor(COLOR_WINDOW));
        CRect inside = r;
        inside.DeflateRect(1, 1);
        if (ownerDrawn) {
          DrawOwnerTab(hwnd, canvas, i, inside);
        } else {
          DrawTab(hwnd, canvas, i, inside);
        }
        if (i == selected_ && HasFocus(hwnd)) {
          CRect focus = inside;
          focus.DeflateRect(2, 2);
          canvas.FocusRect(focus);
        }
        canvas.EndGroup();
      }
    }
  }

 private:
  bool Valid(int index) const { return index >= 0 && index < static_cast<int>(tabs_.size()); }

  int ImageWidth() const {
    int cx = 0;
    int cy = 0;
    return ImageList_GetIconSize(images_, &cx, &cy) ? cx : 0;
  }

  int TabWidth() const {
    if (fixedSize_.cx > 0) return fixedSize_.cx;
    int widest = 0;
    for (const Tab& tab : tabs_) {
      const int image = tab.image >= 0 && ImageWidth() > 0 ? ImageWidth() + (tab.text.empty() ? 0 : 3) : 0;
      widest = std::max(widest, TextWidth(tab.text) + image);
    }
    return std::max(kMinimumTabWidth, widest + 2 * kPadding);
  }

  int TabHeight() const { return fixedSize_.cy > 0 ? fixedSize_.cy : 22; }

  CRect TabRect(int index) const {
    const int width = TabWidth();
    return {kRaise + index * width, kRaise, kRaise + (index + 1) * width, kRaise + TabHeight()};
  }

  int HitTest(POINT p) const {
    for (int i = 0; i < static_cast<int>(tabs_.size()); ++i) {
      CRect r = TabRect(i);
      if (i == selected_) r.InflateRect(kRaise, kRaise);
      if (r.PtInRect(p)) return i;
    }
    return -1;
  }

  LRESULT Insert(HWND hwnd, int index, const TCITEM* item) {
    if (item == nullptr || index < 0) return -1;
    index = std::min(index, static_cast<int>(tabs_.size()));
    Tab tab;
    if ((item->mask & TCIF_TEXT) != 0 && item->pszText != nullptr) tab.text = item->pszText;
    if ((item->mask & TCIF_IMAGE) != 0) tab.image = item->iImage;
    if ((item->mask & TCIF_PARAM) != 0) tab.param = item->lParam;
    tabs_.insert(tabs_.begin() + index, tab);
    if (selected_ < 0) {
      selected_ = 0;  // the first tab inserted becomes the selected one
    } else if (index <= selected_) {
      ++selected_;
    }
    ::InvalidateRect(hwnd, nullptr, TRUE);
    return index;
  }

  LRESULT Delete(HWND hwnd, int index) {
    if (!Valid(index)) return FALSE;
    tabs_.erase(tabs_.begin() + index);
    if (index < selected_ || selected_ >= static_cast<int>(tabs_.size())) --selected_;
    ::InvalidateRect(hwnd, nullptr, TRUE);
    return TRUE;
  }

  LRESULT GetItem(int index, TCITEM* item) const {
    if (!Valid(index) || item == nullptr) return FALSE;
    const Tab& tab = tabs_[static_cast<std::size_t>(index)];
    if ((item->mask & TCIF_TEXT) != 0 && item->pszText != nullptr && item->cchTextMax > 0) {
      const std::size_t n = std::min(tab.text.size(), static_cast<std::size_t>(item->cchTextMax - 1));
      std::memcpy(item->pszText, tab.text.data(), n);
      item->pszText[n] = '\0';
    }
    if ((item->mask & TCIF_IMAGE) != 0) item->iImage = tab.image;
    if ((item->mask & TCIF_PARAM) != 0) item->lParam = tab.param;
    return TRUE;
  }

  LRESULT SetItem(HWND hwnd, int index, const TCITEM* item) {
    if (!Valid(index) || item == nullptr) return FALSE;
    Tab& tab = tabs_[static_cast<std::size_t>(index)];
    if ((item->mask & TCIF_TEXT) != 0) tab.text = item->pszText != nullptr ? item->pszText : "";
    if ((item->mask & TCIF_IMAGE) != 0) tab.image = item->iImage;
    if ((item->mask & TCIF_PARAM) != 0) tab.param = item->lParam;
    ::InvalidateRect(hwnd, nullptr, TRUE);
    return TRUE;
  }

  void Select(HWND hwnd, int index) {
    if (index == selected_) return;
    if (Notify(hwnd, TCN_SELCHANGING) != 0) return;  // the parent refused the change
    selected_ = index;
    ::InvalidateRect(hwnd, nullptr, TRUE);
    Notify(hwnd, TCN_SELCHANGE);
  }

  void DrawTab(HWND hwnd, Canvas& canvas, int index, CRect inside) const {
    const Tab& tab = tabs_[static_cast<std::size_t>(index)];
    const bool enabled = ::IsWindowEnabled(hwnd) != FALSE;
    const int imageWidth = tab.image >= 0 ? ImageWidth() : 0;
    const int content = imageWidth + (imageWidth > 0 && !tab.text.empty() ? 3 : 0) + TextWidth(tab.text);
    int x = inside.left + (inside.Width() - content) / 2;
    if (imageWidth > 0) {
      int cx = 0;
      int cy = 0;
      ImageList_GetIconSize(images_, &cx, &cy);
      const int y = inside.top + (inside.Height() - cy) / 2;
      if (enabled) {
        ImageList_Draw(images_, tab.image, &canvas, x, y, ILD_TRANSPARENT);
      } else {
        DrawImageDimmed(images_, tab.image, &canvas, x, y);
      }
      x += imageWidth + 3;
    }
    canvas.Text(x, inside.top + (inside.Height() - kLineHeight) / 2 + kFontAscent, tab.text,
                {TextColor(hwnd), false, Canvas::Anchor::kStart});
  }

  void DrawOwnerTab(HWND hwnd, Canvas& canvas, int index, const CRect& inside) const {
    canvas.Dc().SetTextColor(TextColor(hwnd));
    AskOwnerToDraw(hwnd, canvas, ODT_TAB, static_cast<UINT>(index), index == selected_ ? ODS_SELECTED : 0, inside,
                   static_cast<UINT_PTR>(tabs_[static_cast<std::size_t>(index)].param));
  }

  std::vector<Tab> tabs_;
  int selected_ = -1;
  HIMAGELIST images_;
  SIZE fixedSize_;
};

}  // namespace

void RegisterTabControlClass() {
  RegisterWindowClass(kTabControlClass, CS_DBLCLKS, [] { return std::make_unique<TabBehaviour>(); });
}

}  // namespace framework

BOOL CTabCtrl::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
  return CWnd::Create(framework::kTabControlClass, "", style, rect, parent, id);
}

LONG CTabCtrl::InsertItem(int index, std::string_view text, int image) {
  std::string copy(text);
  TCITEM item;
  item.mask = TCIF_TEXT | TCIF_IMAGE;
  item.pszText = copy.data();
  item.iImage = image;
  return static_cast<LONG>(SendMessage(TCM_INSERTITEM, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(&item)));
}

BOOL CTabCtrl::DeleteItem(int index) { return static_cast<BOOL>(SendMessage(TCM_DELETEITEM, static_cast<WPARAM>(index))); }
BOOL CTabCtrl::DeleteAllItems() { return static_cast<BOOL>(SendMessage(TCM_DELETEALLITEMS)); }
int CTabCtrl::GetItemCount() const { return static_cast<int>(SendMessage(TCM_GETITEMCOUNT)); }

BOOL CTabCtrl::GetItem(int index, TCITEM* item) const {
  return static_cast<BOOL>(SendMessage(TCM_GETITEM, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(item)));
}

BOOL CTabCtrl::SetItem(int index, TCITEM* item) {
  return static_cast<BOOL>(SendMessage(TCM_SETITEM, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(item)));
}

int CTabCtrl::GetCurSel() const { return static_cast<int>(SendMessage(TCM_GETCURSEL)); }
int CTabCtrl::SetCurSel(int index) { return static_cast<int>(SendMessage(TCM_SETCURSEL, static_cast<WPARAM>(index))); }

BOOL CTabCtrl::GetItemRect(int index, RECT* rect) const {
  return static_cast<BOOL>(SendMessage(TCM_GETITEMRECT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(rect)));
}

int CTabCtrl::HitTest(TCHITTESTINFO* info) const {
  return static_cast<int>(SendMessage(TCM_HITTEST, 0, reinterpret_cast<LPARAM>(info)));
}

HIMAGELIST CTabCtrl::SetImageList(HIMAGELIST list) {
  return HIMAGELIST::FromParam(SendMessage(TCM_SETIMAGELIST, 0, list.ToLParam()));
}

HIMAGELIST CTabCtrl::GetImageList() const { return HIMAGELIST::FromParam(SendMessage(TCM_GETIMAGELIST)); }

void CTabCtrl::DrawItem(LPDRAWITEMSTRUCT) {}

BOOL CTabCtrl::OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
  if (message == WM_DRAWITEM) {
    DrawItem(reinterpret_cast<LPDRAWITEMSTRUCT>(lParam));
    return TRUE;
  }
  return CWnd::OnChildNotify(message, wParam, lParam, result);
}
