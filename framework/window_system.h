// The window system: windows by handle with parent and children, control ids, class, text,
// styles, rectangles, visibility, enabling, focus, capture, hit tests and paint counters.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "framework/geometry.h"
#include "framework/win_constants.h"
#include "framework/win_messages.h"
#include "framework/win_styles.h"
#include "framework/win_types.h"

namespace framework {

// A framework object (a window class of the application) attached to a window: it sees every
// message first and may let the window's class answer.
class AttachedObject {
 public:
  virtual LRESULT WindowProcedure(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) = 0;
  // Offered a queued message before it is dispatched; true when the object consumed it.
  virtual bool PreTranslate(MSG& msg) = 0;

 protected:
  ~AttachedObject() = default;
};

// Attaches an object to a window (or detaches it with null); the previous one is answered.
AttachedObject* AttachObject(HWND hwnd, AttachedObject* object);
AttachedObject* GetAttachedObject(HWND hwnd);
// The next window created gets this object attached before its first message.
void AttachToNextWindow(AttachedObject* object);

// An interceptor sees every message sent to one window before the window does (a tool tip
// following the mouse over its tools, a tree's label editor taking Enter and Escape). It
// answers a result to consume the message, or nothing to let it through.
using Interceptor = std::function<std::optional<LRESULT>(HWND, UINT, WPARAM, LPARAM)>;
int InterceptMessages(HWND hwnd, Interceptor interceptor);  // answers a key, 0 for no window
void StopIntercepting(HWND hwnd, int key);

// Counters of painting requests, so that tests can see what a handler asked to be redrawn.
struct PaintCounters {
  int invalidations = 0;  // InvalidateRect and RedrawWindow with RDW_INVALIDATE
  int erases = 0;         // the invalidations that asked for the background to be erased
  int redraws = 0;        // RedrawWindow and UpdateWindow calls
  int moves = 0;          // position or size changes
};
PaintCounters GetPaintCounters(HWND hwnd);

// Every live window, top-level and child, counted; tests compare it before and after.
std::size_t LiveWindowCount();
// The top-level windows from the bottom of the stacking order to the top.
std::vector<HWND> TopLevelWindows();
// The children of a window in stacking order, from the bottom (created first) to the top.
std::vector<HWND> GetChildren(HWND hwnd);
// The window hit by a point of the screen, deepest child first; transparent windows (group
// boxes, labels, a tab control away from its tabs) let the point through to what lies below.
HWND WindowFromPoint(POINT screen);
// The outermost window above a child (the window itself when it has no parent).
HWND GetTopLevelWindow(HWND hwnd);
// Whether the window and all its ancestors accept input (enabled, visible).
bool AcceptsInput(HWND hwnd);
// The frame widths a window's styles give it, and the caption height, in pixels.
RECT NonClientInsets(DWORD style, DWORD exStyle);

}  // namespace framework

HWND CreateWindowEx(DWORD exStyle, std::string_view className, std::string_view text, DWORD style, int x, int y,
                    int width, int height, HWND parent, int id, LPARAM createParam = 0);
BOOL DestroyWindow(HWND hwnd);
BOOL IsWindow(HWND hwnd);

// Relations.
HWND GetParent(HWND hwnd);  // the parent of a child, the owner of a popup
HWND GetWindow(HWND hwnd, UINT relation);
HWND GetDlgItem(HWND dialog, int id);
int GetDlgCtrlID(HWND hwnd);
void SetDlgCtrlID(HWND hwnd, int id);
BOOL IsChild(HWND parent, HWND hwnd);
std::string GetClassName(HWND hwnd);

// Text (through WM_SETTEXT and WM_GETTEXT, so a control may answer for its own).
BOOL SetWindowText(HWND hwnd, std::string_view text);
std::string GetWindowText(HWND hwnd);
int GetWindowTextLength(HWND hwnd);
BOOL SetDlgItemText(HWND dialog, int id, std::string_view text);
std::string GetDlgItemText(HWND dialog, int id);

// Styles.
DWORD GetWindowStyle(HWND hwnd);
DWORD GetWindowExStyle(HWND hwnd);
void SetWindowStyle(HWND hwnd, DWORD style);
void SetWindowExStyle(HWND hwnd, DWORD exStyle);

// Geometry: window rectangles in screen pixels; a child's position is kept relative to its
// parent's client area.
BOOL GetWindowRect(HWND hwnd, RECT* rect);
BOOL GetClientRect(HWND hwnd, RECT* rect);
BOOL ClientToScreen(HWND hwnd, POINT* point);
BOOL ScreenToClient(HWND hwnd, POINT* point);
// Maps points from one window's client area to another's; a null handle stands for the screen.
void MapWindowPoints(HWND from, HWND to, POINT* points, UINT count);
BOOL MoveWindow(HWND hwnd, int x, int y, int width, int height, BOOL repaint);
BOOL SetWindowPos(HWND hwnd, int x, int y, int width, int height, UINT flags);

// Visibility and enabling.
BOOL ShowWindow(HWND hwnd, int command);  // answers whether it was visible before
BOOL IsWindowVisible(HWND hwnd);          // the window and every ancestor are visible
BOOL EnableWindow(HWND hwnd, BOOL enable);  // answers whether it was disabled before
BOOL IsWindowEnabled(HWND hwnd);

// Painting requests (counted; the picture itself is made on demand by the renderer).
BOOL InvalidateRect(HWND hwnd, const RECT* rect, BOOL erase);
BOOL RedrawWindow(HWND hwnd, const RECT* rect, UINT flags);
BOOL UpdateWindow(HWND hwnd);

// Keyboard focus, the active top-level window and mouse capture.
HWND SetFocus(HWND hwnd);  // answers the window that had the focus
HWND GetFocus();
HWND SetActiveWindow(HWND hwnd);
HWND GetActiveWindow();
HWND SetCapture(HWND hwnd);
BOOL ReleaseCapture();
HWND GetCapture();

// Screen metrics and colours of this window system.
int GetSystemMetrics(int index);
COLORREF GetSysColor(int index);
