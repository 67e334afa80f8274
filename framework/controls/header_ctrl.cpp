// The header class: titles with widths side by side, pressed like buttons when HDS_BUTTONS is set.
#include "framework/controls/header_ctrl.h"

#include <algorithm>
#include <cstring>
#include <vector>

#include "framework/cdc.h"
#include "framework/controls/control_behaviour.h"
#include "framework/window_classes.h"

namespace framework {
namespace {

struct Title {
  std::string text;
  int width = 0;
  int format = HDF_LEFT | HDF_STRING;
  LPARAM param = 0;
};

class HeaderBehaviour : public ControlBehaviour {
 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case HDM_GETITEMCOUNT:
        return static_cast<LRESULT>(titles_.size());
      case HDM_INSERTITEM: {
        const auto* item = reinterpret_cast<const HDITEM*>(lParam);
        if (item == nullptr) return -1;
        const int index = std::clamp(static_cast<int>(wParam), 0, Count());
        Title title;
        Assign(title, *item);
        titles_.insert(titles_.begin() + index, std::move(title));
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return index;
      }
      case HDM_DELETEITEM:
        if (!Valid(static_cast<int>(wParam))) return FALSE;
        titles_.erase(titles_.begin() + static_cast<int>(wParam));
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return TRUE;
      case HDM_GETITEM:
        return Get(static_cast<int>(wParam), reinterpret_cast<HDITEM*>(lParam));
      case HDM_SETITEM:
        if (!Valid(static_cast<int>(wParam)) || lParam == 0) return FALSE;
        Assign(titles_[wParam], *reinterpret_cast<const HDITEM*>(lParam));
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return TRUE;
      case HDM_GETITEMRECT:
        if (!Valid(static_cast<int>(wParam)) || lParam == 0) return FALSE;
        *reinterpret_cast<RECT*>(lParam) = TitleRect(hwnd, static_cast<int>(wParam));
        return TRUE;
      case HDM_HITTEST: {
        auto* info = reinterpret_cast<HDHITTESTINFO*>(lParam);
        if (info == nullptr) return -1;
        info->iItem = HitTest(hwnd, info->pt);
        info->flags = info->iItem >= 0 ? HHT_ONHEADER : HHT_NOWHERE;
        return info->iItem;
      }
      case WM_LBUTTONDOWN:
      case WM_LBUTTONDBLCLK: {
        if ((::GetWindowStyle(hwnd) & HDS_BUTTONS) == 0) return 0;
        pressed_ = HitTest(hwnd, {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)});
        if (pressed_ >= 0) ::SetCapture(hwnd);
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return 0;
      }
      case WM_LBUTTONUP: {
        const int pressed = std::exchange(pressed_, -1);
        if (pressed < 0) return 0;
        ::ReleaseCapture();
        ::InvalidateRect(hwnd, nullptr, FALSE);
        if (HitTest(hwnd, {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)}) != pressed) return 0;
        NMHEADER nm;
        nm.iItem = pressed;
        Notify(hwnd, HDN_ITEMCLICK, &nm.hdr);
        return 0;
      }
      case WM_CAPTURECHANGED:
        if (HWND::FromParam(lParam) != hwnd) pressed_ = -1;
        return 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override {
    const CRect client = ClientRect(hwnd);
    canvas.FillRect(client, ::GetSysColor(COLOR_WINDOW));
    CDC& dc = canvas.Dc();
    dc.SetBkMode(TRANSPARENT);
    for (int i = 0; i < Count(); ++i) {
      const CRect r = TitleRect(hwnd, i);
      Canvas::Attributes attributes = {{"data-column", std::to_string(i)}};
      if (i == pressed_) attributes.emplace_back("data-state", "pushed");
      canvas.BeginGroup(attributes);
      canvas.FillRect(r, i == pressed_ ? RGB(204, 228, 247) : ::GetSysColor(COLOR_WINDOW));
      canvas.FillRect(CRect(r.right - 1, r.top + 2, r.right, r.bottom - 2), RGB(229, 229, 229));
      CRect text(r.left + 6, r.top, r.right - 6, r.bottom);
      const int justify = titles_[static_cast<std::size_t>(i)].format & HDF_JUSTIFYMASK;
      dc.SetTextColor(TextColor(hwnd));
      dc.DrawText(titles_[static_cast<std::size_t>(i)].text, &text,
                  DT_SINGLELINE | DT_VCENTER | DT_NOPREFIX | DT_END_ELLIPSIS |
                      (justify == HDF_CENTER ? DT_CENTER : justify == HDF_RIGHT ? DT_RIGHT : DT_LEFT));
      canvas.EndGroup();
    }
    canvas.FillRect(CRect(client.left, client.bottom - 1, client.right, client.bottom), RGB(229, 229, 229));
  }

 private:
  int Count() const { return static_cast<int>(titles_.size()); }
  bool Valid(int index) const { return index >= 0 && index < Count(); }

  static void Assign(Title& title, const HDITEM& item) {
    if ((item.mask & HDI_TEXT) != 0) title.text = item.pszText != nullptr ? item.pszText : "";
    if ((item.mask & HDI_WIDTH) != 0) title.width = std::max(0, item.cxy);
    if ((item.mask & HDI_FORMAT) != 0) title.format = item.fmt;
    if ((item.mask & HDI_LPARAM) != 0) title.param = item.lParam;
  }

  LRESULT Get(int index, HDITEM* item) const {
    if (!Valid(index) || item == nullptr) return FALSE;
    const Title& title = titles_[static_cast<std::size_t>(index)];
    if ((item->mask & HDI_TEXT) != 0 && item->pszText != nullptr && item->cchTextMax > 0) {
      const std::size_t n = std::min(title.text.size(), static_cast<std::size_t>(item->cchTextMax - 1));
      std::memcpy(item->pszText, title.text.data(), n);
      item->pszText[n] = '\0';
    }
    if ((item->mask & HDI_WIDTH) != 0) item->cxy = title.width;
    if ((item->mask & HDI_FORMAT) != 0) item->fmt = title.format;
    if ((item->mask & HDI_LPARAM) != 0) item->lParam = title.param;
    return TRUE;
  }

  CRect TitleRect(HWND hwnd, int index) const {
    int left = 0;
    for (int i = 0; i < index; ++i) left += titles_[static_cast<std::size_t>(i)].width;
    return {left, 0, left + titles_[static_cast<std::size_t>(index)].width, ClientRect(hwnd).Height()};
  }

  int HitTest(HWND hwnd, POINT p) const {
    for (int i = 0; i < Count(); ++i) {
      if (TitleRect(hwnd, i).PtInRect(p)) return i;
    }
    return -1;
  }

  std::vector<Title> titles_;
  int pressed_ = -1;
};

}  // namespace

void RegisterHeaderClass() {
  RegisterWindowClass(kHeaderClass, CS_DBLCLKS, [] { return std::make_unique<HeaderBehaviour>(); });
}

}  // namespace framework

int CHeaderCtrl::GetItemCount() const { return static_cast<int>(SendMessage(HDM_GETITEMCOUNT)); }

BOOL CHeaderCtrl::GetItem(int index, HDITEM* item) const {
  return static_cast<BOOL>(SendMessage(HDM_GETITEM, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(item)));
}

BOOL CHeaderCtrl::GetItemRect(int index, RECT* rect) const {
  return static_cast<BOOL>(SendMessage(HDM_GETITEMRECT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(rect)));
}

std::string CHeaderCtrl::GetItemText(int index) const {
  char buffer[260] = {};
  HDITEM item;
  item.mask = HDI_TEXT;
  item.pszText = buffer;
  item.cchTextMax = sizeof buffer;
  return GetItem(index, &item) ? std::string(buffer) : std::string();
}
