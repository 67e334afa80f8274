// The popup-menu window and the tracking of a menu: the window lays the items out, follows the
// mouse and the keys (which it takes from the queue while it is open), and ends the tracking
// with the chosen command id or with none.
#include <algorithm>
#include <cctype>

#include "framework/canvas.h"
#include "framework/cdc.h"
#include "framework/controls/control_behaviour.h"
#include "framework/image_list.h"
#include "framework/menu.h"
#include "framework/menu_table.h"
#include "framework/message_queue.h"
#include "framework/resource_module.h"
#include "framework/text_metrics.h"
#include "framework/window_classes.h"

namespace framework {
namespace {

constexpr int kItemHeight = 22;
constexpr int kSeparatorHeight = 7;
constexpr int kImageColumn = 28;  // the check mark, bitmap or image of an item
constexpr int kTextRightPadding = 24;
constexpr int kMinimumWidth = 120;

using detail::MenuItem;

struct Tracking {
  HMENU menu;
  UINT flags = 0;
  UINT chosen = 0;
  bool done = false;
};

bool IsSeparator(const MenuItem& item) { return (item.flags & MF_SEPARATOR) != 0; }
bool IsEnabled(const MenuItem& item) { return (item.flags & (MF_GRAYED | MF_DISABLED)) == 0 && !IsSeparator(item); }

// The key that chooses an item: the character after its "&".
char Mnemonic(const MenuItem& item) {
  const auto at = item.text.find('&');
  if (at == std::string::npos || at + 1 >= item.text.size() || item.text[at + 1] == '&') return 0;
  return static_cast<char>(std::toupper(static_cast<unsigned char>(item.text[at + 1])));
}

const std::vector<MenuItem>& ItemsOf(HMENU menu) {
  static const std::vector<MenuItem> none;
  const std::vector<MenuItem>* items = detail::MenuItems(menu);
  return items != nullptr ? *items : none;
}

CRect ItemRect(HMENU menu, int width, std::size_t index) {
  const std::vector<MenuItem>& items = ItemsOf(menu);
  int top = 0;
  for (std::size_t i = 0; i < index && i < items.size(); ++i) top += IsSeparator(items[i]) ? kSeparatorHeight : kItemHeight;
  const int height = index < items.size() && IsSeparator(items[index]) ? kSeparatorHeight : kItemHeight;
  return {0, top, width, top + height};
}

SIZE MenuSize(HMENU menu) {
  int width = kMinimumWidth;
  int height = 0;
  for (const MenuItem& item : ItemsOf(menu)) {
    height += IsSeparator(item) ? kSeparatorHeight : kItemHeight;
    width = std::max(width, kImageColumn + 4 + TextWidth(WithoutMnemonics(item.text)) + kTextRightPadding);
  }
  return {width, height};
}

class PopupMenuBehaviour : public ControlBehaviour {
 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case WM_CREATE:
        tracking_ = reinterpret_cast<Tracking*>(reinterpret_cast<const CREATESTRUCT*>(lParam)->lpCreateParams);
        return 0;
      case WM_NCHITTEST:
        return HTCLIENT;
      case MN_GETHMENU:
        return tracking_->menu.ToLParam();
      case WM_MOUSEMOVE: {
        const int item = ItemAt(hwnd, {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)});
        if (item != hot_) {
          hot_ = item;
          ::InvalidateRect(hwnd, nullptr, FALSE);
        }
        return 0;
      }
      case WM_LBUTTONDOWN:
      case WM_RBUTTONDOWN:
      case WM_LBUTTONDBLCLK:
        if (!ClientRect(hwnd).PtInRect({GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)})) {
          End(0);  // a press anywhere else dismisses the menu
        } else {
          pressed_ = true;
        }
        return 0;
      case WM_LBUTTONUP:
      case WM_RBUTTONUP: {
        if (message == WM_RBUTTONUP && (tracking_->flags & TPM_RIGHTBUTTON) == 0) return 0;
        const int item = ItemAt(hwnd, {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)});
        // The release of the press that opened the menu chooses nothing unless the mouse went
        // over an item first.
        if (item >= 0 && (pressed_ || item == hot_)) Choose(item);
        return 0;
      }
      case WM_KEYDOWN:
        OnKey(hwnd, static_cast<UINT>(wParam));
        return 0;
      case WM_CAPTURECHANGED:
        if (HWND::FromParam(lParam) != hwnd) End(0);
        return 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override {
    const CRect client = ClientRect(hwnd);
    canvas.FillRect(client, RGB(242, 242, 242));
    const std::vector<MenuItem>& items = ItemsOf(tracking_->menu);
    CDC& dc = canvas.Dc();
    dc.SetBkMode(TRANSPARENT);
    for (std::size_t i = 0; i < items.size(); ++i) {
      const MenuItem& item = items[i];
      const CRect r = ItemRect(tracking_->menu, client.Width(), i);
      if (IsSeparator(item)) {
        canvas.FillRect(CRect(kImageColumn, r.top + 3, r.right - 2, r.top + 4), RGB(215, 215, 215));
        continue;
      }
      std::string state;
      const auto add = [&state](std::string_view word) { state += (state.empty() ? "" : " ") + std::string(word); };
      if (static_cast<int>(i) == hot_) add("highlighted");
      if ((item.flags & MF_CHECKED) != 0) add("checked");
      if (!IsEnabled(item)) add("disabled");
      Canvas::Attributes attributes = {{"data-item", WithoutMnemonics(item.text)}, {"data-command", std::to_string(item.id)}};
      if (!state.empty()) attributes.emplace_back("data-state", state);
      canvas.BeginGroup(attributes);
      if (static_cast<int>(i) == hot_) {
        canvas.FillRect(CRect(r.left + 2, r.top, r.right - 2, r.bottom), RGB(145, 201, 247));
      }
      PaintMark(canvas, item, CRect(r.left, r.top, r.left + kImageColumn, r.bottom));
      CRect text(kImageColumn + 4, r.top, r.right - kTextRightPadding, r.bottom);
      dc.SetTextColor(IsEnabled(item) ? RGB(0, 0, 0) : ::GetSysColor(COLOR_GRAYTEXT));
      dc.DrawText(item.text, &text, DT_SINGLELINE | DT_VCENTER);
      canvas.EndGroup();
    }
    canvas.FrameRect(client, RGB(204, 204, 204));
  }

 private:
  // What stands in the image column: the item's bitmap or image, else a check mark.
  static void PaintMark(Canvas& canvas, const MenuItem& item, const CRect& column) {
    const bool checked = (item.flags & MF_CHECKED) != 0;
    const HBITMAP bitmap = checked ? item.checked : item.unchecked;
    const CPoint at(column.left + (column.Width() - 16) / 2, column.top + (column.Height() - 16) / 2);
    if (item.images && item.image >= 0) {
      int cx = 16;
      int cy = 16;
      ImageList_GetIconSize(item.images, &cx, &cy);
      const CPoint origin(column.left + (column.Width() - cx) / 2, column.top + (column.Height() - cy) / 2);
      if (IsEnabled(item)) {
        ImageList_Draw(item.images, item.image, &canvas, origin.x, origin.y, ILD_TRANSPARENT);
      } else {
        DrawImageDimmed(item.images, item.image, &canvas, origin.x, origin.y);
      }
      if (checked) canvas.FrameRect(CRect(origin.x - 2, origin.y - 2, origin.x + cx + 2, origin.y + cy + 2), RGB(0, 120, 215));
    } else if (const std::string_view picture = BitmapPicture(bitmap); !picture.empty()) {
      canvas.Picture(CRect(at, CSize(16, 16)), picture, !IsEnabled(item),
                     {{"data-icon", std::to_string(BitmapResourceId(bitmap))}});
    } else if (checked) {
      canvas.Polyline({{at.x + 3, at.y + 8}, {at.x + 6, at.y + 11}, {at.x + 12, at.y + 4}}, RGB(0, 0, 0), 2);
    }
  }

  int ItemAt(HWND hwnd, POINT p) const {
    const CRect client = ClientRect(hwnd);
    if (!client.PtInRect(p)) return -1;
    const std::vector<MenuItem>& items = ItemsOf(tracking_->menu);
    for (std::size_t i = 0; i < items.size(); ++i) {
      if (ItemRect(tracking_->menu, client.Width(), i).PtInRect(p)) return IsSeparator(items[i]) ? -1 : static_cast<int>(i);
    }
    return -1;
  }

  void Choose(int index) {
    const std::vector<MenuItem>& items = ItemsOf(tracking_->menu);
    if (index < 0 || index >= static_cast<int>(items.size()) || !IsEnabled(items[static_cast<std::size_t>(index)])) return;
    End(items[static_cast<std::size_t>(index)].id);
  }

  void End(UINT chosen) {
    if (tracking_->done) return;
    tracking_->chosen = chosen;
    tracking_->done = true;
  }

  void OnKey(HWND hwnd, UINT key) {
    const std::vector<MenuItem>& items = ItemsOf(tracking_->menu);
    const int count = static_cast<int>(items.size());
    if (key == VK_ESCAPE) {
      End(0);
    } else if (key == VK_RETURN) {
      Choose(hot_);
    } else if (key == VK_UP || key == VK_DOWN || key == VK_HOME || key == VK_END) {
      // The highlight moves over the items (not the separators), round at the ends.
      const int step = key == VK_UP || key == VK_END ? -1 : 1;
      int at = key == VK_HOME ? -1 : key == VK_END ? count : hot_;
      for (int tries = 0; tries < count; ++tries) {
        at = ((at + step) % count + count) % count;
        if (!IsSeparator(items[static_cast<std::size_t>(at)])) break;
      }
      hot_ = count > 0 ? at : -1;
      ::InvalidateRect(hwnd, nullptr, FALSE);
    } else if (std::isalnum(static_cast<int>(key)) != 0) {
      for (int i = 0; i < count; ++i) {
        if (Mnemonic(items[static_cast<std::size_t>(i)]) == static_cast<char>(key)) {
          Choose(i);
          break;
        }
      }
    }
  }

  Tracking* tracking_ = nullptr;
  int hot_ = -1;
  bool pressed_ = false;
};

// The menu windows that are showing, for GetMenuItemRect.
std::vector<HWND>& OpenMenus() {
  static std::vector<HWND> open;
  return open;
}

}  // namespace

void RegisterPopupMenuClass() {
  RegisterWindowClass(kPopupMenuClass, CS_DBLCLKS, [] { return std::make_unique<PopupMenuBehaviour>(); });
}

}  // namespace framework

int TrackPopupMenu(HMENU menu, UINT flags, int x, int y, int, HWND owner, const RECT*) {
  if (!IsMenu(menu) || GetMenuItemCount(menu) <= 0) return 0;
  if (::IsWindow(owner)) {
    ::SendMessage(owner, WM_ENTERMENULOOP, TRUE, 0);
    ::SendMessage(owner, WM_INITMENUPOPUP, menu.ToWParam(), 0);  // the owner may still change the items
  }
  const SIZE size = framework::MenuSize(menu);
  const int width = size.cx + 2;  // and the border
  const int height = size.cy + 2;
  int left = (flags & TPM_CENTERALIGN) != 0 ? x - width / 2 : (flags & TPM_RIGHTALIGN) != 0 ? x - width : x;
  int top = (flags & TPM_VCENTERALIGN) != 0 ? y - height / 2 : (flags & TPM_BOTTOMALIGN) != 0 ? y - height : y;
  left = std::clamp(left, 0, std::max(0, ::GetSystemMetrics(SM_CXSCREEN) - width));
  top = std::clamp(top, 0, std::max(0, ::GetSystemMetrics(SM_CYSCREEN) - height));

  framework::Tracking tracking{menu, flags};
  const HWND window = ::CreateWindowEx(WS_EX_TOOLWINDOW | WS_EX_TOPMOST, framework::kPopupMenuClass, "",
                                       WS_POPUP | WS_BORDER, left, top, width, height, owner, 0,
                                       reinterpret_cast<LPARAM>(&tracking));
  if (!window) return 0;
  framework::OpenMenus().push_back(window);
  ::ShowWindow(window, SW_SHOWNA);
  const HWND captureBefore = ::GetCapture();
  ::SetCapture(window);
  // While the menu is open the keys are the menu's, whichever window has the focus.
  const int filter = framework::AddMessageFilter([window](MSG& msg) {
    if (msg.message != WM_KEYDOWN && msg.message != WM_KEYUP && msg.message != WM_CHAR) return false;
    if (msg.message == WM_KEYDOWN) ::SendMessage(window, WM_KEYDOWN, msg.wParam, 0);
    return true;
  });
  framework::RunModalLoop(window, [&tracking, window] { return tracking.done || !::IsWindow(window); });
  framework::RemoveMessageFilter(filter);
  std::erase(framework::OpenMenus(), window);
  ::DestroyWindow(window);
  if (::IsWindow(captureBefore)) ::SetCapture(captureBefore);
  if (::IsWindow(owner)) ::SendMessage(owner, WM_EXITMENULOOP, TRUE, 0);

  const UINT chosen = tracking.chosen;
  if ((flags & TPM_RETURNCMD) != 0) return static_cast<int>(chosen);
  if (chosen != 0 && (flags & TPM_NONOTIFY) == 0 && ::IsWindow(owner)) ::PostMessage(owner, WM_COMMAND, MAKEWPARAM(chosen, 0), 0);
  return chosen != 0 ? TRUE : FALSE;
}

BOOL GetMenuItemRect(HWND menuWindow, HMENU menu, UINT position, RECT* rect) {
  if (rect == nullptr || position >= static_cast<UINT>(std::max(0, GetMenuItemCount(menu)))) return FALSE;
  HWND window = menuWindow;
  if (!window || static_cast<UINT>(::SendMessage(window, MN_GETHMENU, 0, 0)) != menu.Value()) {
    window = HWND();
    for (HWND open : framework::OpenMenus()) {
      if (HMENU::FromParam(::SendMessage(open, MN_GETHMENU, 0, 0)) == menu) window = open;
    }
  }
  if (!window) return FALSE;
  RECT client;
  ::GetClientRect(window, &client);
  CRect r = framework::ItemRect(menu, client.right, position);
  ::MapWindowPoints(window, HWND(), reinterpret_cast<POINT*>(&r), 2);
  *rect = r;
  return TRUE;
}
