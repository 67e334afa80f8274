// Window classes: each registered class name makes one behaviour object per window, which keeps
// the window's own state (a tree's items, an edit's caret) and answers its messages.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>

#include "framework/win_types.h"

// Class styles.
constexpr UINT CS_DBLCLKS = 0x0008;  // the class wants double-click messages

namespace framework {

// The window procedure of a class, one instance per window. Messages it does not handle go to
// DefWindowProc; painting is its WM_PAINT with the device context in wParam.
class WindowBehaviour {
 public:
  WindowBehaviour() = default;
  WindowBehaviour(const WindowBehaviour&) = delete;
  WindowBehaviour& operator=(const WindowBehaviour&) = delete;
  virtual ~WindowBehaviour() = default;

  virtual LRESULT Handle(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam);
  // Words for the state a picture of the window must show ("checked", "pushed"), separated
  // by blanks; the renderer adds the states every window has (disabled, focused).
  virtual std::string StateWords(HWND hwnd) const;
};

using BehaviourFactory = std::function<std::unique_ptr<WindowBehaviour>()>;

// Registers (or replaces) a class; answers false for an empty name.
bool RegisterWindowClass(std::string_view name, UINT classStyle, BehaviourFactory factory);
bool IsWindowClassRegistered(std::string_view name);
UINT GetClassStyle(std::string_view name);

// The behaviour object of a window when it is of the given type, else null: lets a control's
// wrapper and its geometry helpers reach the state its class keeps.
WindowBehaviour* GetWindowBehaviour(HWND hwnd);
template <class T>
T* BehaviourOf(HWND hwnd) {
  return dynamic_cast<T*>(GetWindowBehaviour(hwnd));
}

}  // namespace framework

// The system's default answer to every message a window does not handle itself.
LRESULT DefWindowProc(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam);
