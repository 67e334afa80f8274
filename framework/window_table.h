// The window records behind the handles, shared by the window system and the message queue.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "framework/window_class.h"
#include "framework/window_system.h"

namespace framework::detail {

struct Window {
  HWND handle;
  std::string className;
  UINT classStyle = 0;
  std::unique_ptr<WindowBehaviour> behaviour;
  std::string text;
  DWORD style = 0;
  DWORD exStyle = 0;
  int id = 0;
  RECT rect;  // relative to the parent's client area; screen pixels for a top-level window
  HWND parent;
  HWND owner;
  std::vector<HWND> children;  // stacking order, bottom first
  AttachedObject* object = nullptr;
  std::vector<std::pair<int, Interceptor>> interceptors;
  PaintCounters paint;
  bool destroying = false;
};

// The live record of a handle, or null. Never keep the pointer across a message: the handler
// may destroy the window.
Window* Find(HWND hwnd);

// The class behaviour of a window answers (or DefWindowProc for a window without one).
LRESULT CallBehaviour(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam);

// Hooks of the message queue that the window system calls on destruction.
void ForgetWindowTimers(HWND hwnd);

// A new behaviour object for a window of the class (null for a class without one).
std::unique_ptr<WindowBehaviour> MakeBehaviour(std::string_view className);

// Registers the classes the framework brings (buttons, edits, trees, ...) on first need.
void EnsureBuiltInClasses();

}  // namespace framework::detail
