// From input to messages: hit test, capture, activation, the close box, focus.
#include "framework/input.h"

#include <algorithm>
#include <utility>

#include "framework/geometry.h"
#include "framework/message_queue.h"
#include "framework/window_class.h"
#include "framework/window_system.h"

namespace framework::input {
namespace {

constexpr WPARAM kCloseCommand = 0xF060;  // SC_CLOSE

WPARAM& ButtonsDown() {
  static WPARAM buttons = 0;
  return buttons;
}

HWND& PressedCloseBox() {
  static HWND window;
  return window;
}

WPARAM ButtonFlag(MouseButton button) {
  switch (button) {
    case MouseButton::kRight:
      return MK_RBUTTON;
    case MouseButton::kMiddle:
      return MK_MBUTTON;
    default:
      return MK_LBUTTON;
  }
}

WPARAM KeyFlags() {
  WPARAM flags = ButtonsDown();
  if ((::GetKeyState(static_cast<int>(VK_SHIFT)) & 0x8000) != 0) flags |= MK_SHIFT;
  if ((::GetKeyState(static_cast<int>(VK_CONTROL)) & 0x8000) != 0) flags |= MK_CONTROL;
  return flags;
}

bool ToScreen(HWND topLevel, POINT point, POINT& screen) {
  RECT r;
  if (!::GetWindowRect(topLevel, &r)) return false;
  screen = {r.left + point.x, r.top + point.y};
  SetCursorPosition(screen);
  return true;
}

// The window the mouse acts on: the capturing window, else the one under the point if it
// takes input (windows disabled by a modal dialog do not).
HWND MouseTarget(POINT screen) {
  if (const HWND capture = ::GetCapture()) return capture;
  const HWND hit = WindowFromPoint(screen);
  return AcceptsInput(hit) ? hit : HWND();
}

// Whether a screen point lies on a top-level window's close box (the caption's right end).
bool OnCloseBox(HWND hwnd, POINT screen) {
  const DWORD style = ::GetWindowStyle(hwnd);
  if ((style & WS_CHILD) != 0 || (style & WS_CAPTION) != WS_CAPTION || (style & WS_SYSMENU) == 0) return false;
  RECT outer;
  ::GetWindowRect(hwnd, &outer);
  const RECT insets = NonClientInsets(style, ::GetWindowExStyle(hwnd));
  const CRect box(outer.right - insets.right - 22, outer.top + insets.left, outer.right - insets.right,
                  outer.top + insets.top);
  return box.PtInRect(screen);
}

bool InClientArea(HWND hwnd, POINT screen) {
  POINT local = screen;
  ::ScreenToClient(hwnd, &local);
  RECT client;
  ::GetClientRect(hwnd, &client);
  return CRect(client).PtInRect(local);
}

void Deliver(HWND target, UINT message, WPARAM wParam, POINT screen) {
  POINT local = screen;
  ::ScreenToClient(target, &local);
  PostInputMessage(target, message, wParam, MAKELPARAM(local.x, local.y));
  PumpPendingMessages();
}

// The press, release or double-click message of a button.
UINT ButtonMessage(MouseButton button, UINT offset) {
  UINT base = WM_LBUTTONDOWN;
  if (button == MouseButton::kRight) base = WM_RBUTTONDOWN;
  if (button == MouseButton::kMiddle) base = WM_MBUTTONDOWN;
  return base + offset;
}

constexpr UINT kPress = 0;
constexpr UINT kRelease = 1;
constexpr UINT kDoubleClick = 2;

HWND KeyTarget() {
  HWND target = ::GetFocus();
  if (!target) target = ::GetActiveWindow();
  return AcceptsInput(target) ? target : HWND();
}

void DeliverKey(UINT message, WPARAM wParam) {
  const HWND target = KeyTarget();
  if (!target) return;
  PostInputMessage(target, message, wParam, 1);
  PumpPendingMessages();
}

}  // namespace

void MouseMove(HWND topLevel, POINT point) {
  POINT screen;
  if (!ToScreen(topLevel, point, screen)) return;
  const HWND target = MouseTarget(screen);
  if (target && (::GetCapture() == target || InClientArea(target, screen))) {
    Deliver(target, WM_MOUSEMOVE, KeyFlags(), screen);
  }
}

void MouseDown(HWND topLevel, POINT point, MouseButton button, bool doubleClick) {
  POINT screen;
  if (!ToScreen(topLevel, point, screen)) return;
  ButtonsDown() |= ButtonFlag(button);
  const HWND target = MouseTarget(screen);
  if (!target) return;
  const HWND top = GetTopLevelWindow(target);
  if (::GetActiveWindow() != top && (::GetWindowExStyle(top) & WS_EX_TOOLWINDOW) == 0) ::SetActiveWindow(top);
  if (::GetCapture() != target && !InClientArea(target, screen)) {
    if (button == MouseButton::kLeft && OnCloseBox(target, screen)) PressedCloseBox() = target;
    return;
  }
  const bool wantsDouble = (GetClassStyle(::GetClassName(target)) & CS_DBLCLKS) != 0;
  Deliver(target, ButtonMessage(button, doubleClick && wantsDouble ? kDoubleClick : kPress), KeyFlags(), screen);
}

void MouseUp(HWND topLevel, POINT point, MouseButton button) {
  POINT screen;
  if (!ToScreen(topLevel, point, screen)) return;
  ButtonsDown() &= ~ButtonFlag(button);
  const HWND closing = std::exchange(PressedCloseBox(), HWND());
  const HWND target = MouseTarget(screen);
  if (!target) return;
  if (closing && closing == target && OnCloseBox(target, screen)) {
    PostInputMessage(target, WM_SYSCOMMAND, kCloseCommand, 0);
    PumpPendingMessages();
    return;
  }
  if (::GetCapture() == target || InClientArea(target, screen)) {
    Deliver(target, ButtonMessage(button, kRelease), KeyFlags(), screen);
  }
}

void KeyDown(UINT virtualKey) {
  SetKeyDown(virtualKey, true);
  DeliverKey(WM_KEYDOWN, virtualKey);
}

void KeyUp(UINT virtualKey) {
  SetKeyDown(virtualKey, false);
  DeliverKey(WM_KEYUP, virtualKey);
}

void Character(char character) { DeliverKey(WM_CHAR, static_cast<unsigned char>(character)); }

void Wait(DWORD milliseconds) {
  // Time passes in steps, so that a timer due within the wait runs at its time, not at the end.
  constexpr DWORD kStep = 10;
  for (DWORD waited = 0; waited < milliseconds; waited += kStep) {
    AdvanceClock(std::min(kStep, milliseconds - waited));
    PumpPendingMessages();
  }
}

}  // namespace framework::input
