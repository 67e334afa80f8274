// The window table: creation, destruction, relations, geometry, visibility, focus and capture.
#include "framework/window_system.h"

#include <algorithm>
#include <map>
#include <memory>
#include <utility>

#include "framework/message_queue.h"
#include "framework/win_structs.h"
#include "framework/window_table.h"

namespace framework::detail {
namespace {

struct WindowTable {
  std::map<std::uint32_t, std::unique_ptr<Window>> windows;
  std::vector<HWND> topLevels;  // stacking order, bottom first
  // Records of destroyed windows stay alive until no message is being handled any more, so a
  // handler that destroys its own window can still return through its own code.
  std::vector<std::unique_ptr<Window>> graveyard;
  std::uint32_t nextHandle = 1;
  int dispatchDepth = 0;
  int nextInterceptorKey = 1;
  AttachedObject* pendingObject = nullptr;
  HWND focus;
  HWND active;
  HWND capture;
};

WindowTable& Table() {
  static WindowTable table;
  return table;
}

void RaiseTopLevel(HWND hwnd) {
  auto& order = Table().topLevels;
  const auto it = std::find(order.begin(), order.end(), hwnd);
  if (it == order.end()) return;
  order.erase(it);
  order.push_back(hwnd);
  // Topmost windows (tips) stay above every other top-level window.
  std::stable_partition(order.begin(), order.end(), [](HWND h) {
    const Window* w = Find(h);
    return w == nullptr || (w->exStyle & WS_EX_TOPMOST) == 0;
  });
}

bool IsInSubtree(HWND root, HWND hwnd) {
  for (HWND h = hwnd; h;) {
    if (h == root) return true;
    const Window* w = Find(h);
    h = w != nullptr ? w->parent : HWND();
  }
  return false;
}

// Focus leaves a window that is hidden, disabled or destroyed, as keyboard input it could no
// longer take would otherwise go nowhere.
void DropFocusFrom(HWND root) {
  WindowTable& t = Table();
  if (t.focus && IsInSubtree(root, t.focus)) ::SetFocus(HWND());
  if (t.capture && IsInSubtree(root, t.capture)) ::ReleaseCapture();
}

LPARAM ClientSizeParam(HWND hwnd) {
  RECT client;
  ::GetClientRect(hwnd, &client);
  return MAKELPARAM(client.right, client.bottom);
}

void DestroyRecursively(HWND hwnd);

void SendDestroy(HWND hwnd) {
  ::SendMessage(hwnd, WM_DESTROY, 0, 0);
  const Window* w = Find(hwnd);
  if (w == nullptr) return;
  for (HWND child : std::vector<HWND>(w->children)) SendDestroy(child);
}

void FinishDestroy(HWND hwnd) {
  Window* w = Find(hwnd);
  if (w == nullptr) return;
  for (HWND child : std::vector<HWND>(w->children)) FinishDestroy(child);
  ForgetWindowTimers(hwnd);
  ::SendMessage(hwnd, WM_NCDESTROY, 0, 0);
  WindowTable& t = Table();
  w = Find(hwnd);
  if (w == nullptr) return;
  w->object = nullptr;
  if (Window* parent = Find(w->parent)) std::erase(parent->children, hwnd);
  std::erase(t.topLevels, hwnd);
  if (t.active == hwnd) t.active = HWND();
  auto node = t.windows.extract(hwnd.Value());
  t.graveyard.push_back(std::move(node.mapped()));
}

void DestroyRecursively(HWND hwnd) {
  Window* w = Find(hwnd);
  if (w == nullptr || w->destroying) return;
  w->destroying = true;
  // Windows owned by this one (its dialogs and tips) go first.
  for (HWND top : std::vector<HWND>(Table().topLevels)) {
    const Window* other = Find(top);
    if (other != nullptr && other->owner == hwnd) DestroyRecursively(top);
  }
  DropFocusFrom(hwnd);
  if ((w = Find(hwnd)) != nullptr) w->style &= ~WS_VISIBLE;  // hidden without WM_SHOWWINDOW
  SendDestroy(hwnd);
  FinishDestroy(hwnd);
}

}  // namespace

Window* Find(HWND hwnd) {
  if (!hwnd) return nullptr;
  auto& windows = Table().windows;
  const auto it = windows.find(hwnd.Value());
  return it == windows.end() ? nullptr : it->second.get();
}

LRESULT CallBehaviour(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) {
  Window* w = Find(hwnd);
  if (w == nullptr) return 0;
  if (w->behaviour) return w->behaviour->Handle(hwnd, message, wParam, lParam);
  return ::DefWindowProc(hwnd, message, wParam, lParam);
}

}  // namespace framework::detail

using framework::detail::Find;
using framework::detail::Table;
using framework::detail::Window;

namespace framework {

AttachedObject* AttachObject(HWND hwnd, AttachedObject* object) {
  Window* w = Find(hwnd);
  if (w == nullptr) return nullptr;
  AttachedObject* previous = w->object;
  w->object = object;
  return previous;
}

AttachedObject* GetAttachedObject(HWND hwnd) {
  const Window* w = Find(hwnd);
  return w != nullptr ? w->object : nullptr;
}

void AttachToNextWindow(AttachedObject* object) { Table().pendingObject = object; }

int InterceptMessages(HWND hwnd, Interceptor interceptor) {
  Window* w = Find(hwnd);
  if (w == nullptr) return 0;
  const int key = Table().nextInterceptorKey++;
  w->interceptors.emplace_back(key, std::move(interceptor));
  return key;
}

void StopIntercepting(HWND hwnd, int key) {
  if (Window* w = Find(hwnd)) std::erase_if(w->interceptors, [key](const auto& entry) { return entry.first == key; });
}

PaintCounters GetPaintCounters(HWND hwnd) {
  const Window* w = Find(hwnd);
  return w != nullptr ? w->paint : PaintCounters{};
}

std::size_t LiveWindowCount() { return Table().windows.size(); }

std::vector<HWND> TopLevelWindows() { return Table().topLevels; }

std::vector<HWND> GetChildren(HWND hwnd) {
  const Window* w = Find(hwnd);
  return w != nullptr ? w->children : std::vector<HWND>{};
}

namespace {

HWND ChildFromPoint(HWND hwnd, POINT screen) {
  const Window* w = Find(hwnd);
  if (w == nullptr) return hwnd;
  POINT local = screen;
  ::ScreenToClient(hwnd, &local);
  const std::vector<HWND> children = w->children;
  for (auto it = children.rbegin(); it != children.rend(); ++it) {
    const Window* child = Find(*it);
    if (child == nullptr || (child->style & WS_VISIBLE) == 0) continue;
    if (!CRect(child->rect).PtInRect(local)) continue;
    if (::SendMessage(*it, WM_NCHITTEST, 0, MAKELPARAM(screen.x, screen.y)) == HTTRANSPARENT) continue;
    return ChildFromPoint(*it, screen);
  }
  return hwnd;
}

}  // namespace

HWND WindowFromPoint(POINT screen) {
  const std::vector<HWND> order = Table().topLevels;
  for (auto it = order.rbegin(); it != order.rend(); ++it) {
    const Window* w = Find(*it);
    if (w == nullptr || (w->style & WS_VISIBLE) == 0 || !CRect(w->rect).PtInRect(screen)) continue;
    return ChildFromPoint(*it, screen);
  }
  return HWND();
}

HWND GetTopLevelWindow(HWND hwnd) {
  const Window* w = Find(hwnd);
  while (w != nullptr && w->parent) {
    hwnd = w->parent;
    w = Find(hwnd);
  }
  return w != nullptr ? hwnd : HWND();
}

bool AcceptsInput(HWND hwnd) {
  if (!::IsWindow(hwnd)) return false;
  for (const Window* w = Find(hwnd); w != nullptr; w = Find(w->parent)) {
    if ((w->style & WS_DISABLED) != 0 || (w->style & WS_VISIBLE) == 0) return false;
  }
  return true;
}

RECT NonClientInsets(DWORD style, DWORD exStyle) {
  LONG frame = 0;
  const bool caption = (style & WS_CAPTION) == WS_CAPTION;
  if ((style & WS_THICKFRAME) != 0) {
    frame = 4;
  } else if ((exStyle & WS_EX_DLGMODALFRAME) != 0 || ((style & WS_DLGFRAME) != 0 && !caption)) {
    frame = ::GetSystemMetrics(SM_CXDLGFRAME);
  } else if ((style & WS_BORDER) != 0) {
    frame = ::GetSystemMetrics(SM_CXBORDER);
  }
  if ((exStyle & WS_EX_CLIENTEDGE) != 0) frame += ::GetSystemMetrics(SM_CXEDGE);
  if ((exStyle & WS_EX_STATICEDGE) != 0) frame += 1;
  const LONG top = frame + (caption ? ::GetSystemMetrics(SM_CYCAPTION) : 0);
  return {frame, top, frame, frame};
}

}  // namespace framework

HWND CreateWindowEx(DWORD exStyle, std::string_view className, std::string_view text, DWORD style, int x, int y,
                    int width, int height, HWND parent, int id, LPARAM createParam) {
  framework::detail::EnsureBuiltInClasses();
  auto& t = Table();
  framework::AttachedObject* object = std::exchange(t.pendingObject, nullptr);
  if (!framework::IsWindowClassRegistered(className)) return HWND();
  const bool child = (style & WS_CHILD) != 0;
  if (child && !IsWindow(parent)) return HWND();
  if (parent && !IsWindow(parent)) return HWND();

  auto record = std::make_unique<Window>();
  Window& w = *record;
  w.handle = HWND(t.nextHandle++);
  w.className = std::string(className);
  w.classStyle = framework::GetClassStyle(className);
  w.text = std::string(text);
  w.style = style & ~WS_VISIBLE;
  w.exStyle = exStyle;
  w.id = child ? id : 0;
  w.rect = {x, y, x + width, y + height};
  w.parent = child ? parent : HWND();
  w.owner = child ? HWND() : framework::GetTopLevelWindow(parent);
  w.object = object;
  const HWND hwnd = w.handle;
  t.windows.emplace(hwnd.Value(), std::move(record));
  if (child) {
    Find(parent)->children.push_back(hwnd);
  } else {
    t.topLevels.push_back(hwnd);
    framework::detail::RaiseTopLevel(hwnd);
  }
  // The behaviour is made once the record exists, so that it may look at its own window.
  framework::detail::Find(hwnd)->behaviour = framework::detail::MakeBehaviour(className);

  const std::string nameCopy(text);
  const std::string classCopy(className);
  CREATESTRUCT cs{createParam, id, parent, height, width, y, x, style, nameCopy.c_str(), classCopy.c_str(), exStyle};
  const LPARAM csParam = reinterpret_cast<LPARAM>(&cs);
  if (SendMessage(hwnd, WM_NCCREATE, 0, csParam) == FALSE || SendMessage(hwnd, WM_CREATE, 0, csParam) == -1) {
    DestroyWindow(hwnd);
    return HWND();
  }
  if (!IsWindow(hwnd)) return HWND();
  SendMessage(hwnd, WM_SIZE, SIZE_RESTORED, framework::detail::ClientSizeParam(hwnd));
  SendMessage(hwnd, WM_MOVE, 0, MAKELPARAM(x, y));
  if ((style & WS_VISIBLE) != 0) ShowWindow(hwnd, SW_SHOW);
  return IsWindow(hwnd) ? hwnd : HWND();
}

BOOL DestroyWindow(HWND hwnd) {
  if (!IsWindow(hwnd)) return FALSE;
  framework::detail::DestroyRecursively(hwnd);
  if (Table().dispatchDepth == 0) Table().graveyard.clear();
  return TRUE;
}

BOOL IsWindow(HWND hwnd) { return Find(hwnd) != nullptr; }

LRESULT SendMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) {
  Window* w = Find(hwnd);
  if (w == nullptr) return 0;
  auto& t = Table();
  ++t.dispatchDepth;
  std::optional<LRESULT> result;
  for (const auto& [key, interceptor] : std::vector(w->interceptors)) {
    if (!IsWindow(hwnd) || (result = interceptor(hwnd, message, wParam, lParam))) break;
  }
  if (!result && (w = Find(hwnd)) != nullptr) {
    result = w->object != nullptr ? w->object->WindowProcedure(hwnd, message, wParam, lParam)
                                  : framework::detail::CallBehaviour(hwnd, message, wParam, lParam);
  }
  if (--t.dispatchDepth == 0) t.graveyard.clear();
  return result.value_or(0);
}

HWND GetParent(HWND hwnd) {
  const Window* w = Find(hwnd);
  if (w == nullptr) return HWND();
  return w->parent ? w->parent : w->owner;
}

HWND GetWindow(HWND hwnd, UINT relation) {
  const Window* w = Find(hwnd);
  if (w == nullptr) return HWND();
  if (relation == GW_CHILD) return w->children.empty() ? HWND() : w->children.front();
  if (relation == GW_OWNER) return w->owner;
  const std::vector<HWND>& siblings = w->parent ? Find(w->parent)->children : Table().topLevels;
  const auto it = std::find(siblings.begin(), siblings.end(), hwnd);
  switch (relation) {
    case GW_HWNDFIRST:
      return siblings.front();
    case GW_HWNDLAST:
      return siblings.back();
    case GW_HWNDNEXT:
      return it + 1 != siblings.end() ? *(it + 1) : HWND();
    case GW_HWNDPREV:
      return it != siblings.begin() ? *(it - 1) : HWND();
    default:
      return HWND();
  }
}

HWND GetDlgItem(HWND dialog, int id) {
  const Window* w = Find(dialog);
  if (w == nullptr) return HWND();
  for (HWND child : w->children) {
    if (Find(child)->id == id) return child;
  }
  return HWND();
}

int GetDlgCtrlID(HWND hwnd) {
  const Window* w = Find(hwnd);
  return w != nullptr ? w->id : 0;
}

void SetDlgCtrlID(HWND hwnd, int id) {
  if (Window* w = Find(hwnd); w != nullptr && w->parent) w->id = id;
}

BOOL IsChild(HWND parent, HWND hwnd) { return hwnd != parent && framework::detail::IsInSubtree(parent, hwnd); }

std::string GetClassName(HWND hwnd) {
  const Window* w = Find(hwnd);
  return w != nullptr ? w->className : std::string();
}

BOOL SetWindowText(HWND hwnd, std::string_view text) {
  const std::string copy(text);
  return static_cast<BOOL>(SendMessage(hwnd, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(copy.c_str())));
}

std::string GetWindowText(HWND hwnd) {
  const LRESULT length = SendMessage(hwnd, WM_GETTEXTLENGTH, 0, 0);
  if (length <= 0) return {};
  std::string text(static_cast<std::size_t>(length) + 1, '\0');
  const LRESULT copied = SendMessage(hwnd, WM_GETTEXT, text.size(), reinterpret_cast<LPARAM>(text.data()));
  text.resize(static_cast<std::size_t>(std::clamp<LRESULT>(copied, 0, length)));
  return text;
}

int GetWindowTextLength(HWND hwnd) { return static_cast<int>(SendMessage(hwnd, WM_GETTEXTLENGTH, 0, 0)); }

BOOL SetDlgItemText(HWND dialog, int id, std::string_view text) { return SetWindowText(GetDlgItem(dialog, id), text); }

std::string GetDlgItemText(HWND dialog, int id) { return GetWindowText(GetDlgItem(dialog, id)); }

DWORD GetWindowStyle(HWND hwnd) {
  const Window* w = Find(hwnd);
  return w != nullptr ? w->style : 0;
}

DWORD GetWindowExStyle(HWND hwnd) {
  const Window* w = Find(hwnd);
  return w != nullptr ? w->exStyle : 0;
}

// Visibility and enabling change only through ShowWindow and EnableWindow, which tell the window.
void SetWindowStyle(HWND hwnd, DWORD style) {
  if (Window* w = Find(hwnd)) w->style = (style & ~(WS_VISIBLE | WS_DISABLED)) | (w->style & (WS_VISIBLE | WS_DISABLED));
}

void SetWindowExStyle(HWND hwnd, DWORD exStyle) {
  if (Window* w = Find(hwnd)) w->exStyle = exStyle;
}

BOOL GetWindowRect(HWND hwnd, RECT* rect) {
  const Window* w = Find(hwnd);
  if (w == nullptr || rect == nullptr) return FALSE;
  CRect r(w->rect);
  if (w->parent) {
    POINT origin{0, 0};
    ClientToScreen(w->parent, &origin);
    r.OffsetRect(origin.x, origin.y);
  }
  *rect = r;
  return TRUE;
}

BOOL GetClientRect(HWND hwnd, RECT* rect) {
  const Window* w = Find(hwnd);
  if (w == nullptr || rect == nullptr) return FALSE;
  const RECT insets = framework::NonClientInsets(w->style, w->exStyle);
  const CRect outer(w->rect);
  *rect = {0, 0, std::max<LONG>(0, outer.Width() - insets.left - insets.right),
           std::max<LONG>(0, outer.Height() - insets.top - insets.bottom)};
  return TRUE;
}

BOOL ClientToScreen(HWND hwnd, POINT* point) {
  RECT outer;
  if (point == nullptr || !GetWindowRect(hwnd, &outer)) return FALSE;
  const Window* w = Find(hwnd);
  const RECT insets = framework::NonClientInsets(w->style, w->exStyle);
  point->x += outer.left + insets.left;
  point->y += outer.top + insets.top;
  return TRUE;
}

BOOL ScreenToClient(HWND hwnd, POINT* point) {
  POINT origin{0, 0};
  if (point == nullptr || !ClientToScreen(hwnd, &origin)) return FALSE;
  point->x -= origin.x;
  point->y -= origin.y;
  return TRUE;
}

void MapWindowPoints(HWND from, HWND to, POINT* points, UINT count) {
  for (UINT i = 0; i < count; ++i) {
    if (from) ClientToScreen(from, &points[i]);
    if (to) ScreenToClient(to, &points[i]);
  }
}

BOOL MoveWindow(HWND hwnd, int x, int y, int width, int height, BOOL repaint) {
  return SetWindowPos(hwnd, x, y, width, height, SWP_NOZORDER | (repaint ? 0U : SWP_NOREDRAW));
}

BOOL SetWindowPos(HWND hwnd, int x, int y, int width, int height, UINT flags) {
  Window* w = Find(hwnd);
  if (w == nullptr) return FALSE;
  CRect r(w->rect);
  const CRect before = r;
  if ((flags & SWP_NOMOVE) == 0) r = CRect(CPoint(x, y), r.Size());
  if ((flags & SWP_NOSIZE) == 0) r = CRect(r.TopLeft(), CSize(std::max(0, width), std::max(0, height)));
  w->rect = r;
  if (r != before) ++w->paint.moves;
  if ((flags & SWP_NOREDRAW) == 0 && r != before) ++w->paint.invalidations;
  const bool resized = r.Size() != before.Size();
  const bool moved = r.TopLeft() != before.TopLeft();
  if (resized) SendMessage(hwnd, WM_SIZE, SIZE_RESTORED, framework::detail::ClientSizeParam(hwnd));
  if (moved && IsWindow(hwnd)) SendMessage(hwnd, WM_MOVE, 0, MAKELPARAM(r.left, r.top));
  if ((flags & SWP_SHOWWINDOW) != 0) ShowWindow(hwnd, SW_SHOWNA);
  if ((flags & SWP_HIDEWINDOW) != 0) ShowWindow(hwnd, SW_HIDE);
  return TRUE;
}

BOOL ShowWindow(HWND hwnd, int command) {
  Window* w = Find(hwnd);
  if (w == nullptr) return FALSE;
  const bool wasVisible = (w->style & WS_VISIBLE) != 0;
  const bool show = command != SW_HIDE;
  if (show != wasVisible) {
    SendMessage(hwnd, WM_SHOWWINDOW, show ? TRUE : FALSE, 0);
    if ((w = Find(hwnd)) == nullptr) return wasVisible;
    if (show) {
      w->style |= WS_VISIBLE;
    } else {
      w->style &= ~WS_VISIBLE;
      framework::detail::DropFocusFrom(hwnd);
    }
    if (Window* parent = Find(w->parent)) ++parent->paint.invalidations;
  }
  const bool activate = command == SW_SHOW || command == SW_SHOWNORMAL;
  if (show && activate && !w->parent) SetActiveWindow(hwnd);
  return wasVisible;
}

BOOL IsWindowVisible(HWND hwnd) {
  if (!IsWindow(hwnd)) return FALSE;
  for (const Window* w = Find(hwnd); w != nullptr; w = Find(w->parent)) {
    if ((w->style & WS_VISIBLE) == 0) return FALSE;
  }
  return TRUE;
}

BOOL EnableWindow(HWND hwnd, BOOL enable) {
  Window* w = Find(hwnd);
  if (w == nullptr) return FALSE;
  const bool wasDisabled = (w->style & WS_DISABLED) != 0;
  if (wasDisabled == (enable == FALSE)) return wasDisabled;
  if (enable) {
    w->style &= ~WS_DISABLED;
  } else {
    w->style |= WS_DISABLED;
    framework::detail::DropFocusFrom(hwnd);
  }
  ++w->paint.invalidations;
  SendMessage(hwnd, WM_ENABLE, enable ? TRUE : FALSE, 0);
  return wasDisabled;
}

BOOL IsWindowEnabled(HWND hwnd) {
  const Window* w = Find(hwnd);
  return w != nullptr && (w->style & WS_DISABLED) == 0;
}

BOOL InvalidateRect(HWND hwnd, const RECT*, BOOL erase) {
  Window* w = Find(hwnd);
  if (w == nullptr) return FALSE;
  ++w->paint.invalidations;
  if (erase) ++w->paint.erases;
  return TRUE;
}

BOOL RedrawWindow(HWND hwnd, const RECT* rect, UINT flags) {
  Window* w = Find(hwnd);
  if (w == nullptr) return FALSE;
  ++w->paint.redraws;
  if ((flags & RDW_INVALIDATE) != 0) InvalidateRect(hwnd, rect, (flags & RDW_ERASE) != 0 ? TRUE : FALSE);
  if ((flags & RDW_ALLCHILDREN) != 0) {
    for (HWND child : std::vector<HWND>(w->children)) RedrawWindow(child, nullptr, flags);
  }
  return TRUE;
}

BOOL UpdateWindow(HWND hwnd) {
  Window* w = Find(hwnd);
  if (w == nullptr) return FALSE;
  ++w->paint.redraws;
  return TRUE;
}

HWND SetFocus(HWND hwnd) {
  auto& t = Table();
  if (hwnd && !IsWindow(hwnd)) return HWND();
  const HWND previous = t.focus;
  if (previous == hwnd) return previous;
  t.focus = hwnd;
  if (hwnd) t.active = framework::GetTopLevelWindow(hwnd);
  if (IsWindow(previous)) SendMessage(previous, WM_KILLFOCUS, hwnd.ToWParam(), 0);
  if (t.focus == hwnd && IsWindow(hwnd)) SendMessage(hwnd, WM_SETFOCUS, previous.ToWParam(), 0);
  return previous;
}

HWND GetFocus() { return IsWindow(Table().focus) ? Table().focus : HWND(); }

HWND SetActiveWindow(HWND hwnd) {
  auto& t = Table();
  const HWND previous = t.active;
  hwnd = framework::GetTopLevelWindow(hwnd);
  if (!hwnd) return previous;
  t.active = hwnd;
  framework::detail::RaiseTopLevel(hwnd);
  if (t.focus && framework::GetTopLevelWindow(t.focus) != hwnd) SetFocus(HWND());
  return previous;
}

HWND GetActiveWindow() { return IsWindow(Table().active) ? Table().active : HWND(); }

HWND SetCapture(HWND hwnd) {
  auto& t = Table();
  const HWND previous = t.capture;
  if (previous == hwnd) return previous;
  t.capture = hwnd;
  if (IsWindow(previous)) SendMessage(previous, WM_CAPTURECHANGED, 0, hwnd.ToLParam());
  return previous;
}

BOOL ReleaseCapture() {
  auto& t = Table();
  const HWND previous = std::exchange(t.capture, HWND());
  if (IsWindow(previous)) SendMessage(previous, WM_CAPTURECHANGED, 0, 0);
  return TRUE;
}

HWND GetCapture() { return IsWindow(Table().capture) ? Table().capture : HWND(); }
